// How the program goes into simulation and comes out again: the fixed order of table, socket, timer and window, with a
// way back from each failure.
#pragma once

#include "editor/mode_switch.h"
#include "shell/program.h"

inline constexpr int kStandardTimerMs = 9;
inline constexpr int kOpenGLTimerMs = 1;

// What the lifecycle asks of the window, besides what every change of mode does. Status texts and boxes go through the
// host.
class SimulationFace : public ModeFace {
public:
    virtual void setTimer(bool on, int intervalMs) = 0;  // hrTimer1
    virtual void showQueueGauge(bool shown) = 0;         // prbQueueLen
    virtual void showFrames(const QImage& frame) = 0;    // picMain shows this image from here on
    virtual void SetControlsForSimulation(bool on) = 0;
    virtual void layOutForEditor() = 0;
    // The window of the OpenGL engine: made and shown, or nothing where it cannot be had; and gone again.
    virtual GLTarget* ZephCreateRenderWindow() = 0;
    virtual void resizeRenderWindow() = 0;
    virtual void closeRenderWindow() = 0;
    virtual void showMainWindow(bool shown) = 0;

    void stopTimer() final { setTimer(false, kStandardTimerMs); }
};

// The simulation's side of the mode switch, over the program and its window.
class ProgramModes final : public SimulationDoor {
public:
    ProgramModes(Program& program, SimulationFace& face) : program_(program), face_(face) {}

    ModeContext context() {
        return {*program_.simulation, program_.editor, program_.seams.host, face_, *this, program_.failures};
    }
    bool enterSimulation() override;
    void ZephCleanUpAfterSimulation() override;

private:
    Program& program_;
    SimulationFace& face_;
};

// Enters simulation; does nothing while it runs.
void mnuSimulationMode_Click(Program& program, SimulationFace& face);

// The one switch, with the tool as it is. requestedMode: see editor/mode_switch.h.
void ZephSwitchMode(int requestedMode, Program& program, SimulationFace& face);

// Leaves simulation; the socket stays open.
void EndSimulation(Program& program, SimulationFace& face);

// Erases what the run made: tables, frames, the points that assembly added.
void ZephCleanUpAfterSimulation(Program& program, SimulationFace& face);

// One tick of hrTimer1. frameDone shows a finished frame before waiting events get their turn.
void hrTimer1_Timer(const std::function<void()>& frameDone, Program& program, SimulationFace& face);
