#include "link/capture_file.h"

#include "util/failure.h"

#include <charconv>
#include <cstring>
#include <sstream>

namespace {

bool standsForItself(char letter) {
    return letter >= 0x20 && letter <= 0x7E && letter != '\\';
}

// 0..15, or -1: capture files have upper-case digits only, so that a stream has one spelling.
int hexValue(char digit) {
    if (digit >= '0' && digit <= '9') return digit - '0';
    if (digit >= 'A' && digit <= 'F') return digit - 'A' + 10;
    return -1;
}

[[noreturn]] void failAt(int line, const std::string& what) {
    throw Failure("line " + std::to_string(line) + ": " + what);
}

struct LineReader {
    std::string_view text;
    int line;
    bool unfinished;  // no line end: the last line of the file, which may have been cut anywhere
};

// The piece's bytes. Returns false where an unfinished line stops within an escape.
bool readBytes(const LineReader& reader, std::string& bytes) {
    std::string_view text = reader.text;
    bytes.reserve(text.size());
    while (!text.empty()) {
        if (standsForItself(text.front())) {
            bytes += text.front();
            text.remove_prefix(1);
            continue;
        }
        if (text.front() != '\\') failAt(reader.line, "a byte that must be written as \\xHH");
        const bool marked = text.size() < 2 || text[1] == 'x';
        const bool firstDigit = text.size() < 3 || hexValue(text[2]) >= 0;
        if (text.size() < 4 && marked && firstDigit && reader.unfinished) return false;
        if (text.size() < 4 || !marked || !firstDigit || hexValue(text[3]) < 0) {
            failAt(reader.line, "a backslash must begin \\xHH with two upper-case hexadecimal digits");
        }
        bytes += static_cast<char>(hexValue(text[2]) * 16 + hexValue(text[3]));
        text.remove_prefix(4);
    }
    return true;
}

// One line that holds a piece. Returns false where an unfinished line stops before its end.
bool readPiece(LineReader reader, CapturePiece& piece) {
    const char* const end = reader.text.data() + reader.text.size();
    const auto isDigit = [](char letter) { return letter >= '0' && letter <= '9'; };
    if (!isDigit(reader.text.front())) failAt(reader.line, "a line begins with the time in milliseconds");
    const auto [next, error] = std::from_chars(reader.text.data(), end, piece.timeMs);
    if (error != std::errc()) failAt(reader.line, "the time is too large");
    if (next == end && reader.unfinished) return false;
    if (next == end || *next != ' ') failAt(reader.line, "one blank must follow the time");
    reader.text.remove_prefix(static_cast<std::size_t>(next + 1 - reader.text.data()));
    return readBytes(reader, piece.bytes);
}

}  // namespace

std::string captureLine(std::int32_t timeMs, std::string_view bytes) {
    constexpr std::string_view hexDigits = "0123456789ABCDEF";
    std::string line = std::to_string(timeMs) + " ";
    line.reserve(line.size() + bytes.size() + 16);
    for (const char letter : bytes) {
        if (standsForItself(letter)) {
            line += letter;
        } else {
            const unsigned code = static_cast<unsigned char>(letter);
            line.append("\\x");
            line += hexDigits[code / 16];
            line += hexDigits[code % 16];
        }
    }
    line += '\n';
    return line;
}

Capture parseCapture(std::string_view text) {
    Capture capture;
    std::int32_t lastMs = 0;
    for (int line = 1; line == 1 || !text.empty(); ++line) {
        const std::size_t lineEnd = text.find('\n');
        const bool unfinished = lineEnd == std::string_view::npos;
        std::string_view content = text.substr(0, lineEnd);
        text.remove_prefix(unfinished ? text.size() : lineEnd + 1);
        if (content.ends_with('\r')) content.remove_suffix(1);
        if (line == 1) {
            if (content != kCaptureHeader) failAt(line, "not a capture file: it must begin with \"zeph-capture 1\"");
            continue;
        }
        if (content.empty() || content.front() == '#') continue;
        CapturePiece piece;
        if (!readPiece({content, line, unfinished}, piece)) {
            capture.cutLine = line;
            break;
        }
        if (piece.timeMs < lastMs) failAt(line, "the time is before that of the line above");
        lastMs = piece.timeMs;
        capture.pieces.push_back(std::move(piece));
    }
    return capture;
}

Capture loadCapture(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    std::ostringstream text;
    if (file.is_open() && file.peek() != std::ifstream::traits_type::eof()) text << file.rdbuf();
    if (!file.is_open() || file.bad() || text.fail()) throw Failure(path + " cannot be read");
    try {
        return parseCapture(text.view());
    } catch (const Failure& failure) {
        throw Failure(path + ", " + failure.what());
    }
}

CaptureWriter::CaptureWriter(const std::string& path) : path_(path), file_(path, std::ios::binary | std::ios::trunc) {
    if (!file_.is_open()) throw Failure(path_ + " cannot be written");
    writeLine(std::string(kCaptureHeader) + "\n");
}

void CaptureWriter::piece(std::int32_t timeMs, std::string_view bytes) {
    require(timeMs >= lastMs_, "the times of a capture never decrease");
    writeLine(captureLine(timeMs, bytes));
    lastMs_ = timeMs;
}

void CaptureWriter::writeLine(std::string_view line) {
    file_.write(line.data(), static_cast<std::streamsize>(line.size()));
    file_.flush();
    if (!file_) throw Failure(path_ + " cannot be written");
}
