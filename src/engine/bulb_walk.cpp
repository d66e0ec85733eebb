#include "engine/bulb_walk.h"

#include "util/units.h"

#include <algorithm>

std::int32_t walkedChannels(const ZephFixture& fixture) noexcept {
    if (fixture.Channel_Type == kChannelRgb) return 1;
    return std::clamp(fixture.ChannelCount, 1, kMaxChannels);
}

std::int32_t multiColors(const ZephChannel& channel) noexcept {
    return channel.Sub_Type == kSpecialMultiColor ? std::clamp(channel.Sub_Parm, 1, kMaxMultiColors) : 1;
}

std::int32_t usedPoints(const ZephFixture& fixture) noexcept {
    return std::clamp(fixture.PointCount, 0, kMaxPoints);
}

BulbRhythm bulbRhythm(const ZephFixture& fixture, std::int32_t channel) noexcept {
    const std::int32_t channels = walkedChannels(fixture);
    const double pitch = static_cast<double>(fixture.BulbSpacing) + 2.0 * fixture.BulbSize;
    if (channel < 1 || channel > channels || pitch < 1) return {};

    BulbRhythm rhythm{.walks = true, .pitch = pitch, .colors = multiColors(fixture.Channels[channel])};
    for (std::int32_t other = 1; other <= channels; ++other) {
        const double step = pitch * multiColors(fixture.Channels[other]);
        if (other < channel) rhythm.offset += step;
        if (other != channel) rhythm.gap += step;
    }
    return rhythm;
}

std::int32_t roundedPixelX(std::int32_t twips) noexcept {
    return roundHalfEven(static_cast<double>(twips) / TwipsPerPixelX);
}

std::int32_t roundedPixelY(std::int32_t twips) noexcept {
    return roundHalfEven(static_cast<double>(twips) / TwipsPerPixelY);
}
