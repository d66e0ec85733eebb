#include "engine/rgb_effects.h"
#include "engine/ribbon_channels.h"
#include "engine/ribbon_effects.h"
#include "engine/ribbon_motion.h"
#include "tests/support/engine_rig.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <numeric>

using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

std::vector<int> span(int first, int last) {
    std::vector<int> list(static_cast<std::size_t>(std::max(last - first + 1, 0)));
    std::iota(list.begin(), list.end(), first);
    return list;
}

std::vector<int> join(std::vector<int> left, const std::vector<int>& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

// The lit pixels of a whole strand of 50, resolution "1 Pixel" (one group of all).
std::vector<int> lit(ZephKeshState& ribbon, std::int32_t nowMs = 1000, std::int32_t points = 50) {
    const PixelList list = ReturnKeshBulbLocs(1, 7, points, nowMs, ribbon);
    return {list.pixels.begin(), list.pixels.begin() + list.count};
}

std::vector<int> motion(int kind, int parm, int position) {
    ZephKeshState ribbon;
    ribbon.KeshMotion = kind;
    ribbon.KeshMotionParm = parm;
    ribbon.KeshMotionPos = position;
    ribbon.KeshStrobeOn = true;
    return lit(ribbon);
}

}  // namespace

TEST(RibbonChannels, MapBothWaysInBothModes) {
    for (int index = 1; index <= 150; ++index) {
        const RibbonPixel triple = ReturnKeshTripletKey(index, 0, 0);
        EXPECT_EQ(AbsoluteKeshChannelID(0, 0, triple.pixel, triple.colour), index);
        const RibbonPixel sequential = ReturnKeshTripletKey(index, 1, 5);
        EXPECT_EQ(AbsoluteKeshChannelID(1, 5, sequential.pixel, sequential.colour), index);
    }
    EXPECT_EQ(ReturnKeshTripletKey(150, 0, 0).pixel, 50);
    EXPECT_EQ(ReturnKeshTripletKey(17, 1, 3).colour, 2);
    EXPECT_EQ(ReturnKeshTripletKey(17, 1, 3).pixel, 1);
    EXPECT_EQ(AbsoluteKeshChannelID(1, 3, 1, 2), 18) << "the count is 17 where the group is 16";
    EXPECT_EQ(ReturnKeshTripletKey(7, 1, 7).colour, 7);
    EXPECT_EQ(LegacyKeshIDs(157, 3).unit, 12);
    EXPECT_EQ(LegacyKeshIDs(157, 3).circuit, 13);
    EXPECT_EQ(LegacyKeshIDs(16, 3).unit, 3);
}

TEST(RibbonGroups, CoverTheStrandAtEveryResolution) {
    struct Row {
        int resolution;
        int triplet;
        int first;
        int last;
    };
    const Row rows[] = {{0, 50, 50, 50}, {1, 25, 49, 50}, {2, 8, 22, 24}, {2, 9, 25, 26},  {2, 10, 27, 29},
                        {2, 17, 48, 50}, {3, 1, 1, 4},    {3, 2, 5, 7},   {3, 16, 47, 50}, {3, 17, 47, 50},
                        {4, 10, 46, 50}, {5, 5, 41, 50},  {6, 2, 26, 50}, {7, 1, 1, 50}};
    for (const Row& row : rows) {
        const PixelRange group = ribbonGroup(row.triplet, row.resolution, 50);
        EXPECT_EQ(group.first, row.first) << row.resolution << "/" << row.triplet;
        EXPECT_EQ(group.last, row.last) << row.resolution << "/" << row.triplet;
    }
    EXPECT_EQ(ribbonGroup(3, 5, 27).last, 27) << "cut at the end of the strand";
    const PixelRange past = ribbonGroup(31, 0, 30);
    EXPECT_GT(past.first, past.last);
}

TEST(RibbonMotions, LightTheRangesOfTheirRows) {
    struct Row {
        const char* name;
        int kind;
        int parm;
        int position;
        std::vector<int> expected;
    };
    const Row rows[] = {
        {"none", 0, 0, 0, span(1, 50)},
        {"block without width", 1, 0, 50, span(1, 25)},
        {"block: a width of 50 is none", 1, 50, 50, span(1, 25)},
        {"block with width", 1, 10, 50, span(21, 30)},  // head 30.5, to 20.5 behind it
        {"block at its end", 1, 10, 99, {}},
        {"block without width at its end", 1, 0, 100, span(1, 50)},
        {"fill from end", 2, 0, 10, span(46, 50)},
        {"fill from end, full at 99", 2, 0, 99, span(1, 50)},
        {"fill from end, not begun", 2, 0, 0, {}},
        {"two blocks to the middle", 3, 0, 50, {12, 39}},
        {"two blocks with width", 3, 5, 50, join(span(11, 15), span(36, 40))},  // head 15.00002, to 10.00002
        {"two blocks: a width of 25 is none", 3, 25, 50, {12, 39}},
        {"fill from the middle", 4, 0, 20, join(span(21, 25), span(26, 30))},
        {"two blocks in step", 7, 0, 50, join(span(1, 12), span(26, 37))},
        {"two blocks in step with width 25", 7, 25, 50, join(span(1, 25), span(26, 50))},
        {"fill two halves", 8, 0, 20, join(span(21, 25), span(46, 50))},
        {"strobe on", 11, 0, 0, span(1, 50)},
        {"unknown", 12, 50, 50, {}},
    };
    for (const Row& row : rows) {
        std::vector<int> expected = row.expected;
        std::ranges::sort(expected);
        EXPECT_EQ(motion(row.kind, row.parm, row.position), expected) << row.name;
    }
}

TEST(RibbonMotions, ChasesStepByTimeOrByPositionAndReverseTheirList) {
    ZephKeshState ribbon;
    ribbon.KeshMotion = 5;
    ribbon.KeshMotionParm = 32;  // three on, two off
    ribbon.KeshMotionPos = 75;   // every 100 ms
    // off off on on on, turned by one at the first step: on off off on on
    EXPECT_EQ(lit(ribbon, 1000, 10), (std::vector<int>{1, 4, 5, 6, 9, 10}));
    EXPECT_EQ(lit(ribbon, 1100, 10), (std::vector<int>{1, 4, 5, 6, 9, 10})) << "not above 100 ms yet";
    EXPECT_EQ(lit(ribbon, 1101, 10), (std::vector<int>{1, 2, 5, 6, 7, 10}));

    ClearKeshParms(ribbon);
    ribbon.KeshMotion = 10;
    ribbon.KeshMotionPosLast = 75;
    EXPECT_EQ(lit(ribbon, 2000, 5), (std::vector<int>{3, 2, 1})) << "from the far end";
    ribbon.KeshMotionPos = 76;
    EXPECT_EQ(lit(ribbon, 2001, 5), (std::vector<int>{5, 2, 1}));

    EXPECT_EQ(motion(5, 30, 0), span(1, 50));
    EXPECT_THAT(motion(5, 5, 0), IsEmpty());
}

TEST(RibbonMotions, StrobeAlternatesByItsTwoTimes) {
    ZephKeshState ribbon;
    ribbon.KeshMotion = 11;
    ribbon.KeshMotionPos = 100;
    ClearKeshParms(ribbon);
    stepMotionStrobe(1000, ribbon);
    EXPECT_FALSE(ribbon.KeshStrobeOn);
    EXPECT_EQ(ribbon.KeshStrobeNext, 1010);
    EXPECT_THAT(lit(ribbon), IsEmpty());
    stepMotionStrobe(1011, ribbon);
    EXPECT_TRUE(ribbon.KeshStrobeOn);
    EXPECT_EQ(ribbon.KeshStrobeNext, 1036);
    ribbon.KeshStrobeOn = false;
    ribbon.KeshMotionParm = 50;
    stepMotionStrobe(2000, ribbon);
    EXPECT_EQ(ribbon.KeshStrobeNext, 2000 + 426);  // 416.5 + 10, to even
}

TEST(MagicChannels, AnUnknownResolutionValueBringsTheConfiguredOneBack) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.simulation->Fixtures[f].Kesh.Resolution = 4;
    rig.build();
    const ZephKeshState& ribbon = (*rig.states)[f].Kesh;
    EXPECT_EQ(ribbon.KeshResolution, 4);
    rig.command(3, 151, 0, 16);
    rig.pass(9);
    EXPECT_EQ(ribbon.KeshResolution, 3);
    rig.command(3, 151, 0, 3, 0, 0, 9);
    rig.pass(18);
    EXPECT_EQ(ribbon.KeshResolution, 4);
}

TEST(MagicChannels, AHeldMotionClearsTwice) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.build();
    ZephKeshState& ribbon = (*rig.states)[f].Kesh;
    rig.command(3, 152, 0, 5);
    for (const int t : {9, 18}) {
        ribbon.ChaseTime = 77;
        rig.pass(t);
        EXPECT_EQ(ribbon.ChaseTime, 0) << t;
    }
    ribbon.ChaseTime = 77;
    rig.pass(27);
    EXPECT_EQ(ribbon.ChaseTime, 77);
    EXPECT_EQ(ribbon.KeshMotion, 5);
}

TEST(MagicChannels, SpeedTurnsRoundAndIntensityStands) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.build();
    rig.command(3, 156, 0, 30);
    rig.command(3, 157, 0, 80);
    rig.command(3, 154, 0, 12);
    rig.pass(9);
    const ZephKeshState& ribbon = (*rig.states)[f].Kesh;
    EXPECT_EQ(ribbon.KeshSpeed, 70);
    EXPECT_EQ(ribbon.KeshIntensity, 80);
    EXPECT_EQ(ribbon.KeshMotionPos, 12);
}

TEST(ColourEffects, TakeTheColoursOverAndGiveThemBackToTheNextCommand) {
    EngineRig rig;
    rig.addRibbon(3);
    rig.build();
    rig.command(3, 157, 0, 100);
    rig.command(3, 155, 0, 7);  // white twinkle
    rig.random.otherwise = 0.9;
    rig.pass(9);
    // The keys run 155 before 157, so the first step still had no intensity; the next comes 580 ms later at speed 0.
    rig.pass(700);
    ASSERT_EQ(rig.surface.groups.size(), 50u);
    EXPECT_THAT(rig.surface.groups[0].levels, ElementsAre(255, 255, 255));
    EXPECT_THAT(rig.tables.RGBData[1].Mode, ElementsAre(0, 2, 2, 2));

    rig.command(3, 1, 0, 100, 0, 0, 700);
    rig.pass(709);
    EXPECT_THAT(rig.tables.RGBData[1].Mode, ElementsAre(0, 2, 2, 2)) << "plain commands do not reach it";

    rig.command(3, 155, 0, 0, 0, 0, 709);
    rig.pass(718);
    EXPECT_THAT(rig.tables.RGBData[1].Mode, ElementsAre(0, 4, 4, 4));
    EXPECT_THAT(rig.tables.RGBData[1].Level, ElementsAre(0, 0, 0, 0));
    rig.pass(727);
    EXPECT_THAT(rig.surface.groups, IsEmpty()) << "the running command on its red is not a new one";
    rig.command(3, 1, 0, 40, 0, 0, 727);
    rig.pass(736);
    ASSERT_EQ(rig.surface.groups.size(), 1u);
    EXPECT_THAT(rig.surface.groups[0].levels, ElementsAre(102, 0, 0));
}

TEST(ColourEffects, DazzleGlittersBetweenTheTargetAndFourFifthsOfIt) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.build();
    ZephKeshState& ribbon = (*rig.states)[f].Kesh;
    ribbon.KeshIntensity = 100;
    ribbon.KeshSpeed = 100;  // a step every 40 ms
    rig.command(3, 155, 0, 10);
    rig.pass(9);
    EXPECT_TRUE(ribbon.KeshFlip);
    EXPECT_THAT(rig.surface.groups.at(0).levels, ElementsAre(255, 0, 0));
    rig.pass(209);
    EXPECT_FALSE(ribbon.KeshFlip);
    EXPECT_THAT(rig.surface.groups.at(0).levels, ElementsAre(204, 0, 0));
}

TEST(ColourEffects, AnUnknownNumberResetsAndLightsNothing) {
    EngineRig rig;
    rig.addRibbon(3);
    rig.build();
    rig.command(3, 1, 0, 100);
    rig.pass(9);
    rig.command(3, 155, 0, 27, 0, 0, 9);
    rig.pass(18);
    EXPECT_THAT(rig.tables.RGBData[1].Level, ElementsAre(0, 0, 0, 0));
    EXPECT_THAT(rig.tables.RGBData[1].Mode, ElementsAre(0, 2, 2, 2));
}

TEST(ColourEffects, EffectsWithTheSameMaskDifferInTheColourThatAddressesThem) {
    EXPECT_EQ(KeshTwinkleOrDazzle(9), 2);
    EXPECT_EQ(KeshTwinkleOrDazzle(10), -1);
    EXPECT_EQ(KeshTwinkleOrDazzle(22), -1);
    EXPECT_EQ(KeshTwinkleOrDazzle(23), 2);
    // Sequential at "25 Pixels": channel 1 is red of pixel 1, channel 26 green. A second fixture shares none of it.
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.simulation->Fixtures[f].Kesh.Channel_Mode = 1;
    rig.simulation->Fixtures[f].Kesh.Resolution = 1;
    rig.build();
    (*rig.states)[f].Kesh.KeshIntensity = 100;
    rig.command(3, 155, 0, 25);
    rig.pass(9);
    EXPECT_EQ(rig.surface.groups.size(), 25u);
    EXPECT_EQ(rig.tables.RGBData[1].EffectMask, 131);
}

TEST(RgbEffects, TheGlitterLoopLeavesWhenNoColourCanComeOn) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.build();
    (*rig.states)[f].Kesh.KeshIntensity = 100;
    ZephRGBData& group = rig.tables.RGBData[1];
    group.EffectMask = 32;
    const ZephRenderSlot slot = rig.tables.Slots[0];
    RenderContext context = rig.context();
    EXPECT_FALSE(ShimmerRGB(slot, {.elapsed = 100'000}, context));  // Mode 1: driven by plain commands
    group.Mode = {0, 0, 2, 0};
    rig.random.values = {0.1, 0.2, 0.8};
    EXPECT_TRUE(ShimmerRGB(slot, {.elapsed = 100'000}, context));
    EXPECT_THAT(group.EffectLevel, ElementsAre(0, 0, 255, 0));
    EXPECT_THAT(rig.random.values, IsEmpty()) << "drawn until the one colour came on";
}

TEST(RgbEffects, DiscreteColoursComeFromTheMask) {
    ListRandom random;
    const auto of = [&](std::int32_t mask, bool none, double r) {
        random.values = {r};
        return RandomDiscreteChannel(mask, none, random);
    };
    EXPECT_EQ(of(144, false, 0.0), 1);
    EXPECT_EQ(of(144, true, 0.0), 0);
    EXPECT_EQ(of(134, false, 0.9), 2);
    EXPECT_EQ(of(133, false, 0.9), 3) << "red and blue";
    EXPECT_EQ(of(131, false, 0.0), 2);
    EXPECT_EQ(of(131, true, 0.9), 0);
    EXPECT_EQ(of(131, true, 0.5), 3);
}

TEST(PixelRuns, PlaceHoldersStayDarkAndTheLastPointAnswersForMore) {
    EngineRig rig;
    const int f = rig.addFixture(kFixtureDmxPixels, 3);
    ZephFixture& fixture = rig.simulation->Fixtures[f];
    fixture.Channel_Type = kChannelRgb;
    fixture.DMX.Universe = 1;
    fixture.DrawPoints[2].Type = kPointPlaceHolder;
    rig.build();
    for (int address = 1; address <= 9; ++address) {
        ZephAddLightCommand({0, 0, 1, kDeviceDmx, 0, address}, {0, 0, 100}, EngineRig::kStart, rig.tables);
    }
    rig.pass(9);
    ASSERT_EQ(rig.surface.groups.size(), 3u);
    EXPECT_THAT(rig.surface.groups[0].bulbs, ElementsAre(1));
    EXPECT_EQ(rig.surface.groups[1].draw.Alpha, 0);
    EXPECT_THAT(rig.surface.groups[2].bulbs, ElementsAre(3));
}
