#include "model/source_text.h"

#include "util/text.h"

#include <QFile>
#include <QFileInfo>
#include <QStringConverter>

#include <cstring>

namespace {

constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";

// The encoding named by the XML declaration; "" without a declaration or a name in it.
std::string_view declaredEncoding(std::string_view text) {
    if (!text.starts_with("<?xml")) return {};
    std::string_view declaration = text.substr(0, text.find("?>"));
    const std::size_t key = declaration.find("encoding");
    if (key == std::string_view::npos) return {};
    const std::size_t open = declaration.find_first_of("\"'", key);
    if (open == std::string_view::npos) return {};
    const std::size_t close = declaration.find(declaration[open], open + 1);
    if (close == std::string_view::npos) return {};
    return declaration.substr(open + 1, close - open - 1);
}

}  // namespace

SourceText::SourceText(std::size_t capacity)
    : bytes_(std::make_unique_for_overwrite<char[]>(capacity + kSlack)), size_(0) {}

SourceText::SourceText(std::string_view text) : SourceText(text.size()) {
    std::copy(text.begin(), text.end(), bytes_.get());
    size_ = text.size();
    std::memset(bytes_.get() + size_, 0, kSlack);
}

FileReading readWholeFile(const std::string& path, SourceText& text) {
    const QString name = QString::fromStdString(path);
    const QFileInfo info(name);
    if (!info.exists()) return FileReading::Missing;
    QFile file(name);
    if (!info.isFile() || !file.open(QIODevice::ReadOnly | QIODevice::Unbuffered)) return FileReading::Unreadable;
    const qint64 size = file.size();
    SourceText read(static_cast<std::size_t>(size));
    qint64 filled = 0;
    while (filled < size) {
        const qint64 got = file.read(read.bytes_.get() + filled, size - filled);
        if (got < 0) return FileReading::Unreadable;
        if (got == 0) break;  // cut shorter by someone else meanwhile; what is there is read
        filled += got;
    }
    read.size_ = static_cast<std::size_t>(filled);
    std::memset(read.bytes_.get() + read.size_, 0, SourceText::kSlack);
    text = std::move(read);
    return FileReading::Read;
}

bool decodeSource(SourceText& text) {
    const std::string_view bytes = text.view();
    const QByteArrayView raw(bytes.data(), static_cast<qsizetype>(bytes.size()));
    const auto recode = [&](QStringConverter::Encoding encoding) {
        QStringDecoder decoder(encoding, QStringConverter::Flag::Stateless);
        const QString decoded = decoder(raw);
        if (decoder.hasError()) return false;
        text = SourceText(decoded.toUtf8().toStdString());
        return true;
    };
    if (bytes.starts_with(kUtf8Mark)) {
        text = SourceText(bytes.substr(kUtf8Mark.size()));
        return true;
    }
    if (const auto wide = QStringConverter::encodingForData(raw, u'<')) return recode(*wide);
    const std::string_view declared = declaredEncoding(bytes);
    if (declared.empty() || equalIgnoringCase(declared, "UTF-8") || equalIgnoringCase(declared, "US-ASCII"))
        return true;
    return equalIgnoringCase(declared, "ISO-8859-1") && recode(QStringConverter::Latin1);
}
