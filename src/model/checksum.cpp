#include "model/checksum.h"

#include "util/failure.h"

#include <QFile>
#include <QStringConverter>

#include <bit>
#include <utility>

namespace {

static_assert(std::endian::native == std::endian::little, "the code units are hashed as they lie in memory");

constexpr qint64 kFileBlock = 16384;
constexpr std::size_t kTextBlock = 32768;  // with its code units it stays in the processor's nearer caches

QByteArrayView viewOf(std::string_view bytes) {
    return {bytes.data(), static_cast<qsizetype>(bytes.size())};
}

bool isWhite(char letter) noexcept {
    return letter == ' ' || letter == '\t' || letter == '\r' || letter == '\n';
}

// Hashes UTF-8 text as UTF-16 without ever holding all of it: the limit document would take 45 MB.
class TextHash {
public:
    TextHash() : units_(static_cast<std::size_t>(decoder_.requiredSpace(static_cast<qsizetype>(kTextBlock)))) {}

    void add(std::string_view text) {
        while (!text.empty()) {
            const std::string_view block = text.substr(0, kTextBlock);
            const QChar* end = decoder_.appendToBuffer(units_.data(), viewOf(block));
            const auto bytes = (end - units_.data()) * static_cast<std::ptrdiff_t>(sizeof(QChar));
            hash_.HashBlock({reinterpret_cast<const char*>(units_.data()), static_cast<std::size_t>(bytes)});
            text.remove_prefix(block.size());
        }
    }
    std::string value(bool keepMismatch) {
        add(keepMismatch ? " " : std::to_string(kChecksumSeed));
        return hash_.HashValue();
    }

private:
    MD5Hash hash_;
    QStringDecoder decoder_{QStringDecoder::Utf8};
    std::vector<QChar> units_;
};

}  // namespace

void MD5Hash::HashBlock(std::string_view bytes) {
    hash_.addData(viewOf(bytes));
}

std::string MD5Hash::HashValue() const {
    return hash_.result().toHex().toUpper().toStdString();
}

std::string MD5Hash::HashBytes(std::string_view bytes) {
    NewHash();
    HashBlock(bytes);
    return HashValue();
}

std::string MD5Hash::HashFile(const std::string& path) {
    QFile file(QString::fromStdString(path));
    require(file.open(QIODevice::ReadOnly), "File doesn't exist");
    NewHash();
    for (QByteArray block = file.read(kFileBlock); !block.isEmpty(); block = file.read(kFileBlock)) {
        hash_.addData(block);
    }
    return HashValue();
}

std::optional<TextRange> findChecksumAttribute(std::string_view text, std::size_t tagName) {
    std::size_t at = tagName;
    const auto skip = [&](auto&& belongs) {
        while (at < text.size() && belongs(text[at]))
            ++at;
    };
    skip([](char letter) { return !isWhite(letter) && letter != '>' && letter != '/'; });
    for (;;) {
        const std::size_t begin = at;
        skip(isWhite);
        const std::size_t name = at;
        skip([](char letter) { return !isWhite(letter) && letter != '=' && letter != '>' && letter != '/'; });
        const std::string_view attribute = text.substr(name, at - name);
        skip(isWhite);
        if (attribute.empty() || at >= text.size() || text[at] != '=') return std::nullopt;
        ++at;
        skip(isWhite);
        if (at >= text.size() || (text[at] != '"' && text[at] != '\'')) return std::nullopt;
        const std::size_t close = text.find(text[at], at + 1);
        if (close == std::string_view::npos) return std::nullopt;
        at = close + 1;
        if (attribute == "Chksum") return TextRange{begin, at};
    }
}

std::string editorChecksum(std::string_view text, TextRange leftOut, bool keepMismatch) {
    TextHash hash;
    hash.add(text.substr(0, leftOut.begin));
    hash.add(text.substr(leftOut.end));
    return hash.value(keepMismatch);
}

// Without a free thread the library computes it in value().
RunningChecksum::RunningChecksum() : computed_(std::async([this] { return compute(); })) {}

RunningChecksum::~RunningChecksum() {
    close(false);
    if (computed_.valid()) computed_.wait();
}

void RunningChecksum::add(std::string_view piece) {
    {
        const std::lock_guard lock(mutex_);
        waiting_.push_back(piece);
    }
    changed_.notify_one();
}

void RunningChecksum::close(bool keepMismatch) {
    {
        const std::lock_guard lock(mutex_);
        closed_ = true;
        keepMismatch_ = keepMismatch;
    }
    changed_.notify_one();
}

std::string RunningChecksum::value(bool keepMismatch) {
    close(keepMismatch);
    return computed_.get();
}

std::string RunningChecksum::compute() {
    TextHash hash;
    for (;;) {
        std::unique_lock lock(mutex_);
        changed_.wait(lock, [&] { return closed_ || !waiting_.empty(); });
        const std::vector<std::string_view> pieces = std::exchange(waiting_, {});
        if (pieces.empty()) return hash.value(keepMismatch_);
        lock.unlock();
        for (const std::string_view piece : pieces)
            hash.add(piece);
    }
}
