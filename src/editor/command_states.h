// Which commands are available: computed whole from the document and the editor's state after every command, mouse
// operation and change of the selection. Pure: the window shows what comes out.
#pragma once

#include "editor/command_table.h"
#include "editor/editor_state.h"
#include "model/simulation.h"

#include <string>

struct CommandInputs {
    const ZephSimulation& simulation;
    const ZephEditorState& editor;
    UndoSummary undo;
    std::int32_t NameLocation = 0;  // row of the fixture text location table, 0 = no names
    bool RunningInDevelopment = false;
};

struct CommandState {
    bool enabled = true;
    bool visible = true;
    bool checked = false;  // shown pressed

    bool operator==(const CommandState&) const = default;
};

// The options band, control by control.
struct OptionsBandState {
    bool picToolBarButtonContainer = true;
    bool cmdTextColor = true;
    bool cmdToolHandleColor = true;
    bool cmdVertexHandleColor = true;
    bool cmdGridLineColor = true;
    bool cmbGridLineOption = true;
    bool lblToolHandleColor = true;
    bool lblVertexHandleColor = true;
    bool sldIntensity = true;
    bool chkNames = true;

    bool operator==(const OptionsBandState&) const = default;
};

struct CommandStates {
    CommandStates();

    CommandState& operator[](Command command) noexcept { return commands[static_cast<std::size_t>(command)]; }
    const CommandState& operator[](Command command) const noexcept {
        return commands[static_cast<std::size_t>(command)];
    }
    bool operator==(const CommandStates&) const = default;

    std::array<CommandState, kCommands> commands;      // menu items; a pop... twin follows its mnu... item
    std::array<bool, kEditButtons + 1> editButtons{};  // EditToolBar by index, gaps stay false
    std::array<bool, kDrawButtons + 1> drawButtons{};  // DrawToolBar by index, gaps stay false
    bool toolBars = true;                              // EditToolBar and DrawToolBar as wholes
    bool popContextMenu = true;
    OptionsBandState band;
};

// forceEnable: both tool bars' buttons are enabled first. states: as the last call left them; while a stroke is under
// way the menu items keep what they had.
void CheckEnable(bool forceEnable, const CommandInputs& inputs, CommandStates& states);

// Part of the above, also run by itself once the options have changed.
void OptionsToolbandCheckEnable(const CommandInputs& inputs, OptionsBandState& band);
