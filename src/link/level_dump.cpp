#include "link/level_dump.h"

#include "link/command_batch.h"
#include "link/stream_numbers.h"

#include <algorithm>

namespace {

constexpr std::uint8_t kNoDigit = 0xF0;

// Value of a hexadecimal digit, or kNoDigit. A table: a dump of a universe has a thousand of them.
constexpr auto kHexValue = [] {
    std::array<std::uint8_t, 256> values{};
    values.fill(kNoDigit);
    for (std::size_t i = 0; i < 10; ++i)
        values['0' + i] = static_cast<std::uint8_t>(i);
    for (std::size_t i = 0; i < 6; ++i)
        values['A' + i] = values['a' + i] = static_cast<std::uint8_t>(10 + i);
    return values;
}();

std::uint8_t hexValue(char digit) noexcept {
    return kHexValue[static_cast<unsigned char>(digit)];
}

void addDump(std::span<const std::uint8_t> levels, ZephLightCommand address, CommandBatch& batch) {
    address.CommandType = 1;
    for (const std::uint8_t level : levels) {
        ++address.Circuit;
        const std::int32_t intensity = intensityOfDumpByte(level);
        batch.add({address, {.Duration = 0, .StartIntensity = intensity, .EndIntensity = intensity}});
    }
}

}  // namespace

LevelDumpTable::LevelDumpTable(std::int32_t slots)
    : counts_(static_cast<std::size_t>(slots)),
      levels_(std::make_unique_for_overwrite<std::uint8_t[]>(counts_.size() * kMostLevels)) {}

bool LevelDumpTable::store(std::int32_t slot, std::string_view hexDigits) noexcept {
    const std::size_t count = hexDigits.size() / 2;
    std::array<std::uint8_t, kMostLevels> levels;
    unsigned seen = 0;
    for (std::size_t i = 0; i < count; ++i) {
        const unsigned high = hexValue(hexDigits[2 * i]);
        const unsigned low = hexValue(hexDigits[2 * i + 1]);
        seen |= high | low;
        levels[i] = static_cast<std::uint8_t>(high << 4 | low);
    }
    if (seen > 0xF) return false;
    const std::size_t index = static_cast<std::size_t>(slot);
    std::copy_n(levels.begin(), count, &levels_[index * kMostLevels]);
    counts_[index] = static_cast<std::uint16_t>(count);
    return true;
}

std::span<const std::uint8_t> LevelDumpTable::levels(std::int32_t slot) const noexcept {
    const std::size_t index = static_cast<std::size_t>(slot);
    return {&levels_[index * kMostLevels], counts_[index]};
}

void LevelDumpTable::empty(std::int32_t slot) noexcept {
    counts_[static_cast<std::size_t>(slot)] = 0;
}

void LevelDumpTable::clear() noexcept {
    std::fill(counts_.begin(), counts_.end(), std::uint16_t{0});
}

void clearLevelDumps(LevelDumps& dumps) noexcept {
    dumps.ZephDmxDumpTable.clear();
    dumps.ZephControllerDumpTable.clear();
    dumps.ZephDmxDumpPending = false;
    dumps.ZephControllerDumpPending = false;
}

std::int32_t intensityOfDumpByte(std::uint8_t level) noexcept {
    return kIntensityTable[1][level];  // byte / 2.55 is byte / 255 x 100
}

void ZephProcessDmxStreams(CommandSink& sink, FailureReport& failures, LevelDumps& dumps) try {
    if (!dumps.ZephDmxDumpPending) return;
    CommandBatch batch(sink);
    for (std::int32_t universe = kFirstUniverse; universe <= kLastUniverse; ++universe) {
        const std::span<const std::uint8_t> levels = dumps.ZephDmxDumpTable.levels(universe);
        if (levels.empty()) continue;
        addDump(levels, {.Network = universe, .DeviceType = kDumpDmx}, batch);
        dumps.ZephDmxDumpTable.empty(universe);
    }
    batch.flush();
    dumps.ZephDmxDumpPending = false;
}
ZEPH_GUARD(failures, "modZephCommunications", )

void ZephProcessKeshStreams(CommandSink& sink, FailureReport& failures, LevelDumps& dumps) try {
    if (!dumps.ZephControllerDumpPending) return;
    CommandBatch batch(sink);
    for (std::int32_t network = kFirstNetwork; network <= kLastNetwork; ++network) {
        for (std::int32_t unit = kFirstUnit; unit <= kLastUnit; ++unit) {
            const std::int32_t slot = controllerSlot(network, unit);
            const std::span<const std::uint8_t> levels = dumps.ZephControllerDumpTable.levels(slot);
            if (levels.empty()) continue;
            addDump(levels, {.Network = network, .DeviceType = kDumpController, .Unit = unit}, batch);
            dumps.ZephDmxDumpTable.empty(network);
        }
    }
    batch.flush();
    dumps.ZephControllerDumpPending = false;
}
ZEPH_GUARD(failures, "modZephCommunications", )
