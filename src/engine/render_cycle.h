// The render cycle: one pass brings every running command up to date and draws what is lit, level by level; the
// supervisors decide when a pass is due.
#pragma once

#include "engine/render_context.h"
#include "link/payload_parser.h"
#include "util/clock.h"
#include "util/host.h"

#include <functional>

inline constexpr int kEngineStandard = 1;
inline constexpr int kEngineOpenGL = 2;
inline constexpr std::int32_t kStandardFrameMs = 9;
inline constexpr std::int32_t kOpenGLFrameMs = 15;

// One render pass at the clock reading of the frame. Nothing in it allocates, logs or reads a clock.
void ZephRenderLights(std::int32_t nowMs, RenderContext& context);

// What a tick needs around the pass: where text comes from and where commands go, and who is told.
struct TickContext {
    const Clock& clock;
    const ParserSetup& parser;
    Host& host;
    CommandSink& sink;
    ChannelStream& stream;
    RenderContext& run;
    const std::function<void()>& frameDone;  // shows a finished frame, before waiting events get their turn
};

// One tick of the timer while simulating: waiting payloads become commands, then the supervisor of the engine
// (kEngineStandard, kEngineOpenGL) renders a frame if one is due. True where a frame was rendered.
bool ZephRenderTick(int renderEngine, const TickContext& tick);

// Pacing: a frame every 9 ms of render time, or every 15. Level dumps become commands when a frame is drawn.
bool ZephRenderingSupervisor(bool force, const TickContext& tick);
bool ZephRenderingSupervisorGL(const TickContext& tick);

// The clock fields as they stand at entry into simulation.
ZephRenderClocks clocksAtEntry(std::int32_t nowMs);
