#include "editor/mode_switch.h"

#include "editor/command_table.h"
#include "editor/tool_bar_texts.h"

namespace {

constexpr std::string_view kModule = "modZephEditorFunctions";
constexpr int kStatePanel = 2;

void showState(const ModeContext& context) {
    context.host.setStatusPanel(kStatePanel, ZephUpdateStatusBarForUIState(context.simulation, context.editor, false));
}

// What both selecting states have in common. A locked object picked in the list is to be editable, so locks are
// ignored from here until something is selected on the canvas.
void select(int state, bool fromSimulation, const ModeContext& context) {
    context.face.stopTimer();
    if (fromSimulation) context.host.setStatusPanel(kStatePanel, "");
    context.editor.ZephUIState = state;
    context.editor.ZephIgnoreLocks = true;
    context.face.redrawObjects();
    context.face.ZephDeselectflg();
    context.face.ZephLoadUIObjectList();
    showState(context);
}

void draw(bool fromSimulation, const ModeContext& context) {
    context.face.stopTimer();
    if (fromSimulation) {
        context.editor.ZephSelection.Object = 0;
        context.face.redrawObjects();
    }
    context.editor.ZephUIState = kStateDrawing;
    context.host.setStatusPanel(kStatePanel, "Drawing");
    context.face.setCanvasPointer(CanvasPointer::Pencil);
    context.face.ZephLoadUIObjectList();
}

}  // namespace

bool editable(const ModeContext& context) noexcept {
    return context.simulation.SimulationOpen && context.editor.ZephUIState != kStateSimulation;
}

void ZephSwitchMode(int requestedMode, int tool, const ModeContext& context) try {
    ZephEditorState& editor = context.editor;
    context.face.restoreIfMinimized();
    editor.ZephDrawTool = tool;
    if (requestedMode != kModeDrawing) {
        if (strokeActive(editor)) {
            context.face.eraseRubberBand();
            // Otherwise the slot that the stroke reserved would stay in the document as an empty fixture.
            if (editor.ZephInProgressIndex > 0) cancelStroke(context);
        }
        context.face.setCanvasPointer(CanvasPointer::Default);
    }
    const bool fromSimulation = editor.ZephUIState == kStateSimulation;
    if (fromSimulation) context.door.ZephCleanUpAfterSimulation();
    editor.ZephInProgressAnchor.StartX = -1;
    editor.ZephInProgressAnchor.StartY = -1;

    switch (requestedMode) {
    case kStateSimulation:
        if (!context.door.enterSimulation()) {
            ZephSwitchMode(kStateSelectFixture, tool, context);
            return;
        }
        break;
    case kStateSelectProp:
        select(kStateSelectProp, fromSimulation, context);
        break;
    case kStateSelectFixture:
        select(kStateSelectFixture, fromSimulation, context);
        TogglePropFixtureButtons(kStateSelectFixture, editor, context.face);
        context.face.CheckEnable(false);
        break;
    case kModeDrawing:
        draw(fromSimulation, context);
        break;
    default:
        break;
    }
    editor.PressedDrawButton = ToggleDrawBarButtons(requestedMode, tool);
    context.face.showPressedDrawButton();
}
ZEPH_GUARD(context.failures, kModule, )

int ToggleDrawBarButtons(int requestedMode, int tool) noexcept {
    switch (requestedMode) {
    case kStateSimulation:
        return commandRow(Command::SimulationMode).drawButton;
    case kStateSelectProp:
        return commandRow(Command::ItemTool).drawButton;
    case kStateSelectFixture:
        return commandRow(Command::Select).drawButton;
    case kModeDrawing:
        return commandRow(toolCommand(tool)).drawButton;
    default:
        return 0;
    }
}

void TogglePropFixtureButtons(int mode, ZephEditorState& editor, ModeFace& face) {
    editor.ZephChangeToggle = mode == kStateSelectProp ? kToggleProps : kToggleFixtures;
    face.showModeButtons();
}

void cancelStroke(const ModeContext& context) try {
    ZephEditorState& editor = context.editor;
    CleanUpInProgressFixture(editor.ZephInProgressFixture);
    editor.ZephInProgressAnchor.StartX = -1;
    editor.ZephInProgressAnchor.StartY = -1;
    // The box of the matrix wizard reserves no fixture, so there is none to give back.
    if (editor.ZephInProgressIndex > 0) --context.simulation.FixtureCount;
    editor.ZephInProgressIndex = 0;
    editor.ZephSelection.Object = 0;
    context.face.redrawObjects();
    context.face.CheckEnable(false);
}
ZEPH_GUARD(context.failures, kModule, )

void CleanUpInProgressFixture(ZephFixture& inProgress) {
    inProgress = ZephFixture{};
}
