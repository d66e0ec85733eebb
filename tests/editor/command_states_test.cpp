#include "editor/command_states.h"
#include "editor/tool_bar_texts.h"
#include "tests/editor/editor_rig.h"

#include <set>

namespace {

using enum Command;
using Commands = std::vector<Command>;

const Commands kAlways{FileNew, FileLoad, FileOptions, FileExit, HelpAbout};

// What the menus offer, without what is always there.
Commands offered(const CommandStates& states) {
    Commands found;
    for (const CommandRow& row : kCommandTable) {
        if (row.id == None || row.kind == CommandKind::Menu || !states[row.id].enabled) continue;
        if (!std::ranges::count(kAlways, row.id)) found.push_back(row.id);
    }
    return found;
}

const Commands kTools{Draw,       DrawKeshs,  DrawFloods,       DrawBulbs,      ArchWizard,
                      TreeWizard, KeshWizard, KeshMatrixWizard, DrawPixelWizard};
const Commands kOfDocument{BackgroundProperties, FileSaveAs,   LoadQenReference, FileSave,
                           InsertFixture,        InsertSymbol, InsertProp,       EditLevels};
const Commands kOfFixtures{Select, SimulationMode, ItemTool, CreateNewItem};
const Commands kOfSelection{Cut, CopyObject, DeleteObject, HomeObject};

CommandStates check(const EditorRig& rig) {
    CommandStates states;
    CheckEnable(false, rig.inputs(), states);
    return states;
}

Commands together(std::initializer_list<Commands> lists) {
    Commands all;
    for (const Commands& list : lists)
        all.insert(all.end(), list.begin(), list.end());
    std::ranges::sort(all);
    return all;
}

}  // namespace

TEST(CheckEnable, WithoutADocumentOrFixturesThereIsLittleToOffer) {
    EditorRig rig;
    rig.simulation->SimulationOpen = false;
    rig.editor.ZephClipboard.resize(3);
    rig.undo = {2, 2};
    rig.select(kStateSelectFixture, 1);
    const CommandStates states = check(rig);
    EXPECT_EQ(offered(states), Commands{});
    for (const Command command : kAlways)
        EXPECT_TRUE(states[command].enabled) << commandRow(command).name;
    EXPECT_FALSE(states[Insert].enabled || states[Order].enabled || states[Toolbox].enabled);
    const EditorRig empty;
    empty.simulation->FixtureCount = 0;
    EXPECT_EQ(offered(check(empty)), together({kTools, kOfDocument}));
}

TEST(CheckEnable, FollowsStateAndSelection) {
    // The last: what is offered besides the tools and what any document with fixtures offers.
    const std::tuple<const char*, int, int, bool, bool, Commands> rows[] = {
        {"nothing selected", kStateSelectFixture, 0, false, false, {}},
        {"middle level", kStateSelectFixture, 1, false, false,
         together(
             {kOfSelection, {Lock, SendToForeground, MoveForward, SendToBackground, MoveBackward, ObjectProperties}})},
        {"top level, locked", kStateSelectFixture, 2, true, false,
         together({kOfSelection, {Unlock, SendToBackground, MoveBackward, ObjectProperties}})},
        {"bottom level", kStateSelectFixture, 3, false, true,
         together({kOfSelection, {Lock, SendToForeground, MoveForward, ObjectProperties}})},
        {"prop: its lock decides", kStateSelectProp, 3, false, true,
         together({kOfSelection, {Unlock, ObjectProperties}})},
        {"prop: not the fixture's lock", kStateSelectProp, 2, true, false,
         together({kOfSelection, {Lock, ObjectProperties}})},
        {"lone fixture among props", kStateSelectProp, 1, true, false, together({kOfSelection, {Lock}})},
        {"drawing", kStateDrawing, 1, false, false, kOfSelection},
    };
    for (const auto& [name, state, fixture, fixtureLocked, propLocked, besides] : rows) {
        EditorRig rig;
        rig.select(state, fixture);
        if (fixtureLocked) rig.simulation->Fixtures[fixture].Locked = true;
        rig.simulation->Props[1].Locked = propLocked;
        const CommandStates states = check(rig);
        EXPECT_EQ(offered(states), together({kTools, kOfDocument, kOfFixtures, besides})) << name;
        EXPECT_EQ(states[EditLocks].enabled, states[Lock].enabled || states[Unlock].enabled) << name;
    }
}

TEST(CheckEnable, ClipboardUndoAndNamesNeedSomethingToGiveBack) {
    EditorRig rig;
    rig.editor.ZephClipboard.resize(1);
    rig.undo = {1, 0};
    CommandStates states = check(rig);
    EXPECT_TRUE(states[PasteObject].enabled);
    EXPECT_TRUE(states[Undo].enabled);
    EXPECT_FALSE(states[Redo].enabled);
    CommandInputs nameless = rig.inputs();
    nameless.NameLocation = 0;  // names that have no place cannot be hidden
    CheckEnable(false, nameless, states);
    EXPECT_FALSE(states.band.chkNames);
    rig.undo = {0, 1};
    rig.editor.ZephUIState = kStateSimulation;
    states = check(rig);
    EXPECT_FALSE(states[Undo].enabled || states[Redo].enabled);
}

TEST(CheckEnable, AStrokeShutsEverythingAndItsEndOpensItAgain) {
    EditorRig rig;
    CommandStates states;
    CheckEnable(true, rig.inputs(), states);
    const CommandStates before = states;
    rig.beginStroke();
    CheckEnable(false, rig.inputs(), states);
    EXPECT_FALSE(states.toolBars);
    EXPECT_EQ(std::ranges::count(states.editButtons, true) + std::ranges::count(states.drawButtons, true), 0);
    EXPECT_FALSE(states[File].visible || states[File].enabled || states[Edit].visible || states[Edit].enabled);
    EXPECT_FALSE(states.popContextMenu);
    EXPECT_EQ(states.band, (OptionsBandState{false, false, false, false, false, false, false, false, false, false}));

    rig.editor = {};
    CheckEnable(false, rig.inputs(), states);
    EXPECT_EQ(states, before);
}

TEST(CommandTable, GivesNoKeyTwice) {
    std::set<std::string_view> keys;
    for (const CommandRow& row : kCommandTable)
        EXPECT_TRUE(row.shortcut.empty() || keys.insert(row.shortcut).second) << row.name;
}

TEST(ToolBarTexts, TellTheLevelsTheStateAndTheBrightness) {
    EditorRig rig;
    EditToolBarTexts texts;
    rig.select(kStateSelectFixture, 1);
    SetEditToolBarTips(*rig.simulation, rig.editor, {}, texts);
    EXPECT_EQ(texts.MoveForwardTip, "Move Forward (to level:6)");
    EXPECT_EQ(texts.MoveBackwardTip, "Move Backward (to level:4)");
    rig.editor.ZephUIState = kStateDrawing;
    SetEditToolBarTips(*rig.simulation, rig.editor, {}, texts);
    EXPECT_EQ(texts.ObjectProperties, "Fixture Properties");  // a state that selects nothing leaves it

    rig.simulation->Background.PicIntensity = 40;
    EXPECT_EQ(ZephSetOptionsToolbandStuff({}, *rig.simulation).sldIntensity, 40);
    const auto text = [&](int state, int fixture, bool suppress = false) {
        rig.select(state, fixture);
        return ZephUpdateStatusBarForUIState(*rig.simulation, rig.editor, suppress);
    };
    EXPECT_EQ(text(kStateSimulation, 0), "Simulation Active");
    EXPECT_EQ(text(kStateSelectProp, 1), "Prop Selected:Wreath");
    EXPECT_EQ(text(kStateSelectFixture, 3, true), "Select Fixture");
    rig.simulation->SimulationOpen = false;
    EXPECT_EQ(text(kStateDrawing, 0), "");
    EXPECT_EQ(ZephSetOptionsToolbandStuff({}, *rig.simulation).sldIntensity, 100);
}
