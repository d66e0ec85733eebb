#include "engine/light_commands.h"

#include "util/text.h"

#include <algorithm>

namespace {

// What the channel was doing is forgotten, but for the phase of its twinkle.
inline void file(std::int32_t entry, const ZephChannelCommand& command, std::int32_t nowMs, ZephRenderTables& tables) {
    const auto index = static_cast<std::size_t>(entry);
    tables.Live[index] = {.StartTime = nowMs,
                          .Duration = command.Timing.Duration,
                          .LastEffectTime = 0,
                          .CommandType = static_cast<std::uint8_t>(command.Command.CommandType),
                          .EffectType = static_cast<std::uint8_t>(command.Command.EffectType),
                          .StartIntensity = static_cast<std::uint8_t>(command.Timing.StartIntensity),
                          .EndIntensity = static_cast<std::uint8_t>(command.Timing.EndIntensity)};
    // Noted each time and counted once: whether a channel was noted already follows no pattern to jump by.
    std::uint8_t& state = tables.CommandState[index];
    tables.NewEntries[tables.NewEntryCount] = entry;
    tables.NewEntryCount += (state & kCommandNew) == 0 ? 1 : 0;
    state = kCommandActive | kCommandNew;
}

std::int32_t commandKey(const ZephLightCommand& command) {
    return BuildCmdKey(command.DeviceType, command.Network, command.Unit, command.Circuit);
}

}  // namespace

void ZephAddLightCommand(const ZephLightCommand& command, const ZephLightTiming& timing, std::int32_t nowMs,
                         ZephRenderTables& tables) {
    const std::int32_t key = commandKey(command);
    if (key == 0) return;
    const std::int32_t entry = FindCommandData(key, tables);
    if (entry != 0) file(entry, {command, timing}, nowMs, tables);
}

void RenderTableSink::addLightCommands(std::span<const ZephChannelCommand> commands) {
    constexpr std::size_t kBatch = 64;
    const std::int32_t nowMs = clock_.timeGetTime();
    std::array<std::int32_t, kBatch> keys;
    std::array<std::int32_t, kBatch> entries;
    while (!commands.empty()) {
        const std::size_t count = std::min(kBatch, commands.size());
        for (std::size_t i = 0; i < count; ++i)
            keys[i] = commandKey(commands[i].Command);
        tables_.Search.findMany({keys.data(), count}, entries.data());
        for (std::size_t i = 0; i < count; ++i) {
            // Key 0 means an address that has none; a magic channel may stand under it and is not to be reached.
            if (entries[i] != 0 && keys[i] != 0) file(entries[i], commands[i], nowMs, tables_);
        }
        commands = commands.subspan(count);
    }
}

std::int32_t RenderTableSink::virtualChannelKey(std::string_view latin1Name) const {
    return ZephReturnVirtualChannelKey(utf8FromLatin1(latin1Name), tables_);
}
