#include "engine/ribbon_effects.h"

#include "engine/rgb_effects.h"
#include "engine/ribbon_channels.h"
#include "engine/ribbon_motion.h"
#include "model/tables.h"
#include "util/rounding.h"

#include <algorithm>

namespace {

enum Magic : std::int32_t {
    kResolution = 151,
    kMotion = 152,
    kMotionParm = 153,
    kMotionPos = 154,
    kColorEffect = 155,
    kSpeed = 156,
    kIntensity = 157
};

constexpr std::int32_t kMotionStrobe = 11;
constexpr std::int32_t kFlipMs = 200;
constexpr std::int32_t kTwinkles = 2;
constexpr std::int32_t kDazzles = -1;

// The colour whose channel addresses the pixel, and the mask that twinkle and shimmer carry out; row = effect.
// Effects 21 and 25 share a mask and differ in the colour, and 10 to 12 name one colour each: the controllers' own
// table, kept as it is.
struct ColorEffect {
    std::int32_t colour;
    std::int32_t mask;
};
constexpr std::array<ColorEffect, 27> kColorEffects{{
    {0, 0},    // off
    {1, 4},    // twinkle
    {2, 2},    //
    {3, 1},    //
    {1, 6},    //
    {1, 5},    //
    {2, 3},    //
    {1, 8},    //
    {1, 32},   //
    {1, 64},   //
    {1, 4},    // 10: dazzle
    {2, 2},    //
    {3, 1},    //
    {1, 6},    //
    {1, 5},    //
    {2, 3},    //
    {1, 7},    //
    {1, 32},   //
    {1, 64},   //
    {1, 134},  //
    {1, 133},  //
    {2, 131},  // 21
    {1, 144},  //
    {1, 134},  // 23: twinkle
    {1, 133},  //
    {1, 131},  // 25
    {1, 144},  //
}};

// Calls visit(slot) for each slot of a ribbon channel's entry that lies on the fixture.
template <typename Visit>
void forSlotsOnFixture(std::int32_t index, const ZephRenderSlot& magic, RenderContext& context, Visit&& visit) {
    const ZephKeshData& kesh = context.simulation.Fixtures[magic.Fixture].Kesh;
    const RibbonAddress address = ribbonAddress(kesh, index);
    if (address.unit != static_cast<std::int32_t>(address.unit)) return;
    const std::int32_t key =
        BuildCmdKey(kDeviceQen, kesh.Network, static_cast<std::int32_t>(address.unit), address.circuit);
    const std::int32_t entry = key == 0 ? 0 : FindCommandData(key, context.tables);
    if (entry == 0) return;
    const ZephRenderData& data = context.tables.RenderData[static_cast<std::size_t>(entry)];
    for (std::int32_t s = data.FirstSlot; s < data.FirstSlot + data.SlotCount; ++s) {
        const ZephRenderSlot& slot = context.tables.Slots[static_cast<std::size_t>(s)];
        if (slot.Fixture == magic.Fixture) visit(slot);
    }
}

void TurnOffKeshTriplets(std::int32_t index, const ZephRenderSlot& magic, std::int32_t newMode, bool keep,
                         RenderContext& context) {
    forSlotsOnFixture(index, magic, context, [&](const ZephRenderSlot& slot) {
        if (!slot.isRGB()) return;
        ZephRGBData& group = context.tables.RGBData[static_cast<std::size_t>(slot.RGBIndex)];
        for (std::size_t colour = 1; colour <= 3; ++colour) {
            if (!keep) group.Level[colour] = group.LastLevel[colour] = group.EffectLevel[colour] = 0;
            group.Mode[colour] = newMode;
        }
    });
}

bool KeshUpdateRGBTriplet(std::int32_t index, const ZephRenderSlot& magic, std::int32_t kind, std::int32_t mask,
                          std::int32_t elapsed, RenderContext& context) {
    bool changed = false;
    forSlotsOnFixture(index, magic, context, [&](const ZephRenderSlot& slot) {
        context.tables.LevelChanged |= 1u << slot.Level;
        if (!slot.isRGB()) return;
        context.tables.RGBData[static_cast<std::size_t>(slot.RGBIndex)].EffectMask = mask;
        const RgbEffectStep step{.level = 100, .elapsed = elapsed};
        const bool stepped = kind == kTwinkles ? TwinkleRGB(slot, step, context) : ShimmerRGB(slot, step, context);
        changed = changed || stepped;
    });
    return changed;
}

// Puts all fifty pixels under the effect, or, at effect 0, releases them.
void resetPixels(const ZephRenderSlot& slot, std::int32_t effect, std::int32_t first, RenderContext& context) {
    ZephKeshState& ribbon = context.states[slot.Fixture].Kesh;
    const bool begins = effect != 0 && (ribbon.KeshResolutionChanged || first != 0);
    const std::int32_t newMode = begins ? kModeEffect : kModeReleased;
    const bool keep = begins && ribbon.KeshResolutionChanged;
    const std::int32_t channelMode = context.simulation.Fixtures[slot.Fixture].Kesh.Channel_Mode;
    for (std::int32_t pixel = 1; pixel <= kMaxRibbonPixels; ++pixel) {
        TurnOffKeshTriplets(AbsoluteKeshChannelID(channelMode, 0, pixel, 1), slot, newMode, keep, context);
    }
    ribbon.KeshResolutionChanged = false;
}

bool ProcessKeshColorEffect(const ZephRenderSlot& slot, std::int32_t effect, std::int32_t elapsed, std::int32_t first,
                            std::int32_t nowMs, RenderContext& context) {
    ZephKeshState& ribbon = context.states[slot.Fixture].Kesh;
    bool changed = false;
    const bool resolutionChanged = ribbon.KeshResolutionChanged;
    if (effect == 0 || resolutionChanged || first != 0) {
        resetPixels(slot, effect, first, context);
        changed = true;
    }
    if (effect < 1 || effect >= static_cast<std::int32_t>(kColorEffects.size())) return changed;

    const std::int32_t kind = KeshTwinkleOrDazzle(effect);
    if (kind == kDazzles && (nowMs >= ribbon.KeshFlipTime + kFlipMs || ribbon.KeshResolutionChanged)) {
        ribbon.KeshFlip = !ribbon.KeshFlip;
        ribbon.KeshFlipTime = nowMs;
    }
    const ColorEffect& row = kColorEffects[static_cast<std::size_t>(effect)];
    const std::int32_t channelMode = context.simulation.Fixtures[slot.Fixture].Kesh.Channel_Mode;
    const std::int32_t pixels = KeshResolutionToResolutionCount(ribbon.KeshResolution);
    for (std::int32_t pixel = 1; pixel <= pixels; ++pixel) {
        const std::int32_t index = AbsoluteKeshChannelID(channelMode, ribbon.KeshResolution, pixel, row.colour);
        if (KeshUpdateRGBTriplet(index, slot, kind, row.mask, elapsed, context)) changed = true;
    }
    return changed;
}

}  // namespace

std::int32_t KeshTwinkleOrDazzle(std::int32_t effect) {
    return effect <= 9 || (effect >= 23 && effect <= 26) ? kTwinkles : kDazzles;
}

bool ProcessKeshMagicChannel(const ZephRenderSlot& slot, std::int32_t value, std::int32_t elapsed, std::int32_t first,
                             std::int32_t nowMs, RenderContext& context) {
    ZephKeshState& ribbon = context.states[slot.Fixture].Kesh;
    bool changed = false;
    switch (slot.KeshMagic) {
    case kResolution: {
        const std::int32_t resolution =
            KeshResolutionCountToResolution(context.simulation.Fixtures[slot.Fixture], value);
        ribbon.KeshResolutionChanged = resolution != ribbon.KeshResolution;
        ribbon.KeshResolution = resolution;
        changed = true;  // even when it stays: the channel's command thereby ages like one that drew
        break;
    }
    case kMotion:
        // Compared with the value before the present one, so a new value clears twice: the second clearing is what
        // starts a chase from its first step on the controllers too.
        if (value != ribbon.KeshMotionLast) {
            ClearKeshParms(ribbon);
            ribbon.KeshMotionLast = ribbon.KeshMotion;
            ribbon.KeshMotion = value;
            changed = true;
        }
        if (value == kMotionStrobe) stepMotionStrobe(nowMs, ribbon);
        break;
    case kMotionParm:
        if (value != ribbon.KeshMotionParmLast) {
            ribbon.KeshMotionParmLast = ribbon.KeshMotionParm;
            ClearKeshParms(ribbon);
            ribbon.KeshMotionParm = value;
            changed = true;
        }
        break;
    case kMotionPos:
        ribbon.KeshMotionPos = value;
        changed = true;
        break;
    case kColorEffect:
        if (value == 0 && ribbon.KeshColorEffect == 0) break;
        changed = ProcessKeshColorEffect(slot, value, elapsed, first, nowMs, context);
        ribbon.KeshColorEffect = value;
        break;
    case kSpeed:
        ribbon.KeshSpeed = std::clamp(100 - value, 0, 100);
        changed = true;
        break;
    case kIntensity:
        ribbon.KeshIntensity = value;
        changed = true;
        break;
    default:
        break;
    }
    return changed;
}
