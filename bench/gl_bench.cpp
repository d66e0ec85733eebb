// The OpenGL surface at the limit document: the processor's part of a frame, without what the driver does after, beside
// sending every corner anew; and whole frames on this machine's driver, beside a call for each bulb.
#include "bench/bench_display.h"
#include "bench/bench_report.h"
#include "engine/gl_offscreen.h"
#include "engine/gl_programs.h"
#include "engine/opengl_surface.h"
#include "model/dimming_curve.h"
#include "tests/support/limit_document.h"

#include <cstdio>
#include <memory>

namespace {

constexpr int kRuns = 41;
constexpr int kPeerRuns = 3;
constexpr double kGoalMicroseconds = 3000;

struct PrintedFailures : FailureReport {
    void ErrReport(std::string_view description, std::string_view, int) override {
        std::fprintf(stderr, "bench: %.*s\n", static_cast<int>(description.size()), description.data());
    }
};

struct Scene : BenchDisplay {
    std::unique_ptr<ZephGLShapes> shapes = std::make_unique<ZephGLShapes>();
    ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    std::vector<ChannelDraw> draws;  // in the order of painting

    Scene() {
        buildLimitDocument(*simulation);
        compile();
        ZephGLCreateShapes(*shapes);
        for (std::int32_t n = 1; n <= simulation->FixtureCount; ++n) {
            const ZephFixture& fixture = simulation->Fixtures[n];
            for (std::int32_t c = 1; c <= fixture.ChannelCount; ++c)
                draws.push_back({fixture.ZOrder, n, c});
        }
        std::ranges::stable_sort(draws, {}, &ChannelDraw::Level);
    }

    // Every channel at a level of its own that moves on with each frame; one in `step` is lit.
    void setLevels(std::uint32_t frame, std::uint32_t step) {
        for (std::uint32_t i = 0; i < draws.size(); ++i)
            draws[i].Alpha = i % step == 0 ? static_cast<std::uint8_t>(40 + (i * 7 + frame * 13) % 216) : 0;
    }

    void note(OpenGLSurface& surface) const {
        surface.beginFrame();
        for (const ChannelDraw& draw : draws) {
            if (draw.Alpha != 0) surface.drawChannel(draw);
        }
    }

    // visit(bulb, colour with alpha) in the order of painting.
    template <typename Visit>
    void forEachBulb(Visit visit) const {
        for (const ChannelDraw& draw : draws) {
            const ZephBulbLocations& bulbs = *bulbLocations((*states)[draw.Fixture], draw.Channel);
            const auto color =
                static_cast<std::uint32_t>(simulation->Fixtures[draw.Fixture].Channels[draw.Channel].Color) |
                std::uint32_t{draw.Alpha} << 24;
            for (std::int32_t b = 0; b < bulbs.Count; ++b)
                visit(tables.BulbPool[static_cast<std::size_t>(bulbs.First + b)], color);
        }
    }
};

double processorPart(Scene& scene, OpenGLSurface& surface, std::uint32_t step) {
    std::uint32_t frame = 0;
    std::vector<double> times;
    for (int run = 0; run < kRuns; ++run) {
        scene.setLevels(++frame, step);
        times.push_back(microsecondsOf([&] {
            scene.note(surface);
            surface.handOver();
        }));
        surface.endFrame();  // outside the clock: the driver draws
    }
    return medianOf(std::move(times));
}

double wholeFrame(Scene& scene, OpenGLSurface& surface, std::uint32_t step) {
    std::uint32_t frame = 0;
    return medianMicroseconds(
        kPeerRuns, [&] { scene.setLevels(++frame, step); },
        [&] {
            scene.note(surface);
            surface.endFrame();  // off screen it waits for the last pixel
        });
}

// What a program does that keeps nothing on the GPU: all corners of all bulbs, each with its colour, for every frame.
double everyCornerAnew(Scene& scene, GLOffscreen& target) {
    struct ColoredCorner {
        std::int16_t X;
        std::int16_t Y;
        std::uint32_t Color;
    };
    const GLApi api = loadGLApi([&](const char* name) { return target.resolve(name); });
    const GLFill& fill = *fillOf(*scene.shapes, 1, scene.simulation->Fixtures[1].BulbSize);
    std::vector<ColoredCorner> corners;
    GLuint buffer = 0;
    api.GenBuffers(1, &buffer);
    api.BindBuffer(GL_ARRAY_BUFFER, buffer);
    std::uint32_t frame = 0;
    const double time = medianMicroseconds(
        kPeerRuns, [&] { scene.setLevels(++frame, 1); },
        [&] {
            corners.clear();
            scene.forEachBulb([&](const ZephBulbLocation& bulb, std::uint32_t color) {
                for (const ShapeVertex& corner : fill.Corners) {
                    corners.push_back({static_cast<std::int16_t>(bulb.X + corner.X),
                                       static_cast<std::int16_t>(bulb.Y + corner.Y), color});
                }
            });
            api.BufferData(GL_ARRAY_BUFFER, static_cast<GLsizeiptr>(corners.size() * sizeof(ColoredCorner)),
                           corners.data(), GL_STREAM_DRAW);
        });
    api.DeleteBuffers(1, &buffer);
    return time;
}

// What drawing call by call costs: each bulb's place and colour as constant attributes, and a call for its triangles.
double oneCallABulb(Scene& scene, GLOffscreen& target) {
    const GLApi api = loadGLApi([&](const char* name) { return target.resolve(name); });
    const auto setPlace = reinterpret_cast<PFNGLVERTEXATTRIB2FPROC>(target.resolve("glVertexAttrib2f"));
    const auto setColor = reinterpret_cast<PFNGLVERTEXATTRIB4NUBPROC>(target.resolve("glVertexAttrib4Nub"));
    const auto drawElements = reinterpret_cast<decltype(&glDrawElements)>(target.resolve("glDrawElements"));
    const GLFill& fill = *fillOf(*scene.shapes, 1, scene.simulation->Fixtures[1].BulbSize);
    const GLuint program = makeProgram(api, kListSource);
    std::array<GLuint, 2> buffers{};
    GLuint array = 0;
    api.GenVertexArrays(1, &array);
    api.BindVertexArray(array);
    api.GenBuffers(2, buffers.data());
    api.BindBuffer(GL_ARRAY_BUFFER, buffers[0]);
    api.BufferData(GL_ARRAY_BUFFER, static_cast<GLsizeiptr>(fill.Corners.size() * sizeof(ShapeVertex)),
                   fill.Corners.data(), GL_STATIC_DRAW);
    api.EnableVertexAttribArray(kPlaceAttribute);
    api.VertexAttribPointer(kPlaceAttribute, 2, GL_INT, GL_FALSE, sizeof(ShapeVertex), nullptr);
    api.BindBuffer(GL_ELEMENT_ARRAY_BUFFER, buffers[1]);
    api.BufferData(GL_ELEMENT_ARRAY_BUFFER, static_cast<GLsizeiptr>(fill.Triangles.size()), fill.Triangles.data(),
                   GL_STATIC_DRAW);
    api.UseProgram(program);
    api.Uniform2f(api.GetUniformLocation(program, "view"), 2.0F / kMaxCanvasPixels, 2.0F / kMaxCanvasPixels);
    std::uint32_t frame = 0;
    const double time = medianMicroseconds(
        1, [&] { scene.setLevels(++frame, 1); },
        [&] {
            api.Clear(GL_COLOR_BUFFER_BIT);
            scene.forEachBulb([&](const ZephBulbLocation& bulb, std::uint32_t color) {
                setPlace(kCentreAttribute, static_cast<float>(bulb.X), static_cast<float>(bulb.Y));
                setColor(kColorAttribute, static_cast<GLubyte>(color), static_cast<GLubyte>(color >> 8),
                         static_cast<GLubyte>(color >> 16), static_cast<GLubyte>(color >> 24));
                drawElements(GL_TRIANGLES, static_cast<GLsizei>(fill.Triangles.size()), GL_UNSIGNED_BYTE, nullptr);
            });
            api.Finish();
        });
    api.DeleteProgram(program);
    api.DeleteBuffers(2, buffers.data());
    api.DeleteVertexArrays(1, &array);
    return time;
}

void goalOf(const std::string& figure, bool met, BenchReport& report) {
    report.goal("gl-frame-cpu", figure, "3 ms", met);
}

}  // namespace

void benchGL(BenchReport& report) {
    std::unique_ptr<GLOffscreen> target;
    try {
        target = std::make_unique<GLOffscreen>(kMaxCanvasPixels, kMaxCanvasPixels);
    } catch (const Failure& failure) {
        std::fprintf(stderr, "bench: %s\n", failure.what());
        goalOf("no context", false, report);
        return;
    }
    Scene scene;
    PrintedFailures failures;
    OpenGLSurface surface;
    const QImage picture;
    if (!surface.ZephGLStartup({*scene.simulation, scene.tables, *scene.states, scene.curve, *scene.shapes, picture, 20,
                                kMaxCanvasPixels, kMaxCanvasPixels},
                               *target, failures)) {
        goalOf("no context", false, report);
        return;
    }
    const double ours = processorPart(scene, surface, 1);
    const std::string group = "OpenGL, the processor's part of a frame: 262,144 bulbs, all lit";
    report.row(group, "OpenGL surface", ours);
    report.row(group, "OpenGL surface, one channel in ten", processorPart(scene, surface, 10));
    report.row(group, "every corner with its colour sent anew", everyCornerAnew(scene, *target));

    const std::string whole = "OpenGL, the whole frame to its last pixel (" + target->renderer() + ")";
    report.row(whole, "OpenGL surface, all lit", wholeFrame(scene, surface, 1));
    report.row(whole, "OpenGL surface, one channel in ten", wholeFrame(scene, surface, 10));
    report.row(whole, "a call for each bulb, all lit", oneCallABulb(scene, *target));
    surface.release();

    char figure[32];
    std::snprintf(figure, sizeof figure, "%.2f ms", ours / 1000);
    goalOf(figure, ours <= kGoalMicroseconds, report);
}
