// The render cycle: one pass brings every running command up to date and draws what is lit, level by level; the
// supervisors decide when a pass is due.
#pragma once

#include "engine/render_context.h"
#include "util/clock.h"
#include "util/host.h"

#include <functional>

inline constexpr int kEngineStandard = 1;
inline constexpr int kEngineOpenGL = 2;
inline constexpr std::int32_t kStandardFrameMs = 9;
inline constexpr std::int32_t kOpenGLFrameMs = 15;

// One render pass at the clock reading of the frame. Nothing in it allocates, logs or reads a clock.
void ZephRenderLights(std::int32_t nowMs, RenderContext& context);

// What a supervisor needs around the pass.
struct FrameServices {
    const Clock& clock;
    Host& host;
    // Turns the level dumps that have arrived into commands.
    const std::function<void()>& expandDumps;
    // Shows a finished frame.
    const std::function<void()>& frameDone;
};

// Pacing. Gives true where a frame was rendered.
bool ZephRenderingSupervisor(bool force, const FrameServices& services, RenderContext& context);
bool ZephRenderingSupervisorGL(const FrameServices& services, RenderContext& context);

// The clock fields as they stand at entry into simulation.
ZephRenderClocks clocksAtEntry(std::int32_t nowMs);
