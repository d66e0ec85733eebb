// CoolBar1: the two tool bars and the options band above the canvas, and the tips of their buttons, which tell the
// command's keys as well.
#pragma once

#include "shell/command_actions.h"
#include "shell/options_band.h"
#include "shell/tool_bands.h"

#include <QWidget>

class QToolBar;
class QVBoxLayout;

class CoolBar : public QWidget {
public:
    CoolBar(const CommandActions& actions, QWidget* parent);

    void show(const CommandStates& states, bool frozen);
    // Puts the bars into the rows and the order of the layout; each is as wide as what stands in it.
    void arrange(const ToolBandLayout& layout);
    OptionsBand& band() { return *band_; }

    using QWidget::show;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    // commandAt tells the command of a button's index; an index without one is a gap.
    QToolBar* buildBar(const char* name, int buttons, Command (*commandAt)(int), const CommandActions& actions);

    QToolBar* EditToolBar_ = nullptr;
    QToolBar* DrawToolBar_ = nullptr;
    OptionsBand* band_ = nullptr;
    QVBoxLayout* rows_ = nullptr;
};
