#include "model/xml_text.h"

#include <array>
#include <cassert>
#include <charconv>

namespace {

// What a character becomes inside double quotes. Line breaks and tabs must be spelled out, or a reader takes them for
// blanks; "" leaves the character as it is.
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
    case '\t':
        return "&#9;";
    default:
        return "";
    }
}

constexpr std::string_view kSpelledOut("&<>\"\r\n\t\0", 8);

}  // namespace

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
    while (!value.empty()) {
        const std::size_t plain = std::min(value.find_first_of(kSpelledOut), value.size());
        text_.append(value.substr(0, plain));
        value.remove_prefix(plain);
        if (value.empty()) break;
        text_.append(spelling(value.front()));
        value.remove_prefix(1);
    }
    text_.push_back('"');
}

void Indent(int blanks, XmlText& text) {
    constexpr std::string_view kLine = "\r\n                ";
    assert(blanks >= 0 && static_cast<std::size_t>(blanks) + 2 <= kLine.size());
    text.raw(kLine.substr(0, 2 + static_cast<std::size_t>(blanks)));
}
