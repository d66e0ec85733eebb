// Every command of the program, one row each: its names, caption, place, keys, tip and picture. Menus, context menu and
// both tool bars are built from these rows, so that a command looks and answers alike wherever it stands.
#pragma once

#include <array>
#include <cstdint>
#include <string_view>

enum class Command : std::uint8_t {
    None,
    // Menus of the menu bar
    File,
    Edit,
    Debug,
    Help,
    // File
    FileNew,
    FileLoad,
    FileRecent,
    FileSave,
    FileSaveAs,
    LoadQenReference,
    FileOptions,
    FileExit,
    // Edit
    Undo,
    Redo,
    Cut,
    CopyObject,
    PasteObject,
    DeleteObject,
    HomeObject,
    Order,
    SendToForeground,
    SendToBackground,
    MoveForward,
    MoveBackward,
    EditLevels,
    EditLocks,
    Lock,
    Unlock,
    Insert,
    InsertFixture,
    InsertSymbol,
    InsertProp,
    CreateNewItem,
    ItemTool,
    Select,
    Toolbox,
    Draw,
    DrawKeshs,
    DrawFloods,
    DrawBulbs,
    ArchWizard,
    TreeWizard,
    KeshWizard,
    KeshMatrixWizard,
    DrawPixelWizard,
    SimulationMode,
    ObjectProperties,
    BackgroundProperties,
    // Help
    HelpAbout,
    Count,
};

inline constexpr std::size_t kCommands = static_cast<std::size_t>(Command::Count);

enum class CommandKind : std::uint8_t { Menu, Action, Toggle };  // a Toggle's button stays pressed

struct CommandRow {
    Command id = Command::None;
    std::string_view name;         // object name
    std::string_view pop;          // its twin in popContextMenu, "" = none
    Command menu = Command::None;  // the menu that it stands in, None = the menu bar
    CommandKind kind = CommandKind::Action;
    std::string_view caption;   // with its accelerator
    std::string_view shortcut;  // keys in their portable spelling, "; " between alternatives
    std::string_view tip;       // of its buttons
    std::string_view icon;      // file name in assets/icons without its ending
    int editButton = 0;         // index in EditToolBar from 1, 0 = none
    int drawButton = 0;         // index in DrawToolBar from 1, 0 = none
    bool gapBefore = false;     // a separator above it in its menu
    bool built = false;         // has an implementation; the window keeps the others disabled
};

// Row i describes the command of number i.
extern const std::array<CommandRow, kCommands> kCommandTable;

inline constexpr int kEditButtons = 26;  // highest index in EditToolBar; an index without a command is a gap
inline constexpr int kDrawButtons = 21;  // and in DrawToolBar

const CommandRow& commandRow(Command command) noexcept;

// The command of a button, None for a gap and for an index out of range.
Command editButtonCommand(int index) noexcept;
Command drawButtonCommand(int index) noexcept;

// The command that arms a tool 1..9 and, the other way round, the tool of a command; None and 0 where there is none.
Command toolCommand(int tool) noexcept;
int commandTool(Command command) noexcept;
