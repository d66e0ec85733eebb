#include "util/whole_file.h"

#include <QFileInfo>
#include <QSaveFile>

namespace {

// By the rights themselves: who may do everything is not kept from writing, but meant to be.
bool mayBeReplaced(const QString& path) {
    constexpr QFile::Permissions kAnyWrite = QFile::WriteOwner | QFile::WriteGroup | QFile::WriteOther;
    const QFileInfo info(path);
    return !info.exists() || (info.isWritable() && (QFile::permissions(path) & kAnyWrite));
}

}  // namespace

WholeFile::WholeFile(const std::string& path) {
    const QString name = QString::fromStdString(path);
    file_ = std::make_unique<QSaveFile>(name);
    good_ = mayBeReplaced(name) && file_->open(QIODevice::WriteOnly | QIODevice::Unbuffered);
}

WholeFile::~WholeFile() = default;

void WholeFile::write(std::string_view bytes) {
    const auto size = static_cast<qint64>(bytes.size());
    good_ = good_ && file_->write(bytes.data(), size) == size;
}

void WholeFile::append(std::string_view bytes) {
    write(bytes);
}

void WholeFile::overwrite(std::size_t offset, std::string_view bytes) {
    const qint64 end = file_->pos();
    good_ = good_ && file_->seek(static_cast<qint64>(offset));
    write(bytes);
    good_ = good_ && file_->seek(end);
}

bool WholeFile::commit() {
    return good_ && file_->commit();
}

bool replaceWholeFile(const std::string& path, std::string_view bytes) {
    WholeFile file(path);
    file.append(bytes);
    return file.commit();
}
