#include "shell/command_actions.h"

#include "shell/command_icons.h"
#include "shell/window_host.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>

namespace {

QList<QKeySequence> shortcuts(const CommandRow& row) {
    QList<QKeySequence> keys;
    for (const QString& spelled : toQString(row.shortcut).split("; ", Qt::SkipEmptyParts)) {
        keys.append(QKeySequence::fromString(spelled, QKeySequence::PortableText));
    }
    return keys;
}

}  // namespace

CommandActions::CommandActions(QWidget& owner, QMenuBar& bar, std::function<void(Command)> run,
                               std::function<void(int)> recent)
    : owner_(owner), run_(std::move(run)) {
    popContextMenu_ = new QMenu(&owner);
    popContextMenu_->setObjectName("popContextMenu");
    for (const CommandRow& row : kCommandTable) {
        if (row.id == Command::None) continue;
        if (row.kind == CommandKind::Menu) {
            addMenu(row, bar);
        } else {
            addAction(row);
        }
        if (!row.pop.empty()) addTwin(row);
    }
    for (int entry = 0; entry < kRecentFiles; ++entry) {
        QAction* item = menu(Command::FileRecent)->addAction("", &owner, [recent, entry] { recent(entry); });
        item->setObjectName(QString("mnuRecentFiles(%1)").arg(entry));
        item->setVisible(false);
        mnuRecentFiles_[static_cast<std::size_t>(entry)] = item;
    }
}

void CommandActions::addMenu(const CommandRow& row, QMenuBar& bar) {
    const std::size_t at = static_cast<std::size_t>(row.id);
    if (row.menu != Command::None && row.gapBefore) menu(row.menu)->addSeparator();
    menus_[at] = row.menu == Command::None ? bar.addMenu(toQString(row.caption))
                                           : menu(row.menu)->addMenu(toQString(row.caption));
    menus_[at]->setObjectName(toQString(row.name));
    actions_[at] = menus_[at]->menuAction();
}

void CommandActions::addAction(const CommandRow& row) {
    if (row.gapBefore) menu(row.menu)->addSeparator();
    auto* action = new QAction(toQString(row.caption), &owner_);
    action->setObjectName(toQString(row.name));
    action->setToolTip(toQString(row.tip));
    action->setShortcuts(shortcuts(row));
    action->setCheckable(row.kind == CommandKind::Toggle);
    action->setMenuRole(QAction::NoRole);
    if (!row.icon.empty()) action->setIcon(commandIcon(row.icon));
    QObject::connect(action, &QAction::triggered, &owner_, [this, command = row.id] { run_(command); });
    // A key reaches its command only through a widget that is shown, and the menu bar hides in a simulation.
    owner_.addAction(action);
    menu(row.menu)->addAction(action);
    actions_[static_cast<std::size_t>(row.id)] = action;
}

void CommandActions::addTwin(const CommandRow& row) {
    const std::size_t at = static_cast<std::size_t>(row.id);
    QMenu* into = row.menu == Command::Edit ? popContextMenu_ : twinMenus_[static_cast<std::size_t>(row.menu)];
    if (row.gapBefore) into->addSeparator();
    if (row.kind == CommandKind::Menu) {
        twinMenus_[at] = into->addMenu(toQString(row.caption));
        twins_[at] = twinMenus_[at]->menuAction();
        twinMenus_[at]->setObjectName(toQString(row.pop));
        return;
    }
    QAction* original = actions_[at];
    twins_[at] = into->addAction(original->icon(), original->text());
    twins_[at]->setObjectName(toQString(row.pop));
    setTexts(row.id, original->text(), original->toolTip());
    QObject::connect(twins_[at], &QAction::triggered, original, &QAction::trigger);
}

void CommandActions::setTexts(Command command, const QString& caption, const QString& tip) {
    action(command)->setText(caption);
    action(command)->setToolTip(tip);
    // The twin shows the keys without having them: two owners of a key would both lose it.
    if (twin(command) != nullptr) {
        const QString keys = action(command)->shortcut().toString(QKeySequence::NativeText);
        twin(command)->setText(keys.isEmpty() ? caption : caption + "\t" + keys);
    }
}

void CommandActions::show(const CommandStates& states, bool frozen) {
    for (const CommandRow& row : kCommandTable) {
        if (row.id == Command::None) continue;
        const CommandState& state = states[row.id];
        const bool enabled = state.enabled && row.built && !frozen;
        action(row.id)->setEnabled(enabled);
        if (row.kind == CommandKind::Menu && row.id != Command::FileRecent) action(row.id)->setVisible(state.visible);
        if (row.kind == CommandKind::Toggle) action(row.id)->setChecked(state.checked);
        if (twin(row.id) != nullptr) twin(row.id)->setEnabled(enabled);
    }
    // A menu below another one opens only where something in it can be chosen; inner menus stand behind outer ones.
    for (auto row = kCommandTable.rbegin(); row != kCommandTable.rend(); ++row) {
        if (row->kind != CommandKind::Menu || row->menu == Command::None) continue;
        const bool any = std::ranges::any_of(menu(row->id)->actions(), [](const QAction* item) {
            return item->isEnabled() && item->isVisible() && !item->isSeparator();
        });
        action(row->id)->setEnabled(action(row->id)->isEnabled() && any);
        if (twin(row->id) != nullptr) twin(row->id)->setEnabled(action(row->id)->isEnabled());
    }
    popContextMenu_->setEnabled(states.popContextMenu && !frozen);
}

void CommandActions::show(const EditToolBarTexts& texts) {
    action(Command::MoveForward)->setToolTip(toQString(texts.MoveForwardTip));
    action(Command::MoveBackward)->setToolTip(toQString(texts.MoveBackwardTip));
    setTexts(Command::Undo, toQString(texts.Undo.undoItem), toQString(texts.Undo.undoTip));
    setTexts(Command::Redo, toQString(texts.Undo.redoItem), toQString(texts.Undo.redoTip));
    setTexts(Command::ObjectProperties, toQString(texts.ObjectProperties), toQString(texts.ObjectProperties));
}

void CommandActions::showRecentFiles(const QStringList& captions) {
    action(Command::FileRecent)->setVisible(!captions.isEmpty());
    for (int entry = 0; entry < kRecentFiles; ++entry) {
        QAction& item = *mnuRecentFiles_[static_cast<std::size_t>(entry)];
        item.setVisible(entry < captions.size());
        if (entry < captions.size()) item.setText(captions[entry]);
    }
}
