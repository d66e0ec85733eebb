// Motions of a ribbon: which pixels of a group are lit, by the values of its magic channels 152, 153 and 154.
#pragma once

#include "engine/fixture_state.h"
#include "model/simulation.h"

#include <array>
#include <cstdint>

// A list of pixels, numbered from 1, in the order to paint.
struct PixelList {
    std::array<std::int32_t, kMaxRibbonPixels> pixels{};
    std::int32_t count = 0;

    void add(std::int32_t pixel) noexcept { pixels[static_cast<std::size_t>(count++)] = pixel; }
};

// First and last pixel of a group; empty where first is above last.
struct PixelRange {
    std::int32_t first = 1;
    std::int32_t last = 0;
};

// The pixels of triplet 1..50 at a resolution index, cut at the fixture's point count.
PixelRange ribbonGroup(std::int32_t triplet, std::int32_t resolution, std::int32_t pointCount) noexcept;

// The pixels of the group that the ribbon's motion lights now. A chase takes its step here.
PixelList ReturnKeshBulbLocs(std::int32_t triplet, std::int32_t resolution, std::int32_t pointCount, std::int32_t nowMs,
                             ZephKeshState& ribbon);

// Restarts chase and strobe.
void ClearKeshParms(ZephKeshState& ribbon);

// Recreates the chase pattern: off entries dark, then on entries lit.
void BuildChaseMask(std::int32_t on, std::int32_t off, ZephKeshState& ribbon);
// Rotates it one place towards the high end.
void BumpChaseMask(ZephKeshState& ribbon);

// The strobe of motion 11.
void stepMotionStrobe(std::int32_t nowMs, ZephKeshState& ribbon);
