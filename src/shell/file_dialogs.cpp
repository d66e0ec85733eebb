#include "shell/file_dialogs.h"

#include "model/data_directories.h"

#include <QFileInfo>

namespace {

QString withExtension(const QString& path, std::string_view extension) {
    const QString wanted = toQString(extension);
    return path.endsWith(wanted, Qt::CaseInsensitive) ? path : path + wanted;
}

}  // namespace

QString WindowFileDialogs::startFolder(const FileDialog& dialog) const {
    const auto folder = [&](const ZephSettings& settings) {
        return QString::fromStdString(ZephReturnDataDirectory(dialog.folder, program_.paths, settings));
    };
    const QString last = folder(program_.settings);
    return QFileInfo(last).isDir() ? last : folder(ZephSettings{});  // the last one may be gone, with its disk
}

bool WindowFileDialogs::chooseInput(const FileDialog& dialog, std::string& fullPath) {
    const QString chosen = host_.askFile(dialog, startFolder(dialog), false);
    fullPath = chosen.toStdString();
    return !chosen.isEmpty();
}

bool WindowFileDialogs::chooseOutput(const FileDialog& dialog, std::string& fullPath) {
    QString folder = startFolder(dialog);
    for (;;) {
        const QString chosen = host_.askFile(dialog, folder, true);
        if (chosen.isEmpty()) return false;
        const QString path = withExtension(chosen, dialog.extension);
        if (!QFileInfo::exists(path) || mayReplace(dialog, path)) {
            fullPath = path.toStdString();
            return true;
        }
        folder = QFileInfo(path).absolutePath();
    }
}

bool WindowFileDialogs::mayReplace(const FileDialog& dialog, const QString& path) {
    const std::string question = path.toStdString() + " already exists.\r\nDo you want to replace it?";
    return host_.messageBox(dialog.title, question, BoxIcon::Warning, BoxButtons::YesNo) == BoxAnswer::Yes;
}
