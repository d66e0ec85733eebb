// The two clocks of the program: the signed 32-bit millisecond clock that all light timing reads, and the ticks since
// the machine was started. Tests and the headless companion set them by hand.
#pragma once

#include <chrono>
#include <cstdint>

class Clock {
public:
    virtual ~Clock() = default;
    virtual std::int32_t timeGetTime() const = 0;  // ms, signed; wraps to negative
    virtual std::int32_t tickCount() const = 0;    // ms since the machine started, signed; wraps
};

// Steady and monotonic. timeGetTime begins at kStartMs at construction, so that a reading is never 0 at work: a time
// of 0 means "not started" in the engine's records.
class SystemClock : public Clock {
public:
    static constexpr std::int32_t kStartMs = 1'000'000;
    SystemClock();
    std::int32_t timeGetTime() const override;
    std::int32_t tickCount() const override;

private:
    std::chrono::steady_clock::time_point start_;
};

class ManualClock : public Clock {
public:
    explicit ManualClock(std::int32_t nowMs) : nowMs_(nowMs) {}
    std::int32_t timeGetTime() const override { return nowMs_; }
    std::int32_t tickCount() const override { return nowMs_; }
    void set(std::int32_t nowMs) { nowMs_ = nowMs; }

private:
    std::int32_t nowMs_;
};
