#include "engine/render_table.h"
#include "tests/support/engine_rig.h"

#include <random>

using testing::ElementsAre;

namespace {

std::vector<std::int32_t> keys(const ZephRenderTables& tables) {
    return {tables.Keys.begin() + 1, tables.Keys.end()};
}

std::vector<std::int32_t> fixturesOf(const ZephRenderTables& tables, std::size_t entry) {
    std::vector<std::int32_t> fixtures;
    const ZephRenderData& data = tables.RenderData[entry];
    for (std::int32_t s = 0; s < data.SlotCount; ++s)
        fixtures.push_back(tables.Slots[static_cast<std::size_t>(data.FirstSlot + s)].Fixture);
    return fixtures;
}

ZephChannel& addVirtual(ZephFixture& fixture, const std::string& name) {
    ZephChannel& channel = addChannel(fixture, 0, 0);
    channel.DeviceType = kDeviceNone;
    channel.Name = name;
    return channel;
}

// The n-th bulb of a channel, from 0.
const ZephBulbLocation& bulb(const EngineRig& rig, int fixture, std::int32_t channel, std::int32_t n0) {
    const ZephBulbLocations& places = *bulbLocations((*rig.states)[fixture], channel);
    return rig.tables.BulbPool[static_cast<std::size_t>(places.First + n0)];
}

}  // namespace

TEST(RenderTable, SortsKeysAndKeepsFixtureOrderWithinOne) {
    EngineRig rig;
    addChannel(rig.addPlain(2, 5), 0, 1).DeviceType = kDeviceClearedInFile;
    ZephChannel& dmx = addChannel(rig.addPlain(1, 9), 77, 12);
    dmx.DeviceType = kDeviceDmx;
    dmx.Network = 5;
    rig.addPlain(2, 5);
    rig.build();
    EXPECT_THAT(keys(rig.tables), ElementsAre(-99'999'999, 100'001'009, 100'002'005, 700'500'012));
    EXPECT_THAT(fixturesOf(rig.tables, 3), ElementsAre(1, 3));
    EXPECT_EQ(rig.simulation->Fixtures[1].Channels[2].DeviceType, kDeviceCleared) << "marked in the document";
    EXPECT_EQ(rig.tables.RenderDataCount, 4);
    EXPECT_EQ(FindCommandData(BuildCmdKey(kDeviceDmx, 5, 123, 12), rig.tables), 4) << "the unit takes no part";
    EXPECT_EQ(FindCommandData(100'002'006, rig.tables), 0);
    EXPECT_THAT(rig.host.panel2History,
                ElementsAre("Reset Rendering Parms", "Building Virtual Keys", "Building Virtual Keys",
                            "Building Virtual Keys", "Compiling Master/Slave Keshs",
                            "Compiling Master/Slave Pixel Universes", "Creating Channel Table for Fixture-1",
                            "Creating Channel Table for Fixture-2", "Creating Channel Table for Fixture-3",
                            "Pre-build all bulb locations", "Finishing up"));
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
    ZephFixture& fixture = rig.addPlain(1, 1);
    addChannel(fixture, 2'000'000'000, 1);
    addChannel(fixture, 2'000'000'000, 2);
    ZephChannel& cleared = addChannel(fixture, 0, 0);
    cleared.DeviceType = kDeviceCleared;
    cleared.Network = 300;
    rig.build();
    EXPECT_THAT(keys(rig.tables), ElementsAre(100'001'001));
    EXPECT_EQ(rig.failures.reports.size(), 1u);
}

TEST(RenderTable, SaysWhenThereIsNothingToSimulate) {
    EngineRig rig;
    rig.add(kFixtureStrings);
    rig.build();
    EXPECT_EQ(rig.tables.RenderDataCount, 0);
    EXPECT_EQ(rig.host.boxTexts(), "Qen Visualizer-Error|There are no channels to simulate.");
    EXPECT_EQ(rig.host.boxes[0].icon, BoxIcon::Critical);
}

TEST(VirtualChannels, AreFoundInAnyCaseAndTheEmptyNameCounts) {
    EngineRig rig;
    ZephFixture& fixture = rig.add(kFixtureStrings);
    for (const char* name : {"roof", "ARCH", "Roof", "", "Ärch"})
        addVirtual(fixture, name);
    rig.build();
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
    for (int n = 1; n <= 257; ++n) {
        if (n % 16 == 1) rig.add(kFixtureStrings);
        addVirtual(rig.simulation->Fixtures[rig.simulation->FixtureCount], "v" + std::to_string(n > 255 ? 1 : n));
    }
    rig.build();
    EXPECT_EQ(rig.host.boxTexts(), "Qen Visualizer-Max Virtual Channels|You have 255 or more virtual channels.\r\nOnly "
                                   "the first 255 will be simulated.");
    EXPECT_EQ(rig.tables.VirtualChannelCount, 255);
}

TEST(RibbonSlots, LegacySpreadsOverTenUnitsAndMagicChannelsEndTheRow) {
    EngineRig rig;
    rig.addRibbon(3).Kesh.Unit_Mode = 1;
    rig.build();
    EXPECT_EQ(rig.tables.RenderDataCount, 157);
    EXPECT_EQ(rig.tables.Keys[1], 100'003'001);
    EXPECT_EQ(rig.tables.Keys[157], 100'012'013);
    EXPECT_EQ(rig.tables.Slots.back().KeshMagic, 157);
    EXPECT_FALSE(rig.tables.Slots.back().isRGB());
    EXPECT_EQ(rig.tables.RGBData.size() - 1, 50u);
}

TEST(RibbonSlots, SequentialAtACoarseResolutionHasColoursAboveThree) {
    EngineRig rig;
    ZephKeshData& ribbon = rig.addRibbon(3).Kesh;
    ribbon.Channel_Mode = 1;
    ribbon.Resolution = 3;
    rig.build();
    const ZephRenderSlot& slot = rig.tables.Slots[48];  // the 49th channel, groups of 16
    EXPECT_EQ(slot.Channel, 4);
    EXPECT_EQ(slot.Triplet, 1);
    EXPECT_EQ(rig.tables.RGBData.size() - 1, 16u);
    rig.command(3, 49, 0, 100);
    EXPECT_EQ(rig.shown({9}), "") << "a slot without a place in its group";
}

TEST(PixelSlots, CountThreeChannelsAPointFrom1001) {
    EngineRig rig;
    rig.addPixels(2, 4);
    rig.build();
    EXPECT_EQ(rig.tables.RenderDataCount, 12);
    EXPECT_EQ(rig.tables.Keys[12], 700'200'012);
    EXPECT_EQ(rig.tables.Slots[11].Triplet, 1004);
    EXPECT_EQ(rig.tables.Slots[11].Channel, 3);
    EXPECT_EQ(rig.tables.RGBData[4].Key, 1004 + 1000 + 1'024'000);
}

TEST(BulbPlaces, StringsRoundAndSinglePointsAreCutOff) {
    EngineRig rig;
    ZephFixture& string = rig.addPlain(1, 1);
    addChannel(string, 1, 2);
    string.DrawPoints[1] = {kPointMove, 22, 15};  // 1.47 pixels
    string.DrawPoints[2] = {kPointLine, 23 + 30 * 15, 15};
    string.BulbSpacing = 6;
    ZephFixture& flood = rig.add(kFixtureFlood, {{0, 0}});
    flood.DrawPoints[1] = {kPointBulb, 29, -16};
    addChannel(flood, 1, 3);
    rig.build();
    // At 0 and 20 of the 31 pixels, and the other channel at 10 and 30.
    EXPECT_EQ(bulbLocations((*rig.states)[1], 1)->Count, 2);
    EXPECT_EQ(bulbLocations((*rig.states)[1], 2)->Count, 2);
    EXPECT_EQ(bulb(rig, 1, 1, 1).X, 21);
    EXPECT_EQ(bulb(rig, 1, 2, 0).X, 11);
    EXPECT_EQ(bulb(rig, 2, 1, 0).X, 1);
    EXPECT_EQ(bulb(rig, 2, 1, 0).Y, -1);
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
            const auto [first, last] = std::equal_range(sorted.begin(), sorted.end(), probes[i]);
            const auto expected = first == last ? 0 : static_cast<std::int32_t>(first - sorted.begin()) + 1;
            ASSERT_EQ(found[i], expected) << count << " keys, probe " << probes[i];
            ASSERT_EQ(search.findPortable(probes[i]), expected) << count << " keys, probe " << probes[i];
        }
    }
}
