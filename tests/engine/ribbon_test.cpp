#include "engine/rgb_effects.h"
#include "engine/ribbon_channels.h"
#include "engine/ribbon_effects.h"
#include "engine/ribbon_motion.h"
#include "tests/support/engine_rig.h"

using testing::ElementsAre;

namespace {

// The lit pixels of a strand at the resolution "1 Pixel" (one group of all): "1-3 7" for 1, 2, 3 and 7.
std::string lit(ZephKeshState& ribbon, std::int32_t nowMs = 1000, std::int32_t points = 50) {
    const PixelList list = ReturnKeshBulbLocs(1, 7, points, nowMs, ribbon);
    std::string text;
    for (auto first = list.pixels.begin(), end = first + list.count; first != end;) {
        auto last = first;
        while (last + 1 != end && last[1] == *last + 1)
            ++last;
        text += (text.empty() ? "" : " ") + std::to_string(*first) + (last == first ? "" : "-" + std::to_string(*last));
        first = last + 1;
    }
    return text;
}

}  // namespace

TEST(RibbonChannels, MapBothWaysInBothModes) {
    for (int index = 1; index <= 150; ++index) {
        const RibbonPixel triple = ReturnKeshTripletKey(index, 0, 0);
        EXPECT_EQ(AbsoluteKeshChannelID(0, 0, triple.pixel, triple.colour), index);
        const RibbonPixel sequential = ReturnKeshTripletKey(index, 1, 5);
        EXPECT_EQ(AbsoluteKeshChannelID(1, 5, sequential.pixel, sequential.colour), index);
    }
    EXPECT_EQ(ReturnKeshTripletKey(17, 1, 3).colour, 2);
    EXPECT_EQ(AbsoluteKeshChannelID(1, 3, 1, 2), 18) << "the count is 17 where the group is 16";
    EXPECT_EQ(ReturnKeshTripletKey(7, 1, 7).colour, 7);
    EXPECT_EQ(LegacyKeshIDs(16, 3).unit, 3);
}

TEST(RibbonGroups, CoverTheStrandAtEveryResolution) {
    using Row = std::array<int, 4>;  // resolution, triplet, first, last
    for (const auto& [resolution, triplet, first, last] :
         {Row{0, 50, 50, 50}, Row{1, 25, 49, 50}, Row{2, 8, 22, 24}, Row{2, 9, 25, 26}, Row{2, 10, 27, 29},
          Row{2, 17, 48, 50}, Row{3, 1, 1, 4}, Row{3, 2, 5, 7}, Row{3, 16, 47, 50}, Row{3, 17, 47, 50},
          Row{4, 10, 46, 50}, Row{5, 5, 41, 50}, Row{6, 2, 26, 50}, Row{7, 1, 1, 50}}) {
        const PixelRange group = ribbonGroup(triplet, resolution, 50);
        EXPECT_EQ(std::pair(group.first, group.last), std::pair(first, last)) << resolution << "/" << triplet;
    }
    EXPECT_EQ(ribbonGroup(3, 5, 27).last, 27) << "cut at the end of the strand";
    const PixelRange past = ribbonGroup(31, 0, 30);
    EXPECT_GT(past.first, past.last);
}

TEST(RibbonMotions, LightTheRangesOfTheirRows) {
    using Row = std::tuple<const char*, int, int, int, const char*>;  // kind, parameter, position, pixels lit
    for (const auto& [name, kind, parm, position, expected] : std::initializer_list<Row>{
             {"block without width", 1, 0, 50, "1-25"},
             {"block: a width of 50 is none", 1, 50, 50, "1-25"},
             {"block with width", 1, 10, 50, "21-30"},  // head 30.5, to 20.5 behind it
             {"block at its end", 1, 10, 99, ""},
             {"block without width at its end", 1, 0, 100, "1-50"},
             {"fill from end", 2, 0, 10, "46-50"},
             {"fill from end, full at 99", 2, 0, 99, "1-50"},
             {"fill from end, not begun", 2, 0, 0, ""},
             {"two blocks to the middle", 3, 0, 50, "12 39"},
             {"two blocks with width", 3, 5, 50, "11-15 36-40"},  // head 15.00002, to 10.00002
             {"two blocks: a width of 25 is none", 3, 25, 50, "12 39"},
             {"fill from the middle", 4, 0, 20, "21-30"},
             {"chase of none on", 5, 5, 0, ""},
             {"chase of all on", 5, 30, 0, "1-50"},
             {"two blocks in step", 7, 0, 50, "1-12 26-37"},
             {"two blocks in step with width 25", 7, 25, 50, "1-50"},
             {"fill two halves", 8, 0, 20, "21-25 46-50"},
             {"unknown", 12, 50, 50, ""},
         }) {
        ZephKeshState ribbon;
        ribbon.KeshMotion = kind;
        ribbon.KeshMotionParm = parm;
        ribbon.KeshMotionPos = position;
        EXPECT_EQ(lit(ribbon), expected) << name;
    }
}

TEST(RibbonMotions, ChasesStepByTimeOrByPositionAndReverseTheirList) {
    ZephKeshState ribbon;
    ribbon.KeshMotion = 5;
    ribbon.KeshMotionParm = 32;  // three on, two off
    ribbon.KeshMotionPos = 75;   // every 100 ms
    // off off on on on, turned by one at the first step: on off off on on
    EXPECT_EQ(lit(ribbon, 1000, 10), "1 4-6 9-10");
    EXPECT_EQ(lit(ribbon, 1100, 10), "1 4-6 9-10") << "not above 100 ms yet";
    EXPECT_EQ(lit(ribbon, 1101, 10), "1-2 5-7 10");

    ClearKeshParms(ribbon);
    ribbon.KeshMotion = 10;
    ribbon.KeshMotionPosLast = 75;
    EXPECT_EQ(lit(ribbon, 2000, 5), "3 2 1") << "from the far end";
    ribbon.KeshMotionPos = 76;
    EXPECT_EQ(lit(ribbon, 2001, 5), "5 2 1");
}

TEST(RibbonMotions, StrobeAlternatesByItsTwoTimes) {
    ZephKeshState ribbon;
    ribbon.KeshMotion = 11;
    ribbon.KeshMotionPos = 100;
    ClearKeshParms(ribbon);
    stepMotionStrobe(1000, ribbon);
    EXPECT_EQ(ribbon.KeshStrobeNext, 1010);
    EXPECT_EQ(lit(ribbon), "");
    stepMotionStrobe(1011, ribbon);
    EXPECT_TRUE(ribbon.KeshStrobeOn);
    EXPECT_EQ(ribbon.KeshStrobeNext, 1036);
    ribbon.KeshStrobeOn = false;
    ribbon.KeshMotionParm = 50;
    stepMotionStrobe(2000, ribbon);
    EXPECT_EQ(ribbon.KeshStrobeNext, 2000 + 426);  // 416.5 + 10, to even
}

namespace {

// One ribbon on unit 3, as the test sets it up before it is compiled.
struct RibbonRig : EngineRig {
    explicit RibbonRig(std::int32_t channelMode = 0, std::int32_t resolution = 0) {
        ZephKeshData& data = addRibbon(3).Kesh;
        data.Channel_Mode = channelMode;
        data.Resolution = resolution;
        build();
    }
    void send(std::int32_t circuit, std::int32_t end, std::int32_t atMs = 0) {
        command(3, circuit, 0, end, 0, 0, atMs);
    }
    ZephRGBData& group(std::size_t number = 1) { return tables.RGBData[number]; }
};

}  // namespace

TEST(MagicChannels, SetTheRibbonTheirOwnWay) {
    RibbonRig rig(0, 4);
    const auto held = [&](std::int32_t circuit, std::int32_t value, std::int32_t atMs) {
        rig.send(circuit, value, atMs);
        rig.pass(atMs + 9);
        return rig.ribbon();
    };
    EXPECT_EQ(held(151, 16, 0).KeshResolution, 3);
    EXPECT_EQ(held(151, 3, 9).KeshResolution, 4) << "an unknown value brings the configured one back";
    EXPECT_EQ(held(154, 12, 18).KeshMotionPos, 12);
    EXPECT_EQ(held(156, 30, 27).KeshSpeed, 70) << "turned round";
    rig.send(152, 5, 36);
    for (const int t : {45, 54, 63}) {
        rig.ribbon().ChaseTime = 77;
        rig.pass(t);
        EXPECT_EQ(rig.ribbon().ChaseTime, t < 63 ? 0 : 77) << "a held motion clears twice";
    }
    EXPECT_EQ(rig.ribbon().KeshMotion, 5);
}

TEST(ColourEffects, TakeTheColoursOverAndGiveThemBackToTheNextCommand) {
    RibbonRig rig;
    rig.send(157, 100);
    rig.send(155, 7);  // white twinkle
    rig.ribbon().KeshResolutionChanged = true;
    rig.random.otherwise = 0.9;
    // The keys run 155 before 157, so the first step still had no intensity; the next comes 580 ms later at speed 0.
    rig.shown({9, 700});
    EXPECT_THAT(rig.surface.groups.at(0).levels, ElementsAre(255, 255, 255));
    EXPECT_THAT(rig.group().Mode, ElementsAre(0, 2, 2, 2));
    EXPECT_FALSE(rig.ribbon().KeshResolutionChanged);

    rig.send(1, 100, 700);
    rig.pass(709);
    EXPECT_THAT(rig.group().Mode, ElementsAre(0, 2, 2, 2)) << "plain commands do not reach it";

    rig.send(155, 0, 709);
    rig.pass(718);
    EXPECT_THAT(rig.group().Mode, ElementsAre(0, 4, 4, 4));
    EXPECT_THAT(rig.group().Level, ElementsAre(0, 0, 0, 0));
    EXPECT_EQ(rig.shown({727}), "") << "the running command on its red is not a new one";
    rig.send(1, 40, 727);
    EXPECT_EQ(rig.shown({736}), "1.1=102");

    rig.send(155, 27, 736);
    rig.pass(745);
    EXPECT_THAT(rig.group().Level, ElementsAre(0, 0, 0, 0)) << "an unknown effect resets and lights nothing";
    EXPECT_THAT(rig.group().Mode, ElementsAre(0, 2, 2, 2));
}

TEST(ColourEffects, DazzleGlittersBetweenTheTargetAndFourFifthsOfIt) {
    RibbonRig rig;
    rig.ribbon().KeshIntensity = 100;
    rig.ribbon().KeshSpeed = 100;  // a step every 40 ms
    rig.send(155, 10);
    rig.pass(9);
    EXPECT_THAT(rig.surface.groups.at(0).levels, ElementsAre(255, 0, 0));
    rig.pass(209);
    EXPECT_THAT(rig.surface.groups.at(0).levels, ElementsAre(204, 0, 0));
}

TEST(ColourEffects, EffectsWithTheSameMaskDifferInTheColourThatAddressesThem) {
    for (const auto& [effect, colour] : {std::pair{9, 2}, {10, -1}, {22, -1}, {23, 2}})
        EXPECT_EQ(KeshTwinkleOrDazzle(effect), colour) << effect;
    // Sequential, and half as fine as it is wired: the first 25 reds or the 25 behind them.
    for (const int effect : {21, 25}) {
        RibbonRig rig(1, 0);
        rig.ribbon().KeshResolution = 1;
        rig.send(155, effect);
        rig.pass(9);
        EXPECT_EQ(rig.group(effect == 25 ? 25 : 26).EffectMask, 131);
        EXPECT_EQ(rig.group(effect == 25 ? 26 : 25).EffectMask, 0);
    }
}

TEST(RgbEffects, TheGlitterLoopLeavesWhenNoColourCanComeOn) {
    RibbonRig rig;
    rig.ribbon().KeshIntensity = 100;
    rig.group().EffectMask = 32;
    RenderContext context = rig.context();
    const ZephRenderSlot slot = rig.tables.Slots[0];
    EXPECT_FALSE(ShimmerRGB(slot, {.elapsed = 100'000}, context));  // Mode 1: driven by plain commands
    rig.group().Mode = {0, 0, 2, 0};
    rig.random.values = {0.1, 0.709, 0.8};  // on from 71 in 100
    rig.ribbon().KeshSpeed = 10;
    EXPECT_FALSE(ShimmerRGB(slot, {.elapsed = 400}, context)) << "the step is not due";
    EXPECT_TRUE(ShimmerRGB(slot, {.elapsed = 401}, context));
    EXPECT_FALSE(TwinkleRGB(slot, {.elapsed = 220}, context));
    EXPECT_THAT(rig.group().EffectLevel, ElementsAre(0, 0, 255, 0));
    EXPECT_THAT(rig.random.values, testing::IsEmpty()) << "drawn until the one colour came on";
}

TEST(RgbEffects, DiscreteColoursComeFromTheMask) {
    using Row = std::tuple<std::int32_t, bool, double, std::int32_t>;  // mask, none is possible, drawn, colour
    for (const auto& [mask, none, drawn, color] :
         {Row{144, false, 0.0, 1}, Row{144, true, 0.0, 0}, Row{134, false, 0.9, 2},
          Row{133, false, 0.9, 3} /* red and blue */, Row{131, true, 0.9, 0}, Row{131, true, 0.5, 3}}) {
        ListRandom random;
        random.values = {drawn};
        EXPECT_EQ(RandomDiscreteChannel(mask, none, random), color) << mask << " " << drawn;
    }
}

TEST(PixelRuns, PlaceHoldersStayDarkAndTheLastPointAnswersForMore) {
    EngineRig rig;
    rig.addPixels(1, 3).DrawPoints[2].Type = kPointPlaceHolder;
    rig.build();
    for (int address = 1; address <= 9; ++address)
        ZephAddLightCommand({0, 0, 1, kDeviceDmx, 0, address}, {0, 0, 100}, EngineRig::kStart, rig.tables);
    EXPECT_EQ(rig.shown({9}), "1.1001=255 1.1002=0 1.1003=255");
    EXPECT_THAT(rig.surface.groups[2].bulbs, ElementsAre(3));
}
