// A channel's address packed into the one number that the render table is sorted by. Called by the table's compiler and
// for every command that arrives.
#pragma once

#include "model/simulation.h"

#include <cstdint>
#include <optional>

// In decimal, so that a key in a log can be read. A universe has no units. Nothing where it does not fit 32 bits.
constexpr std::optional<std::int32_t> packedKey(std::int64_t deviceType, std::int64_t network, std::int64_t unit,
                                                std::int64_t circuit) noexcept {
    const std::int64_t key = deviceType * 100'000'000 + circuit +
                             (deviceType == kDeviceDmx ? network * 100'000 : network * 1'000'000 + unit * 1'000);
    const auto narrow = static_cast<std::int32_t>(key);
    return narrow == key ? std::optional(narrow) : std::nullopt;
}

// Key of an address; 0 where it has none.
constexpr std::int32_t BuildCmdKey(std::int32_t deviceType, std::int32_t network, std::int32_t unit,
                                   std::int32_t circuit) noexcept {
    return packedKey(deviceType, network, unit, circuit).value_or(0);
}
