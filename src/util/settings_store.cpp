#include "util/settings_store.h"

#include "util/failure.h"

#include <QStandardPaths>

namespace {

constexpr const char* kFileName = "/settings.ini";

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

std::string statusText(QSettings::Status status, const QString& file) {
    switch (status) {
    case QSettings::AccessError:
        return "the settings in " + file.toStdString() + " cannot be opened";
    case QSettings::FormatError:
        return "the settings in " + file.toStdString() + " are damaged; what is legible of them is used";
    case QSettings::NoError:
        break;
    }
    return "";
}

}  // namespace

FileSettingsStore::FileSettingsStore(const std::string& file)
    : file_(text(file), QSettings::IniFormat), problem_(statusText(file_.status(), text(file))) {
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
    const QVariant stored = file_.value(found->second);
    // An unquoted comma, as a hand would write it, makes a list.
    if (stored.metaType() == QMetaType::fromType<QStringList>()) return stored.toStringList().join(',').toStdString();
    require(stored.metaType() == QMetaType::fromType<QString>(), "the stored value is no text");
    return stored.toString().toStdString();
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
    return file_.status() == QSettings::NoError;
}
