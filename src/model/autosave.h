// The document saves itself after a set time. Called by a timer of 600 ms; decides at each tick what is to be done.
#pragma once

#include "model/settings.h"
#include "model/simulation.h"
#include "util/failure.h"
#include "util/host.h"

inline constexpr int kAutoSaveTickMs = 600;
// Ticks for each minute of the setting: 36 seconds, in fact. Users have set their minutes by it.
inline constexpr int kAutoSaveTicksPerMinute = 60;

struct AutoSaveState {
    std::int32_t Tag = 0;  // ticks counted; every load and every save set it to 0
    bool working = false;  // the timer is off while a save and its message boxes are under way
};

class AutoSaveFace {
public:
    virtual ~AutoSaveFace() = default;
    virtual std::string statusPanel2() = 0;  // the text it shows
    virtual void save() = 0;                 // mnuFileSave_Click
};

struct AutoSaveContext {
    const ZephSettings& settings;
    const ZephSimulation& simulation;
    int ZephUIState;
    bool strokeInProgress;  // a drawing was begun: StartX is not -1
    Host& host;
    FailureReport& failures;
    AutoSaveFace& face;
};

void tmrAutoSave_Timer(const AutoSaveContext& context, AutoSaveState& state);
