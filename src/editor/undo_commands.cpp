#include "editor/undo_commands.h"

namespace {

constexpr std::string_view kModule = "frmZephMain";

void tell(std::string_view text, const ModeContext& context) {
    context.host.setStatusPanel(2, text);
    context.face.CheckEnable(false);
}

}  // namespace

void mnuUndo_Click(const EditContext& context) try {
    if (!editable(context.modes) || context.stores.UndoPosition < 1) return;
    bool restoreProperties = false;  // always comes back false, so no dialog follows
    static_cast<void>(ZephUndoLastAction(context.undo, context.modes.simulation, context.stores, restoreProperties));
    CleanUpInProgressFixture(context.modes.editor.ZephInProgressFixture);
    tell("Undo of last action", context.modes);
}
ZEPH_GUARD(context.modes.failures, kModule, )

void mnuRedo_Click(const EditContext& context) try {
    if (!editable(context.modes) || context.stores.RedoPosition < 1) return;
    bool restoreProperties = false;
    static_cast<void>(ZephRedoLastAction(context.undo, context.modes.simulation, context.stores, restoreProperties));
    tell("Redo of last action", context.modes);
}
ZEPH_GUARD(context.modes.failures, kModule, )
