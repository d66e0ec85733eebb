// From levels to drawing calls: the schedules of flashing bulbs, the thresholds below which a group counts as dark, and
// the mixing of colours. What a surface does with a call is its own affair.
#pragma once

#include "engine/render_context.h"

// Draws a plain channel: intensity 0..100. Channels that flash step their bulbs' schedules.
void ZephDrawPreComputedBulbs(std::int32_t fixture, std::int32_t channel, std::int32_t intensity, std::int32_t level,
                              std::int32_t nowMs, RenderContext& context);

// Draws an RGB group. A group too dark to show is told to the surface with alpha 0.
void ZephDrawRGBBulbs(const ZephLevelGroup& group, std::int32_t level, std::int32_t nowMs, RenderContext& context);

// The colour of three levels 0..255 at full strength: the largest becomes 255, the others in proportion, rounded.
// Packed; 0 where all are 0. Brightness is carried by alpha.
std::int32_t ZephColorMixer(std::int32_t red, std::int32_t green, std::int32_t blue);

// The largest of the group's three levels, 0..255.
std::int32_t GetRGBIntensity(const ZephRGBData& group);

// Bulb number, from 1, of a DMX pixel's triplet; the last point for one above the point count, 0 = none.
std::int32_t ReturnPixelBulbLoc(std::int32_t triplet, std::int32_t pointCount);
