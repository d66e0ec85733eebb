#include "engine/bulb_images.h"
#include "util/color.h"

#include <gtest/gtest.h>

#include <memory>

namespace {

struct Workshop {
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    ZephFixture fixture;
    ZephFixtureBulbs bulbs;

    Workshop() {
        ZephDimmingCurve curve;
        for (std::size_t i = 0; i < curve.size(); ++i)
            curve[i] = static_cast<std::uint8_t>(i);
        ZephSetUpMasks(
            curve, [](std::string_view) {}, *masks);
        fixture.Fixture_Type = kFixtureStrings;
        fixture.Channel_Type = kChannelNormal;
        fixture.BulbSize = 3;
        fixture.BulbShape = 4;
    }
    void create() { ZephCreateStaticFixtureBulbs(fixture, *masks, bulbs); }
};

}  // namespace

TEST(StaticBulbs, EachChannelHasItsColourAndAMultiColorOneASetOfThem) {
    Workshop shop;
    shop.fixture.ChannelCount = 3;
    shop.fixture.Channels[1].Color = packColor(1, 2, 3);
    shop.fixture.Channels[2].Sub_Type = kSpecialMultiColor;
    shop.fixture.Channels[2].Sub_Parm = 2;
    shop.fixture.Channels[2].Multi[1] = packColor(255, 0, 0);
    shop.fixture.Channels[2].Multi[2] = packColor(0, 255, 0);
    shop.fixture.Channels[3].Sub_Type = kSpecialMultiColor;
    shop.fixture.Channels[3].Sub_Parm = 99;  // of a damaged file: five
    shop.create();

    EXPECT_EQ(shop.bulbs.Bulb[1].Color, 0xFF010203U);
    EXPECT_EQ(shop.bulbs.Bulb[1].Mask, &shop.masks->ZephBulbMasks[3][4]);
    EXPECT_EQ(shop.bulbs.MultiColorBulbs.size(), 2U);
    EXPECT_EQ(channelImage(shop.fixture, 2, 1, shop.bulbs).Color, 0xFFFF0000U);
    EXPECT_EQ(channelImage(shop.fixture, 2, 4, shop.bulbs).Color, 0xFF00FF00U);
    EXPECT_EQ(channelImage(shop.fixture, 3, 5, shop.bulbs).Color, 0xFFFFFFFFU);
    EXPECT_EQ(shop.bulbs.BlackBulb.Color, 0xFF000000U);
    EXPECT_EQ(shop.bulbs.Bulb[4].Mask, nullptr);
    EXPECT_TRUE(shop.bulbs.Bulb[1].Pixels.empty());  // hard: the mask and the colour are all of it
}

TEST(StaticBulbs, RgbFixturesAndRibbonsShowTheirSample) {
    Workshop shop;
    shop.fixture.Sample = {0, 300, 20, -5};  // of a damaged file
    for (const auto& [type, channelType] :
         {std::pair{kFixtureBulbs, kChannelRgb}, std::pair{kFixtureKesh, kChannelNormal}}) {
        shop.fixture.Fixture_Type = type;
        shop.fixture.Channel_Type = channelType;
        shop.create();
        EXPECT_EQ(shop.bulbs.Bulb[1].Color, 0xFFFF1400U);
    }
}

TEST(StaticBulbs, AFloodHasPixelsOfItsOwn) {
    Workshop shop;
    shop.fixture.Fixture_Type = kFixtureFlood;
    shop.fixture.BulbSize = 10;
    shop.fixture.ChannelCount = 1;
    shop.fixture.Channels[1].Color = packColor(200, 100, 10);
    shop.create();
    // The outermost ring of four has the coverage 59: 200 x 59 / 255 = 46.3, 23.1, 2.3.
    const BulbImage& image = shop.bulbs.Bulb[1];
    EXPECT_EQ(image.Pixels[static_cast<std::size_t>(10 * image.Mask->Stride)], 0x3B2E1702U);
    EXPECT_EQ(shop.bulbs.BlackBulb.Pixels[static_cast<std::size_t>(10 * image.Mask->Stride)], 0x3B000000U);
    shop.fixture.BulbSize = 65;
    shop.create();
    EXPECT_EQ(shop.bulbs.Bulb[1].Mask, nullptr);
}

TEST(StaticBulbs, ARebuildEmptiesTheSlotsThatFellFree) {
    Workshop shop;
    auto document = std::make_unique<ZephSimulation>();
    auto bulbs = std::make_unique<ZephStaticBulbs>();
    shop.fixture.ChannelCount = 1;
    document->Fixtures[1] = document->Fixtures[2] = shop.fixture;
    document->FixtureCount = 2;
    ZephRebuildStaticFixtureBulbs(*document, *shop.masks, *bulbs);
    EXPECT_NE((*bulbs)[2].Bulb[1].Mask, nullptr);
    document->FixtureCount = 1;
    ZephRebuildStaticFixtureBulbs(*document, *shop.masks, *bulbs);
    EXPECT_NE((*bulbs)[1].Bulb[1].Mask, nullptr);
    EXPECT_EQ((*bulbs)[2].Bulb[1].Mask, nullptr);
}
