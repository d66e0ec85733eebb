#include "programs/tool/render_command.h"

#include "editor/background.h"
#include "engine/standard_surface.h"
#include "programs/tool/frame_sink.h"
#include "programs/tool/virtual_run.h"

#include <QCoreApplication>

#include <algorithm>
#include <cstdio>

namespace {

// What a simulation is drawn with, made once from the compiled display.
struct Studio {
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    QImage background;
    StandardSurface surface;

    bool prepare(CompiledDocument& display, const ZephDimmingCurve& curve) {
        ToolDocument& document = *display.document;
        ZephSetUpMasks(
            curve, [](std::string_view) {}, *masks);
        ZephRebuildStaticFixtureBulbs(*document.simulation, *masks, *bulbs);
        background = ZephResetBackground(*document.simulation, QCoreApplication::applicationDirPath().toStdString(),
                                         document.host);
        return surface.prepare({*document.simulation, display.tables, *display.states, *masks, *bulbs, background},
                               document.failures);
    }
};

// The time of film picture n, from 0, in ms.
std::int32_t filmTime(const ToolOptions& options, std::int64_t n) {
    return static_cast<std::int32_t>(*options.from + n * 1000 / options.fps);
}

std::int64_t filmLength(const ToolOptions& options) {
    return (std::int64_t{*options.to} - *options.from) * options.fps / 1000 + 1;
}

bool renderPicture(const ToolOptions& options, Studio& studio, VirtualRun& run) {
    bool written = false;
    run.run(*options.at + kOpenGLFrameMs, studio.surface, [&](std::int32_t t) {
        if (t < *options.at) return true;
        written = studio.surface.image().save(QString::fromLocal8Bit(options.out.c_str()));
        return false;
    });
    if (!written) std::fprintf(stderr, "zeph-tool: the picture %s cannot be written\n", options.out.c_str());
    return written;
}

bool renderFilm(const ToolOptions& options, Studio& studio, VirtualRun& run) {
    const std::int64_t pictures = filmLength(options);
    const std::unique_ptr<FrameSink> sink = openFrameSink(options.out, studio.surface.image().size(), options.fps);
    ProgressBar progress(pictures);
    std::int64_t next = 0;
    run.run(*options.to + kOpenGLFrameMs, studio.surface, [&](std::int32_t t) {
        // A film faster than the frames shows a frame more than once.
        for (; next < pictures && filmTime(options, next) <= t; ++next) {
            sink->add(studio.surface.image());
            progress.show(next + 1);
        }
        return next < pictures;
    });
    sink->finish();
    return true;
}

}  // namespace

int runRender(const ToolOptions& options) {
    CompiledDocument display = compileToolDocument(options.file);
    if (!display.ok()) return 1;
    VirtualRun run(display, loadCapture(options.capture), options.engine, options.seed);
    Studio studio;
    if (!studio.prepare(display, run.curve())) return 1;
    return (options.at ? renderPicture(options, studio, run) : renderFilm(options, studio, run)) ? 0 : 1;
}
