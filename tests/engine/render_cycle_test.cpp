#include "engine/light_drawing.h"
#include "engine/render_cycle.h"
#include "engine/rgb_effects.h"
#include "tests/support/engine_rig.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using testing::ElementsAre;
using testing::IsEmpty;

TEST(Commands, WithoutDurationTakeEffectAtOnceAndGoOnUntilReplaced) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.build();
    rig.command(1, 1, 0, 60);
    rig.pass(9);
    EXPECT_THAT(rig.intensities(), ElementsAre(60));
    rig.pass(18);
    EXPECT_THAT(rig.intensities(), ElementsAre(60));
    rig.command(1, 1, 0, 20);
    rig.command(1, 1, 0, 30);
    rig.pass(27);
    EXPECT_THAT(rig.intensities(), ElementsAre(30)) << "only the last of two counts";
    rig.command(9, 9, 0, 50);
    rig.pass(36);
    EXPECT_THAT(rig.intensities(), ElementsAre(30));
}

TEST(Commands, FadeInProportionAndNeverShowARisingZeroTwice) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.build();
    rig.command(1, 1, 0, 100, 1000);
    rig.pass(0);
    EXPECT_THAT(rig.intensities(), ElementsAre(0));
    rig.pass(500);
    EXPECT_THAT(rig.intensities(), ElementsAre(50));
    rig.pass(1000);
    EXPECT_THAT(rig.intensities(), ElementsAre(100));
    rig.pass(5000);
    EXPECT_THAT(rig.intensities(), ElementsAre(100));

    rig.command(1, 1, 0, 1, 1000, 0, 5000);
    rig.pass(5100);
    EXPECT_THAT(rig.intensities(), ElementsAre(0));
    rig.pass(5200);
    EXPECT_THAT(rig.intensities(), ElementsAre(1));
}

TEST(Commands, ToZeroAreCarriedOutOnceThenEnd) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.build();
    rig.command(1, 1, 100, 0);
    rig.pass(9);
    EXPECT_THAT(rig.intensities(), ElementsAre(0));
    EXPECT_EQ(rig.tables.CommandState[1] & kCommandActive, kCommandActive);
    rig.pass(18);
    EXPECT_THAT(rig.intensities(), IsEmpty());
    EXPECT_EQ(rig.tables.CommandState[1] & kCommandActive, 0);
    EXPECT_EQ(rig.tables.LevelChanged, 0u) << "an idle level costs nothing";
}

TEST(Commands, OnALevelSwitchedOffAreStoredAndNotDrawn) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.simulation->Levels[1].Sim_Enabled = false;
    rig.build();
    rig.command(1, 1, 0, 100);
    rig.pass(9);
    EXPECT_THAT(rig.intensities(), IsEmpty());
    EXPECT_EQ(rig.tables.CommandState[1] & kCommandActive, kCommandActive);
}

TEST(Order, IsLevelThenKeyAndGroupsFollowThePlainChannelsOfTheirLevel) {
    EngineRig rig;
    rig.simulation->Fixtures[rig.addPlain(3, 1)].ZOrder = 2;  // fixture 1
    rig.addPlain(5, 1);                                       // 2
    rig.addRgb(1, 1);                                         // 3
    rig.addPlain(4, 1);                                       // 4
    rig.build();
    for (const int unit : {3, 5, 4})
        rig.command(unit, 1, 0, 100);
    for (const int circuit : {3, 1, 2})
        rig.command(1, circuit, 0, 100);
    rig.pass(9);
    EXPECT_THAT(rig.surface.order, ElementsAre("c4", "c2", "g3.0", "c1"));
}

TEST(Order, AChannelOnTwoLevelsEndsOnTheHigherOneWithoutBeingDrawnThere) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.simulation->Fixtures[rig.addPlain(1, 1)].ZOrder = 5;
    rig.build();
    rig.command(1, 1, 0, 100);
    rig.pass(9);
    EXPECT_THAT(rig.surface.order, ElementsAre("c1", "c2"));
    // The lower level's pass counts as the first; the higher one finds the command carried out already.
    rig.command(1, 1, 100, 0, 0, 0, 9);
    rig.pass(18);
    EXPECT_THAT(rig.surface.order, ElementsAre("c1"));
}

TEST(Shimmer, BlinksAPlainChannelByTheRenderClock) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.build();
    rig.command(1, 1, 100, 100, 0, 1);
    std::vector<std::int32_t> seen;
    for (int t = 9; t <= 90; t += 9) {
        rig.pass(t);
        seen.push_back(rig.intensities().at(0));
    }
    // 9 18 27 dark; at 36 the clock is above 30 and turns.
    EXPECT_THAT(seen, ElementsAre(0, 0, 0, 100, 100, 100, 100, 0, 0, 0));
}

TEST(Twinkle, OfAPlainChannelFollowsItsPhases) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.build();
    rig.command(1, 1, 80, 80, 0, 2);
    rig.random.values = {0.0, 0.0};  // first phase 10 ms, on
    rig.pass(9);
    EXPECT_THAT(rig.intensities(), ElementsAre(80));
    rig.pass(18);
    EXPECT_THAT(rig.intensities(), ElementsAre(80));
    rig.random.values = {0.999};  // 63 and 51 = 51, and at least 20 more: 71 units of 8.333 = 592 ms
    rig.pass(19);
    EXPECT_THAT(rig.intensities(), ElementsAre(0));
    rig.pass(610);
    EXPECT_THAT(rig.intensities(), ElementsAre(0));
    rig.random.values = {0.0};  // an on phase may last none at all
    rig.pass(611);
    EXPECT_THAT(rig.intensities(), ElementsAre(80));
    rig.command(1, 1, 0, 0, 0, 2, 611);
    rig.pass(620);
    rig.pass(629);
    EXPECT_EQ(rig.tables.Twinkle[1].NextTwinkleTime, 0) << "starts from scratch after its command has ended";
}

TEST(Rgb, LevelsRoundAndHoldAndAGroupIsDrawnOnce) {
    EngineRig rig;
    rig.addRgb(1, 1);
    rig.build();
    rig.command(1, 1, 0, 50);
    rig.command(1, 2, 0, 10);
    rig.command(1, 3, 0, 0);
    rig.pass(9);
    ASSERT_EQ(rig.surface.groups.size(), 1u);
    EXPECT_THAT(rig.surface.groups[0].levels, ElementsAre(128, 26, 0));  // 127.5 and 25.5, to even
    EXPECT_EQ(rig.surface.groups[0].draw.Alpha, 128);
    EXPECT_EQ(rig.surface.groups[0].draw.Color, 255 + 256 * 52);
}

TEST(Rgb, DarkGroupsAreToldWithAlphaZero) {
    // Each row: levels, alpha expected.
    const std::vector<std::pair<std::array<std::int32_t, 3>, int>> rows{
        {{24, 24, 24}, 0}, {{25, 0, 0}, 0}, {{29, 29, 29}, 0}, {{30, 0, 0}, 30}, {{0, 0, 0}, 0}};
    for (const auto& [levels, alpha] : rows) {
        EngineRig rig;
        rig.addRgb(1, 1);
        rig.build();
        std::copy(levels.begin(), levels.end(), rig.tables.RGBData[1].Level.begin() + 1);
        RenderContext context = rig.context();
        ZephDrawRGBBulbs(rig.tables.LevelGroups[1][0], 1, 0, context);
        EXPECT_EQ(rig.surface.groups.at(0).draw.Alpha, alpha) << levels[0];
    }
    EXPECT_EQ(ZephColorMixer(0, 0, 0), 0);
    EXPECT_EQ(ZephColorMixer(0, 51, 102), 256 * 128 + 65536 * 255);  // 127.5 to even
}

TEST(Rgb, AFloodAboveItsOpacityGoesThroughTheCurveTwice) {
    EngineRig rig;
    const int f = rig.addRgb(1, 1);
    rig.simulation->Fixtures[f].Fixture_Type = kFixtureFlood;
    rig.simulation->Fixtures[f].Max_Opacity = 40;
    for (std::size_t i = 0; i < 256; ++i)
        rig.curve[i] = static_cast<std::uint8_t>(i / 2);
    rig.build();
    rig.command(1, 1, 0, 100);
    rig.pass(9);
    EXPECT_EQ(rig.surface.groups.at(0).draw.Alpha, 25);  // 102 -> 51 -> 25
    rig.command(1, 1, 0, 15, 0, 0, 9);
    rig.pass(18);
    EXPECT_EQ(rig.surface.groups.at(0).draw.Alpha, 19);  // 38 of 255 is not above the percentage
}

TEST(Strobes, BeginAtRandomPhasesAndAlternate) {
    EngineRig rig;
    const int f = rig.addFixture(kFixtureStrings);
    rig.simulation->Fixtures[f].DrawPoints[2].X = rig.simulation->Fixtures[f].DrawPoints[1].X + 15 * 7;  // two bulbs
    ZephChannel& channel = rig.addChannel(f, 1, 1);
    channel.Sub_Type = kSpecialStrobes;
    channel.Sub_Parm = 10;  // every 100 ms
    rig.build();
    rig.surface.flashingBulbs = 2;
    rig.command(1, 1, 0, 100);
    const auto lit = [&](int t) {
        rig.pass(t);
        return rig.surface.plain.at(0).lit;
    };
    rig.random.values = {0.1, 0.5};  // due above 10 and above 50 ms from now
    EXPECT_THAT(lit(0), ElementsAre(0, 0));
    EXPECT_THAT(lit(10), ElementsAre(0, 0));
    EXPECT_THAT(lit(11), ElementsAre(1, 0));  // for the fire time of 50 ms
    EXPECT_THAT(lit(61), ElementsAre(1, 1));
    rig.random.values = {0.5};  // the next flash one whole interval from now
    EXPECT_THAT(lit(62), ElementsAre(0, 1));
    EXPECT_THAT(lit(111), ElementsAre(0, 1));
    EXPECT_EQ(rig.surface.plain.at(0).draw.Alpha, 255);
    rig.command(1, 1, 0, 0, 0, 0, 111);
    rig.pass(120);
    rig.pass(129);
    EXPECT_FALSE((*rig.states)[f].Channels[1].StrobeRunning) << "a fresh strobe begins anew";
}

TEST(Strobes, ASpeedOfZeroIsReportedAndFlashesWithoutPause) {
    EngineRig rig;
    ZephChannel& channel = rig.addChannel(rig.addFixture(kFixtureStrings), 1, 1);
    channel.Sub_Type = kSpecialStrobes;
    rig.build();
    EXPECT_EQ(rig.failures.reports.size(), 1u);
    EXPECT_EQ((*rig.states)[1].Channels[1].StrobeInterval, 0);
    rig.command(1, 1, 0, 100);
    rig.pass(9);
    EXPECT_EQ(rig.surface.plain.size(), 1u);
}

TEST(Damaged, ARibbonMarkedNormalDrawsNothingOutsideItsArrays) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.simulation->Fixtures[f].Channel_Type = kChannelNormal;
    rig.simulation->Fixtures[f].Kesh.Channel_Mode = 1;
    rig.simulation->Fixtures[f].Kesh.Resolution = 7;  // colours up to 150 become channel numbers
    rig.build();
    for (int circuit = 1; circuit <= 157; ++circuit)
        rig.command(3, circuit, 0, 100);
    rig.pass(9);
    rig.pass(18);
    EXPECT_EQ(rig.surface.plain.size(), 150u);
    EXPECT_TRUE(rig.failures.reports.empty());
}

TEST(Supervisor, PacesFramesAndTellsTheirRate) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.build();
    ManualClock clock(EngineRig::kStart);
    int shown = 0;
    const std::function<void()> done = [&] { ++shown; };
    const ParserSetup parser;
    RenderTableSink sink(rig.tables, clock);
    ChannelStream stream;
    RenderContext run = rig.context();
    const TickContext tick{clock, parser, rig.host, sink, stream, run, done};
    for (int t = 5; t <= 1010; t += 5) {
        clock.set(EngineRig::kStart + t);
        ZephRenderTick(kEngineStandard, tick);
    }
    EXPECT_EQ(shown, 101) << "every second tick of 5 ms";
    EXPECT_EQ(rig.host.panels[3], "FPS:101 Res Free:101");

    rig.clocks = clocksAtEntry(EngineRig::kStart);
    clock.set(EngineRig::kStart + 14);
    EXPECT_FALSE(ZephRenderTick(kEngineOpenGL, tick));
    clock.set(EngineRig::kStart + 15);
    EXPECT_TRUE(ZephRenderTick(kEngineOpenGL, tick));
}

TEST(Tick, TextBecomesCommandsAtOnceAndDumpsWhenAFrameIsDrawn) {
    EngineRig rig;
    rig.addPlain(2, 5);
    ZephChannel& dmx = rig.addChannel(1, 0, 2);
    dmx.DeviceType = kDeviceDmx;
    dmx.Network = 5;
    rig.build();
    ManualClock clock(EngineRig::kStart);
    const std::function<void()> done = [] {};
    ParserSetup parser;
    ZephSetUpPacketParms(parser.PacketParms);
    RenderTableSink sink(rig.tables, clock);
    ChannelStream stream;
    stream.ZephStackBuffer.append("\x01"
                                  "00100360000000010020050001.500100000\x04");
    stream.ZephStackBuffer.append("\x01"
                                  "0010026010000507000002FF80\x04");
    RenderContext run = rig.context();
    const TickContext tick{clock, parser, rig.host, sink, stream, run, done};
    clock.set(EngineRig::kStart + 5);
    EXPECT_FALSE(ZephRenderTick(kEngineStandard, tick));
    EXPECT_EQ(rig.tables.CommandState[1] & kCommandActive, kCommandActive);
    EXPECT_EQ(rig.tables.Live[1].Duration, 15);
    EXPECT_EQ(rig.tables.CommandState[2] & kCommandActive, 0);
    clock.set(EngineRig::kStart + 9);
    EXPECT_TRUE(ZephRenderTick(kEngineStandard, tick));
    EXPECT_EQ(rig.tables.CommandState[2] & kCommandActive, kCommandActive);
    EXPECT_EQ(rig.tables.Live[2].EndIntensity, 50);
}
