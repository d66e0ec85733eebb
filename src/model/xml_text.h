// Builds the text of an XML document in the spelling of the program's files: double quotes, CR LF, and each element on
// a line of its own, indented by blanks.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

// Whether a UTF-8 text has characters that no XML document can hold: those below the blank other than tab and line
// breaks, U+FFFE and U+FFFF (XML 1.0, production 2).
bool holdsForbidden(std::string_view text) noexcept;
// The text as a document holds it: without them. Bytes that are no UTF-8 stay.
std::string withoutForbidden(std::string_view text);

class XmlText {
public:
    explicit XmlText(std::size_t expectedBytes) { text_.reserve(expectedBytes); }

    // "<name"; attributes follow, then closeStart or closeEmpty.
    void openStart(std::string_view name);
    void attribute(std::string_view name, std::int32_t value);
    void attribute(std::string_view name, bool value);              // True, False
    void attribute(std::string_view name, std::string_view value);  // UTF-8; see withoutForbidden
    void attribute(std::string_view name, const char* value) { attribute(name, std::string_view(value)); }
    void closeStart() { text_.push_back('>'); }  // children follow
    void closeEmpty() { text_.append("/>"); }    // no children
    void endTag(std::string_view name);

    // Text that stands as it is, such as the declaration.
    void raw(std::string_view text) { text_.append(text); }

    std::size_t size() const { return text_.size(); }
    std::string take();  // leaves nothing behind

private:
    void beginAttribute(std::string_view name);

    std::string text_;
};

// CR LF and that many blanks: what stands before an element and before the end tag of a group. blanks 0..16.
void Indent(int blanks, XmlText& text);
