#include "engine/bulb_walk.h"
#include "tests/support/fixtures.h"

namespace {

using Points = std::vector<std::array<int, 3>>;  // type, x and y in pixels

// Pitch 10: bulbs of radius 2 with 6 pixels between them.
ZephFixture stringFixture(const Points& points, int channels) {
    ZephFixture fixture;
    InitializeFixture({}, fixture);
    fixture.BulbSpacing = 6;
    fixture.ChannelCount = channels;
    for (const auto& [type, x, y] : points)
        addPoint(fixture, type, {x, y});
    return fixture;
}

std::string walked(const ZephFixture& fixture, int channel) {
    std::string text;
    walkBulbs(fixture, channel, [&](const WalkedBulb& bulb) {
        text += std::to_string(bulb.X) + "," + std::to_string(bulb.Y) + "/" + std::to_string(bulb.ColorIndex) + " ";
    });
    return text;
}

}  // namespace

TEST(BulbWalk, ChannelsTakeTurnsAndTheRemainderCarriesOver) {
    // 35 pixels across, then down.
    const ZephFixture two = stringFixture({{6, 0, 0}, {2, 35, 0}, {2, 35, 40}}, 2);
    EXPECT_EQ(walked(two, 1), "0,0/1 20,0/1 35,5/1 35,25/1 ");
    EXPECT_EQ(walked(two, 2), "10,0/1 30,0/1 35,15/1 35,35/1 ");
    // No bulb hangs on the last point, and none on a line that is shorter than the offset.
    EXPECT_EQ(walked(stringFixture({{6, 0, 0}, {2, 20, 0}}, 1), 1), "0,0/1 10,0/1 ");
    EXPECT_EQ(walked(stringFixture({{6, 0, 0}, {2, 8, 0}, {2, 8, 8}}, 2), 2), "8,2/1 ");
    // A line that ends exactly where the offset does carries the bulb.
    EXPECT_EQ(walked(stringFixture({{6, 0, 0}, {2, 10, 0}}, 2), 2), "10,0/1 ");
}

TEST(BulbWalk, MultiColorHangsItsColoursTogetherAndStartsAnewAtEachStroke) {
    ZephFixture fixture = stringFixture({{6, 0, 0}, {2, 55, 0}, {6, 0, 9}, {2, 15, 9}}, 2);
    fixture.Channels[1].Sub_Type = kSpecialMultiColor;
    fixture.Channels[1].Sub_Parm = 3;
    EXPECT_EQ(walked(fixture, 1), "0,0/1 10,0/2 20,0/3 40,0/1 50,0/2 0,9/1 10,9/2 ");
    EXPECT_EQ(walked(fixture, 2), "30,0/1 ");
}

TEST(BulbWalk, RoundsBulbsToEvenAndPointsToTheNearestPixel) {
    ZephFixture fixture = stringFixture({{6, 0, 0}, {2, 3, 0}}, 1);
    fixture.BulbSpacing = 1;
    fixture.BulbSize = 0;
    fixture.DrawPoints[2] = {2, 22, 37};  // 1.47 -> 1, 2.47 -> 2
    EXPECT_EQ(walked(fixture, 1), "0,0/1 0,1/1 1,2/1 ");
    fixture.DrawPoints[1] = {6, -8, 0};  // -0.53 -> -1
    fixture.DrawPoints[2] = {2, 15, 15};
    fixture.BulbSpacing = 100;
    EXPECT_EQ(walked(fixture, 1), "-1,0/1 ");
}

TEST(BulbWalk, DamagedFixturesEndTheWalk) {
    using Damage = void (*)(ZephFixture&);
    const std::tuple<const char*, Damage, const char*> cases[] = {
        {"pitch 0", [](ZephFixture& f) { f.BulbSpacing = -4; }, ""},
        {"pitch overflows", [](ZephFixture& f) { f.BulbSpacing = f.BulbSize = 2147483647; }, "0,0/1 "},
        {"no channel counts as one", [](ZephFixture& f) { f.ChannelCount = 0; }, "0,0/1 10,0/1 "},
        {"an RGB fixture counts as one", [](ZephFixture& f) { makeRgb(f, 1, 1); }, "0,0/1 10,0/1 "},
        {"colours 0", [](ZephFixture& f) { f.Channels[1].Sub_Type = kSpecialMultiColor; }, "0,0/1 10,0/1 "},
        {"no points", [](ZephFixture& f) { f.PointCount = -3; }, ""},
        {"a line without length", [](ZephFixture& f) { f.DrawPoints[2].X = 0; }, ""},
    };
    for (const auto& [name, damage, expected] : cases) {
        ZephFixture fixture = stringFixture({{6, 0, 0}, {2, 20, 0}}, 1);
        damage(fixture);
        EXPECT_EQ(walked(fixture, 1), expected) << name;
    }
    EXPECT_EQ(walked(stringFixture({{6, 0, 0}, {2, 20, 0}}, 2), 3), "");

    ZephFixture endless = stringFixture({{6, 0, 0}, {2, 100'000'000, 0}}, 1);
    endless.BulbSpacing = 1;
    endless.BulbSize = 0;
    int count = 0;
    walkBulbs(endless, 1, [&](const WalkedBulb&) { ++count; });
    EXPECT_EQ(count, kMaxWalkedBulbs);
}
