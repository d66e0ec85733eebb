// Numbers as the channel stream writes them, and their conversion to ms and percent. All conversions are exact and
// round to the nearest whole number, a tie to the even neighbour.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string_view>

// Digits only, 1 to 9 of them; nothing for any other text. A sign or a blank is not part of the format: a field that
// holds one was not written by a sender, and what stands behind it cannot be trusted.
std::optional<std::int32_t> readDigits(std::string_view field) noexcept;

// Hundredths of a second, 1 to 17 characters, digits with at most one point among them, as ms; saturates at 32 bits.
std::optional<std::int32_t> readDurationMs(std::string_view field) noexcept;

// A level as it stands in the stream, 0..999, as an intensity: percent is clamped to 100; for sub 03 the scale
// 0..255 becomes 0..100, then clamped.
constexpr std::int32_t kMostStreamLevel = 999;
constexpr std::int32_t intensityOf(std::int32_t streamLevel, bool scale255) noexcept {
    // 200 n / 510 is never halfway between two whole numbers: 255 is odd.
    const std::int32_t percent = scale255 ? (streamLevel * 200 + 255) / 510 : streamLevel;
    return percent < 100 ? percent : 100;
}
static_assert(intensityOf(255, true) == 100 && intensityOf(128, true) == 50 && intensityOf(1, true) == 0);

// intensityOf as a table: one row for percent, one for the scale 0..255.
inline constexpr auto kIntensityTable = [] {
    std::array<std::array<std::uint8_t, kMostStreamLevel + 1>, 2> table{};
    for (std::int32_t level = 0; level <= kMostStreamLevel; ++level) {
        table[0][static_cast<std::size_t>(level)] = static_cast<std::uint8_t>(intensityOf(level, false));
        table[1][static_cast<std::size_t>(level)] = static_cast<std::uint8_t>(intensityOf(level, true));
    }
    return table;
}();
