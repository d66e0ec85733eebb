// The text of a file as the readers of documents want it: in one piece, UTF-8, with zero bytes behind it so that a
// scanner may look a few bytes ahead without counting.
#pragma once

#include <memory>
#include <string>
#include <string_view>

enum class FileReading { Read, Missing, Unreadable };

class SourceText {
public:
    static constexpr std::size_t kSlack = 64;  // zero bytes behind the text

    SourceText() : SourceText(std::string_view()) {}
    explicit SourceText(std::string_view text);

    std::string_view view() const noexcept { return {bytes_.get(), size_}; }

private:
    friend FileReading readWholeFile(const std::string& path, SourceText& text);
    explicit SourceText(std::size_t capacity);

    std::unique_ptr<char[]> bytes_;
    std::size_t size_;
};

// Reads a regular file. Anything else under that name (a folder, a pipe), or a read that breaks off, is Unreadable,
// and the text stays as it was.
[[nodiscard]] FileReading readWholeFile(const std::string& path, SourceText& text);

// Turns the text into UTF-8 without a byte order mark. The encoding is told by the mark, by the zero bytes around the
// first '<', or by the XML declaration: UTF-8, UTF-16 and UTF-32 of either byte order, US-ASCII, ISO-8859-1. False for
// an encoding that cannot be read, and for wide text that is none in its encoding. UTF-8 is not looked at here: the
// readers of the text do that on their way.
[[nodiscard]] bool decodeSource(SourceText& text);
