#include "engine/bulb_images.h"
#include "tests/support/fixtures.h"
#include "tests/support/masks.h"
#include "util/color.h"

namespace {

struct Workshop {
    std::unique_ptr<ZephSimulation> document = std::make_unique<ZephSimulation>();
    ZephFixture& fixture = addFixture(*document, kFixtureStrings);
    ZephFixtureBulbs bulbs;

    void create() { ZephCreateStaticFixtureBulbs(fixture, masks(), bulbs); }
};

}  // namespace

TEST(StaticBulbs, EachChannelHasItsColourAndAMultiColorOneASetOfThem) {
    Workshop shop;
    addChannel(shop.fixture, 1, 1, packColor(1, 2, 3));
    ZephChannel& multi = addChannel(shop.fixture, 1, 2);
    multi.Sub_Type = kSpecialMultiColor;
    multi.Sub_Parm = 2;
    multi.Multi[1] = packColor(255, 0, 0);
    multi.Multi[2] = packColor(0, 255, 0);
    ZephChannel& damaged = addChannel(shop.fixture, 1, 3);
    damaged.Sub_Type = kSpecialMultiColor;
    damaged.Sub_Parm = 99;  // counts as five
    shop.fixture.BulbSize = 3;
    shop.fixture.BulbShape = 4;
    shop.create();
    EXPECT_EQ(shop.bulbs.Bulb[1].Color, 0xFF010203U);
    EXPECT_EQ(shop.bulbs.Bulb[1].Mask, &masks().ZephBulbMasks[3][4]);
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
    addChannel(shop.fixture, 1, 1, packColor(200, 100, 10));
    shop.create();
    // The outermost ring of four has the coverage 59: 200 x 59 / 255 = 46.3, 23.1, 2.3.
    const auto rim = static_cast<std::size_t>(10 * shop.bulbs.Bulb[1].Mask->Stride);
    EXPECT_EQ(shop.bulbs.Bulb[1].Pixels[rim], 0x3B2E1702U);
    EXPECT_EQ(shop.bulbs.BlackBulb.Pixels[rim], 0x3B000000U);
    shop.fixture.BulbSize = 65;
    shop.create();
    EXPECT_EQ(shop.bulbs.Bulb[1].Mask, nullptr);
}

TEST(StaticBulbs, ARebuildEmptiesTheSlotsThatFellFree) {
    Workshop shop;
    auto bulbs = std::make_unique<ZephStaticBulbs>();
    addChannel(shop.fixture, 1, 1);
    addChannel(addFixture(*shop.document, kFixtureStrings), 1, 2);
    ZephRebuildStaticFixtureBulbs(*shop.document, masks(), *bulbs);
    EXPECT_NE((*bulbs)[2].Bulb[1].Mask, nullptr);
    shop.document->FixtureCount = 1;
    ZephRebuildStaticFixtureBulbs(*shop.document, masks(), *bulbs);
    EXPECT_NE((*bulbs)[1].Bulb[1].Mask, nullptr);
    EXPECT_EQ((*bulbs)[2].Bulb[1].Mask, nullptr);
}
