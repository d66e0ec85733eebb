// Where lights are drawn: pixels on an image, OpenGL, or a recorder. The render cycle makes these calls for every
// frame, level 1 to 16 and in render table order within a level; a surface paints in the order of the calls.
#pragma once

#include "engine/render_table.h"

#include <cstdint>

// All bulbs of a plain channel at one intensity.
struct ChannelDraw {
    std::int32_t Level = 0;
    std::int32_t Fixture = 0;
    std::int32_t Channel = 0;
    std::int32_t Intensity = 0;             // 0..100
    std::uint8_t Alpha = 0;                 // of the intensity through the dimming curve; no flood limit applied
    const std::uint8_t* BulbLit = nullptr;  // 0 or 1 a bulb, from index 0; nullptr = all are lit
};

// Bulbs of one colour of an RGB group. A group that stays dark is told with Alpha 0.
struct GroupDraw {
    std::int32_t Level = 0;
    std::int32_t Fixture = 0;
    std::int32_t RGBIndex = 0;
    std::int32_t Triplet = 0;
    std::int32_t Color = 0;               // packed, at full strength
    std::uint8_t Alpha = 0;               // brightness, through the dimming curve
    const std::int32_t* Bulbs = nullptr;  // bulb numbers from 1 in BulbLocations[1], in the order to paint;
    std::int32_t BulbCount = 0;           // nullptr = all bulbs
};

class LightSurface {
public:
    virtual ~LightSurface() = default;
    virtual void beginFrame() = 0;  // what was lit before is gone: the background shows
    virtual void drawChannel(const ChannelDraw& draw) = 0;
    virtual void drawGroup(const GroupDraw& draw, ZephRGBData& group) = 0;
    virtual void endFrame() = 0;  // everything drawn since beginFrame is visible
};
