#include "editor/command_table.h"

#include "editor/editor_state.h"

namespace {

using enum Command;
using enum CommandKind;

constexpr bool kGap = true;
constexpr bool kBuilt = true;

// clang-format off
constexpr std::array<CommandRow, kCommands> kRows{{
    {},
    {File, "mnufile", "", None, Menu, "&File", "", "", "", 0, 0, false, kBuilt},
    {Edit, "mnuEdit", "", None, Menu, "&Edit", "", "", "", 0, 0, false, kBuilt},
    {Debug, "mnuDebug", "", None, Menu, "&Debug", "", "", "", 0, 0, false, kBuilt},
    {Help, "mnuHelp", "", None, Menu, "&Help", "", "", "", 0, 0, false, kBuilt},

    {FileNew, "mnuFileNew", "", File, Action, "&New...", "Ctrl+N", "New Simulation", "file-new", 1, 0, false, kBuilt},
    {FileLoad, "mnuFileLoad", "", File, Action, "&Open...", "Ctrl+O", "Open Simulation", "file-open", 2, 0, false, kBuilt},
    {FileRecent, "mnuFileRecent", "", File, Menu, "Open &Recent", "", "", "", 0, 0, false, kBuilt},
    {FileSave, "mnuFileSave", "", File, Action, "&Save", "Ctrl+S", "Save Simulation", "file-save", 3, 0, kGap, kBuilt},
    {FileSaveAs, "mnuFileSaveAs", "", File, Action, "Save &As...", "Ctrl+Shift+S", "Save Simulation As", "file-save-as", 0, 0, false, kBuilt},
    {LoadQenReference, "mnuLoadQenReference", "", File, Action, "&Load Reference Channels...", "Ctrl+R", "Load Reference Channels", "reference", 26, 0, kGap},
    {FileOptions, "mnuFileOptions", "", File, Action, "O&ptions...", "Ctrl+,", "Options", "options", 0, 0, false, kBuilt},
    {FileExit, "mnuFileExit", "", File, Action, "E&xit", "Ctrl+Q", "Exit", "exit", 0, 0, kGap, kBuilt},

    {Undo, "mnuUndo", "popUndo", Edit, Action, "Undo", "Ctrl+Z", "Undo", "undo", 20, 0, false, kBuilt},
    {Redo, "mnuRedo", "popRedo", Edit, Action, "Redo", "Ctrl+Y; Ctrl+Shift+Z", "Redo", "redo", 21, 0, false, kBuilt},
    {Cut, "mnuCut", "popCut", Edit, Action, "Cu&t", "Ctrl+X", "Cut", "cut", 16, 0, kGap},
    {CopyObject, "mnuCopyObject", "popCopyObject", Edit, Action, "&Copy", "Ctrl+C", "Copy", "copy", 17, 0},
    {PasteObject, "mnuPasteObject", "popPasteObject", Edit, Action, "&Paste", "Ctrl+V", "Paste", "paste", 18, 0},
    {DeleteObject, "mnuDeleteObject", "popDeleteObject", Edit, Action, "&Delete", "Del", "Delete", "delete", 6, 0},
    {HomeObject, "mnuHomeObject", "popHomeObject", Edit, Action, "&Home Object", "Ctrl+Home", "Move to the Upper Left Corner", "home", 5, 0, kGap},
    {Order, "mnuOrder", "popOrder", Edit, Menu, "&Order", "", "", "", 0, 0, false, kBuilt},
    {SendToForeground, "mnuSendToForeground", "popSendToForeground", Order, Action, "Send to &Foreground", "Ctrl+PgUp", "Send to Foreground", "to-foreground", 8, 0},
    {SendToBackground, "mnuSendToBackground", "popSendToBackground", Order, Action, "Send to &Background", "Ctrl+PgDown", "Send to Background", "to-background", 9, 0},
    {MoveForward, "mnuMoveForward", "popMoveForward", Order, Action, "&Move Forward", "+", "Move Forward", "forward", 10, 0},
    {MoveBackward, "mnuMoveBackward", "popMoveBackward", Order, Action, "Mo&ve Backward", "-", "Move Backward", "backward", 11, 0},
    {EditLevels, "mnuEditLevels", "popEditLevels", Order, Action, "Edit &Levels...", "Ctrl+L", "Edit Levels", "levels", 0, 20, kGap},
    {EditLocks, "mnuEditLocks", "popEditLocks", Edit, Menu, "Loc&ks", "", "", "", 0, 0, false, kBuilt},
    {Lock, "mnuLock", "popLock", EditLocks, Action, "&Lock", "Ctrl+K", "Lock", "lock", 13, 0},
    {Unlock, "mnuUnlock", "popUnlock", EditLocks, Action, "&Unlock", "Ctrl+Shift+K", "Unlock", "unlock", 14, 0},
    {Insert, "mnuInsert", "", Edit, Menu, "&Insert", "", "", "", 0, 0, kGap, kBuilt},
    {InsertFixture, "mnuInsertFixture", "", Insert, Action, "Insert &Fixture...", "Ctrl+Shift+F", "Insert Fixture", "insert-fixture", 0, 16, false, kBuilt},
    {InsertSymbol, "mnuInsertSymbol", "", Insert, Action, "Insert &Symbol...", "Ctrl+Shift+T", "Insert Symbol", "insert-symbol", 0, 17},
    {InsertProp, "mnuInsertProp", "", Insert, Action, "Insert &Prop...", "Ctrl+Shift+P", "Insert Prop", "insert-prop", 0, 18, false, kBuilt},
    {CreateNewItem, "mnuCreateNewItem", "", Edit, Action, "Create &New Prop...", "Ctrl+G", "Create New Prop", "new-prop", 0, 21},
    {ItemTool, "mnuItemTool", "", Edit, Toggle, "Prop &Select Tool", "F2", "Prop Select Tool", "select-prop", 0, 2, kGap, kBuilt},
    {Select, "mnuSelect", "", Edit, Toggle, "&Fixture Select Tool", "F3", "Fixture Select Tool", "select-fixture", 0, 3, false, kBuilt},
    {Toolbox, "mnutoolbox", "", Edit, Menu, "D&rawing Tools", "", "", "", 0, 0, false, kBuilt},
    {Draw, "mnuDraw", "", Toolbox, Toggle, "Draw &Light Strings", "Ctrl+1", "Draw Light Strings", "draw-strings", 0, 5},
    {DrawKeshs, "mnuDrawKeshs", "", Toolbox, Toggle, "Draw &Kesh", "Ctrl+2", "Draw Kesh", "draw-kesh", 0, 6},
    {DrawFloods, "mnuDrawFloods", "", Toolbox, Toggle, "Draw Floo&d Lights", "Ctrl+3", "Draw Flood Lights", "draw-floods", 0, 7},
    {DrawBulbs, "mnuDrawBulbs", "", Toolbox, Toggle, "Draw Single &Bulbs", "Ctrl+4", "Draw Single Bulbs", "draw-bulbs", 0, 8},
    {ArchWizard, "mnuArchWizard", "", Toolbox, Toggle, "&Arch Wizard", "Ctrl+5", "Arch Wizard", "wizard-arch", 0, 10, kGap},
    {TreeWizard, "mnuTreeWizard", "", Toolbox, Toggle, "&Tree Wizard", "Ctrl+6", "Tree Wizard", "wizard-tree", 0, 11},
    {KeshWizard, "mnuKeshWizard", "", Toolbox, Toggle, "Draw &Kesh Wizard", "Ctrl+7", "Draw Kesh Wizard", "wizard-kesh", 0, 12},
    {KeshMatrixWizard, "mnuKeshMatrixWizard", "", Toolbox, Toggle, "&Matrix Wizard", "Ctrl+8", "Matrix Wizard", "wizard-matrix", 0, 13},
    {DrawPixelWizard, "mnuDrawPixelWizard", "", Toolbox, Toggle, "Draw &Pixel Wizard...", "Ctrl+9", "Draw Pixel Wizard", "wizard-pixel", 0, 14},
    {SimulationMode, "mnuSimulationMode", "", Edit, Toggle, "Si&mulation Mode", "F5", "Simulation Mode", "simulate", 0, 1, false, kBuilt},
    {ObjectProperties, "mnuObjectProperties", "popObjectProperties", Edit, Action, "Fixture Properties", "Alt+Return", "Fixture Properties", "properties", 23, 0, kGap},
    {BackgroundProperties, "mnuBackgroundProperties", "popBackgroundProperties", Edit, Action, "Back&ground Properties...", "Ctrl+B", "Background Properties", "background", 24, 0, false, kBuilt},

    {HelpAbout, "mnuHelpAbout", "", Help, Action, "&About...", "", "", "about", 0, 0, false, kBuilt},
}};
// clang-format on

constexpr bool rowsStandInOrder() {
    for (std::size_t row = 1; row < kRows.size(); ++row) {
        if (kRows[row].id != static_cast<Command>(row)) return false;
    }
    return true;
}
static_assert(rowsStandInOrder());

constexpr bool buttonsAreInRangeAndUnique() {
    std::array<int, kEditButtons + 1> edit{};
    std::array<int, kDrawButtons + 1> draw{};
    for (const CommandRow& row : kRows) {
        if (row.editButton < 0 || row.editButton > kEditButtons || row.drawButton < 0 ||
            row.drawButton > kDrawButtons) {
            return false;
        }
        if (row.editButton > 0 && ++edit[static_cast<std::size_t>(row.editButton)] > 1) return false;
        if (row.drawButton > 0 && ++draw[static_cast<std::size_t>(row.drawButton)] > 1) return false;
    }
    return true;
}
static_assert(buttonsAreInRangeAndUnique());

constexpr std::array<Command, 10> kToolCommands{None,       Draw,       DrawKeshs,  DrawFloods,       DrawBulbs,
                                                ArchWizard, TreeWizard, KeshWizard, KeshMatrixWizard, DrawPixelWizard};

Command withButton(int CommandRow::*button, int index) noexcept {
    if (index < 1) return None;
    const auto row = std::ranges::find(kRows, index, button);
    return row == kRows.end() ? None : row->id;
}

}  // namespace

constinit const std::array<CommandRow, kCommands> kCommandTable = kRows;

const CommandRow& commandRow(Command command) noexcept {
    return kCommandTable[static_cast<std::size_t>(command)];
}

Command editButtonCommand(int index) noexcept {
    return withButton(&CommandRow::editButton, index);
}

Command drawButtonCommand(int index) noexcept {
    return withButton(&CommandRow::drawButton, index);
}

Command toolCommand(int tool) noexcept {
    const bool known = tool >= 1 && tool < static_cast<int>(kToolCommands.size());
    return known ? kToolCommands[static_cast<std::size_t>(tool)] : None;
}

int commandTool(Command command) noexcept {
    if (command == None) return 0;
    const auto found = std::ranges::find(kToolCommands, command);
    return found == kToolCommands.end() ? 0 : static_cast<int>(found - kToolCommands.begin());
}
