#include "engine/render_cycle.h"

#include "engine/light_drawing.h"
#include "engine/rgb_effects.h"
#include "engine/ribbon_effects.h"
#include "util/rounding.h"

namespace {

constexpr const char* kModule = "modZephRenderMainEngine";
constexpr std::int32_t kShimmerMs = 30;
constexpr std::int32_t kSecondMs = 1000;
constexpr int kFramesPanel = 3;
constexpr std::int32_t kEffectShimmer = 1;
constexpr std::int32_t kEffectTwinkle = 2;

// The intensity 0..100 of a running command.
std::int32_t presentIntensity(const ZephRenderLive& live, std::int32_t nowMs) {
    const std::int32_t elapsed = std::max(nowMs - live.StartTime, 0);
    if (live.Duration <= 0 || elapsed > live.Duration) return live.EndIntensity;
    const double done = static_cast<double>(elapsed) / live.Duration;
    const std::int32_t change = live.EndIntensity - live.StartIntensity;
    const std::int32_t intensity = roundHalfEven(live.StartIntensity + change * done);
    // A fade that rises must not be taken for one that has ended at 0.
    const bool rises = live.EndIntensity > live.StartIntensity && live.LastEffectTime != 0;
    return intensity == 0 && rises ? 1 : intensity;
}

// One entry under way in a pass.
struct EntryPass {
    std::size_t index;
    ZephRenderLive& live;
    std::int32_t nowMs;
    bool changed = false;
};

void driveMagic(const ZephRenderSlot& slot, std::int32_t intensity, EntryPass& pass, RenderContext& context) {
    const std::int32_t first = pass.live.LastEffectTime != 0 ? 0 : 2;
    const std::int32_t elapsed = pass.nowMs - pass.live.LastEffectTime;
    if (ProcessKeshMagicChannel(slot, intensity, elapsed, first, pass.nowMs, context)) pass.changed = true;
}

void driveColour(const ZephRenderSlot& slot, std::int32_t intensity, EntryPass& pass, RenderContext& context) {
    if (slot.Channel < 1 || slot.Channel > 3) return;  // a colour that the group has no place for
    ZephRGBData& group = context.tables.RGBData[static_cast<std::size_t>(slot.RGBIndex)];
    std::int32_t& mode = group.Mode[static_cast<std::size_t>(slot.Channel)];
    if (mode == kModeReleased && (context.tables.CommandState[pass.index] & kCommandNew) != 0) mode = 0;
    if (mode != 0 && mode != kModePlain) return;  // a colour effect owns this colour
    const bool effect = pass.live.EffectType == kEffectShimmer || pass.live.EffectType == kEffectTwinkle;
    if (!effect) {
        group.Level[static_cast<std::size_t>(slot.Channel)] = levelRounded(intensity);
        group.Changed = true;
        pass.changed = true;
        return;
    }
    if (!context.clocks.ShimmerPhase && pass.live.EffectType == kEffectShimmer) intensity = 0;
    const RgbEffectStep step{.level = levelRounded(intensity),
                             .elapsed = pass.nowMs - pass.live.LastEffectTime,
                             .mode = pass.live.LastEffectTime == 0 ? kModePlain : 0,
                             .single = true};
    const bool stepped =
        pass.live.EffectType == kEffectShimmer ? ShimmerRGB(slot, step, context) : TwinkleRGB(slot, step, context);
    if (stepped) pass.changed = true;
}

std::int32_t plainIntensity(std::int32_t intensity, EntryPass& pass, RenderContext& context) {
    switch (pass.live.EffectType) {
    case kEffectShimmer:
        return context.clocks.ShimmerPhase ? intensity : 0;
    case kEffectTwinkle:
        return ChannelTwinkle(intensity, context.tables.Twinkle[pass.index], pass.nowMs, context.random);
    default:
        return intensity;
    }
}

void driveSlot(const ZephRenderSlot& slot, EntryPass& pass, RenderContext& context) {
    std::uint8_t& state = context.tables.CommandState[pass.index];
    std::int32_t intensity = presentIntensity(pass.live, pass.nowMs);
    // A command ends in the pass after the one that carried its 0 out, so it takes two at least.
    if (intensity < 1 && pass.live.LastEffectTime != 0) {
        state &= static_cast<std::uint8_t>(~kCommandActive);
        context.tables.Twinkle[pass.index].NextTwinkleTime = 0;
    }
    const bool active = (state & kCommandActive) != 0;
    if (slot.KeshMagic != 0) {
        if (active) driveMagic(slot, intensity, pass, context);
    } else if (slot.isRGB()) {
        if (active) driveColour(slot, intensity, pass, context);
    } else if (active) {
        intensity = plainIntensity(intensity, pass, context);
        ZephDrawPreComputedBulbs(slot.Fixture, slot.Channel, intensity, slot.Level, pass.nowMs, context);
        pass.changed = true;
    }
    if (active) {
        context.tables.LevelChanged |= 1u << slot.Level;
    } else if (slot.KeshMagic == 0 && slot.Channel >= 1 && slot.Channel <= kMaxChannels) {
        context.states[slot.Fixture].Channels[static_cast<std::size_t>(slot.Channel)].StrobeRunning = false;
    }
}

void driveEntries(std::size_t level, std::int32_t nowMs, RenderContext& context) {
    ZephRenderTables& tables = context.tables;
    for (const std::int32_t e : tables.LevelEntries[level]) {
        const std::size_t index = static_cast<std::size_t>(e);
        if ((tables.CommandState[index] & kCommandActive) == 0) continue;
        EntryPass pass{index, tables.Live[index], nowMs};
        const ZephRenderData& entry = tables.RenderData[index];
        for (std::int32_t s = entry.FirstSlot; s < entry.FirstSlot + entry.SlotCount; ++s) {
            const ZephRenderSlot& slot = tables.Slots[static_cast<std::size_t>(s)];
            if (slot.Level == static_cast<std::int32_t>(level)) driveSlot(slot, pass, context);
        }
        if (pass.changed) pass.live.LastEffectTime = nowMs;
    }
    // For every entry, on this level or not: slots on a higher level see the command as no longer new. That is how a
    // channel on two levels has always behaved.
    for (std::size_t n = 0; n < tables.NewEntryCount; ++n) {
        tables.CommandState[static_cast<std::size_t>(tables.NewEntries[n])] &= static_cast<std::uint8_t>(~kCommandNew);
    }
    tables.NewEntryCount = 0;
}

// The levels of commands that came since the last pass have something to show.
void markNewLevels(ZephRenderTables& tables) {
    for (std::size_t n = 0; n < tables.NewEntryCount; ++n) {
        tables.LevelChanged |= tables.RenderData[static_cast<std::size_t>(tables.NewEntries[n])].LevelUsed;
    }
}

void drawGroups(std::size_t level, std::int32_t nowMs, RenderContext& context) {
    for (const ZephLevelGroup& group : context.tables.LevelGroups[level]) {
        ZephRGBData& data = context.tables.RGBData[static_cast<std::size_t>(group.RGBIndex)];
        if (!data.Changed) continue;
        ZephDrawRGBBulbs(group, static_cast<std::int32_t>(level), nowMs, context);
        data.Changed = false;
    }
}

// The head of both supervisors.
void countTick(std::int32_t nowMs, std::int32_t delta, ZephRenderClocks& clocks) {
    clocks.LastTick = nowMs;
    if (clocks.TickCount == 0) clocks.SecondStart = nowMs;
    ++clocks.TickCount;
    clocks.FrameClock += delta;
    clocks.ShimmerClock += delta;
}

void renderFrame(std::int32_t nowMs, const TickContext& tick) {
    ZephProcessDmxStreams(tick.sink, tick.run.failures, tick.stream.Dumps);
    ZephProcessKeshStreams(tick.sink, tick.run.failures, tick.stream.Dumps);
    ZephRenderLights(nowMs, tick.run);
    tick.run.clocks.FrameClock = 0;
    ++tick.run.clocks.FrameCount;
    tick.frameDone();
}

bool secondOver(const TickContext& tick) {
    return tick.clock.timeGetTime() - tick.run.clocks.SecondStart > kSecondMs;
}

}  // namespace

void ZephRenderLights(std::int32_t nowMs, RenderContext& context) try {
    if (context.clocks.ShimmerClock > kShimmerMs) {
        context.clocks.ShimmerPhase = !context.clocks.ShimmerPhase;
        context.clocks.ShimmerClock = 0;
    }
    markNewLevels(context.tables);
    context.surface.beginFrame();
    for (std::size_t level = 1; level <= kLevels; ++level) {
        const std::uint32_t bit = 1u << level;
        if (!context.simulation.Levels[static_cast<int>(level)].Sim_Enabled || !(context.tables.LevelChanged & bit)) {
            continue;
        }
        context.tables.LevelChanged &= ~bit;
        driveEntries(level, nowMs, context);
        drawGroups(level, nowMs, context);
    }
    context.surface.endFrame();
}
ZEPH_GUARD(context.failures, kModule, )

bool ZephRenderTick(int renderEngine, const TickContext& tick) {
    ZephProcessPayloads(true, tick.parser, tick.sink, tick.run.failures, tick.stream);
    return renderEngine == kEngineOpenGL ? ZephRenderingSupervisorGL(tick) : ZephRenderingSupervisor(false, tick);
}

bool ZephRenderingSupervisor(bool force, const TickContext& tick) {
    ZephRenderClocks& clocks = tick.run.clocks;
    const std::int32_t nowMs = tick.clock.timeGetTime();
    countTick(nowMs, nowMs - clocks.LastTick, clocks);
    tick.stream.ZephReceptionCount = 0;
    const bool due = force || clocks.FrameClock >= kStandardFrameMs;
    if (due) renderFrame(nowMs, tick);
    tick.host.pumpEvents();
    if (secondOver(tick)) {
        tick.host.setStatusPanel(kFramesPanel, "FPS:" + std::to_string(clocks.FrameCount) +
                                                   " Res Free:" + std::to_string(clocks.TickCount - clocks.FrameCount));
        clocks.TickCount = 0;
        clocks.FrameCount = 0;
        tick.host.pumpEvents();
    }
    return due;
}

bool ZephRenderingSupervisorGL(const TickContext& tick) {
    ZephRenderClocks& clocks = tick.run.clocks;
    const std::int32_t nowMs = tick.clock.timeGetTime();
    const std::int32_t delta = nowMs - clocks.LastTick;
    if (delta < kOpenGLFrameMs) return false;
    countTick(nowMs, delta, clocks);
    tick.stream.ZephReceptionCount = 0;
    renderFrame(nowMs, tick);
    if (secondOver(tick)) {
        tick.host.setStatusPanel(kFramesPanel, "FPS:" + std::to_string(clocks.FrameCount));
        clocks.TickCount = 0;
        clocks.FrameCount = 0;
    }
    tick.host.pumpEvents();
    return true;
}

ZephRenderClocks clocksAtEntry(std::int32_t nowMs) {
    ZephRenderClocks clocks;
    clocks.LastTick = nowMs;
    clocks.SecondStart = nowMs;
    return clocks;
}
