#include "engine/light_drawing.h"

#include "engine/ribbon_channels.h"
#include "engine/ribbon_motion.h"
#include "model/tables.h"
#include "util/color.h"

#include <algorithm>

namespace {

// A group is dark unless one colour reaches the first and the brightest the second. Two tests, as on the controllers:
// the second decides, the first spares the work of mixing.
constexpr std::int32_t kDarkColour = 25;
constexpr std::int32_t kDarkGroup = 30;

std::uint8_t throughCurve(const ZephDimmingCurve& curve, std::int32_t level) {
    return curve[static_cast<std::size_t>(clampByte(level))];
}

// One step of a bulb's schedule; true while it is lit.
bool stepStrobe(ZephStrobeBulb& bulb, const ZephChannelState& channel, std::int32_t nowMs, RandomSource& random) {
    const double interval = channel.StrobeInterval;
    if (!channel.StrobeRunning) {
        // Random phases, so that the bulbs of a channel do not flash together.
        bulb.NextOnTime = nowMs + roundHalfEven(random.next() * interval);
        bulb.BulbOn = false;
        return false;
    }
    if (bulb.BulbOn) {
        if (nowMs <= bulb.NextOffTime) return true;
        // Counted from the moment off, not from the last flash: a flash longer than its interval still alternates.
        bulb.BulbOn = false;
        bulb.NextOnTime = nowMs + roundHalfEven(random.next() * (interval * 0.2) - interval * 0.1 + interval);
        return false;
    }
    if (nowMs <= bulb.NextOnTime) return false;
    bulb.BulbOn = true;
    bulb.NextOffTime = nowMs + channel.StrobeFireTime;
    return true;
}

const std::uint8_t* stepStrobes(const ZephBulbLocations& bulbs, const ZephChannelState& channel, std::int32_t nowMs,
                                RenderContext& context) {
    for (std::int32_t b = 0; b < bulbs.Count; ++b) {
        ZephStrobeBulb& strobe = context.tables.StrobePool[static_cast<std::size_t>(bulbs.FirstStrobe + b)];
        context.tables.BulbLit[static_cast<std::size_t>(b)] =
            stepStrobe(strobe, channel, nowMs, context.random) ? 1 : 0;
    }
    return context.tables.BulbLit.data();
}

// The bulbs of a group that a ribbon or a pixel run lights; false = none.
bool chooseBulbs(const ZephLevelGroup& group, std::int32_t nowMs, RenderContext& context, PixelList& list,
                 GroupDraw& draw) {
    const ZephFixture& fixture = context.simulation.Fixtures[group.Fixture];
    ZephFixtureState& state = context.states[group.Fixture];
    if (fixture.Fixture_Type == kFixtureKesh) {
        const std::int32_t resolution = state.Kesh.KeshResolution;
        if (KeshResolutionToResolutionCount(resolution) < group.Triplet) return false;
        list = ReturnKeshBulbLocs(group.Triplet, resolution, fixture.PointCount, nowMs, state.Kesh);
    } else if (fixture.Fixture_Type == kFixtureDmxPixels) {
        const std::int32_t bulb = ReturnPixelBulbLoc(group.Triplet, fixture.PointCount);
        if (bulb == 0 || fixture.DrawPoints[bulb].Type == kPointPlaceHolder) return false;
        list.add(bulb);
    } else {
        return true;  // all of them
    }
    draw.Bulbs = list.pixels.data();
    draw.BulbCount = list.count;
    return list.count > 0;
}

}  // namespace

void ZephDrawPreComputedBulbs(std::int32_t fixture, std::int32_t channel, std::int32_t intensity, std::int32_t level,
                              std::int32_t nowMs, RenderContext& context) {
    ChannelDraw draw;
    draw.Level = level;
    draw.Fixture = fixture;
    draw.Channel = channel;
    draw.Intensity = intensity;
    draw.Alpha = throughCurve(context.curve, levelCut(intensity));

    ZephFixtureState& state = context.states[fixture];
    const ZephBulbLocations* bulbs = bulbLocations(state, channel);
    const bool recorded = channel >= 1 && channel <= kMaxChannels;  // a damaged ribbon drives channels it has not
    if (recorded) {
        ZephChannelState& channelState = state.Channels[static_cast<std::size_t>(channel)];
        const std::int32_t special = context.simulation.Fixtures[fixture].Channels[channel].Sub_Type;
        if (special == kSpecialStrobes && bulbs && bulbs->FirstStrobe >= 0) {
            draw.BulbLit = stepStrobes(*bulbs, channelState, nowMs, context);
        }
        if (special != kSpecialNone) channelState.StrobeRunning = true;
    }
    context.surface.drawChannel(draw);
}

void ZephDrawRGBBulbs(const ZephLevelGroup& group, std::int32_t level, std::int32_t nowMs, RenderContext& context) {
    ZephRGBData& data = context.tables.RGBData[static_cast<std::size_t>(group.RGBIndex)];
    GroupDraw draw;
    draw.Level = level;
    draw.Fixture = group.Fixture;
    draw.RGBIndex = group.RGBIndex;
    draw.Triplet = group.Triplet;

    PixelList list;
    std::int32_t brightness = GetRGBIntensity(data);
    const bool lit = brightness >= kDarkColour && brightness >= kDarkGroup;
    if (lit) {
        const ZephFixture& fixture = context.simulation.Fixtures[group.Fixture];
        draw.Color = ZephColorMixer(data.Level[1], data.Level[2], data.Level[3]);
        // A brightness of 0..255 is compared with a percentage, and what the curve gives goes through the curve once
        // more: flood opacities in displays were set by eye against exactly this.
        if (fixture.Fixture_Type == kFixtureFlood && brightness > fixture.Max_Opacity) {
            brightness = throughCurve(context.curve, levelCut(std::clamp(fixture.Max_Opacity, 0, 100)));
        }
        if (draw.Color != 0 && chooseBulbs(group, nowMs, context, list, draw)) {
            draw.Alpha = throughCurve(context.curve, brightness);
        }
    }
    context.surface.drawGroup(draw, data);
}

std::int32_t ZephColorMixer(std::int32_t red, std::int32_t green, std::int32_t blue) {
    const std::int32_t largest = std::max({red, green, blue});
    if (largest <= 0) return 0;
    return packColor(divideHalfEven(red * 255, largest), divideHalfEven(green * 255, largest),
                     divideHalfEven(blue * 255, largest));
}

std::int32_t GetRGBIntensity(const ZephRGBData& group) {
    return std::max({group.Level[1], group.Level[2], group.Level[3]});
}

std::int32_t ReturnPixelBulbLoc(std::int32_t triplet, std::int32_t pointCount) {
    // Above the point count the last point answers, once more, as a pixel run's controller holds its last pixel.
    const std::int32_t bulb = triplet - (kFirstPixelTriplet - 1);
    return bulb < 0 ? 0 : std::min(bulb, pointCount);
}
