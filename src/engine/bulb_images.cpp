#include "engine/bulb_images.h"

#include "engine/bulb_walk.h"
#include "util/color.h"

#include <algorithm>

std::uint32_t opaquePixel(std::int32_t color) noexcept {
    const ColorParts parts = ZephColorToRGB(color);
    return 0xFF000000U | static_cast<std::uint32_t>(parts.red) << 16 | static_cast<std::uint32_t>(parts.green) << 8 |
           static_cast<std::uint32_t>(parts.blue);
}

std::uint32_t coveredPixel(std::uint32_t opaqueColor, std::uint32_t coverage) noexcept {
    const auto part = [&](int shift) { return ((opaqueColor >> shift) & 255U) * coverage / 255U << shift; };
    return coverage << 24 | part(16) | part(8) | part(0);
}

void makeBulbImage(const BulbMask* mask, std::int32_t color, BulbImage& image) {
    image.Mask = mask;
    image.Color = opaquePixel(color);
    image.Pixels.clear();
    if (mask == nullptr || !mask->Soft) return;

    // A flood has few steps of grey: each is worked out once.
    std::array<std::uint32_t, 256> steps;
    for (std::uint32_t a = 0; a < 256; ++a)
        steps[a] = coveredPixel(image.Color, a);
    const std::int32_t side = 2 * mask->Size;
    image.Pixels.assign(static_cast<std::size_t>(side * mask->Stride), 0);
    for (std::int32_t y = 0; y < side; ++y) {
        const std::uint8_t* coverage = mask->Coverage.data() + y * side;
        std::uint32_t* pixels = image.Pixels.data() + y * mask->Stride;
        std::transform(coverage, coverage + side, pixels, [&](std::uint8_t a) { return steps[a]; });
    }
}

void ZephCreateChannelBulb(const ZephFixture& fixture, std::int32_t channel, std::int32_t color, const ZephMasks& masks,
                           ZephFixtureBulbs& bulbs) {
    if (fixture.Channels.at(channel).Sub_Type == kSpecialMultiColor) {
        ZephCreateMultiColorBulbs(fixture, channel, masks, bulbs);
        return;
    }
    makeBulbImage(maskOf(masks, fixture), color, bulbs.Bulb[static_cast<std::size_t>(channel)]);
}

void ZephCreateMultiColorBulbs(const ZephFixture& fixture, std::int32_t channel, const ZephMasks& masks,
                               ZephFixtureBulbs& bulbs) {
    const ZephChannel& record = fixture.Channels.at(channel);
    std::int32_t& index = bulbs.MultiColorIndex[static_cast<std::size_t>(channel)];
    if (index == 0) {
        bulbs.MultiColorBulbs.emplace_back();
        index = static_cast<std::int32_t>(bulbs.MultiColorBulbs.size());
    }
    ZephMultiColorBulbSet& set = bulbs.MultiColorBulbs[static_cast<std::size_t>(index - 1)];
    for (std::int32_t k = 1; k <= multiColors(record); ++k) {
        makeBulbImage(maskOf(masks, fixture), record.Multi[k], set.Bulbs[static_cast<std::size_t>(k)]);
    }
}

void CreateBlackBulb(const ZephFixture& fixture, const ZephMasks& masks, ZephFixtureBulbs& bulbs) {
    makeBulbImage(maskOf(masks, fixture), 0, bulbs.BlackBulb);
}

void ZephCreateStaticFixtureBulbs(const ZephFixture& fixture, const ZephMasks& masks, ZephFixtureBulbs& bulbs) {
    bulbs = {};
    if (fixture.Channel_Type != kChannelRgb && fixture.Fixture_Type != kFixtureKesh) {
        const std::int32_t channels = std::clamp(fixture.ChannelCount, 0, kMaxChannels);
        for (std::int32_t channel = 1; channel <= channels; ++channel) {
            ZephCreateChannelBulb(fixture, channel, fixture.Channels[channel].Color, masks, bulbs);
        }
    } else {
        const ZephSampleColor& sample = fixture.Sample;
        const std::int32_t color = packColor(clampByte(sample.RGB_R), clampByte(sample.RGB_G), clampByte(sample.RGB_B));
        ZephCreateChannelBulb(fixture, 1, color, masks, bulbs);
    }
    CreateBlackBulb(fixture, masks, bulbs);
}

void ZephRebuildStaticFixtureBulbs(const ZephSimulation& document, const ZephMasks& masks, ZephStaticBulbs& bulbs) {
    for (std::int32_t n = 1; n <= kMaxFixtures; ++n) {
        if (n <= document.FixtureCount) {
            ZephCreateStaticFixtureBulbs(document.Fixtures[n], masks, bulbs[n]);
        } else {
            bulbs[n] = {};
        }
    }
}

const BulbImage& channelImage(const ZephFixture& fixture, std::int32_t channel, std::int32_t bulb,
                              const ZephFixtureBulbs& bulbs) noexcept {
    const std::int32_t set = bulbs.MultiColorIndex[static_cast<std::size_t>(channel)];
    if (set == 0) return bulbs.Bulb[static_cast<std::size_t>(channel)];
    const std::int32_t color = (bulb - 1) % multiColors(fixture.Channels[channel]) + 1;
    return bulbs.MultiColorBulbs[static_cast<std::size_t>(set - 1)].Bulbs[static_cast<std::size_t>(color)];
}
