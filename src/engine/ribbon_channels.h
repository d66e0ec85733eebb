// How the 157 channels of a ribbon map to its pixels: 150 colour channels and 7 magic channels, and how a DMX pixel
// run numbers its own. Indexes, pixels and colours count from 1.
#pragma once

#include "model/simulation.h"

#include <cstdint>

inline constexpr std::int32_t kFirstPixelTriplet = 1001;  // triplet id of a DMX run's first pixel

inline constexpr std::int32_t kUnitLegacy = 1;      // Unit_Mode: 16 circuits to a unit
inline constexpr std::int32_t kModeSequential = 1;  // Channel_Mode: all reds, then all greens, then all blues

struct RibbonAddress {
    std::int64_t unit = 0;
    std::int32_t circuit = 0;
};

struct RibbonPixel {
    std::int32_t pixel = 0;
    std::int32_t colour = 0;  // 1 red, 2 green, 3 blue; above 3 on a Sequential ribbon at a coarse resolution
};

// Unit and circuit 1..16 of a channel index, 16 to a unit from the base unit on.
RibbonAddress LegacyKeshIDs(std::int32_t index, std::int32_t baseUnit) noexcept;

// The same by the ribbon's Unit_Mode: Normal puts all 157 on the base unit.
RibbonAddress ribbonAddress(const ZephKeshData& kesh, std::int32_t index) noexcept;

// Pixel and colour of a channel index 1..150. In Sequential mode the pixel counts groups of the resolution.
RibbonPixel ReturnKeshTripletKey(std::int32_t index, std::int32_t channelMode, std::int32_t resolution) noexcept;

// Channel index of a pixel's colour; the way back, but for resolution index 3, whose count and group differ.
std::int32_t AbsoluteKeshChannelID(std::int32_t channelMode, std::int32_t resolution, std::int32_t pixel,
                                   std::int32_t colour) noexcept;
