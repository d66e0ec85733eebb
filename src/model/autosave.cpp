#include "model/autosave.h"

#include "model/ui_state.h"

namespace {

// Keeps the timer off for as long as it lives.
class TimerOff {
public:
    explicit TimerOff(AutoSaveState& state) : state_(state) { state_.working = true; }
    ~TimerOff() { state_.working = false; }
    TimerOff(const TimerOff&) = delete;
    TimerOff& operator=(const TimerOff&) = delete;

private:
    AutoSaveState& state_;
};

bool mayInterrupt(const AutoSaveContext& context) {
    return context.ZephUIState == kStateSelectFixture ||
           (context.ZephUIState == kStateDrawing && !context.strokeInProgress);
}

void saveNow(const AutoSaveContext& context) {
    if (context.simulation.FileName.empty()) {
        context.host.setStatusPanel(2, "Warning:  Autosave is disabled until you save this new file");
        return;
    }
    const std::string shown = context.face.statusPanel2();
    context.host.setStatusPanel(2, "Autosave in progress.");
    context.face.save();
    context.host.setStatusPanel(2, shown);
}

}  // namespace

void tmrAutoSave_Timer(const AutoSaveContext& context, AutoSaveState& state) try {
    if (state.working) return;
    if (context.settings.AutoSave == 0 || !context.simulation.SimulationOpen) {
        state.Tag = 0;
        return;
    }
    if (std::int64_t{state.Tag} + 1 < std::int64_t{context.settings.AutoSave} * kAutoSaveTicksPerMinute) {
        ++state.Tag;
        return;
    }
    const TimerOff off(state);
    if (!context.simulation.SimulationDirty) {
        state.Tag = 0;
    } else if (mayInterrupt(context)) {
        state.Tag = 0;
        saveNow(context);
    }
    // In any other state the count stays, and the next tick that finds a better one saves.
}
ZEPH_GUARD(context.failures, "frmZephMain", )
