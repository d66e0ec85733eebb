#include "programs/tool/render_command.h"

#include "programs/tool/frame_sink.h"
#include "programs/tool/render_studio.h"
#include "programs/tool/virtual_run.h"

#include <cstdio>

namespace {

// The time of film picture n, from 0, in ms.
std::int32_t filmTime(const ToolOptions& options, std::int64_t n) {
    return static_cast<std::int32_t>(*options.from + n * 1000 / options.fps);
}

std::int64_t filmLength(const ToolOptions& options) {
    return (std::int64_t{*options.to} - *options.from) * options.fps / 1000 + 1;
}

bool renderPicture(const ToolOptions& options, RenderStudio& studio, VirtualRun& run) {
    bool written = false;
    studio.expectPicture(run.tickMs() >= *options.at);
    run.run(*options.at + kOpenGLFrameMs, studio.surface(), [&](std::int32_t t) {
        studio.expectPicture(t + run.tickMs() >= *options.at);
        if (t < *options.at) return true;
        written = studio.picture().save(QString::fromLocal8Bit(options.out.c_str()));
        return false;
    });
    if (!written) std::fprintf(stderr, "zeph-tool: the picture %s cannot be written\n", options.out.c_str());
    return written;
}

bool renderFilm(const ToolOptions& options, RenderStudio& studio, VirtualRun& run) {
    const std::int64_t pictures = filmLength(options);
    const std::unique_ptr<FrameSink> sink = openFrameSink(options.out, studio.size(), options.fps);
    ProgressBar progress(pictures);
    std::int64_t next = 0;
    studio.expectPicture(run.tickMs() >= *options.from);
    run.run(*options.to + kOpenGLFrameMs, studio.surface(), [&](std::int32_t t) {
        // A film faster than the frames shows a frame more than once.
        for (; next < pictures && filmTime(options, next) <= t; ++next) {
            sink->add(studio.picture());
            progress.show(next + 1);
        }
        studio.expectPicture(next < pictures && t + run.tickMs() >= filmTime(options, next));
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
    const std::unique_ptr<RenderStudio> studio = openRenderStudio(options.engine, display, run.curve());
    if (!studio) return 1;
    return (options.at ? renderPicture(options, *studio, run) : renderFilm(options, *studio, run)) ? 0 : 1;
}
