// The receive buffer: the stream's bytes that no frame has been cut from yet. Filled by the socket's event, worked off
// once a tick. Nothing is moved when a frame is cut off: an offset advances, and the front is given up rarely.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

class StreamBuffer {
public:
    static constexpr std::size_t kNone = std::string_view::npos;

    // Appends bytes. Views into the buffer end here.
    void append(std::string_view bytes);

    bool empty() const noexcept { return start_ == text_.size(); }
    std::size_t size() const noexcept { return text_.size() - start_; }
    std::string_view view() const noexcept { return std::string_view(text_).substr(start_); }

    // Cuts count bytes off the front, at most all. Views stay good until the next append or clear.
    void consume(std::size_t count) noexcept;
    void clear() noexcept;

    // Skips to the first SOH. Returns false with the buffer emptied where there is none, or where junk stands before
    // one that is the very last byte.
    bool resynchronise() noexcept;

    // Position of the first EOT in view(), counted from 0; kNone = not arrived yet. A buffer that waits for its EOT is
    // not searched twice.
    std::size_t findEndOfFrame() noexcept;

private:
    std::string text_;
    std::size_t start_ = 0;     // index of the first byte that is still to be processed
    std::size_t searched_ = 0;  // index up to which there is no EOT behind start_
};
