// How the program goes into simulation and comes out again: the fixed order of table, socket, timer and window, with a
// way back from each failure.
#pragma once

#include "shell/program.h"

inline constexpr int kStandardTimerMs = 9;

// What the lifecycle asks of the window. Status texts and boxes go through the host.
class SimulationFace {
public:
    virtual ~SimulationFace() = default;
    virtual void setTimer(bool on, int intervalMs) = 0;  // hrTimer1
    virtual void showQueueGauge(bool shown) = 0;         // prbQueueLen
    virtual void showFrames(const QImage& frame) = 0;    // picMain shows this image from here on
    virtual void redrawObjects() = 0;                    // picMain shows the editor's canvas
    virtual void SetControlsForSimulation(bool on) = 0;
    virtual void layOutForEditor() = 0;
    virtual void CheckEnable() = 0;
};

// Enters simulation; does nothing while it runs.
void mnuSimulationMode_Click(Program& program, SimulationFace& face);

// newState: kStateSimulation or kStateSelectFixture, to which every failure returns.
void ZephSwitchMode(int newState, Program& program, SimulationFace& face);

// Leaves simulation; the socket stays open.
void EndSimulation(Program& program, SimulationFace& face);

// Erases what the run made: tables, frames, the points that assembly added.
void ZephCleanUpAfterSimulation(Program& program, SimulationFace& face);

// One tick of hrTimer1. frameDone shows a finished frame before waiting events get their turn.
void hrTimer1_Timer(const std::function<void()>& frameDone, Program& program, SimulationFace& face);

// Text of panel 2 in the editor.
void ZephUpdateStatusBarForUIState(Program& program);
