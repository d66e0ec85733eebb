// A command sink that keeps every command, and knows virtual channels by their lower-case names.
#pragma once

#include "link/light_command.h"
#include "util/text.h"

#include <map>
#include <string>
#include <vector>

class RecordingSink : public CommandSink {
public:
    void addLightCommands(std::span<const ZephChannelCommand> batch) override {
        commands.insert(commands.end(), batch.begin(), batch.end());
    }
    std::int32_t virtualChannelKey(std::string_view latin1Name) const override {
        const auto found = channels.find(lowerCase(utf8FromLatin1(latin1Name)));
        return found == channels.end() ? 0 : found->second;
    }

    std::vector<ZephChannelCommand> commands;
    std::map<std::string, std::int32_t> channels;  // lower-case UTF-8 name to position from 1
};
