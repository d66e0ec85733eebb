#include "util/paths.h"

#include <QDir>
#include <QStandardPaths>

namespace {

// Begins every stored path that lies below the folder of its kind.
constexpr std::string_view kBaseMarker = "<base>/";

std::string withSeparator(const QString& folder) {
    const QString clean = QDir::cleanPath(folder);
    return (clean.endsWith('/') ? clean : clean + '/').toStdString();
}

}  // namespace

ZephPathService::ZephPathService(std::string_view base)
    : base_(withSeparator(QDir(QString::fromUtf8(base.data(), static_cast<qsizetype>(base.size()))).absolutePath())) {}

std::string ZephPathService::userBase() {
    const QByteArray chosen = qgetenv("ZEPH_DATA");
    if (!chosen.isEmpty()) return withSeparator(QString::fromLocal8Bit(chosen));
    return withSeparator(QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) + "/Zeph");
}

std::string ZephPathService::GetPath(int kind) const {
    switch (kind) {
    case kPathInstallation:
        return base_ + "Shared/";
    case kPathPrivate:
        return base_ + "Private/";
    case kPathBase:
        return base_;
    default:
        return "";
    }
}

std::string ZephPathService::CollapsePath(std::string_view fullPath, int kind) const {
    const std::string folder = GetPath(kind);
    if (!folder.empty() && fullPath.starts_with(folder)) {
        return std::string(kBaseMarker).append(fullPath.substr(folder.size()));
    }
    return std::string(fullPath);
}

std::string ZephPathService::ExpandPath(std::string_view storedPath, int kind) const {
    if (storedPath.starts_with(kBaseMarker)) {
        return GetPath(kind).append(storedPath.substr(kBaseMarker.size()));
    }
    return std::string(storedPath);
}

bool ZephCheckDirectoriesAtStartup(const ZephPathService& paths) {
    const QString base = QString::fromStdString(paths.GetPath(kPathBase));
    QDir().mkpath(QString::fromStdString(paths.GetPath(kPathInstallation)));
    QDir().mkpath(base);
    for (const char* folder : {"Editor", "Fixtures", "Props", "Curves", "Bulbs", "System"})
        QDir().mkpath(base + folder);
    return true;
}
