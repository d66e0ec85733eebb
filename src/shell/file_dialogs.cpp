#include "shell/file_dialogs.h"

#include "model/data_directories.h"
#include "shell/window_host.h"

#include <QFileDialog>

namespace {

// "Words|*.ext" as the toolkit spells it.
QString shownFilter(std::string_view filter) {
    const QStringList parts = toQString(filter).split('|');
    return QString("%1 (%2)").arg(parts.value(0), parts.value(1));
}

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

QString WindowFileDialogs::ask(const FileDialog& dialog, const QString& start, bool save) {
    QFileDialog box(&owner_, toQString(dialog.title), start, shownFilter(dialog.filter));
    box.setAcceptMode(save ? QFileDialog::AcceptSave : QFileDialog::AcceptOpen);
    box.setFileMode(save ? QFileDialog::AnyFile : QFileDialog::ExistingFile);
    // Asked here instead: the dialog does not know the name with its extension.
    box.setOption(QFileDialog::DontConfirmOverwrite);
    if (QFileInfo(start).isFile() || !QFileInfo(start).isDir()) box.selectFile(start);
    return box.exec() == QDialog::Accepted ? box.selectedFiles().value(0) : QString();
}

bool WindowFileDialogs::chooseInput(const FileDialog& dialog, std::string& fullPath) {
    const QString chosen = ask(dialog, startFolder(dialog), false);
    fullPath = chosen.toStdString();
    return !chosen.isEmpty();
}

bool WindowFileDialogs::chooseOutput(const FileDialog& dialog, std::string& fullPath) {
    QString start = startFolder(dialog);
    for (;;) {
        const QString chosen = ask(dialog, start, true);
        if (chosen.isEmpty()) return false;
        const QString path = withExtension(chosen, dialog.extension);
        fullPath = path.toStdString();
        if (!QFileInfo::exists(path)) return true;
        const std::string question = fullPath + " already exists.\r\nDo you want to replace it?";
        if (program_.seams.host.messageBox(dialog.title, question, BoxIcon::Warning, BoxButtons::YesNo) ==
            BoxAnswer::Yes) {
            return true;
        }
        start = path;
    }
}
