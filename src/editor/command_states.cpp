#include "editor/command_states.h"

#include "model/document.h"

#include <initializer_list>

namespace {

using enum Command;

// What editing takes at all: tools and insertions.
constexpr std::array kDocumentCommands{Draw,         DrawKeshs,  DrawFloods,       DrawBulbs,       ArchWizard,
                                       TreeWizard,   KeshWizard, KeshMatrixWizard, DrawPixelWizard, InsertFixture,
                                       InsertSymbol, InsertProp, EditLevels};
// What takes a fixture to work on.
constexpr std::array kFixtureCommands{Select, SimulationMode, ItemTool, CreateNewItem};
constexpr std::array kFileCommands{BackgroundProperties, FileSaveAs, LoadQenReference, FileSave};
constexpr std::array kSelectionCommands{
    Cut,         CopyObject,       DeleteObject, HomeObject,      Lock, Unlock, SendToForeground,
    MoveForward, SendToBackground, MoveBackward, ObjectProperties};

template <typename Commands>
void enable(const Commands& commands, bool enabled, CommandStates& states) {
    for (const Command command : commands)
        states[command].enabled = enabled;
}

void enableSelectionCommands(const CommandInputs& inputs, CommandStates& states) {
    const ZephEditorState& editor = inputs.editor;
    const ZephFixture& fixture = fixtureOrEmpty(inputs.simulation, editor.ZephSelection.Object);
    const bool selectsFixture = editor.ZephUIState == kStateSelectFixture;
    const bool selectsProp = editor.ZephUIState == kStateSelectProp;

    enable(std::initializer_list<Command>{Cut, CopyObject, DeleteObject, HomeObject}, true, states);
    // A fixture without a prop counts as unlocked where props are selected: a prop's lock is all that is asked there.
    const bool locked = selectsFixture ? fixture.Locked : propOrEmpty(inputs.simulation, fixture.AssignedItem).Locked;
    states[Lock].enabled = (selectsFixture || selectsProp) && !locked;
    states[Unlock].enabled = (selectsFixture || selectsProp) && locked;
    const bool forward = selectsFixture && fixture.ZOrder < kLevels;
    const bool backward = selectsFixture && fixture.ZOrder > 1;
    enable(std::initializer_list<Command>{SendToForeground, MoveForward}, forward, states);
    enable(std::initializer_list<Command>{SendToBackground, MoveBackward}, backward, states);
    states[ObjectProperties].enabled = selectsFixture || (selectsProp && fixture.AssignedItem > 0);
}

// A menu whose every item is disabled is disabled itself.
void enableGroup(Command menu, std::initializer_list<Command> items, CommandStates& states) {
    states[menu].enabled = std::ranges::any_of(items, [&](Command item) { return states[item].enabled; });
}

void showPressedButtons(const ZephEditorState& editor, CommandStates& states) {
    for (const CommandRow& row : kCommandTable) {
        states[row.id].checked = row.drawButton > 0 && row.drawButton == editor.PressedDrawButton;
    }
}

// A button follows its command.
void enableButtons(CommandStates& states) {
    for (const CommandRow& row : kCommandTable) {
        if (row.editButton > 0) states.editButtons[static_cast<std::size_t>(row.editButton)] = states[row.id].enabled;
        if (row.drawButton > 0) states.drawButtons[static_cast<std::size_t>(row.drawButton)] = states[row.id].enabled;
    }
}

void enableAllButtons(bool enabled, CommandStates& states) {
    for (const CommandRow& row : kCommandTable) {
        if (row.editButton > 0) states.editButtons[static_cast<std::size_t>(row.editButton)] = enabled;
        if (row.drawButton > 0) states.drawButtons[static_cast<std::size_t>(row.drawButton)] = enabled;
    }
    states.toolBars = enabled;
}

void shutForStroke(const CommandInputs& inputs, CommandStates& states) {
    if (states.toolBars) enableAllButtons(false, states);
    for (const Command menu : {File, Edit}) {
        states[menu].enabled = false;
        states[menu].visible = false;
    }
    states.popContextMenu = false;
    OptionsToolbandCheckEnable(inputs, states.band);
}

}  // namespace

CommandStates::CommandStates() {
    enableAllButtons(true, *this);
    commands[static_cast<std::size_t>(Debug)] = {false, false, false};
    commands[static_cast<std::size_t>(FileRecent)].visible = false;
}

void CheckEnable(bool forceEnable, const CommandInputs& inputs, CommandStates& states) {
    const bool open = inputs.simulation.SimulationOpen;
    const ZephEditorState& editor = inputs.editor;
    showPressedButtons(editor, states);
    if (drawingInProgress(editor)) {
        shutForStroke(inputs, states);
        return;
    }
    if (!states.toolBars || forceEnable) enableAllButtons(true, states);
    for (const Command menu : {File, Edit, Help}) {
        states[menu].enabled = true;
        states[menu].visible = true;
    }
    states[Debug].enabled = inputs.RunningInDevelopment;
    states[Debug].visible = inputs.RunningInDevelopment;
    states.popContextMenu = true;

    enable(kDocumentCommands, open, states);
    enable(kFixtureCommands, open && inputs.simulation.FixtureCount >= 1, states);
    enable(kFileCommands, open, states);
    enable(kSelectionCommands, false, states);
    if (open && objectSelected(editor)) enableSelectionCommands(inputs, states);
    const bool editing = open && editor.ZephUIState != kStateSimulation;
    states[PasteObject].enabled = open && !editor.ZephClipboard.empty();
    states[Undo].enabled = editing && inputs.undo.UndoCount >= 1;
    states[Redo].enabled = editing && inputs.undo.RedoCount >= 1;

    enableGroup(Insert, {InsertFixture, InsertProp, InsertSymbol}, states);
    enableGroup(Order, {SendToForeground, SendToBackground, MoveForward, MoveBackward, EditLevels}, states);
    enableGroup(Toolbox, {Draw, DrawKeshs, DrawFloods, DrawBulbs}, states);
    enableGroup(EditLocks, {Lock, Unlock}, states);
    enableButtons(states);
    OptionsToolbandCheckEnable(inputs, states.band);
}

void OptionsToolbandCheckEnable(const CommandInputs& inputs, OptionsBandState& band) {
    const bool usable = inputs.editor.ZephUIState != kStateSimulation && !drawingInProgress(inputs.editor);
    band = {usable, usable, usable, usable, usable, usable, usable, usable, usable, usable};
    band.sldIntensity = usable && inputs.simulation.SimulationOpen;
    band.chkNames = usable && inputs.NameLocation != 0;
}
