#include "util/text.h"

#include <QString>

#include <charconv>

namespace {

char asciiLower(char letter) noexcept {
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter + ('a' - 'A')) : letter;
}

std::size_t afterLastSeparator(std::string_view path) noexcept {
    const std::size_t separator = path.find_last_of("/\\");
    return separator == std::string_view::npos ? 0 : separator + 1;
}

}  // namespace

std::string_view trimmed(std::string_view text) noexcept {
    constexpr std::string_view white = " \t\r\n";
    const std::size_t first = text.find_first_not_of(white);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(white) - first + 1);
}

std::optional<std::int32_t> parseLong(std::string_view text) noexcept {
    text = trimmed(text);
    if (!text.empty() && text.front() == '+') {
        text.remove_prefix(1);
        if (!text.empty() && text.front() == '-') return std::nullopt;
    }
    std::int32_t value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (error != std::errc() || end != text.data() + text.size()) return std::nullopt;
    return value;
}

std::optional<bool> parseFlag(std::string_view text) noexcept {
    text = trimmed(text);
    if (equalIgnoringCase(text, "true")) return true;
    if (equalIgnoringCase(text, "false")) return false;
    return std::nullopt;
}

bool equalIgnoringCase(std::string_view left, std::string_view right) noexcept {
    if (left.size() != right.size()) return false;
    for (std::size_t i = 0; i < left.size(); ++i) {
        if (asciiLower(left[i]) != asciiLower(right[i])) return false;
    }
    return true;
}

std::string lowerCase(std::string_view utf8) {
    bool plain = true;
    for (const char letter : utf8)
        plain = plain && static_cast<unsigned char>(letter) < 0x80;
    if (plain) {
        std::string lower(utf8);
        for (char& letter : lower)
            letter = asciiLower(letter);
        return lower;
    }
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size())).toLower().toStdString();
}

std::string utf8FromLatin1(std::string_view bytes) {
    std::string utf8;
    utf8.reserve(bytes.size());
    for (const char byte : bytes) {
        const unsigned code = static_cast<unsigned char>(byte);
        if (code < 0x80) {
            utf8.push_back(byte);
        } else {
            utf8.push_back(static_cast<char>(0xC0 | (code >> 6)));
            utf8.push_back(static_cast<char>(0x80 | (code & 0x3F)));
        }
    }
    return utf8;
}

std::string ZephNameFromFullPath(std::string_view path) {
    return std::string(path.substr(afterLastSeparator(path)));
}

std::string ZephPathFromFullPath(std::string_view path) {
    return std::string(path.substr(0, afterLastSeparator(path)));
}
