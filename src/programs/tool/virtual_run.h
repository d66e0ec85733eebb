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
    // engine: "standard" or "opengl". The document is loaded. Nothing is compiled yet.
    VirtualRun(ToolDocument& document, Capture capture, const std::string& engine, std::uint64_t seed);

    // Compiles the document. False where it cannot be simulated; its message was printed.
    bool enter();

    // Runs ticks until t passes `until`. After each one that drew a frame onFrame(t) is called; false from it ends the
    // run.
    void run(std::int32_t until, LightSurface& surface, const std::function<bool(std::int32_t)>& onFrame);

    ZephRenderTables& tables() { return tables_; }
    ZephFixtureStates& states() { return *states_; }
    const ZephDimmingCurve& curve() const { return curve_; }

private:
    ToolDocument& document_;
    Capture capture_;
    int engine_;
    SeededRandom random_;
    ZephDimmingCurve curve_{};
    std::unique_ptr<ZephFixtureStates> states_ = std::make_unique<ZephFixtureStates>();
    ZephRenderTables tables_;
};
