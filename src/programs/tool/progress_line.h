// One line of progress on standard error, rewritten in place; nothing at all where that is no terminal.
#pragma once

#include <chrono>
#include <cstdio>
#include <unistd.h>

class ProgressLine {
public:
    ~ProgressLine() {
        if (shown_) std::fputc('\n', stderr);
    }

    // Writes at most five times a second; takes the format and values of printf.
    template <typename... Values>
    void show(const char* format, Values... values) {
        const auto now = std::chrono::steady_clock::now();
        if (!terminal_ || now < next_) return;
        next_ = now + std::chrono::milliseconds(200);
        shown_ = true;
        std::fputs("\r\x1B[K", stderr);  // begin of line, erase it
        std::fprintf(stderr, format, values...);
        std::fflush(stderr);
    }

private:
    bool terminal_ = ::isatty(STDERR_FILENO) != 0;
    bool shown_ = false;
    std::chrono::steady_clock::time_point next_;
};
