// Twinkle and shimmer: what random light does to a plain channel and to the colours of an RGB group.
#pragma once

#include "engine/render_context.h"

// Bits of a colour effect's mask.
inline constexpr std::int32_t kMaskBlue = 1;
inline constexpr std::int32_t kMaskGreen = 2;
inline constexpr std::int32_t kMaskRed = 4;
inline constexpr std::int32_t kMaskWhite = 8;    // all three in step
inline constexpr std::int32_t kMaskAnyOne = 16;  // any one of the three colours
inline constexpr std::int32_t kMaskRandomOnOff = 32;
inline constexpr std::int32_t kMaskRandomLevel = 64;
inline constexpr std::int32_t kMaskOneAtATime = 128;

// Bits of ZephRGBData::Mode.
inline constexpr std::int32_t kModePlain = 1;     // driven by plain commands
inline constexpr std::int32_t kModeEffect = 2;    // driven by a colour effect
inline constexpr std::int32_t kModeReleased = 4;  // neither, until the next new command

// One step of an RGB effect.
struct RgbEffectStep {
    std::int32_t level = 0;    // 0..255, of the single colour
    std::int32_t elapsed = 0;  // ms since the entry's last step
    std::int32_t mode = 0;     // not 0: the colour's new Mode
    bool single = false;       // one colour twinkles, whatever effect runs
};

// The intensity 0..100 that a twinkling plain channel shows now: the given one or 0.
std::int32_t ChannelTwinkle(std::int32_t intensity, ZephTwinklePhase& phase, std::int32_t nowMs, RandomSource& random);

// Both give true where the entry's step counts as taken. A slot of a colour above 3 does nothing.
bool TwinkleRGB(const ZephRenderSlot& slot, const RgbEffectStep& step, RenderContext& context);
bool ShimmerRGB(const ZephRenderSlot& slot, const RgbEffectStep& step, RenderContext& context);

// A colour 1..3 from those that the mask allows; 0 = none, only where that is allowed.
std::int32_t RandomDiscreteChannel(std::int32_t mask, bool allowNone, RandomSource& random);
