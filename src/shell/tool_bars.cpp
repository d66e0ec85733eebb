#include "shell/tool_bars.h"

#include <QAction>
#include <QHBoxLayout>
#include <QHelpEvent>
#include <QToolBar>
#include <QToolButton>
#include <QToolTip>
#include <QVBoxLayout>

namespace {

constexpr int kIconPixels = 20;

QString tipWithKeys(const QAction& action) {
    const QString tip = action.toolTip().toHtmlEscaped();
    const QString keys = action.shortcut().toString(QKeySequence::NativeText).toHtmlEscaped();
    return keys.isEmpty() ? tip : QString("<nobr>%1 &nbsp; <b>%2</b></nobr>").arg(tip, keys);
}

}  // namespace

CoolBar::CoolBar(const CommandActions& actions, QWidget* parent) : QWidget(parent) {
    setObjectName("CoolBar1");
    EditToolBar_ = buildBar("EditToolBar", kEditButtons, editButtonCommand, actions);
    DrawToolBar_ = buildBar("DrawToolBar", kDrawButtons, drawButtonCommand, actions);
    band_ = new OptionsBand(this);

    rows_ = new QVBoxLayout(this);
    rows_->setContentsMargins(6, 3, 8, 4);
    rows_->setSpacing(2);
    arrange(firstToolBandLayout());
}

void CoolBar::arrange(const ToolBandLayout& layout) {
    while (QLayoutItem* row = rows_->takeAt(0))
        delete row;  // a row owns its places, not the bars in them
    QHBoxLayout* row = nullptr;
    for (const ToolBand& place : layout.Bands) {
        auto* bar = findChild<QWidget*>(QString::fromStdString(place.ChildName), Qt::FindDirectChildrenOnly);
        if (bar == nullptr) continue;
        if (row == nullptr || place.NewRow) {
            row = new QHBoxLayout;
            row->setSpacing(8);
            rows_->addLayout(row);
        } else {
            row->addStretch();
        }
        row->addWidget(bar);
    }
}

QToolBar* CoolBar::buildBar(const char* name, int buttons, Command (*commandAt)(int), const CommandActions& actions) {
    auto* bar = new QToolBar(this);
    bar->setObjectName(name);
    bar->setIconSize(QSize(kIconPixels, kIconPixels));
    for (int index = 1; index <= buttons; ++index) {
        const Command command = commandAt(index);
        if (command == Command::None) {
            bar->addSeparator();
            continue;
        }
        bar->addAction(actions.action(command));
        QWidget* button = bar->widgetForAction(actions.action(command));
        button->setObjectName(QString("%1(%2)").arg(name).arg(index));
        button->setFocusPolicy(Qt::NoFocus);  // keys belong to the form
        button->installEventFilter(this);
    }
    return bar;
}

void CoolBar::show(const CommandStates& states, bool frozen) {
    EditToolBar_->setEnabled(states.toolBars && !frozen);
    DrawToolBar_->setEnabled(states.toolBars && !frozen);
    band_->show(states.band);
}

bool CoolBar::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::ToolTip) return QWidget::eventFilter(watched, event);
    auto* button = static_cast<QToolButton*>(watched);
    QToolTip::showText(static_cast<QHelpEvent*>(event)->globalPos(), tipWithKeys(*button->defaultAction()), button);
    return true;
}
