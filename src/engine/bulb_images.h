// Bulb images: a mask in a colour, blended wherever the bulb hangs. The images that a fixture keeps while its look does
// not change lie in an array of their own, numbered as the fixtures are. A hard mask has one colour all over, so its
// image is the mask and the colour; only floods have pixels of their own.
#pragma once

#include "engine/bulb_masks.h"

#include <array>
#include <cstdint>
#include <vector>

struct BulbImage {
    const BulbMask* Mask = nullptr;     // nullptr = no image, draws nothing
    std::uint32_t Color = 0;            // 0xFFRRGGBB
    std::vector<std::uint32_t> Pixels;  // soft masks: rows of Mask->Stride pixels, colour times alpha, else empty
};

struct ZephMultiColorBulbSet {
    std::array<BulbImage, kMaxMultiColors + 1> Bulbs;  // 1..5
};

// The static images of one fixture.
struct ZephFixtureBulbs {
    std::array<BulbImage, kMaxChannels + 1> Bulb;  // 1..: of a channel; 1 = the sample colour of an RGB fixture
    BulbImage BlackBulb;
    std::vector<ZephMultiColorBulbSet> MultiColorBulbs;
    std::array<std::int32_t, kMaxChannels + 1> MultiColorIndex{};  // 1.. into MultiColorBulbs, 0 = none
};

// About 1 MB: made once, on the heap.
using ZephStaticBulbs = OneBased<ZephFixtureBulbs, kMaxFixtures>;

// The packed colour of the document as an opaque pixel, 0xFFRRGGBB.
std::uint32_t opaquePixel(std::int32_t color) noexcept;

// The pixel of an image at the coverage a: each part is c x a / 255, the fraction cut off; the alpha byte is a.
std::uint32_t coveredPixel(std::uint32_t opaqueColor, std::uint32_t coverage) noexcept;

// The mask in a colour, into an image that is made anew; allocates only if a soft image outgrows its storage. A mask of
// nullptr gives no image.
void makeBulbImage(const BulbMask* mask, std::int32_t color, BulbImage& image);

// channel 1..16 of the fixture. A Multi Color channel gets the images of its colours instead of the one of color.
void ZephCreateChannelBulb(const ZephFixture& fixture, std::int32_t channel, std::int32_t color, const ZephMasks& masks,
                           ZephFixtureBulbs& bulbs);
void ZephCreateMultiColorBulbs(const ZephFixture& fixture, std::int32_t channel, const ZephMasks& masks,
                               ZephFixtureBulbs& bulbs);
void CreateBlackBulb(const ZephFixture& fixture, const ZephMasks& masks, ZephFixtureBulbs& bulbs);

// All images of a fixture; to be called whenever its look changes. A size or shape without a mask gives no images.
void ZephCreateStaticFixtureBulbs(const ZephFixture& fixture, const ZephMasks& masks, ZephFixtureBulbs& bulbs);
// The same for every fixture of the document; slots past FixtureCount are emptied.
void ZephRebuildStaticFixtureBulbs(const ZephSimulation& document, const ZephMasks& masks, ZephStaticBulbs& bulbs);

// The image of bulb b (from 1) of a channel in simulation: Multi Color channels take their colours in turn.
const BulbImage& channelImage(const ZephFixture& fixture, std::int32_t channel, std::int32_t bulb,
                              const ZephFixtureBulbs& bulbs) noexcept;
