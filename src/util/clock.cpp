#include "util/clock.h"

#include <ctime>

namespace {

// Wraps as a 32-bit counter does, instead of overflowing.
std::int32_t wrapped(std::int64_t ms) {
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(ms));
}

}  // namespace

SystemClock::SystemClock() : start_(std::chrono::steady_clock::now()) {}

std::int32_t SystemClock::timeGetTime() const {
    const auto elapsed = std::chrono::steady_clock::now() - start_;
    return wrapped(kStartMs + std::chrono::duration_cast<std::chrono::milliseconds>(elapsed).count());
}

std::int32_t SystemClock::tickCount() const {
    timespec now{};
    clock_gettime(CLOCK_BOOTTIME, &now);
    return wrapped(static_cast<std::int64_t>(now.tv_sec) * 1000 + now.tv_nsec / 1'000'000);
}
