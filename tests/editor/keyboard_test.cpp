#include "editor/keyboard.h"
#include "tests/editor/editor_rig.h"

namespace {

KeyAnswer answer(const EditorRig& rig, const KeyDown& down, const KeyScene& scene = {}, bool menu = true) {
    return IWindowsHook_HookProc(down, scene, rig.inputs(), menu);
}

}  // namespace

TEST(Keyboard, AnswersByStateAndSelection) {
    using enum KeyAction;
    const std::tuple<const char*, int, int, KeyDown, KeyAnswer> rows[] = {
        {"Esc ends a simulation", kStateSimulation, 0, {kKeyEsc}, {StopSimulation}},
        {"nothing is pasted into a simulation", kStateSimulation, 1, {kKeyV, true}, {None}},
        {"Ctrl+C", kStateSelectProp, 1, {kKeyC, true}, {RunCommand, Command::CopyObject}},
        {"Ctrl+C without a selection", kStateSelectProp, 0, {kKeyC, true}, {None}},
        {"Ctrl+V", kStateSelectProp, 0, {kKeyV, true}, {RunCommand, Command::PasteObject}},
        {"Del", kStateSelectFixture, 1, {kKeyDel}, {RunCommand, Command::DeleteObject}},
        {"numpad +", kStateSelectFixture, 1, {kKeyNumpadAdd}, {RunCommand, Command::MoveForward}},
        {"Shift and =", kStateSelectFixture, 1, {kKeyEquals, false, true}, {RunCommand, Command::MoveForward}},
        {"= alone", kStateSelectFixture, 1, {kKeyEquals}, {None}},
        {"+ on the top level", kStateSelectFixture, 2, {kKeyNumpadAdd}, {None}},
        {"+ among props", kStateSelectProp, 1, {kKeyNumpadAdd}, {None}},
        {"Shift and -", kStateSelectFixture, 1, {kKeyMinus, false, true}, {None}},
        {"numpad - on the bottom level", kStateSelectFixture, 3, {kKeyNumpadSubtract}, {None}},
        {"Apps", kStateSelectFixture, 0, {kKeyApps}, {ShowContextMenu}},
        {"Tab", kStateSelectProp, 0, {kKeyTab}, {NextRow}},
        {"Shift and Tab", kStateSelectFixture, 0, {kKeyTab, false, true}, {PreviousRow}},
        {"Tab while drawing", kStateDrawing, 0, {kKeyTab}, {None}},
        {"Esc without a stroke", kStateDrawing, 0, {kKeyEsc}, {None}},
    };
    for (const auto& [name, state, fixture, down, expected] : rows) {
        EditorRig rig;
        rig.editor.ZephClipboard.resize(1);
        rig.select(state, fixture);
        EXPECT_EQ(answer(rig, down), expected) << name;
        rig.simulation->SimulationOpen = false;
        EXPECT_EQ(answer(rig, down), KeyAnswer{}) << name << " without a document";
    }
}

TEST(Keyboard, EndsAStrokeAndLeavesKeysToOthers) {
    EditorRig rig;
    rig.select(kStateSelectFixture, 1);
    EXPECT_EQ(answer(rig, {kKeyDel}, {false, false}), KeyAnswer{});  // the focus is elsewhere
    EXPECT_EQ(answer(rig, {kKeyTab}, {true, true}), KeyAnswer{});    // Tab is moving the list already
    EXPECT_EQ(answer(rig, {kKeyApps}, {}, false), KeyAnswer{});
    EXPECT_EQ(answer(rig, {kKeyV, true}), KeyAnswer{});  // the clipboard is empty

    rig.beginStroke();
    EXPECT_EQ(answer(rig, {kKeyEnd}).action, KeyAction::FinishDrawing);
    EXPECT_EQ(answer(rig, {kKeyEnter}).action, KeyAction::FinishDrawing);
    EXPECT_EQ(answer(rig, {kKeyEsc}).action, KeyAction::CancelDrawing);
}
