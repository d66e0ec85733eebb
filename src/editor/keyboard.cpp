#include "editor/keyboard.h"

#include "model/document.h"

namespace {

constexpr KeyAnswer run(Command command) {
    return {KeyAction::RunCommand, command};
}

KeyAnswer whileDrawing(const KeyDown& down, const ZephEditorState& editor) {
    if (!strokeActive(editor)) return {};
    if (down.key == kKeyEnd || down.key == kKeyEnter) return {KeyAction::FinishDrawing, Command::None};
    if (down.key == kKeyEsc) return {KeyAction::CancelDrawing, Command::None};
    return {};
}

KeyAnswer onClipboard(const KeyDown& down, const CommandInputs& inputs) {
    const bool selected = objectSelected(inputs.editor);
    if (down.key == kKeyC && selected) return run(Command::CopyObject);
    if (down.key == kKeyV && !inputs.editor.ZephClipboard.empty()) return run(Command::PasteObject);
    if (down.key == kKeyX && selected) return run(Command::Cut);
    return {};
}

KeyAnswer onLevels(const KeyDown& down, const CommandInputs& inputs) {
    if (inputs.editor.ZephUIState != kStateSelectFixture || !objectSelected(inputs.editor)) return {};
    const std::int32_t level = fixtureOrEmpty(inputs.simulation, inputs.editor.ZephSelection.Object).ZOrder;
    const bool plus = down.key == kKeyNumpadAdd || (down.key == kKeyEquals && down.shift);
    const bool minus = down.key == kKeyNumpadSubtract || (down.key == kKeyMinus && !down.shift);
    if (plus && level < kLevels) return run(Command::MoveForward);
    if (minus && level > 1) return run(Command::MoveBackward);
    return {};
}

}  // namespace

KeyAnswer IWindowsHook_HookProc(const KeyDown& down, const KeyScene& scene, const CommandInputs& inputs,
                                bool popContextMenuEnabled) {
    if (scene.reentered || !scene.focusInForm || !inputs.simulation.SimulationOpen) return {};
    const ZephEditorState& editor = inputs.editor;
    if (editor.ZephUIState == kStateDrawing) return whileDrawing(down, editor);
    if (editor.ZephUIState == kStateSimulation) {
        // The document is frozen: nothing may be pasted into it, and there is no menu to show.
        return down.key == kKeyEsc ? KeyAnswer{KeyAction::StopSimulation, Command::None} : KeyAnswer{};
    }
    if (down.ctrl) return onClipboard(down, inputs);
    switch (down.key) {
    case kKeyDel:
        return objectSelected(editor) ? run(Command::DeleteObject) : KeyAnswer{};
    case kKeyApps:
        return popContextMenuEnabled ? KeyAnswer{KeyAction::ShowContextMenu, Command::None} : KeyAnswer{};
    case kKeyTab:
        if (inputs.simulation.FixtureCount < 1) return {};
        return {down.shift ? KeyAction::PreviousRow : KeyAction::NextRow, Command::None};
    default:
        return onLevels(down, inputs);
    }
}

int nextListRow(int row, int rows, bool backward) noexcept {
    if (backward) return row <= 0 ? rows - 1 : row - 1;
    return row + 1 >= rows ? 0 : row + 1;
}
