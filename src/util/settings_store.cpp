#include "util/settings_store.h"

#include "util/settings_file.h"

#include <QStandardPaths>

namespace {

constexpr const char* kFileName = "/settings.ini";

const QSettings::Format kForm = QSettings::registerFormat("ini", readSettingsFile, writeSettingsFile);

QString text(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

// A separator inside a section's name would nest it.
QString section(std::string_view key) {
    return text(key).replace('\\', '.').replace('/', '.');
}

QString fullName(std::string_view key, std::string_view name) {
    return section(key) + '/' + text(name);
}

}  // namespace

FileSettingsStore::FileSettingsStore(const std::string& file) : file_(text(file), kForm) {
    if (file_.status() != QSettings::NoError) problem_ = "the settings in " + file + " cannot be opened";
    for (const QString& name : file_.allKeys()) {
        if (isIllegibleEntry(name, file_.value(name))) {
            problem_ = "the settings in " + file + " are damaged; what is legible of them is used";
        }
    }
    listNames();
}

void FileSettingsStore::listNames() {
    spelling_.clear();
    for (const QString& name : file_.allKeys())
        spelling_.insert_or_assign(name.toLower(), name);
}

std::string FileSettingsStore::userFile() {
    const QByteArray chosen = qgetenv("ZEPH_DATA");
    if (!chosen.isEmpty()) return (QString::fromLocal8Bit(chosen) + kFileName).toStdString();
    return (QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) + "/Zeph" + kFileName)
        .toStdString();
}

std::optional<std::string> FileSettingsStore::value(std::string_view key, std::string_view name) const {
    const auto found = spelling_.find(fullName(key, name).toLower());
    if (found == spelling_.end()) return std::nullopt;
    return file_.value(found->second).toString().toStdString();
}

void FileSettingsStore::setValue(std::string_view key, std::string_view name, std::string_view value) {
    const QString written = fullName(key, name);
    QString& spelled = spelling_[written.toLower()];
    if (!spelled.isEmpty() && spelled != written) file_.remove(spelled);
    spelled = written;
    file_.setValue(written, text(value));
}

void FileSettingsStore::removeKey(std::string_view key) {
    const QString prefix = section(key).toLower() + '/';
    for (auto next = spelling_.lower_bound(prefix); next != spelling_.end() && next->first.startsWith(prefix);) {
        file_.remove(next->second);
        next = spelling_.erase(next);
    }
}

bool FileSettingsStore::flush() {
    file_.sync();
    listNames();  // another process may have brought new ones
    return file_.status() == QSettings::NoError;
}
