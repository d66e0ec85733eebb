#include "model/xml_text.h"

#include <array>
#include <cassert>
#include <charconv>
#include <utility>

namespace {

enum : std::uint8_t { kPlain = 0, kSpelledOut = 1, kPerhapsForbidden = 2 };

// What to look closer at. U+FFFE and U+FFFF begin with the byte EF, as many allowed characters do.
constexpr std::array<std::uint8_t, 256> kClasses = [] {
    std::array<std::uint8_t, 256> classes{};
    for (std::size_t code = 0; code < 0x20; ++code)
        classes[code] = kPerhapsForbidden;
    classes[0xEF] = kPerhapsForbidden;
    for (const char letter : {'&', '<', '>', '"', '\r', '\n', '\t'})
        classes[static_cast<unsigned char>(letter)] = kSpelledOut;
    return classes;
}();

std::uint8_t classOf(char letter) noexcept {
    return kClasses[static_cast<unsigned char>(letter)];
}

// The first character of the classes, or the text's size.
std::size_t findClasses(std::string_view text, unsigned classes) noexcept {
    std::size_t at = 0;
    while (at < text.size() && (classOf(text[at]) & classes) == 0)
        ++at;
    return at;
}

// How many bytes a forbidden character at the beginning of the text takes; 0 for an allowed one.
std::size_t forbiddenBytes(std::string_view text) noexcept {
    if (classOf(text.front()) != kPerhapsForbidden) return 0;
    if (static_cast<unsigned char>(text.front()) < 0x20) return 1;
    return text.starts_with("\xEF\xBF\xBE") || text.starts_with("\xEF\xBF\xBF") ? 3 : 0;
}

// What a character becomes inside double quotes. Line breaks and tabs must be spelled out, or a reader takes them for
// blanks.
std::string_view spelling(char letter) noexcept {
    switch (letter) {
    case '&':
        return "&amp;";
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '"':
        return "&quot;";
    case '\r':
        return "&#13;";
    case '\n':
        return "&#10;";
    default:
        return "&#9;";
    }
}

}  // namespace

bool holdsForbidden(std::string_view text) noexcept {
    for (;;) {
        text.remove_prefix(findClasses(text, kPerhapsForbidden));
        if (text.empty()) return false;
        if (forbiddenBytes(text) != 0) return true;
        text.remove_prefix(1);
    }
}

std::string withoutForbidden(std::string_view text) {
    std::string allowed;
    while (!text.empty()) {
        const std::size_t forbidden = forbiddenBytes(text);
        if (forbidden == 0) allowed.push_back(text.front());
        text.remove_prefix(std::max<std::size_t>(forbidden, 1));
    }
    return allowed;
}

std::string XmlText::take() {
    return std::exchange(text_, {});
}

void XmlText::openStart(std::string_view name) {
    text_.push_back('<');
    text_.append(name);
}

void XmlText::endTag(std::string_view name) {
    text_.append("</").append(name).push_back('>');
}

void XmlText::beginAttribute(std::string_view name) {
    text_.push_back(' ');
    text_.append(name).append("=\"");
}

void XmlText::attribute(std::string_view name, std::int32_t value) {
    beginAttribute(name);
    std::array<char, 12> digits;
    const auto written = std::to_chars(digits.data(), digits.data() + digits.size(), value);
    text_.append(digits.data(), static_cast<std::size_t>(written.ptr - digits.data()));
    text_.push_back('"');
}

void XmlText::attribute(std::string_view name, bool value) {
    beginAttribute(name);
    text_.append(value ? "True\"" : "False\"");
}

void XmlText::attribute(std::string_view name, std::string_view value) {
    beginAttribute(name);
    for (;;) {
        const std::size_t plain = findClasses(value, kSpelledOut | kPerhapsForbidden);
        text_.append(value.substr(0, plain));
        value.remove_prefix(plain);
        if (value.empty()) break;
        const std::size_t forbidden = forbiddenBytes(value);
        if (classOf(value.front()) == kSpelledOut) {
            text_.append(spelling(value.front()));
        } else if (forbidden == 0) {
            text_.push_back(value.front());
        }
        value.remove_prefix(std::max<std::size_t>(forbidden, 1));
    }
    text_.push_back('"');
}

void Indent(int blanks, XmlText& text) {
    constexpr std::string_view kLine = "\r\n                ";
    assert(blanks >= 0 && static_cast<std::size_t>(blanks) + 2 <= kLine.size());
    text.raw(kLine.substr(0, 2 + static_cast<std::size_t>(blanks)));
}
