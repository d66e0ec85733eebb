#include "editor/keyboard.h"
#include "tests/editor/editor_rig.h"

namespace {

constexpr bool kMenu = true;

KeyAnswer answer(const EditorRig& rig, const KeyDown& down, const KeyScene& scene = {}, bool menu = kMenu) {
    return IWindowsHook_HookProc(down, scene, rig.inputs(), menu);
}

}  // namespace

TEST(Keyboard, AnswersByStateAndSelection) {
    struct Row {
        const char* name;
        int state;
        int fixture;
        KeyDown down;
        KeyAction action;
        Command command = Command::None;
    };
    using enum KeyAction;
    const Row rows[] = {
        {"Esc ends a simulation", kStateSimulation, 0, {kKeyEsc}, StopSimulation},
        {"nothing is pasted into a simulation", kStateSimulation, 1, {kKeyV, true}, None},
        {"Esc elsewhere", kStateSelectFixture, 1, {kKeyEsc}, None},
        {"Ctrl+C", kStateSelectProp, 1, {kKeyC, true}, RunCommand, Command::CopyObject},
        {"Ctrl+C without a selection", kStateSelectProp, 0, {kKeyC, true}, None},
        {"C alone", kStateSelectProp, 1, {kKeyC}, None},
        {"Ctrl+V", kStateSelectProp, 0, {kKeyV, true}, RunCommand, Command::PasteObject},
        {"Ctrl+X", kStateSelectFixture, 1, {kKeyX, true}, RunCommand, Command::Cut},
        {"Del", kStateSelectFixture, 1, {kKeyDel}, RunCommand, Command::DeleteObject},
        {"Del without a selection", kStateSelectFixture, 0, {kKeyDel}, None},
        {"numpad +", kStateSelectFixture, 1, {kKeyNumpadAdd}, RunCommand, Command::MoveForward},
        {"Shift and =", kStateSelectFixture, 1, {kKeyEquals, false, true}, RunCommand, Command::MoveForward},
        {"= alone", kStateSelectFixture, 1, {kKeyEquals}, None},
        {"+ on the top level", kStateSelectFixture, 2, {kKeyNumpadAdd}, None},
        {"+ among props", kStateSelectProp, 1, {kKeyNumpadAdd}, None},
        {"+ without a selection", kStateSelectFixture, 0, {kKeyNumpadAdd}, None},
        {"-", kStateSelectFixture, 1, {kKeyMinus}, RunCommand, Command::MoveBackward},
        {"Shift and -", kStateSelectFixture, 1, {kKeyMinus, false, true}, None},
        {"numpad - on the bottom level", kStateSelectFixture, 3, {kKeyNumpadSubtract}, None},
        {"Apps", kStateSelectFixture, 0, {kKeyApps}, ShowContextMenu},
        {"Tab", kStateSelectProp, 0, {kKeyTab}, NextRow},
        {"Shift and Tab", kStateSelectFixture, 0, {kKeyTab, false, true}, PreviousRow},
        {"Tab while drawing", kStateDrawing, 0, {kKeyTab}, None},
        {"Esc without a stroke", kStateDrawing, 0, {kKeyEsc}, None},
        {"Enter without a stroke", kStateDrawing, 0, {kKeyEnter}, None},
    };
    for (const Row& row : rows) {
        EditorRig rig;
        rig.editor.ZephClipboard.resize(1);
        rig.select(row.state, row.fixture);
        EXPECT_EQ(answer(rig, row.down), (KeyAnswer{row.action, row.command})) << row.name;
        rig.simulation->SimulationOpen = false;
        EXPECT_EQ(answer(rig, row.down), KeyAnswer{}) << row.name << " without a document";
    }
}

TEST(Keyboard, AStrokeIsFinishedOrGivenUp) {
    EditorRig rig;
    rig.beginStroke();
    EXPECT_EQ(answer(rig, {kKeyEnd}).action, KeyAction::FinishDrawing);
    EXPECT_EQ(answer(rig, {kKeyEnter}).action, KeyAction::FinishDrawing);
    EXPECT_EQ(answer(rig, {kKeyEsc}).action, KeyAction::CancelDrawing);
    EXPECT_EQ(answer(rig, {kKeyDel}).action, KeyAction::None);
}

TEST(Keyboard, LeavesKeysToOthers) {
    EditorRig rig;
    rig.select(kStateSelectFixture, 1);
    EXPECT_EQ(answer(rig, {kKeyDel}, {false, false}), KeyAnswer{});  // the focus is elsewhere
    EXPECT_EQ(answer(rig, {kKeyTab}, {true, true}), KeyAnswer{});    // Tab is moving the list already
    EXPECT_EQ(answer(rig, {kKeyApps}, {}, !kMenu), KeyAnswer{});
    rig.editor.ZephClipboard.clear();
    EXPECT_EQ(answer(rig, {kKeyV, true}), KeyAnswer{});
    rig.simulation->FixtureCount = 0;
    EXPECT_EQ(answer(rig, {kKeyTab}), KeyAnswer{});
}

TEST(Keyboard, TabWrapsThroughTheList) {
    EXPECT_EQ(nextListRow(-1, 3, false), 0);
    EXPECT_EQ(nextListRow(1, 3, false), 2);
    EXPECT_EQ(nextListRow(2, 3, false), 0);
    EXPECT_EQ(nextListRow(-1, 3, true), 2);
    EXPECT_EQ(nextListRow(0, 3, true), 2);
    EXPECT_EQ(nextListRow(0, 1, false), 0);
}
