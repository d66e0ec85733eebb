#include "programs/tool/stop_signal.h"

#include <pthread.h>
#include <time.h>

// The signals are blocked and waited for, which needs no handler and so no variable that all the program shares.
StopSignal::StopSignal() {
    sigemptyset(&signals_);
    sigaddset(&signals_, SIGINT);
    sigaddset(&signals_, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &signals_, &maskBefore_);
}

StopSignal::~StopSignal() {
    pthread_sigmask(SIG_SETMASK, &maskBefore_, nullptr);
}

bool StopSignal::waitUntil(std::chrono::steady_clock::time_point time) {
    while (!asked_) {
        const auto now = std::chrono::steady_clock::now();
        const auto left = time > now ? std::chrono::nanoseconds(time - now) : std::chrono::nanoseconds(0);
        const timespec timeout{left.count() / 1'000'000'000, left.count() % 1'000'000'000};
        asked_ = sigtimedwait(&signals_, nullptr, &timeout) > 0;
        if (std::chrono::steady_clock::now() >= time) break;
    }
    return asked_;
}
