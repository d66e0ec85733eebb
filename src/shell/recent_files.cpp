#include "shell/recent_files.h"

#include "util/text.h"

#include <QString>

namespace {

constexpr int kCaptionLength = 35;
constexpr std::u32string_view kTail = U"...\\";
constexpr std::u32string_view kCut = U"...";

// Lengths are counted in characters, not in bytes.
std::u32string characters(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size())).toStdU32String();
}

std::string utf8(std::u32string_view text) {
    return QString::fromUcs4(text.data(), static_cast<qsizetype>(text.size())).toStdString();
}

std::string withSeparator(std::string folder) {
    if (folder.empty() || folder.ends_with('/') || folder.ends_with('\\')) return folder;
    return folder + (folder.find('\\') != std::string::npos && folder.find('/') == std::string::npos ? '\\' : '/');
}

std::string doubledAmpersands(std::string_view text) {
    std::string doubled;
    for (const char letter : text)
        doubled.append(letter == '&' ? 2 : 1, letter);
    return doubled;
}

}  // namespace

void ZephUpdateRecentFilesList(std::string_view path, ZephSettings& settings) {
    if (path.empty()) return;
    auto& files = settings.RecentFiles;
    const std::string wanted = lowerCase(path);
    auto found = std::ranges::find_if(files, [&](const std::string& file) { return lowerCase(file) == wanted; });
    if (found == files.begin()) return;
    if (found == files.end()) --found;  // the oldest, or a free place, makes room
    *found = path;
    std::rotate(files.begin(), found, found + 1);
}

std::string ZephDisplayFileName(int maxLength, std::string_view folder, std::string_view name) {
    const std::u32string shownFolder =
        characters(withSeparator(name.empty() ? ZephPathFromFullPath(folder) : std::string(folder)));
    const std::u32string shownName = characters(name.empty() ? ZephNameFromFullPath(folder) : std::string(name));
    const std::size_t most = static_cast<std::size_t>(std::max(maxLength, 0));
    if (shownFolder.size() + shownName.size() <= most) return utf8(shownFolder + shownName);
    if (shownName.size() + kTail.size() <= most) {
        // The drive is the beginning of the folder, so a drive longer than the room is cut by the same rule.
        const std::size_t room = most - kTail.size() - shownName.size();
        return utf8(shownFolder.substr(0, room).append(kTail).append(shownName));
    }
    const std::size_t kept = most - std::min(most, kCut.size());
    return utf8(shownName.substr(0, kept).append(kCut));
}

std::vector<std::string> ZephRecentFileCaptions(const ZephSettings& settings, const ZephPathService& paths) {
    std::vector<std::string> captions;
    for (const std::string& file : settings.RecentFiles) {
        if (file.empty()) break;
        const std::string stored = paths.CollapsePath(file, kPathBase);
        const std::string shown =
            ZephDisplayFileName(kCaptionLength, ZephPathFromFullPath(stored), ZephNameFromFullPath(stored));
        captions.push_back("&" + std::to_string(captions.size() + 1) + " " + doubledAmpersands(shown));
    }
    return captions;
}

StartupAction ZephStartupAction(const ZephSettings& settings) {
    constexpr int kShowDialog = 1;
    constexpr int kOpenLast = 2;
    if (settings.OnStartup == kShowDialog) return StartupAction::ShowOpenDialog;
    if (settings.OnStartup != kOpenLast) return StartupAction::Nothing;
    return settings.RecentFiles[1].empty() ? StartupAction::ShowOpenDialog : StartupAction::OpenNewest;
}
