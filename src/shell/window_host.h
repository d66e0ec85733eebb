// The host of the window program: real message boxes and file dialogs over the main window, its status panels, the busy
// pointer, and the one place where waiting events get a turn.
#pragma once

#include "editor/file_dialogs.h"
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
    // The file that is chosen, "" = cancelled. save: it need not exist, and nothing is asked where it does.
    virtual QString askFile(const FileDialog& dialog, const QString& folder, bool save);

private:
    // Over an open dialog a box belongs to that dialog, or it could come to lie behind it.
    QWidget* owner() const;

    QWidget* window_ = nullptr;
    PanelWriter panels_;
    bool busy_ = false;
    bool pumping_ = false;
};

QString toQString(std::string_view utf8);
