// A simulation on a clock of its own: a capture is played tick by tick, as fast as the machine can.
#pragma once

#include "engine/light_commands.h"
#include "engine/render_cycle.h"
#include "link/capture_file.h"
#include "programs/tool/tool_document.h"

#include <functional>

// The clock's reading at entry into simulation, which is t = 0.
inline constexpr std::int32_t kVirtualStartMs = 100'000;

class VirtualRun {
public:
    // engine: "standard" or "opengl".
    VirtualRun(CompiledDocument& display, Capture capture, const std::string& engine, std::uint64_t seed);

    // Runs ticks until t passes `until`. After each one that drew a frame onFrame(t) is called; false from it ends the
    // run.
    void run(std::int32_t until, LightSurface& surface, const std::function<bool(std::int32_t)>& onFrame);

    // Time from one tick to the next, each of which draws a frame; the first tick is at t = tickMs.
    std::int32_t tickMs() const { return engine_ == kEngineOpenGL ? kOpenGLFrameMs : kStandardFrameMs; }
    const ZephDimmingCurve& curve() const { return curve_; }

private:
    CompiledDocument& display_;
    Capture capture_;
    int engine_;
    SeededRandom random_;
    ZephDimmingCurve curve_{};
};
