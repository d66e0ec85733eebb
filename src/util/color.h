// Packed colours of the document: red + 256 x green + 65536 x blue, each 0..255.
#pragma once

#include "util/rounding.h"

#include <cstdint>

struct ColorParts {
    std::int32_t red = 0;
    std::int32_t green = 0;
    std::int32_t blue = 0;
    bool operator==(const ColorParts&) const = default;
};

constexpr std::int32_t packColor(std::int32_t red, std::int32_t green, std::int32_t blue) noexcept {
    return red + 256 * green + 65536 * blue;
}

// Bits above the three bytes are ignored: a damaged file may hold any 32-bit number.
constexpr ColorParts ZephColorToRGB(std::int32_t color) noexcept {
    return {color & 255, (color >> 8) & 255, (color >> 16) & 255};
}

// The colour scaled by level / 255, each part rounded; above 250 the colour as it stands. level 0..255.
constexpr std::int32_t ZephApplyIntensity(std::int32_t color, std::int32_t level) noexcept {
    if (level > 250) return color;
    const ColorParts parts = ZephColorToRGB(color);
    return packColor(divideHalfEven(parts.red * level, 255), divideHalfEven(parts.green * level, 255),
                     divideHalfEven(parts.blue * level, 255));
}
