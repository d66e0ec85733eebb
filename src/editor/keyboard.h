// The keyboard commands of the window: a key and the state in, what is to be done out. Key codes are the virtual key
// codes of the platform that the program's keys come from; the window translates its own into them.
#pragma once

#include "editor/command_states.h"

inline constexpr int kKeyTab = 9;
inline constexpr int kKeyEnter = 13;
inline constexpr int kKeyEsc = 27;
inline constexpr int kKeyEnd = 35;
inline constexpr int kKeyDel = 46;
inline constexpr int kKeyC = 67;
inline constexpr int kKeyV = 86;
inline constexpr int kKeyX = 88;
inline constexpr int kKeyApps = 93;
inline constexpr int kKeyNumpadAdd = 107;
inline constexpr int kKeyNumpadSubtract = 109;
inline constexpr int kKeyEquals = 187;
inline constexpr int kKeyMinus = 189;

struct KeyDown {
    int key = 0;         // kKey...
    bool ctrl = false;   // held at this instant
    bool shift = false;  // held at this instant
};

// Whether keys belong to the form at all.
struct KeyScene {
    bool focusInForm = true;
    bool reentered = false;  // the form's re-entry flag: Tab is moving the list
};

enum class KeyAction {
    None,  // the key is not for the form and goes on to whoever has the focus; every other action swallows it
    StopSimulation,
    RunCommand,
    ShowContextMenu,
    NextRow,
    PreviousRow,
    FinishDrawing,  // as picMain_DblClick
    CancelDrawing,
};

struct KeyAnswer {
    KeyAction action = KeyAction::None;
    Command command = Command::None;  // of RunCommand

    bool operator==(const KeyAnswer&) const = default;
};

KeyAnswer IWindowsHook_HookProc(const KeyDown& down, const KeyScene& scene, const CommandInputs& inputs,
                                bool popContextMenuEnabled);

// The row of the object list that Tab goes to. row: the highlighted one from 0, -1 = none; rows: how many there are, at
// least 1. Wraps at both ends; from no row at all the first is next, the last is previous.
int nextListRow(int row, int rows, bool backward) noexcept;
