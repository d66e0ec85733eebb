#include "link/receive_queue.h"

#include <utility>

void ReceiveQueue::put(std::string_view bytes) {
    const std::lock_guard lock(guard_);
    if (waiting_.empty() || waiting_.back().size() + bytes.size() > kBlockBytes) {
        if (spare_.empty()) {
            waiting_.emplace_back().reserve(kBlockBytes);
        } else {
            waiting_.push_back(std::move(spare_.back()));
            spare_.pop_back();
        }
    }
    waiting_.back().append(bytes);
}

void ReceiveQueue::take(std::string& text) {
    text.clear();
    const std::lock_guard lock(guard_);
    if (waiting_.empty()) return;
    text.swap(waiting_.front());
    if (spare_.size() < kMostSpare && waiting_.front().capacity() >= kBlockBytes) {
        spare_.push_back(std::move(waiting_.front()));
    }
    waiting_.pop_front();
}
