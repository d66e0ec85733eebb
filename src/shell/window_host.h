// The host of the window program: real message boxes over the main window, its status panels, the busy pointer, and
// the one place where waiting events get a turn.
#pragma once

#include "util/host.h"

#include <QString>

#include <functional>

class QWidget;

class WindowHost : public Host {
public:
    // What shows a status panel's text; both are set once the main window stands.
    using PanelWriter = std::function<void(int panel, const QString& text)>;
    void attach(QWidget* window, PanelWriter panels);

    BoxAnswer messageBox(std::string_view title, std::string_view text, BoxIcon icon, BoxButtons buttons) override;
    void setStatusPanel(int panel, std::string_view text) override;
    void setBusyPointer(bool busy) override;
    void showCompileErrors(std::string_view text) override;
    // Does nothing while it is already at work: an event that it runs must not start another round.
    void pumpEvents() override;

private:
    QWidget* window_ = nullptr;
    PanelWriter panels_;
    bool busy_ = false;
    bool pumping_ = false;
};

QString toQString(std::string_view utf8);
