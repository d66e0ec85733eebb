// The commands as a window has them: one action a row of the command table, the menus that hold them, the context
// menu with their twins. Built once; shows whatever states and texts it is given.
#pragma once

#include "editor/command_states.h"
#include "editor/tool_bar_texts.h"

#include <QStringList>

#include <functional>

class QAction;
class QMenu;
class QMenuBar;
class QWidget;

class CommandActions {
public:
    static constexpr int kRecentFiles = 4;

    // owner: the window whose keys run the commands. run is called for each command chosen; recent for an entry of the
    // recent files, from 0.
    CommandActions(QWidget& owner, QMenuBar& bar, std::function<void(Command)> run, std::function<void(int)> recent);

    // frozen: neither menus nor keys reach any command (a running simulation, a stroke).
    void show(const CommandStates& states, bool frozen);
    void show(const EditToolBarTexts& texts);
    // Captions newest first; none hides the menu.
    void showRecentFiles(const QStringList& captions);

    QAction* action(Command command) const { return actions_[static_cast<std::size_t>(command)]; }
    QMenu* contextMenu() const { return popContextMenu_; }

private:
    void addMenu(const CommandRow& row, QMenuBar& bar);
    void addAction(const CommandRow& row);
    void addTwin(const CommandRow& row);
    void setTexts(Command command, const QString& caption, const QString& tip);
    QAction* twin(Command command) const { return twins_[static_cast<std::size_t>(command)]; }
    QMenu* menu(Command command) const { return menus_[static_cast<std::size_t>(command)]; }

    QWidget& owner_;
    std::function<void(Command)> run_;
    std::array<QAction*, kCommands> actions_{};  // of a menu: the action that opens it
    std::array<QAction*, kCommands> twins_{};    // in popContextMenu, null = none
    std::array<QMenu*, kCommands> menus_{};
    std::array<QMenu*, kCommands> twinMenus_{};
    QMenu* popContextMenu_ = nullptr;
    std::array<QAction*, kRecentFiles> mnuRecentFiles_{};
};
