// Stopping on the user's signal: while it lives, SIGINT and SIGTERM do not end the thread's work in the middle but are
// asked for between two steps of it.
#pragma once

#include <chrono>
#include <csignal>

class StopSignal {
public:
    StopSignal();
    ~StopSignal();
    StopSignal(const StopSignal&) = delete;
    StopSignal& operator=(const StopSignal&) = delete;

    // Waits until the time has come; true where a signal came first, and from then on.
    bool waitUntil(std::chrono::steady_clock::time_point time);
    bool asked() { return waitUntil(std::chrono::steady_clock::time_point::min()); }

private:
    sigset_t signals_;
    sigset_t maskBefore_;
    bool asked_ = false;
};
