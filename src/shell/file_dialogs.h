// Which file to read or to write: where the dialogs start, the extension, and the question before a file is replaced.
#pragma once

#include "editor/file_dialogs.h"
#include "shell/program.h"
#include "shell/window_host.h"

class WindowFileDialogs : public FileDialogs {
public:
    WindowFileDialogs(const Program& program, WindowHost& host) : program_(program), host_(host) {}

    bool chooseInput(const FileDialog& dialog, std::string& fullPath) override;
    bool chooseOutput(const FileDialog& dialog, std::string& fullPath) override;

private:
    QString startFolder(const FileDialog& dialog) const;
    bool mayReplace(const FileDialog& dialog, const QString& path);

    const Program& program_;
    WindowHost& host_;
};
