#include "link/stream_buffer.h"

#include "link/stream_format.h"

#include <algorithm>

void StreamBuffer::append(std::string_view bytes) {
    // Giving up the front costs a move of the rest, so it waits until the front is the larger part.
    constexpr std::size_t worthMoving = 65'536;
    if (empty()) {
        clear();
    } else if (start_ >= worthMoving && start_ >= size()) {
        text_.erase(0, start_);
        searched_ -= std::min(searched_, start_);
        start_ = 0;
    }
    text_.append(bytes);
}

void StreamBuffer::consume(std::size_t count) noexcept {
    start_ += std::min(count, size());
}

void StreamBuffer::clear() noexcept {
    text_.clear();
    start_ = 0;
    searched_ = 0;
}

bool StreamBuffer::resynchronise() noexcept {
    const std::size_t found = view().find(kStartOfFrame);
    if (found == 0) return true;
    // Senders in the field begin again with a whole frame, so an SOH that stands last behind junk is given up with it.
    if (found == kNone || found == size() - 1) {
        clear();
        return false;
    }
    consume(found);
    return true;
}

std::size_t StreamBuffer::findEndOfFrame() noexcept {
    const std::size_t from = std::max(start_, searched_);
    const std::size_t found = text_.find(kEndOfFrame, from);
    searched_ = found == kNone ? text_.size() : found;
    return found == kNone ? kNone : found - start_;
}
