#include "model/data_directories.h"

#include "util/text.h"

namespace {

std::string folderOf(const std::string& recentFile, const std::string& otherwise) {
    return recentFile.empty() ? otherwise : ZephPathFromFullPath(recentFile);
}

}  // namespace

std::string ZephReturnDataDirectory(int kind, const ZephPathService& paths, const ZephSettings& settings) {
    const std::string base = paths.GetPath(kPathBase);
    switch (kind) {
    case 1:
        return folderOf(settings.RecentFiles[0], base + "Editor/");
    case 2:
        return folderOf(settings.LastFixtureFile, base + "Fixtures/");
    case 3:
        return folderOf(settings.LastPropFile, base + "Props/");
    case 4:
        return base + "Curves/";
    case 6:
        return paths.GetPath(kPathPrivate);
    case 7:
        return base + "System/";
    default:
        return "";
    }
}
