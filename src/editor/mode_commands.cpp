#include "editor/mode_commands.h"

#include "editor/limits.h"
#include "editor/tool_bar_texts.h"

namespace {

constexpr std::string_view kModule = "frmZephMain";

void deselect(const ModeContext& context) {
    context.face.ZephDeselectflg();
    context.editor.ZephSelection.Object = 0;
    context.face.redrawObjects();
}

// Locks hold again until the switch, which sets the flag for a selection made in the list.
void changeTo(int state, const ModeContext& context) {
    context.editor.ZephIgnoreLocks = false;
    deselect(context);
    ZephSwitchMode(state, context.editor.ZephDrawTool, context);
    context.host.setStatusPanel(2, ZephUpdateStatusBarForUIState(context.simulation, context.editor, false));
    context.face.CheckEnable(false);
}

}  // namespace

void mnuSelect_Click(const ModeContext& context) try {
    if (!editable(context) || context.editor.ZephUIState == kStateSelectFixture) return;
    changeTo(kStateSelectFixture, context);
}
ZEPH_GUARD(context.failures, kModule, )

void mnuItemTool_Click(const ModeContext& context) try {
    if (!editable(context) || context.editor.ZephUIState == kStateSelectProp) return;
    if (context.editor.ZephChangeToggle != kToggleProps) {
        TogglePropFixtureButtons(kStateSelectProp, context.editor, context.face);
    }
    changeTo(kStateSelectProp, context);
}
ZEPH_GUARD(context.failures, kModule, )

void drawTool_Click(int tool, const ModeContext& context) try {
    ZephEditorState& editor = context.editor;
    if (!editable(context)) return;
    // The only tool with this guard: choosing light strings again goes on with the stroke, choosing another tool again
    // forgets the fixture that bulbs were being added to.
    if (tool == kToolLightStrings && editor.ZephUIState == kStateDrawing && editor.ZephDrawTool == tool) return;
    if (tool >= kToolArchWizard &&
        !(fixtureFits(context.simulation, context.host) && propFits(context.simulation, context.host))) {
        return;
    }
    if (objectSelected(editor)) deselect(context);
    editor.ZephIgnoreLocks = false;
    editor.ZephAppendTarget = 0;
    context.host.setStatusPanel(2, "Drawing");
    ZephSwitchMode(kModeDrawing, tool, context);
    context.face.CheckEnable(false);
}
ZEPH_GUARD(context.failures, kModule, )

void chkCmdFixtureOrProp_MouseUp(int button, bool leftButton, const ModeContext& context) try {
    const int pressed = context.editor.ZephChangeToggle;
    if (leftButton && editable(context) && button != pressed) {
        context.editor.ZephChangeToggle = button;
        if (button == kToggleFixtures) {
            mnuSelect_Click(context);
        } else {
            mnuItemTool_Click(context);
        }
    }
    context.face.showModeButtons();  // the control has changed itself at the click
}
ZEPH_GUARD(context.failures, kModule, )

void chkSimplePropMode_Click(bool simple, const ModeContext& context) try {
    context.editor.SimplePropMode = simple;
    if (!editable(context)) return;
    if (objectSelected(context.editor)) {
        context.face.ZephDeselectflg();
        context.editor.ZephSelection.Object = 0;
    }
    context.face.ZephLoadUIObjectList();
    context.face.redrawObjects();
    context.host.setStatusPanel(2, ZephUpdateStatusBarForUIState(context.simulation, context.editor, false));
    context.face.CheckEnable(false);
}
ZEPH_GUARD(context.failures, kModule, )
