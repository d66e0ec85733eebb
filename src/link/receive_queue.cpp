#include "link/receive_queue.h"

#include <utility>

ReceiveQueue::HandOver ReceiveQueue::tryHandOver() {
    if (filling_.empty()) return HandOver::Nothing;
    const std::unique_lock lock(guard_, std::try_to_lock);
    if (!lock.owns_lock()) return HandOver::Busy;
    handOverLocked();
    return HandOver::Done;
}

void ReceiveQueue::handOver() {
    const std::lock_guard lock(guard_);
    handOverLocked();
}

void ReceiveQueue::handOverLocked() {
    if (filling_.empty()) return;
    // A block that waits is filled up before the next one is begun, so that the other side takes few large pieces.
    if (!waiting_.empty() && waiting_.back().size() + filling_.size() <= kBlockBytes) {
        waiting_.back().append(filling_);
        filling_.clear();
        return;
    }
    waiting_.push_back(std::move(filling_));
    filling_.clear();
    if (!spare_.empty()) {
        filling_ = std::move(spare_.back());
        spare_.pop_back();
    }
    filling_.reserve(kBlockBytes);
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
