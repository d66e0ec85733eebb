// How the user moves between selecting props, selecting fixtures, drawing and the simulation: one switch, through which
// every change of ZephUIState goes. The window shows what it is told through ModeFace; the simulation's own long way in
// and out stands behind SimulationDoor.
#pragma once

#include "editor/editor_state.h"
#include "util/failure.h"
#include "util/host.h"

enum class CanvasPointer { Default, Pencil };

// What the switch and the mode commands ask of the window.
class ModeFace {
public:
    virtual ~ModeFace() = default;
    virtual void restoreIfMinimized() = 0;
    virtual void eraseRubberBand() = 0;  // drawn once more in invert mode, dotted, from start to end of the anchor
    virtual void setCanvasPointer(CanvasPointer pointer) = 0;
    virtual void stopTimer() = 0;                            // hrTimer1
    virtual void redrawObjects() = 0;                        // picMain shows the editor's canvas with ZephSelection
    virtual void ZephHighlightflg(std::int32_t object) = 0;  // the row of the fixture, if it has one
    virtual void ZephDeselectflg() = 0;                      // no row of the object list is highlighted
    virtual void ZephLoadUIObjectList() = 0;                 // the object list anew, from the document
    virtual void showPressedDrawButton() = 0;                // PressedDrawButton of the state
    virtual void showModeButtons() = 0;                      // chkCmdFixtureOrProp by ZephChangeToggle
    virtual void CheckEnable(bool forceEnable) = 0;
};

class SimulationDoor {
public:
    virtual ~SimulationDoor() = default;
    // Everything between the common head of the switch and the running simulation. True: ZephUIState is
    // kStateSimulation. False: a step failed, was told to the user, and the timer is off.
    [[nodiscard]] virtual bool enterSimulation() = 0;
    virtual void ZephCleanUpAfterSimulation() = 0;
};

struct ModeContext {
    ZephSimulation& simulation;
    ZephEditorState& editor;
    Host& host;
    ModeFace& face;
    SimulationDoor& door;
    FailureReport& failures;
};

// Whether a command may touch the document: the one of a running simulation is frozen, and there may be none. Each
// command asks for itself, since keys and the list reach it past the menus.
bool editable(const ModeContext& context) noexcept;

// requestedMode: kStateSimulation, kStateSelectProp, kStateSelectFixture or kModeDrawing; any other value changes the
// tool only. tool: 1..9, stored whatever the mode. A simulation that cannot be entered ends in kStateSelectFixture.
void ZephSwitchMode(int requestedMode, int tool, const ModeContext& context);

// The index of the button of DrawToolBar that stands for a mode and its tool, 0 = none.
int ToggleDrawBarButtons(int requestedMode, int tool) noexcept;

// Presses the mode button of kStateSelectProp or kStateSelectFixture and releases the other.
void TogglePropFixtureButtons(int mode, ZephEditorState& editor, ModeFace& face);

// Gives up the stroke under way, with the fixture that it had reserved. What Esc does.
void cancelStroke(const ModeContext& context);

void CleanUpInProgressFixture(ZephFixture& inProgress);
