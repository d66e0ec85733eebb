#include "engine/render_table.h"
#include "tests/support/engine_rig.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <random>

using testing::ElementsAre;

namespace {

std::vector<std::int32_t> keys(const ZephRenderTables& tables) {
    return {tables.Keys.begin() + 1, tables.Keys.end()};
}

std::vector<std::int32_t> fixturesOf(const ZephRenderTables& tables, std::size_t entry) {
    std::vector<std::int32_t> fixtures;
    const ZephRenderData& data = tables.RenderData[entry];
    for (std::int32_t s = 0; s < data.SlotCount; ++s) {
        fixtures.push_back(tables.Slots[static_cast<std::size_t>(data.FirstSlot + s)].Fixture);
    }
    return fixtures;
}

}  // namespace

TEST(RenderTable, SortsKeysAndKeepsFixtureOrderWithinOne) {
    EngineRig rig;
    rig.addPlain(2, 5);
    rig.addPlain(1, 9);
    rig.addPlain(2, 5);
    rig.addChannel(1, 0, 1).DeviceType = kDeviceClearedInFile;
    ZephChannel& dmx = rig.addChannel(2, 77, 12);
    dmx.DeviceType = kDeviceDmx;
    dmx.Network = 5;
    rig.build();
    EXPECT_THAT(keys(rig.tables), ElementsAre(-99'999'999, 100'001'009, 100'002'005, 700'500'012));
    EXPECT_THAT(fixturesOf(rig.tables, 3), ElementsAre(1, 3));
    EXPECT_EQ(rig.simulation->Fixtures[1].Channels[2].DeviceType, kDeviceCleared) << "marked in the document";
    EXPECT_EQ(rig.tables.RenderDataCount, 4);
    EXPECT_EQ(FindCommandData(BuildCmdKey(kDeviceDmx, 5, 123, 12), rig.tables), 4) << "the unit takes no part";
    EXPECT_EQ(FindCommandData(100'002'006, rig.tables), 0);
}

TEST(RenderTable, KeepsSixteenFixturesOfAKeyAndNumbersGroupsByWhatItKeeps) {
    EngineRig rig;
    for (int i = 0; i < 17; ++i)
        rig.addRgb(1, 1);
    rig.addRgb(2, 1);
    rig.build();
    EXPECT_EQ(rig.tables.RenderData[1].SlotCount, 16);
    EXPECT_EQ(rig.tables.RGBData.size() - 1, 17u) << "16 of the first address and the one of the second";
    EXPECT_EQ(rig.tables.RGBData[17].Key, 18'000);
}

TEST(RenderTable, ReportsKeysThatDoNotFitOnceAndClearedDevicesStayNegative) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.addChannel(1, 2'000'000'000, 1);
    rig.addChannel(1, 2'000'000'000, 2);
    ZephChannel& cleared = rig.addChannel(1, 0, 0);
    cleared.DeviceType = kDeviceCleared;
    cleared.Network = 300;
    rig.build();
    EXPECT_THAT(keys(rig.tables), ElementsAre(100'001'001));
    EXPECT_EQ(rig.failures.reports.size(), 1u);
}

TEST(RenderTable, SaysWhenThereIsNothingToSimulate) {
    EngineRig rig;
    rig.addFixture(kFixtureStrings);
    rig.build();
    EXPECT_EQ(rig.tables.RenderDataCount, 0);
    ASSERT_EQ(rig.host.boxes.size(), 1u);
    EXPECT_EQ(rig.host.boxes[0].title, "Qen Visualizer-Error");
    EXPECT_EQ(rig.host.boxes[0].text, "There are no channels to simulate.");
    EXPECT_EQ(rig.host.boxes[0].icon, BoxIcon::Critical);
}

TEST(RenderTable, TellsItsStepsInTheStatusBar) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.build();
    EXPECT_THAT(rig.host.panel2History,
                ElementsAre("Reset Rendering Parms", "Building Virtual Keys", "Compiling Master/Slave Keshs",
                            "Compiling Master/Slave Pixel Universes", "Creating Channel Table for Fixture-1",
                            "Pre-build all bulb locations", "Finishing up"));
}

TEST(VirtualChannels, AreFoundInAnyCaseAndTheEmptyNameCounts) {
    EngineRig rig;
    const int f = rig.addFixture(kFixtureStrings);
    for (const char* name : {"roof", "ARCH", "Roof", "", "Ärch"}) {
        ZephChannel& channel = rig.addChannel(f, 0, 0);
        channel.DeviceType = kDeviceNone;
        channel.Name = name;
    }
    rig.build();
    EXPECT_EQ(rig.tables.VirtualChannelCount, 4);
    EXPECT_EQ(ZephReturnVirtualChannelKey("", rig.tables), 1);
    EXPECT_EQ(ZephReturnVirtualChannelKey("arch", rig.tables), 2);
    EXPECT_EQ(ZephReturnVirtualChannelKey("ROOF", rig.tables), 3);
    EXPECT_EQ(ZephReturnVirtualChannelKey("no", rig.tables), 0);
    EXPECT_THAT(keys(rig.tables), ElementsAre(1, 2, 3, 4));
    const ManualClock clock(0);
    EXPECT_EQ(RenderTableSink(rig.tables, clock).virtualChannelKey("\xC4RCH"), 4);
}

TEST(VirtualChannels, TheCallAfter255WarnsOnceEvenWithAKnownName) {
    EngineRig rig;
    int f = 0;
    for (int n = 1; n <= 257; ++n) {
        if (n % 16 == 1) f = rig.addFixture(kFixtureStrings);
        ZephChannel& channel = rig.addChannel(f, 0, 0);
        channel.DeviceType = kDeviceNone;
        channel.Name = "v" + std::to_string(n > 255 ? 1 : n);
    }
    rig.build();
    ASSERT_EQ(rig.host.boxes.size(), 1u);
    EXPECT_EQ(rig.host.boxes[0].title, "Qen Visualizer-Max Virtual Channels");
    EXPECT_EQ(rig.host.boxes[0].text,
              "You have 255 or more virtual channels.\r\nOnly the first 255 will be simulated.");
    EXPECT_EQ(rig.tables.VirtualChannelCount, 255);
}

TEST(RibbonSlots, LegacySpreadsOverTenUnitsAndMagicChannelsEndTheRow) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.simulation->Fixtures[f].Kesh.Unit_Mode = 1;
    rig.build();
    EXPECT_EQ(rig.tables.RenderDataCount, 157);
    EXPECT_EQ(rig.tables.Keys[1], 100'003'001);
    EXPECT_EQ(rig.tables.Keys[157], 100'012'013);
    const ZephRenderSlot& magic = rig.tables.Slots.back();
    EXPECT_EQ(magic.KeshMagic, 157);
    EXPECT_FALSE(magic.isRGB());
    EXPECT_EQ(rig.tables.RGBData.size() - 1, 50u);
}

TEST(RibbonSlots, SequentialAtACoarseResolutionHasColoursAboveThree) {
    EngineRig rig;
    const int f = rig.addRibbon(3);
    rig.simulation->Fixtures[f].Kesh.Channel_Mode = 1;
    rig.simulation->Fixtures[f].Kesh.Resolution = 3;
    rig.build();
    const ZephRenderSlot& slot = rig.tables.Slots[48];  // the 49th channel, groups of 16
    EXPECT_EQ(slot.Channel, 4);
    EXPECT_EQ(slot.Triplet, 1);
    EXPECT_EQ(rig.tables.RGBData.size() - 1, 16u);
    rig.command(3, 49, 0, 100);
    rig.pass(9);  // a slot without a place in its group: nothing is drawn, nothing is touched
    EXPECT_TRUE(rig.surface.groups.empty());
}

TEST(PixelSlots, CountThreeChannelsAPointFrom1001) {
    EngineRig rig;
    const int f = rig.addFixture(kFixtureDmxPixels, 4);
    rig.simulation->Fixtures[f].Channel_Type = kChannelRgb;
    rig.simulation->Fixtures[f].DMX.Universe = 2;
    rig.build();
    EXPECT_EQ(rig.tables.RenderDataCount, 12);
    EXPECT_EQ(rig.tables.Keys[12], 700'200'012);
    EXPECT_EQ(rig.tables.Slots[11].Triplet, 1004);
    EXPECT_EQ(rig.tables.Slots[11].Channel, 3);
    EXPECT_EQ(rig.tables.RGBData[4].Key, 1004 + 1000 + 1'024'000);
}

TEST(BulbPlaces, StringsRoundAndSinglePointsAreCutOff) {
    EngineRig rig;
    const int string = rig.addFixture(kFixtureStrings);
    rig.simulation->Fixtures[string].DrawPoints[1] = {kPointMove, 22, 15};  // 1.47 pixels
    rig.simulation->Fixtures[string].DrawPoints[2] = {kPointLine, 23 + 30 * 15, 15};
    rig.simulation->Fixtures[string].BulbSpacing = 6;
    rig.simulation->Fixtures[string].BulbSize = 2;
    rig.addChannel(string, 1, 1);
    rig.addChannel(string, 1, 2);
    const int flood = rig.addFixture(kFixtureFlood, 1);
    rig.simulation->Fixtures[flood].DrawPoints[1] = {kPointBulb, 29, -16};
    rig.addChannel(flood, 1, 3);
    rig.build();
    const ZephBulbLocations& first = (*rig.states)[string].BulbLocations[1];
    const ZephBulbLocations& second = (*rig.states)[string].BulbLocations[2];
    ASSERT_EQ(first.Count, 2);  // at 0 and 20 of the 31 pixels; the other channel at 10 and 30
    ASSERT_EQ(second.Count, 2);
    EXPECT_EQ(rig.tables.BulbPool[static_cast<std::size_t>(first.First + 1)].X, 21);
    EXPECT_EQ(rig.tables.BulbPool[static_cast<std::size_t>(second.First)].X, 11);
    const ZephBulbLocation& bulb =
        rig.tables.BulbPool[static_cast<std::size_t>((*rig.states)[flood].BulbLocations[1].First)];
    EXPECT_EQ(bulb.X, 1);
    EXPECT_EQ(bulb.Y, -1);
}

TEST(KeySearch, BothFormsFindWhatABisectionFinds) {
    std::mt19937 random(7);
    for (const int count : {0, 1, 15, 16, 17, 255, 256, 257, 5000}) {
        std::vector<std::int32_t> sorted;
        std::int64_t key = -2'147'483'648LL;
        for (int i = 0; i < count; ++i) {
            sorted.push_back(static_cast<std::int32_t>(key));
            key += 1 + static_cast<std::int64_t>(random() % (4'000'000'000u / static_cast<unsigned>(count)));
            key = std::min<std::int64_t>(key, 2'147'483'647LL - count + i + 1);
        }
        if (count > 20) sorted.back() = 2'147'483'647;
        KeySearch search;
        search.build(sorted);
        std::vector<std::int32_t> probes = sorted;
        for (const std::int32_t value : sorted) {
            probes.push_back(value - (value > -2'147'483'647));
            probes.push_back(value + (value < 2'147'483'647));
        }
        probes.insert(probes.end(), {0, 1, -1, 2'147'483'647, -2'147'483'647 - 1});
        std::vector<std::int32_t> found(probes.size());
        search.findMany(probes, found.data());
        for (std::size_t i = 0; i < probes.size(); ++i) {
            const auto place = std::lower_bound(sorted.begin(), sorted.end(), probes[i]);
            const std::int32_t expected = place != sorted.end() && *place == probes[i]
                                              ? static_cast<std::int32_t>(place - sorted.begin()) + 1
                                              : 0;
            ASSERT_EQ(found[i], expected) << count << " keys, probe " << probes[i];
            ASSERT_EQ(search.findPortable(probes[i]), expected) << count << " keys, probe " << probes[i];
        }
    }
}
