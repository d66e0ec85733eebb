#include "engine/bulb_masks.h"
#include "engine/bulb_shapes.h"
#include "tests/support/masks.h"

namespace {

// '#' = covered, a '/' between rows.
std::string drawn(const BulbMask& mask) {
    std::string text;
    const auto side = static_cast<std::size_t>(2 * mask.Size);
    for (std::size_t i = 0; i < mask.Coverage.size(); ++i) {
        if (i > 0 && i % side == 0) text += '/';
        text += mask.Coverage[i] == 0 ? '.' : '#';
    }
    return text;
}

int at(const BulbMask& mask, int x, int y) {
    return mask.Coverage[static_cast<std::size_t>(y * 2 * mask.Size + x)];
}

}  // namespace

TEST(BulbMasks, AreHardAndEveryShapeIsVisibleAtEverySize) {
    const auto& bulbs = masks().ZephBulbMasks;
    EXPECT_EQ(drawn(bulbs[1][1]), "##/##");
    EXPECT_EQ(drawn(bulbs[2][1]), ".##./####/####/.##.");
    // Corners at (3, 0), (8, 8) and (0, 8): the sides lie at 3 - 3y/8 and 3 + 5y/8, to the nearest pixel, and the base
    // is cut off.
    EXPECT_EQ(drawn(bulbs[4][2]), "...#..../...##.../..###.../..####../..#####./.######./.#######/########");
    EXPECT_EQ(ZephStarEight.at(16)[5], (ShapeVertex{24, 16}));
    EXPECT_EQ(ZephStarFive.at(16)[6], (ShapeVertex{6, 32}));
    ZephFixture fixture;
    fixture.Fixture_Type = kFixtureBulbs;
    for (fixture.BulbSize = 1; fixture.BulbSize <= kMaxBulbSize; ++fixture.BulbSize) {
        for (fixture.BulbShape = 1; fixture.BulbShape <= kBulbShapes; ++fixture.BulbShape)
            EXPECT_NE(drawn(*maskOf(masks(), fixture)).find('#'), std::string::npos) << fixture.BulbSize;
    }
    fixture.Fixture_Type = kFixtureFlood;
    fixture.BulbSize = kMaxFloodSize;
    EXPECT_EQ(maskOf(masks(), fixture), &masks().ZephFloodMasks[kMaxFloodSize]);
}

TEST(FloodMasks, AreStaircasesOfRingsUnderTheCurve) {
    const BulbMask& flood = masks().ZephFloodMasks[10];  // 4 rings (10 / 2.3 = 4.35), step 255 / 4.35 = 59
    for (const auto& [x, expected] : {std::pair{0, 59}, {1, 59}, {2, 118}, {4, 177}, {6, 236}, {9, 236}, {19, 59}})
        EXPECT_EQ(at(flood, x, 10), expected) << x;
    EXPECT_EQ(drawn(masks().ZephFloodMasks[1]), "../..");
    EXPECT_EQ(at(masks().ZephFloodMasks[64], 63, 63), 252);  // 28 rings in steps of 9

    ZephDimmingCurve steep{};
    steep[236] = 200;
    const auto tight = makeMasks(steep);
    EXPECT_EQ(at(tight->ZephFloodMasks[10], 6, 10), 200);
}

TEST(SetUpMasks, TellsWhatItIsDoing) {
    std::vector<std::string> texts;
    const auto made = std::make_unique<ZephMasks>();
    const auto tell = [&](std::string_view text) { texts.emplace_back(text); };
    ZephSetUpMasks(ZephCreateDummyDimmingCurve(), tell, *made);
    ASSERT_EQ(texts.size(), 11U + 64 + 64);
    EXPECT_EQ(texts[6], "Creating Bulb Masks - 4 Point Star");
    EXPECT_EQ(texts[11], "Creating Bulb Masks - Flood size:1");
    EXPECT_EQ(texts.back(), "Buffering Bulb Masks - Flood size:64");
}
