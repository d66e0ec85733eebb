// The file dialogs of the window.
#pragma once

#include "editor/file_dialogs.h"
#include "shell/program.h"

class QWidget;

class WindowFileDialogs : public FileDialogs {
public:
    WindowFileDialogs(QWidget& owner, const Program& program) : owner_(owner), program_(program) {}

    bool chooseInput(const FileDialog& dialog, std::string& fullPath) override;
    bool chooseOutput(const FileDialog& dialog, std::string& fullPath) override;

private:
    QString startFolder(const FileDialog& dialog) const;
    QString ask(const FileDialog& dialog, const QString& start, bool save);

    QWidget& owner_;
    const Program& program_;
};
