// Gathers commands and hands them to the sink 64 at a time, in order: enough for the sink to look keys up side by
// side, few enough to stay in the nearest cache.
#pragma once

#include "link/light_command.h"

#include <array>
#include <cstddef>

class CommandBatch {
public:
    static constexpr std::size_t kSize = 64;

    explicit CommandBatch(CommandSink& sink) : sink_(sink) {}
    CommandBatch(const CommandBatch&) = delete;
    CommandBatch& operator=(const CommandBatch&) = delete;

    void add(const ZephChannelCommand& command) {
        commands_[count_++] = command;
        if (count_ == kSize) flush();
    }

    // For whoever writes commands in place: room() commands fit at free(), then take(n) counts n of them.
    std::size_t room() const noexcept { return kSize - count_; }
    ZephChannelCommand* free() noexcept { return commands_.data() + count_; }
    void take(std::size_t count) {
        count_ += count;
        if (count_ == kSize) flush();
    }

    void flush() {
        const std::size_t count = count_;
        count_ = 0;
        if (count > 0) sink_.addLightCommands({commands_.data(), count});
    }

private:
    CommandSink& sink_;
    std::size_t count_ = 0;
    std::array<ZephChannelCommand, kSize> commands_;  // only the first count_ are read
};
