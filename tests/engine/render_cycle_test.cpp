#include "engine/light_drawing.h"
#include "engine/render_cycle.h"
#include "tests/support/engine_rig.h"

using testing::ElementsAre;

namespace {

struct RenderCycle : testing::Test, EngineRig {};

// The engine on its ticks, with a stream before it.
struct Tick : testing::Test, EngineRig {
    Tick() {
        addPlain(2, 5);
        addPixels(5, 1);  // entries 2 to 4
        build();
        ZephSetUpPacketParms(parser.PacketParms);
    }
    bool tick(int engine, std::int32_t atMs) {
        clock.set(kStart + atMs);
        RenderContext run = context();
        return ZephRenderTick(engine, {clock, parser, host, sink, stream, run, frameDone});
    }

    ManualClock clock{kStart};
    ParserSetup parser;
    RenderTableSink sink{tables, clock};
    ChannelStream stream;
    int frames = 0;
    std::function<void()> frameDone = [this] { ++frames; };
};

}  // namespace

TEST_F(RenderCycle, CommandsWithoutDurationTakeEffectAtOnceAndGoOnUntilReplacedOrEnded) {
    addPlain(1, 1);
    build();
    command(1, 1, 0, 60);
    EXPECT_EQ(shown({9, 18}), "1=60, 1=60");
    command(1, 1, 0, 20);
    command(1, 1, 0, 30);
    command(9, 9, 0, 50);
    EXPECT_EQ(tables.NewEntryCount, 1U);
    EXPECT_EQ(shown({27}), "1=30") << "only the last of two counts";
    command(1, 1, 100, 0);
    EXPECT_EQ(shown({36, 45}), "1=0, ") << "a command to zero is carried out once";
    EXPECT_EQ(tables.CommandState[1] & kCommandActive, 0);
    EXPECT_EQ(tables.LevelChanged, 0u) << "an idle level costs nothing";
    simulation->Levels[1].Sim_Enabled = false;
    command(1, 1, 0, 100);
    EXPECT_EQ(shown({54}), "");
    EXPECT_EQ(tables.CommandState[1] & kCommandActive, kCommandActive)
        << "stored on a level switched off, and not drawn";
}

TEST_F(RenderCycle, CommandsFadeInProportionAndNeverShowARisingZeroTwice) {
    addPlain(1, 1);
    build();
    command(1, 1, 0, 100, 1000);
    EXPECT_EQ(shown({0, 500, 1000, 5000}), "1=0, 1=50, 1=100, 1=100");
    command(1, 1, 0, 1, 1000, 0, 5000);
    EXPECT_EQ(shown({5100, 5200}), "1=0, 1=1");
    command(1, 1, 40, 100, 1000, 0, 5500);
    EXPECT_EQ(shown({5209}), "1=40") << "a clock that ran backwards fades nothing";
}

TEST_F(RenderCycle, OrderIsLevelThenKeyAndGroupsFollowThePlainChannelsOfTheirLevel) {
    addPlain(3, 1).ZOrder = 2;
    addPlain(5, 1);
    addRgb(1, 1);
    addPlain(4, 1);
    build();
    for (const auto& [unit, circuit] : {std::pair{3, 1}, {5, 1}, {4, 1}, {1, 3}, {1, 1}, {1, 2}})
        command(unit, circuit, 0, 100);
    EXPECT_EQ(shown({9}), "4=100 2=100 3.0=255 1=100");
}

TEST_F(RenderCycle, OrderAChannelOnTwoLevelsEndsOnTheHigherOneWithoutBeingDrawnThere) {
    addPlain(1, 1);
    addPlain(1, 1).ZOrder = 5;
    build();
    command(1, 1, 0, 100);
    EXPECT_EQ(shown({9}), "1=100 2=100");
    // The lower level's pass counts as the first; the higher one finds the command carried out already.
    command(1, 1, 100, 0, 0, 0, 9);
    EXPECT_EQ(shown({18}), "1=0");
}

TEST_F(RenderCycle, EffectsShimmerAndTwinkleOfAPlainChannelFollowTheirClocks) {
    addPlain(1, 1);
    build();
    command(1, 1, 100, 100, 0, 1);
    // At 36 the clock is above 30 and turns.
    EXPECT_EQ(shown({9, 18, 27, 36, 45, 54, 63, 72, 81, 90}),
              "1=0, 1=0, 1=0, 1=100, 1=100, 1=100, 1=100, 1=0, 1=0, 1=0");

    command(1, 1, 80, 80, 0, 2, 90);
    random.values = {0.0, 0.0};  // first phase 10 ms, on
    EXPECT_EQ(shown({99, 108}), "1=80, 1=80");
    random.values = {0.999};  // 63 and 51 = 51, and at least 20 more: 71 units of 8.333 = 592 ms
    EXPECT_EQ(shown({109, 700}), "1=0, 1=0");
    random.values = {0.0};  // an on phase may last none at all
    EXPECT_EQ(shown({701}), "1=80");
    command(1, 1, 0, 0, 0, 2, 701);
    shown({710, 719});
    EXPECT_EQ(tables.Twinkle[1].NextTwinkleTime, 0) << "starts from scratch after its command has ended";
}

TEST_F(RenderCycle, RgbLevelsRoundAndAGroupIsDrawnOnceWithAlphaZeroWhereItIsDark) {
    addRgb(1, 1);
    build();
    for (const auto& [circuit, percent] : {std::pair{1, 50}, {2, 10}, {3, 0}})
        command(1, circuit, 0, percent);
    EXPECT_EQ(shown({9}), "1.0=128");
    EXPECT_THAT(surface.groups[0].levels, ElementsAre(128, 26, 0));  // 127.5 and 25.5, to even
    EXPECT_EQ(surface.groups[0].draw.Color, 255 + 256 * 52);

    RenderContext run = context();
    const std::pair<std::array<std::int32_t, 4>, int> rows[] = {
        {{0, 29, 29, 29}, 0}, {{0, 30, 0, 0}, 30}, {{0, 0, 0, 0}, 0}};
    for (const auto& [levels, alpha] : rows) {
        tables.RGBData[1].Level = levels;
        ZephDrawRGBBulbs(tables.LevelGroups[1][0], 1, 0, run);
        EXPECT_EQ(surface.groups.back().draw.Alpha, alpha) << levels[1];
    }
}

TEST_F(RenderCycle, RgbAFloodAboveItsOpacityGoesThroughTheCurveTwice) {
    ZephFixture& flood = addRgb(1, 1);
    flood.Fixture_Type = kFixtureFlood;
    flood.Max_Opacity = 40;
    for (std::size_t i = 0; i < 256; ++i)
        curve[i] = static_cast<std::uint8_t>(i / 2);
    build();
    command(1, 1, 0, 100);
    EXPECT_EQ(shown({9}), "1.0=25");  // 102 -> 51 -> 25
    command(1, 1, 0, 15, 0, 0, 9);
    EXPECT_EQ(shown({18}), "1.0=19");  // 38 of 255 is not above the percentage
}

TEST_F(RenderCycle, StrobesBeginAtRandomPhasesAndAlternate) {
    ZephChannel& channel = addChannel(add(kFixtureStrings, {{0, 0}, {7, 0}}), 1, 1);  // two bulbs
    channel.Sub_Type = kSpecialStrobes;
    channel.Sub_Parm = 10;  // every 100 ms
    build();
    surface.flashingBulbs = 2;
    command(1, 1, 0, 100);
    const auto lit = [&](int t) {
        pass(t);
        return surface.lit;
    };
    random.values = {0.1, 0.5};  // due above 10 and above 50 ms from now
    lit(0);
    EXPECT_THAT(lit(10), ElementsAre(0, 0));
    EXPECT_THAT(lit(11), ElementsAre(1, 0));  // for the fire time of 50 ms
    EXPECT_THAT(lit(61), ElementsAre(1, 1));
    random.values = {0.5};  // the next flash one whole interval from now
    EXPECT_THAT(lit(62), ElementsAre(0, 1));
    EXPECT_THAT(lit(162), ElementsAre(0, 0)) << "counted from the moment off, not from the end of the flash";
    EXPECT_THAT(lit(163), ElementsAre(1, 0));
    EXPECT_EQ(surface.plain.at(0).Alpha, 255);
    command(1, 1, 0, 0, 0, 0, 163);
    shown({172, 181});
    EXPECT_FALSE((*states)[1].Channels[1].StrobeRunning) << "a fresh strobe begins anew";
}

TEST_F(RenderCycle, StrobesASpeedOfZeroIsReportedAndFlashesWithoutPause) {
    addPlain(1, 1).Channels[1].Sub_Type = kSpecialStrobes;
    build();
    EXPECT_EQ(failures.reports.size(), 1u);
    command(1, 1, 0, 100);
    EXPECT_EQ(shown({9}), "1=100");
}

TEST_F(RenderCycle, DamagedARibbonMarkedNormalDrawsNothingOutsideItsArrays) {
    ZephFixture& ribbon = addRibbon(3);
    ribbon.Channel_Type = kChannelNormal;
    ribbon.Kesh.Channel_Mode = 1;
    ribbon.Kesh.Resolution = 7;  // colours up to 150 become channel numbers
    build();
    for (int circuit = 1; circuit <= 157; ++circuit)
        command(3, circuit, 0, 100);
    shown({9, 18});
    EXPECT_EQ(surface.plain.size(), 150u);
    EXPECT_TRUE(failures.reports.empty());
}

TEST_F(Tick, PacesFramesAndTellsTheirRate) {
    for (int t = 5; t <= 1010; t += 5)
        tick(kEngineStandard, t);
    EXPECT_EQ(frames, 101) << "every second tick of 5 ms";
    EXPECT_EQ(host.panels[3], "FPS:101 Res Free:101");
    clocks = clocksAtEntry(kStart);
    EXPECT_FALSE(tick(kEngineOpenGL, 14));
    EXPECT_TRUE(tick(kEngineOpenGL, 15));
}

TEST_F(Tick, TextBecomesCommandsAtOnceAndDumpsWhenAFrameIsDrawn) {
    stream.ZephStackBuffer.append("\x01"
                                  "00100360000000010020050001.500100000\x04"
                                  "\x01"
                                  "0010026010000507000002FF80\x04");
    EXPECT_FALSE(tick(kEngineStandard, 5));
    EXPECT_EQ(tables.Live[1].Duration, 15);
    EXPECT_EQ(tables.CommandState[3] & kCommandActive, 0);
    EXPECT_TRUE(tick(kEngineStandard, 9));
    EXPECT_EQ(tables.Live[3].EndIntensity, 50);
}
