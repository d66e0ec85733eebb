// The capture file (.zcap): a channel stream with its times, as plain text. Written by recordings and the demo show,
// read by playback and by the headless simulation.
// First line "zeph-capture 1"; then a line for each piece of text read from the socket: ms since the start, one blank,
// and the bytes, in which a backslash and every byte outside 0x20..0x7E stand as \xHH.
#pragma once

#include <cstdint>
#include <fstream>
#include <string>
#include <string_view>
#include <vector>

struct CapturePiece {
    std::int32_t timeMs = 0;  // since the start of the capture; never less than the piece before
    std::string bytes;        // as read from the socket: part of a frame, or several

    bool operator==(const CapturePiece&) const = default;
};

struct Capture {
    std::vector<CapturePiece> pieces;
    int cutLine = 0;  // number of the last line, from 1, where it was cut short and left out; 0 = none

    bool operator==(const Capture&) const = default;
};

inline constexpr std::string_view kCaptureHeader = "zeph-capture 1";

// The line of a piece, line feed included.
std::string captureLine(std::int32_t timeMs, std::string_view bytes);

// Reads a whole capture. Throws Failure with a text that begins "line N: " (from 1) where a line has another form.
// Only a last line without a line end is forgiven for stopping short, as a recording that lost its power leaves it:
// it is left out and cutLine names it.
Capture parseCapture(std::string_view text);

// Reads the file. Throws Failure that names the file, also where it cannot be read.
Capture loadCapture(const std::string& path);

// Writes a capture piece by piece. Each line leaves the process in one write, so a killed writer leaves whole lines.
class CaptureWriter {
public:
    // Replaces the file and writes the first line. Throws Failure where the file cannot be written.
    explicit CaptureWriter(const std::string& path);

    // Throws Failure where the line cannot be written (what was written before stays), or when the time is negative or
    // before that of the piece before.
    void piece(std::int32_t timeMs, std::string_view bytes);

private:
    void writeLine(std::string_view line);

    std::string path_;
    std::ofstream file_;
    std::int32_t lastMs_ = 0;
};
