// Level dumps: one payload that carries the levels of a whole universe or controller. A dump waits in its slot until a
// frame is drawn and is then turned into light commands.
#pragma once

#include "link/light_command.h"
#include "link/stream_format.h"
#include "util/failure.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string_view>
#include <vector>

// Slots 0..slots-1 of up to 999 levels each. Storage is made once; a dump that arrives allocates nothing.
class LevelDumpTable {
public:
    static constexpr std::size_t kMostLevels = 999;

    explicit LevelDumpTable(std::int32_t slots);

    // Replaces the slot's dump by the levels of the text, two hexadecimal digits in either case for each. Returns
    // false, the slot unchanged, where a character is no such digit. The text has at most 2 x 999 characters.
    [[nodiscard]] bool store(std::int32_t slot, std::string_view hexDigits) noexcept;

    std::span<const std::uint8_t> levels(std::int32_t slot) const noexcept;  // 0..255, first channel first
    void empty(std::int32_t slot) noexcept;
    void clear() noexcept;

private:
    std::vector<std::uint16_t> counts_;  // levels in each slot; apart from them, so that empty slots cost nothing
    std::unique_ptr<std::uint8_t[]> levels_;
};

// The two tables, their slots and their flags: raised by a dump that arrives, lowered when it was turned into commands.
struct LevelDumps {
    LevelDumpTable ZephDmxDumpTable{kLastUniverse + 1};            // slot = universe 1..999
    LevelDumpTable ZephControllerDumpTable{(kLastUnit + 1) * 17};  // slot = controllerSlot
    bool ZephDmxDumpPending = false;
    bool ZephControllerDumpPending = false;
};

constexpr std::int32_t controllerSlot(std::int32_t network, std::int32_t unit) noexcept {
    return unit * 17 + network;
}

// Empties both tables and lowers both flags; on entry into simulation.
void clearLevelDumps(LevelDumps& dumps) noexcept;

// A dumped byte 0..255 as an intensity 0..100: byte / 2.55, rounded.
std::int32_t intensityOfDumpByte(std::uint8_t level) noexcept;

// Turns the pending dumps of the universes into commands of CommandType 1 and empties their slots. Called when a frame
// is drawn, before ZephProcessKeshStreams.
void ZephProcessDmxStreams(CommandSink& sink, FailureReport& failures, LevelDumps& dumps);

// The same for the controllers. Their slots stay filled: displays in the field rely on every controller's last dump
// being applied again whenever one of them sends a new one. What is emptied instead is the universe slot that has the
// number of the network.
void ZephProcessKeshStreams(CommandSink& sink, FailureReport& failures, LevelDumps& dumps);
