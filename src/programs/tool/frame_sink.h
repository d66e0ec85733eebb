// Where the pictures of a film go: into a file through the installed ffmpeg, or into a folder as numbered pictures.
#pragma once

#include <QImage>

#include <cstdint>
#include <memory>
#include <string>

class FrameSink {
public:
    virtual ~FrameSink() = default;
    virtual void add(const QImage& frame) = 0;  // throws Failure where it cannot be written
    virtual void finish() = 0;                  // throws Failure where the film did not come out whole
};

// out: a folder, told by a separator at its end or by being one (frame00001.png onward are written into it), or a film
// whose ending ffmpeg knows. Throws Failure where it cannot be opened or there is no ffmpeg.
std::unique_ptr<FrameSink> openFrameSink(const std::string& out, QSize size, std::int32_t fps);

// A bar on standard error, where that is a terminal.
class ProgressBar {
public:
    explicit ProgressBar(std::int64_t whole);
    ~ProgressBar();
    ProgressBar(const ProgressBar&) = delete;
    ProgressBar& operator=(const ProgressBar&) = delete;
    void show(std::int64_t done);

private:
    std::int64_t whole_;
    std::int64_t shown_ = -1;  // per cent
    bool terminal_;
};
