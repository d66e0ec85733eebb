#include "shell/recent_files.h"

#include "shell/window_host.h"
#include "util/text.h"

namespace {

constexpr int kEditorFolder = 1;

bool isSeparator(QChar character) {
    return character == '/' || character == '\\';
}

}  // namespace

void ZephUpdateRecentFilesList(std::string_view path, ZephSettings& settings) {
    auto& files = settings.RecentFiles;
    auto place = std::ranges::find_if(files, [&](const std::string& file) { return equalIgnoringCase(file, path); });
    if (place == files.begin()) return;
    if (place == files.end()) {
        place = files.end() - 1;
        *place = path;
    }
    std::rotate(files.begin(), place, place + 1);
}

std::string ZephDisplayFileName(int maxLength, std::string_view folderText, std::string_view nameText) {
    QString folder = toQString(folderText);
    QString name = toQString(nameText);
    if (name.isEmpty()) {
        name = QString::fromStdString(ZephNameFromFullPath(folderText));
        folder = QString::fromStdString(ZephPathFromFullPath(folderText));
    }
    const QChar separator = folder.contains('\\') && !folder.contains('/') ? '\\' : '/';
    if (!folder.isEmpty() && !isSeparator(folder.back())) folder += separator;
    if (folder.size() + name.size() <= maxLength) return (folder + name).toStdString();

    const QString tail = QString("...") + separator + name;
    if (tail.size() > maxLength) return (name.left(maxLength - 3) + "...").toStdString();
    // A drive stands at the folder's beginning, so what fits of either is what fits of the folder.
    return (folder.left(maxLength - tail.size()) + tail).toStdString();
}

QStringList recentFileCaptions(const ZephSettings& settings, const ZephPathService& paths) {
    QStringList captions;
    for (const std::string& file : settings.RecentFiles) {
        if (file.empty()) break;
        const std::string stored = paths.CollapsePath(file, kEditorFolder);
        // An ampersand of the name is no accelerator.
        const QString shown = QString::fromStdString(
            ZephDisplayFileName(kRecentFileLength, ZephPathFromFullPath(stored), ZephNameFromFullPath(stored)));
        captions.append(QString("&%1 ").arg(captions.size() + 1) + QString(shown).replace("&", "&&"));
    }
    return captions;
}
