#include "engine/bulb_images.h"
#include "tests/support/fixtures.h"
#include "tests/support/masks.h"
#include "util/color.h"

TEST(StaticBulbs, AreInTheColoursOfTheChannelsOrTheSample) {
    const auto document = std::make_unique<ZephSimulation>();
    const auto bulbs = std::make_unique<ZephStaticBulbs>();
    ZephFixture& fixture = addFixture(*document, kFixtureStrings);
    addChannel(fixture, 1, 1, packColor(1, 2, 3));
    for (const std::int32_t colours : {2, 99}) {  // 99, of a damaged file, counts as five
        ZephChannel& multi = addChannel(fixture, 1, 2);
        multi.Sub_Type = kSpecialMultiColor;
        multi.Sub_Parm = colours;
        multi.Multi[1] = packColor(255, 0, 0);
        multi.Multi[2] = packColor(0, 255, 0);
    }
    addChannel(addFixture(*document, kFixtureStrings), 1, 2);
    ZephRebuildStaticFixtureBulbs(*document, masks(), *bulbs);
    EXPECT_EQ((*bulbs)[1].Bulb[1].Color, 0xFF010203U);
    EXPECT_EQ(channelImage(fixture, 2, 4, (*bulbs)[1]).Color, 0xFF00FF00U);
    EXPECT_EQ(channelImage(fixture, 3, 6, (*bulbs)[1]).Color, 0xFFFF0000U);
    EXPECT_EQ((*bulbs)[1].BlackBulb.Color, 0xFF000000U);
    EXPECT_NE((*bulbs)[2].Bulb[1].Mask, nullptr);

    document->FixtureCount = 1;           // its slot falls free
    fixture.Sample = {0, 300, 20, -5};    // of a damaged file
    fixture.Fixture_Type = kFixtureKesh;  // shows its sample even as a Normal one
    ZephRebuildStaticFixtureBulbs(*document, masks(), *bulbs);
    EXPECT_EQ((*bulbs)[1].Bulb[1].Color, 0xFFFF1400U);
    EXPECT_EQ((*bulbs)[2].Bulb[1].Mask, nullptr);
    fixture.Fixture_Type = kFixtureBulbs;
    fixture.Channel_Type = kChannelRgb;
    ZephRebuildStaticFixtureBulbs(*document, masks(), *bulbs);
    EXPECT_EQ((*bulbs)[1].Bulb[1].Color, 0xFFFF1400U);
}
