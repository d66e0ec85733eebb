// What a run of the lights reads and changes, handed to every procedure of the render cycle.
#pragma once

#include "engine/light_surface.h"
#include "model/dimming_curve.h"
#include "util/failure.h"
#include "util/random_source.h"

// Pacing of frames; all ms of the light clock. Set afresh at entry into simulation.
struct ZephRenderClocks {
    std::int32_t FrameClock = 0;    // since the last rendered frame
    std::int32_t ShimmerClock = 0;  // since ShimmerPhase last changed
    bool ShimmerPhase = false;
    std::int32_t LastTick = 0;
    std::int32_t SecondStart = 0;  // first tick of the present second
    std::int32_t TickCount = 0;    // of the present second
    std::int32_t FrameCount = 0;
    bool StopRequested = false;  // the next tick ends the simulation
};

struct RenderContext {
    const ZephSimulation& simulation;
    const ZephDimmingCurve& curve;
    ZephRenderTables& tables;
    ZephFixtureStates& states;
    ZephRenderClocks& clocks;
    RandomSource& random;
    LightSurface& surface;
    FailureReport& failures;
};
