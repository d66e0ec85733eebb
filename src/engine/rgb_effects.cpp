#include "engine/rgb_effects.h"

#include "util/rounding.h"

#include <algorithm>
#include <optional>

namespace {

constexpr std::int32_t kColours = 3;
constexpr std::int32_t kColourMask[kColours + 1] = {0, kMaskRed, kMaskGreen, kMaskBlue};  // of colour 1..3

// Units of the twinkle's phases, ms.
constexpr double kTwinkleUnitMs = 8.333;
// Keeps bits 0, 1, 4 and 5 of the random number: the phases cluster, as those of the controllers do.
constexpr std::int32_t kTwinkleBits = 51;
constexpr std::int32_t kTwinkleLeastOff = 20;  // units; an on phase may last none at all

// 49 in 100, not one half: above 50 of 0..99.
bool pick(RandomSource& random) {
    return floorToInt(random.next() * 100) > 50;
}

bool hasEffect(const ZephRGBData& group, std::int32_t colour) {
    return (group.Mode[static_cast<std::size_t>(colour)] & kModeEffect) != 0;
}

std::int32_t twinklePhaseMs(std::int32_t leastUnits, RandomSource& random) {
    const std::int32_t units = (ZephReturnRandomNumber(0, 63, random) & kTwinkleBits) + leastUnits;
    return roundHalfEven(units * kTwinkleUnitMs);
}

// The level of every colour under the effect: what the rule gives for it.
template <typename Rule>
void setEffectColours(ZephRGBData& group, std::array<std::int32_t, 4>& levels, Rule&& rule) {
    for (std::int32_t colour = 1; colour <= kColours; ++colour) {
        if (hasEffect(group, colour)) levels[static_cast<std::size_t>(colour)] = rule(colour);
    }
}

void setAll(ZephRGBData& group, std::int32_t level) {
    std::fill(group.Level.begin() + 1, group.Level.end(), level);
}

void twinkleStep(ZephRGBData& group, std::int32_t intensity, RandomSource& random) {
    const std::int32_t mask = group.EffectMask;
    const std::int32_t full = levelRounded(intensity);
    if (mask & kMaskRandomLevel) {
        setEffectColours(group, group.Level, [&](std::int32_t) {
            return pick(random) ? levelRounded(floorToInt(intensity * random.next())) : 0;
        });
    } else if (mask & kMaskRandomOnOff) {
        setEffectColours(group, group.Level,
                         [&](std::int32_t) { return floorToInt(random.next() * 60) > 50 ? full : 0; });
    } else if (mask & kMaskOneAtATime) {
        if (pick(random)) {
            const std::int32_t chosen = RandomDiscreteChannel(mask, true, random);
            setEffectColours(group, group.Level, [&](std::int32_t colour) { return colour == chosen ? full : 0; });
        } else {
            setAll(group, 0);
        }
    } else if (mask & kMaskWhite) {
        if (hasEffect(group, 1)) setAll(group, pick(random) ? full : 0);
    } else {
        for (std::int32_t colour = 1; colour <= kColours; ++colour) {
            if (!(mask & kColourMask[colour]) || !hasEffect(group, colour)) continue;
            group.Level[static_cast<std::size_t>(colour)] = pick(random) ? full : 0;
        }
    }
}

// True where a colour took a new target.
bool shimmerStep(ZephRGBData& group, const ZephKeshState& ribbon, RandomSource& random) {
    const std::int32_t mask = group.EffectMask;
    const std::int32_t full = levelRounded(ribbon.KeshIntensity);
    const bool any = hasEffect(group, 1) || hasEffect(group, 2) || hasEffect(group, 3);
    if (mask & kMaskRandomLevel) {
        setEffectColours(group, group.EffectLevel, [&](std::int32_t) {
            return clampByte(roundHalfEven(ribbon.KeshIntensity * random.next() * 2.55 + 2 * ribbon.KeshSpeed));
        });
        return any;
    }
    if (mask & kMaskRandomOnOff) {
        bool cameOn = false;
        // Without a colour to light, no draw would ever end this.
        while (any && !cameOn) {
            setEffectColours(group, group.EffectLevel, [&](std::int32_t) {
                if (floorToInt(random.next() * 100) <= 70) return 0;
                cameOn = true;
                return full;
            });
        }
        return any;
    }
    if (mask & kMaskOneAtATime) {
        const std::int32_t chosen = RandomDiscreteChannel(mask, false, random);
        setEffectColours(group, group.EffectLevel, [&](std::int32_t colour) { return colour == chosen ? full : 0; });
        return chosen >= 1 && chosen <= kColours && hasEffect(group, chosen);
    }
    bool changed = false;
    for (std::int32_t colour = 1; colour <= kColours; ++colour) {
        if (!(mask & kColourMask[colour]) || !hasEffect(group, colour)) continue;
        group.EffectLevel[static_cast<std::size_t>(colour)] = full;
        changed = true;
    }
    return changed;
}

struct Target {
    ZephRGBData& group;
    std::int32_t& level;
    std::int32_t& mode;
    const ZephKeshState& ribbon;
};

// The group and the colour of a slot. Colours above 3 exist on Sequential ribbons at coarse resolutions; they have no
// place in a group.
std::optional<Target> targetOf(const ZephRenderSlot& slot, RenderContext& context) {
    if (!slot.isRGB() || slot.Channel < 1 || slot.Channel > kColours) return std::nullopt;
    ZephRGBData& group = context.tables.RGBData[static_cast<std::size_t>(slot.RGBIndex)];
    const std::size_t colour = static_cast<std::size_t>(slot.Channel);
    return Target{group, group.Level[colour], group.Mode[colour], context.states[slot.Fixture].Kesh};
}

}  // namespace

std::int32_t ChannelTwinkle(std::int32_t intensity, ZephTwinklePhase& phase, std::int32_t nowMs, RandomSource& random) {
    if (phase.NextTwinkleTime == 0) {
        phase.NextTwinkleTime = nowMs + 10 * ZephReturnRandomNumber(1, 17, random);
        phase.TwinkleOn = ZephReturnRandomNumber(1, 2, random) == 1;
    } else if (phase.NextTwinkleTime <= nowMs) {
        phase.TwinkleOn = !phase.TwinkleOn;
        phase.NextTwinkleTime = nowMs + twinklePhaseMs(phase.TwinkleOn ? 0 : kTwinkleLeastOff, random);
    }
    return phase.TwinkleOn ? intensity : 0;
}

bool TwinkleRGB(const ZephRenderSlot& slot, const RgbEffectStep& step, RenderContext& context) {
    const std::optional<Target> target = targetOf(slot, context);
    if (!target) return false;
    if (step.mode != 0) target->mode = step.mode;
    bool changed = false;
    if (step.single || target->group.EffectMask == 0) {
        if (target->mode & kModePlain) {
            changed = true;
            target->level = step.level != 0 && pick(context.random) ? step.level : 0;
        }
    } else if (step.elapsed > target->ribbon.KeshSpeed * 4 + 180) {
        changed = true;
        twinkleStep(target->group, target->ribbon.KeshIntensity, context.random);
    }
    target->group.Changed = true;  // in every case: a group under an effect is painted in each pass
    return changed;
}

bool ShimmerRGB(const ZephRenderSlot& slot, const RgbEffectStep& step, RenderContext& context) {
    const std::optional<Target> target = targetOf(slot, context);
    if (!target) return false;
    if (step.mode != 0) target->mode = step.mode;
    ZephRGBData& group = target->group;
    bool changed = false;
    if (step.single || group.EffectMask == 0) {
        if (target->mode & kModePlain) {
            changed = true;
            target->level = step.level;
        }
    } else {
        if (step.elapsed > (110 - target->ribbon.KeshSpeed) * 4) {
            changed = shimmerStep(group, target->ribbon, context.random);
        }
        setEffectColours(group, group.Level, [&](std::int32_t colour) {
            const std::int32_t full = group.EffectLevel[static_cast<std::size_t>(colour)];
            return target->ribbon.KeshFlip ? full : divideHalfEven(full * 8, 10);
        });
    }
    group.Changed = true;
    return changed;
}

std::int32_t RandomDiscreteChannel(std::int32_t mask, bool allowNone, RandomSource& random) {
    const std::int32_t lowest = allowNone ? 0 : 1;
    if (mask & kMaskAnyOne) return ZephReturnRandomNumber(lowest, 3, random);
    if (mask & kMaskRed) {
        const std::int32_t colour = ZephReturnRandomNumber(lowest, 2, random);
        return colour == 2 && (mask & kMaskBlue) ? 3 : colour;
    }
    const std::int32_t colour = ZephReturnRandomNumber(2, allowNone ? 4 : 3, random);
    return colour == 4 ? 0 : colour;
}
