// One whole frame on the standard surface, background restored, beside what a user could take instead: QPainter and
// pixman drawing the same images at the same opacities, and a plain loop over pixels. Levels change in every frame.
#include "bench/bench_display.h"
#include "bench/bench_report.h"
#include "bench/peers.h"
#include "engine/standard_surface.h"
#include "tests/support/fixtures.h"
#include "tests/support/limit_document.h"
#include "tests/support/masks.h"
#include "util/color.h"
#include "util/random_source.h"

#include <QPainter>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>

namespace {

constexpr int kRuns = 41;
constexpr int kPeerRuns = 7;

class StopOnFailure : public FailureReport {
public:
    void ErrReport(std::string_view description, std::string_view, int) override {
        std::fprintf(stderr, "bench: %.*s\n", static_cast<int>(description.size()), description.data());
        std::exit(1);
    }
};

std::string shown(const char* format, double value) {
    char text[64];
    std::snprintf(text, sizeof text, format, value);
    return text;
}

QImage gradient() {
    QImage picture(kMaxCanvasPixels, kMaxCanvasPixels, QImage::Format_RGB32);
    for (int y = 0; y < picture.height(); ++y) {
        auto* row = reinterpret_cast<std::uint32_t*>(picture.scanLine(y));
        for (int x = 0; x < picture.width(); ++x) {
            row[x] = 0xFF000000U | static_cast<std::uint32_t>(x * 11 + y * 7) * 2654435761U >> 8;
        }
    }
    return picture;
}

// A document of plain channels made ready to draw, for the surface and for its peers alike.
struct Scene : BenchDisplay {
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    QImage background = gradient();

    struct Channel {
        ChannelDraw draw;
        ZephBulbLocations places;
        std::int32_t radius;
        QImage picture;
    };
    std::vector<Channel> channels;

    void finish() {
        compile();
        ZephRebuildStaticFixtureBulbs(*simulation, masks(), *bulbs);
        for (std::int32_t n = 1; n <= simulation->FixtureCount; ++n) {
            const ZephFixture& fixture = simulation->Fixtures[n];
            if (fixture.Channel_Type == kChannelRgb) continue;
            for (std::int32_t c = 1; c <= fixture.ChannelCount; ++c) {
                const auto slot = static_cast<std::size_t>(c);
                channels.push_back({{fixture.ZOrder, n, c},
                                    (*states)[n].BulbLocations[slot],
                                    fixture.BulbSize,
                                    asPicture((*bulbs)[n].Bulb[slot])});
            }
        }
        // Frames are painted level by level.
        std::ranges::stable_sort(channels, {}, [](const Channel& channel) { return channel.draw.Level; });
    }

    // Every channel at a level of its own that moves on with each frame; one in `step` is lit.
    void setLevels(std::uint32_t frame, std::uint32_t step) {
        for (std::uint32_t i = 0; i < channels.size(); ++i) {
            const bool lit = i * 2654435761U / step * step == i * 2654435761U || step == 1;
            channels[i].draw.Alpha = lit ? static_cast<std::uint8_t>(40 + (i * 7 + frame * 13) % 216) : 0;
        }
    }

    SurfaceScene surfaceScene() const { return {*simulation, tables, *states, masks(), *bulbs, background}; }
};

double surfaceFrame(Scene& scene, std::uint32_t step) {
    StopOnFailure failures;
    StandardSurface surface;
    if (!surface.prepare(scene.surfaceScene(), failures)) return 0;
    std::uint32_t frame = 0;
    return medianMicroseconds(
        kRuns, [&] { scene.setLevels(++frame, step); },
        [&] {
            surface.beginFrame();
            for (const Scene::Channel& channel : scene.channels) {
                if (channel.draw.Alpha != 0) surface.drawChannel(channel.draw);
            }
            surface.endFrame();
        });
}

// visit(channel, x, y): the upper left corner of each lit bulb, in the order of painting.
template <typename Visit>
void forEachLitBulb(const Scene& scene, Visit visit) {
    for (const Scene::Channel& channel : scene.channels) {
        if (channel.draw.Alpha == 0) continue;
        for (std::int32_t b = 0; b < channel.places.Count; ++b) {
            const ZephBulbLocation& bulb = scene.tables.BulbPool[static_cast<std::size_t>(channel.places.First + b)];
            visit(channel, bulb.X - channel.radius, bulb.Y - channel.radius);
        }
    }
}

double painterFrame(Scene& scene) {
    QImage canvas = scene.background.copy();
    std::uint32_t frame = 0;
    return medianMicroseconds(
        kPeerRuns, [&] { scene.setLevels(++frame, 1); },
        [&] {
            QPainter painter(&canvas);
            painter.setCompositionMode(QPainter::CompositionMode_Source);
            painter.drawImage(0, 0, scene.background);
            painter.setCompositionMode(QPainter::CompositionMode_SourceOver);
            std::uint8_t alpha = 255;
            forEachLitBulb(scene, [&](const Scene::Channel& channel, std::int32_t x, std::int32_t y) {
                if (channel.draw.Alpha != alpha) painter.setOpacity((alpha = channel.draw.Alpha) / 255.0);
                painter.drawImage(x, y, channel.picture);
            });
        });
}

double pixmanFrame(Scene& scene) {
    QImage canvasPixels = scene.background.copy();
    QImage backgroundPixels = scene.background.copy();
    const PixmanImage canvas = pixmanView(canvasPixels, PIXMAN_x8r8g8b8);
    const PixmanImage background = pixmanView(backgroundPixels, PIXMAN_x8r8g8b8);
    std::vector<PixmanImage> sprites;
    for (Scene::Channel& channel : scene.channels)
        sprites.push_back(pixmanView(channel.picture, PIXMAN_a8r8g8b8));
    const std::vector<PixmanImage> opacities = pixmanOpacities();
    std::uint32_t frame = 0;
    return medianMicroseconds(
        kPeerRuns, [&] { scene.setLevels(++frame, 1); },
        [&] {
            pixman_image_composite32(PIXMAN_OP_SRC, background.get(), nullptr, canvas.get(), 0, 0, 0, 0, 0, 0,
                                     canvasPixels.width(), canvasPixels.height());
            forEachLitBulb(scene, [&](const Scene::Channel& channel, std::int32_t x, std::int32_t y) {
                const auto index = static_cast<std::size_t>(&channel - scene.channels.data());
                pixman_image_composite32(PIXMAN_OP_OVER, sprites[index].get(), opacities[channel.draw.Alpha].get(),
                                         canvas.get(), 0, 0, 0, 0, x, y, 2 * channel.radius, 2 * channel.radius);
            });
        });
}

double loopFrame(Scene& scene) {
    QImage canvas = scene.background.copy();
    std::uint32_t frame = 0;
    return medianMicroseconds(
        kPeerRuns, [&] { scene.setLevels(++frame, 1); },
        [&] {
            std::copy_n(scene.background.constBits(), scene.background.sizeInBytes(), canvas.bits());
            forEachLitBulb(scene, [&](const Scene::Channel& channel, std::int32_t left, std::int32_t top) {
                blendPlainly(channel.picture, channel.draw.Alpha, left, top, canvas);
            });
        });
}

struct PeerTimes {
    double ours = 0;
    double painter = 0;
    double pixman = 0;
};

PeerTimes besidePeers(const std::string& group, Scene& scene, BenchReport& report) {
    PeerTimes times;
    times.ours = surfaceFrame(scene, 1);
    report.row(group, "standard surface", times.ours);
    times.painter = painterFrame(scene);
    report.row(group, "QPainter, drawImage with opacity", times.painter);
    times.pixman = pixmanFrame(scene);
    report.row(group, "pixman, OVER with a constant mask", times.pixman);
    report.row(group, "plain loop over pixels", loopFrame(scene));
    return times;
}

// The limit document's light strings lie in rows, which is kind to the memory of everyone; scattered over the canvas
// its bulbs are not, and that is what the goals are about.
void scatter(Scene& scene) {
    SeededRandom random(3);
    for (ZephBulbLocation& bulb : scene.tables.BulbPool) {
        bulb.X = ZephReturnRandomNumber(0, kMaxCanvasPixels - 1, random);
        bulb.Y = ZephReturnRandomNumber(0, kMaxCanvasPixels - 1, random);
    }
}

void benchThin(const std::string& layout, Scene& scene, double& tenth, double& hundredth, BenchReport& report) {
    tenth = surfaceFrame(scene, 10);
    hundredth = surfaceFrame(scene, 100);
    report.row("Frame of the same " + layout + ", thinly lit", "one channel in ten", tenth);
    report.row("Frame of the same " + layout + ", thinly lit", "one channel in a hundred", hundredth);
}

void benchLimit(BenchReport& report) {
    Scene scene;
    buildLimitDocument(*scene.simulation);
    scene.finish();
    double tenth = 0;
    double hundredth = 0;
    besidePeers("Frame of 262,144 round bulbs of size 2 in rows, all lit", scene, report);
    benchThin("in rows", scene, tenth, hundredth, report);

    scatter(scene);
    const PeerTimes all = besidePeers("Frame of 262,144 round bulbs of size 2 scattered, all lit", scene, report);
    report.goal("frame-limit",
                shown("%.2f ms", all.ours / 1000) + shown(", QPainter x %.1f", all.painter / all.ours) +
                    shown(", pixman x %.1f", all.pixman / all.ours),
                "4.5 ms, QPainter x 20, pixman x 15",
                all.ours <= 4500 && all.painter >= 20 * all.ours && all.pixman >= 15 * all.ours);
    benchThin("scattered", scene, tenth, hundredth, report);
    report.goal("frame-tenth", shown("%.2f ms", tenth / 1000), "1.2 ms", tenth <= 1200);
    report.goal("frame-hundredth", shown("%.3f ms", hundredth / 1000), "0.2 ms", hundredth <= 200);
}

void benchBigBulbs(BenchReport& report) {
    Scene scene;
    buildLimitDocument(*scene.simulation, {.bulbSize = 8});
    scene.finish();
    scatter(scene);
    const PeerTimes all = besidePeers("Frame of 262,144 round bulbs of size 8 scattered, all lit", scene, report);
    report.goal("frame-big-bulbs", shown("QPainter x %.1f", all.painter / all.ours), "QPainter x 9",
                all.painter >= 9 * all.ours);
}

void benchFloods(BenchReport& report) {
    Scene scene;
    for (std::int32_t n = 0; n < 64; ++n) {
        ZephFixture& flood = addFixture(*scene.simulation, kFixtureFlood, {{150 + n % 8 * 300, 150 + n / 8 * 300}});
        flood.BulbSize = 64;
        addChannel(flood, 1 + n, 1, packColor(255, 4 * n + 3, 90));
    }
    scene.finish();
    const PeerTimes all = besidePeers("Frame of 64 floods of size 64", scene, report);
    report.goal("frame-floods", shown("QPainter x %.2f", all.painter / all.ours), "QPainter x 1.15",
                all.painter >= 1.15 * all.ours);
}

void benchRibbons(BenchReport& report) {
    Scene scene;
    buildLimitDocument(*scene.simulation, {.points = 50, .channels = 0, .fixtureType = kFixtureKesh});
    for (std::int32_t n = 1; n <= scene.simulation->FixtureCount; ++n) {
        ZephFixture& ribbon = scene.simulation->Fixtures[n];
        ribbon.Channel_Type = kChannelRgb;
        ribbon.Kesh.Network = (n - 1) / 240;
        ribbon.Kesh.Base_Unit = (n - 1) % 240 + 1;
    }
    scene.finish();
    StopOnFailure failures;
    StandardSurface surface;
    if (!surface.prepare(scene.surfaceScene(), failures)) return;
    SeededRandom random(7);
    std::vector<GroupDraw> draws;
    const auto groups = static_cast<std::int32_t>(scene.tables.RGBData.size()) - 1;
    std::vector<std::int32_t> bulb(51);
    for (std::int32_t b = 1; b <= 50; ++b)
        bulb[static_cast<std::size_t>(b)] = b;
    for (std::int32_t g = 1; g <= groups; ++g) {
        const std::int32_t triplet = scene.tables.RGBData[static_cast<std::size_t>(g)].Key % 1000;
        draws.push_back({1, scene.tables.RGBData[static_cast<std::size_t>(g)].Key / 1000, g, triplet, 0, 0,
                         &bulb[static_cast<std::size_t>(triplet)], 1});
    }
    const auto newColors = [&] {
        for (GroupDraw& draw : draws) {
            ZephRGBData& group = scene.tables.RGBData[static_cast<std::size_t>(draw.RGBIndex)];
            for (std::size_t c = 1; c <= 3; ++c)
                group.Level[c] = (group.Level[c] + 90) % 256;
            draw.Color = ZephReturnRandomNumber(1, kWhite, random);
            draw.Alpha = static_cast<std::uint8_t>(ZephReturnRandomNumber(40, 255, random));
        }
    };
    const double time = medianMicroseconds(kRuns, newColors, [&] {
        surface.beginFrame();
        for (const GroupDraw& draw : draws) {
            surface.drawGroup(draw, scene.tables.RGBData[static_cast<std::size_t>(draw.RGBIndex)]);
        }
        surface.endFrame();
    });
    report.row("Frame of 1024 ribbons of 50 pixels, every colour new", "standard surface", time);
    report.goal("frame-rgb", shown("%.2f ms", time / 1000), "6 ms", time <= 6000);
}

}  // namespace

void benchFrame(BenchReport& report) {
    benchLimit(report);
    benchBigBulbs(report);
    benchFloods(report);
    benchRibbons(report);
}

void benchMasks(BenchReport& report) {
    const ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    const auto made = std::make_unique<ZephMasks>();
    const auto quietly = [](std::string_view) {};
    const double time = medianMicroseconds(
        11, [&] { *made = {}; }, [&] { ZephSetUpMasks(curve, quietly, *made); });
    report.row("All masks, shapes and floods", "at start-up", time);
    report.goal("masks", shown("%.1f ms", time / 1000), "60 ms", time <= 60000);
}
