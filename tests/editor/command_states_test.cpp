#include "editor/command_states.h"
#include "editor/tool_bar_texts.h"
#include "tests/editor/editor_rig.h"

#include <cctype>
#include <map>
#include <tuple>

namespace {

using enum Command;
using Commands = std::vector<Command>;

// What the menus offer, without what is always there.
Commands offered(const CommandStates& states) {
    Commands found;
    for (const CommandRow& row : kCommandTable) {
        const bool always = row.id == None || row.id == FileNew || row.id == FileLoad || row.id == FileOptions ||
                            row.id == FileExit || row.id == HelpAbout;
        if (!always && row.kind != CommandKind::Menu && states[row.id].enabled) found.push_back(row.id);
    }
    return found;
}

const Commands kTools{Draw,       DrawKeshs,  DrawFloods,       DrawBulbs,      ArchWizard,
                      TreeWizard, KeshWizard, KeshMatrixWizard, DrawPixelWizard};
const Commands kOfDocument{BackgroundProperties, FileSaveAs,   LoadQenReference, FileSave,
                           InsertFixture,        InsertSymbol, InsertProp,       EditLevels};
const Commands kOfFixtures{Select, SimulationMode, ItemTool, CreateNewItem};
const Commands kOfSelection{Cut, CopyObject, DeleteObject, HomeObject};

Commands together(std::initializer_list<Commands> lists) {
    Commands all;
    for (const Commands& list : lists)
        all.insert(all.end(), list.begin(), list.end());
    std::ranges::sort(all);
    return all;
}

}  // namespace

TEST(CheckEnable, WithoutADocumentOffersOnlyFilesOptionsHelpAndExit) {
    EditorRig rig;
    rig.simulation->SimulationOpen = false;
    rig.editor.ZephClipboard.resize(3);
    rig.undo = {2, 2};
    rig.select(kStateSelectFixture, 1);
    CommandStates states;
    CheckEnable(false, rig.inputs(), states);
    EXPECT_EQ(offered(states), Commands{});
    for (const Command command : {FileNew, FileLoad, FileOptions, FileExit, HelpAbout, File, Edit, Help})
        EXPECT_TRUE(states[command].enabled) << commandRow(command).name;
    for (const Command group : {Insert, Order, Toolbox, EditLocks})
        EXPECT_FALSE(states[group].enabled) << commandRow(group).name;
    EXPECT_FALSE(states.band.sldIntensity);
    EXPECT_TRUE(states.band.cmdTextColor);
}

TEST(CheckEnable, FollowsStateAndSelection) {
    struct Row {
        const char* name;
        int state;
        int fixture;
        bool fixtureLocked;
        bool propLocked;
        Commands besides;  // what is offered besides the tools and what any document with fixtures offers
    };
    const Row rows[] = {
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
        {"a fixture that is not there", kStateSelectFixture, 99999, false, false,
         together({kOfSelection, {Lock, SendToForeground, MoveForward, ObjectProperties}})},
    };
    for (const Row& row : rows) {
        EditorRig rig;
        rig.select(row.state, row.fixture);
        if (row.fixture >= 1 && row.fixture <= 3) rig.simulation->Fixtures[row.fixture].Locked = row.fixtureLocked;
        rig.simulation->Props[1].Locked = row.propLocked;
        CommandStates states;
        CheckEnable(false, rig.inputs(), states);
        EXPECT_EQ(offered(states), together({kTools, kOfDocument, kOfFixtures, row.besides})) << row.name;
        const bool lockable = std::ranges::count(row.besides, Lock) + std::ranges::count(row.besides, Unlock) > 0;
        EXPECT_EQ(states[EditLocks].enabled, lockable) << row.name;
        EXPECT_TRUE(states[Order].enabled) << row.name;  // the levels themselves can always be edited
    }
}

TEST(CheckEnable, AnEmptyDocumentCanBeDrawnOnButNotSelectedIn) {
    EditorRig rig;
    rig.simulation->FixtureCount = 0;
    CommandStates states;
    CheckEnable(false, rig.inputs(), states);
    EXPECT_EQ(offered(states), together({kTools, kOfDocument}));
}

TEST(CheckEnable, ClipboardAndUndoNeedSomethingToGiveBack) {
    EditorRig rig;
    rig.editor.ZephClipboard.resize(1);
    rig.undo = {1, 0};
    CommandStates states;
    CheckEnable(false, rig.inputs(), states);
    EXPECT_TRUE(states[PasteObject].enabled);
    EXPECT_TRUE(states[Undo].enabled);
    EXPECT_FALSE(states[Redo].enabled);
    rig.undo = {0, 1};
    rig.editor.ZephUIState = kStateSimulation;
    CheckEnable(false, rig.inputs(), states);
    EXPECT_FALSE(states[Undo].enabled);
    EXPECT_FALSE(states[Redo].enabled);
    EXPECT_FALSE(states.band.picToolBarButtonContainer);
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
    EXPECT_TRUE(states[Help].visible);
    EXPECT_FALSE(states.popContextMenu);
    EXPECT_EQ(states.band, (OptionsBandState{false, false, false, false, false, false, false, false, false, false}));

    rig.editor = {};
    CheckEnable(false, rig.inputs(), states);
    EXPECT_EQ(states, before);
}

TEST(CheckEnable, ButtonsAndBandFollowTheirCommands) {
    EditorRig rig;
    rig.select(kStateSelectFixture, 2);
    CommandStates states;
    CheckEnable(true, rig.inputs(), states);
    EXPECT_FALSE(states.editButtons[10]);  // forward, from the top level
    EXPECT_TRUE(states.editButtons[11]);   // backward
    EXPECT_FALSE(states.editButtons[4]);   // a gap
    EXPECT_TRUE(states.drawButtons[14]);
    EXPECT_TRUE(states.band.chkNames);
    CommandInputs nameless = rig.inputs();
    nameless.NameLocation = 0;  // names that have no place cannot be hidden
    CheckEnable(true, nameless, states);
    EXPECT_FALSE(states.band.chkNames);
    EXPECT_TRUE(states.band.sldIntensity);
}

TEST(CommandTable, HasEveryButtonInItsPlace) {
    const std::tuple<int, const char*, const char*> rows[] = {{0, "", ""},
                                                              {1, "mnuFileNew", "mnuSimulationMode"},
                                                              {4, "", ""},
                                                              {9, "mnuSendToBackground", ""},
                                                              {15, "", ""},
                                                              {18, "mnuPasteObject", "mnuInsertProp"},
                                                              {21, "mnuRedo", "mnuCreateNewItem"},
                                                              {26, "mnuLoadQenReference", ""},
                                                              {27, "", ""}};
    for (const auto& [index, edit, draw] : rows) {
        EXPECT_EQ(commandRow(editButtonCommand(index)).name, edit) << index;
        EXPECT_EQ(commandRow(drawButtonCommand(index)).name, draw) << index;
    }
}

TEST(CommandTable, GivesNoKeyAndNoAcceleratorTwice) {
    std::vector<std::string_view> keys;
    std::map<Command, std::string> letters;
    for (const CommandRow& row : kCommandTable) {
        if (!row.shortcut.empty()) keys.push_back(row.shortcut);
        const std::size_t mark = row.caption.find('&');
        // Two of the drawing tools have the same letter: the menu then goes from one to the other.
        if (mark == std::string_view::npos || row.id == KeshWizard) continue;
        const char letter = static_cast<char>(std::toupper(row.caption[mark + 1]));
        EXPECT_EQ(letters[row.menu].find(letter), std::string::npos) << row.caption;
        letters[row.menu] += letter;
    }
    std::ranges::sort(keys);
    EXPECT_EQ(std::ranges::adjacent_find(keys), keys.end());
}

TEST(ToolBarTexts, NameTheLevelAndTheTopOfTheStores) {
    EditorRig rig;
    EditToolBarTexts texts;
    ZephUndoStores stores;
    stores.UndoStore.push_back({kUndoCut, "Cut Wreath", kStateSelectFixture, 1, {}});
    stores.UndoPosition = 1;
    rig.select(kStateSelectFixture, 1);
    SetEditToolBarTips(*rig.simulation, rig.editor, stores, texts);
    EXPECT_EQ(texts.MoveForwardTip, "Move Forward (to level:6)");
    EXPECT_EQ(texts.MoveBackwardTip, "Move Backward (to level:4)");
    EXPECT_EQ(texts.Undo.undoTip, "Undo: Cut Wreath");
    EXPECT_EQ(texts.Undo.undoItem, "Undo Cut Wreath");
    EXPECT_EQ(texts.Undo.redoTip, "Redo");
    EXPECT_EQ(texts.ObjectProperties, "Fixture Properties");
    rig.select(kStateSelectFixture, 2);
    SetEditToolBarTips(*rig.simulation, rig.editor, {}, texts);
    EXPECT_EQ(texts.MoveForwardTip, "Move Forward");
    EXPECT_EQ(texts.MoveBackwardTip, "Move Backward (to level:15)");
    EXPECT_EQ(texts.Undo.undoItem, "Undo");
    rig.select(kStateSelectProp, 3);
    SetEditToolBarTips(*rig.simulation, rig.editor, {}, texts);
    EXPECT_EQ(texts.MoveForwardTip, "Move Forward");
    EXPECT_EQ(texts.ObjectProperties, "Prop Properties");
    rig.editor.ZephUIState = kStateDrawing;
    SetEditToolBarTips(*rig.simulation, rig.editor, {}, texts);
    EXPECT_EQ(texts.ObjectProperties, "Prop Properties");  // a state that selects nothing leaves it
}

TEST(ToolBarTexts, TellTheStateInPanelTwo) {
    EditorRig rig;
    const auto text = [&](int state, int fixture, bool suppress = false) {
        rig.select(state, fixture);
        return ZephUpdateStatusBarForUIState(*rig.simulation, rig.editor, suppress);
    };
    EXPECT_EQ(text(kStateSimulation, 0), "Simulation Active");
    EXPECT_EQ(text(kStateSelectProp, 0), "Select Prop");
    EXPECT_EQ(text(kStateSelectProp, 1), "Prop Selected:Wreath");
    EXPECT_EQ(text(kStateSelectProp, 2, true), "Prop Selected:Snowman (arm)");
    EXPECT_EQ(text(kStateSelectFixture, 0), "Select Fixture");
    EXPECT_EQ(text(kStateSelectFixture, 3), "Fixture Selected:Hat - Layer:1");
    EXPECT_EQ(text(kStateSelectFixture, 3, true), "Select Fixture");
    EXPECT_EQ(text(kStateDrawing, 0), "Drawing");
    rig.simulation->SimulationOpen = false;
    EXPECT_EQ(text(kStateDrawing, 0), "");
}

TEST(ToolBarTexts, TheBandShowsTheDocumentsBrightnessAndThatNamesAreHidden) {
    EditorRig rig;
    ZephSettings settings;
    settings.DisableFixtureText = true;
    rig.simulation->Background.PicIntensity = 40;
    EXPECT_EQ(ZephSetOptionsToolbandStuff(settings, *rig.simulation).sldIntensity, 40);
    EXPECT_TRUE(ZephSetOptionsToolbandStuff(settings, *rig.simulation).chkNames);
    rig.simulation->SimulationOpen = false;
    EXPECT_EQ(ZephSetOptionsToolbandStuff(settings, *rig.simulation).sldIntensity, 100);
}
