#include "engine/render_table.h"
#include "tests/support/engine_rig.h"

#include <random>
#include <set>

using testing::ElementsAre;

namespace {

struct RenderTable : testing::Test, EngineRig {};

std::vector<std::int32_t> keys(const ZephRenderTables& tables) {
    return {tables.Keys.begin() + 1, tables.Keys.end()};
}

void addVirtual(ZephFixture& fixture, const std::string& name) {
    ZephChannel& channel = addChannel(fixture, 0, 0);
    channel.DeviceType = kDeviceNone;
    channel.Name = name;
}

}  // namespace

TEST_F(RenderTable, SortsKeysAndKeepsFixtureOrderWithinOne) {
    addChannel(addPlain(2, 5), 0, 1).DeviceType = kDeviceClearedInFile;
    ZephChannel& dmx = addChannel(addPlain(1, 9), 77, 12);
    dmx.DeviceType = kDeviceDmx;
    dmx.Network = 5;
    addPlain(2, 5);
    build();
    EXPECT_THAT(keys(tables), ElementsAre(-99'999'999, 100'001'009, 100'002'005, 700'500'012));
    const auto shared = tables.Slots.begin() + tables.RenderData[3].FirstSlot;
    EXPECT_THAT((std::array{shared[0].Fixture, shared[1].Fixture}), ElementsAre(1, 3));
    EXPECT_EQ(simulation->Fixtures[1].Channels[2].DeviceType, kDeviceCleared) << "marked in the document";
    EXPECT_EQ(FindCommandData(BuildCmdKey(kDeviceDmx, 5, 123, 12), tables), 4) << "the unit takes no part";
    EXPECT_THAT(host.panel2History,
                ElementsAre("Reset Rendering Parms", "Building Virtual Keys", "Building Virtual Keys",
                            "Building Virtual Keys", "Compiling Master/Slave Keshs",
                            "Compiling Master/Slave Pixel Universes", "Creating Channel Table for Fixture-1",
                            "Creating Channel Table for Fixture-2", "Creating Channel Table for Fixture-3",
                            "Pre-build all bulb locations", "Finishing up"));
}

TEST_F(RenderTable, KeepsSixteenFixturesOfAKeyAndNumbersGroupsByWhatItKeeps) {
    for (int i = 0; i < 17; ++i)
        addRgb(1, 1);
    addRgb(2, 1);
    build();
    EXPECT_EQ(tables.RenderData[1].SlotCount, 16);
    EXPECT_EQ(tables.RGBData.size() - 1, 17u) << "16 of the first address and the one of the second";
    EXPECT_EQ(tables.RGBData[17].Key, 18'000);
}

TEST_F(RenderTable, ReportsKeysThatDoNotFitOnceAndClearedDevicesStayNegative) {
    ZephFixture& fixture = addPlain(1, 1);
    addChannel(fixture, 2'000'000'000, 1);
    addChannel(fixture, 2'000'000'000, 2);
    ZephChannel& cleared = addChannel(fixture, 0, 0);
    cleared.DeviceType = kDeviceCleared;
    cleared.Network = 300;
    build();
    EXPECT_THAT(keys(tables), ElementsAre(100'001'001));
    EXPECT_EQ(failures.reports.size(), 1u);
}

TEST_F(RenderTable, VirtualChannelsAreFoundInAnyCaseAndTheEmptyNameCounts) {
    ZephFixture& fixture = add(kFixtureStrings);
    for (const char* name : {"roof", "ARCH", "Roof", "", "Ärch"})
        addVirtual(fixture, name);
    build();
    EXPECT_EQ(ZephReturnVirtualChannelKey("", tables), 1);
    EXPECT_EQ(ZephReturnVirtualChannelKey("arch", tables), 2);
    EXPECT_EQ(ZephReturnVirtualChannelKey("ROOF", tables), 3);
    EXPECT_EQ(ZephReturnVirtualChannelKey("no", tables), 0);
    EXPECT_THAT(keys(tables), ElementsAre(1, 2, 3, 4));
    const ManualClock clock(0);
    EXPECT_EQ(RenderTableSink(tables, clock).virtualChannelKey("\xC4RCH"), 4);
}

TEST_F(RenderTable, VirtualChannelsTheCallAfter255WarnsOnceEvenWithAKnownName) {
    for (int n = 1; n <= 257; ++n) {
        if (n % 16 == 1) add(kFixtureStrings);
        addVirtual(simulation->Fixtures[simulation->FixtureCount], "v" + std::to_string(n > 255 ? 1 : n));
    }
    build();
    EXPECT_EQ(host.boxTexts(), "Qen Visualizer-Max Virtual Channels|You have 255 or more virtual channels.\r\nOnly "
                               "the first 255 will be simulated.");
    EXPECT_EQ(tables.VirtualChannelCount, 255);
}

TEST_F(RenderTable, RibbonSlotsLegacySpreadsOverTenUnitsEndsWithMagicChannelsAndPixelsFollow) {
    addRibbon(3).Kesh.Unit_Mode = 1;
    addPixels(2, 4);
    build();
    EXPECT_EQ(tables.RenderDataCount, 157 + 12);
    EXPECT_EQ(tables.Keys[1], 100'003'001);
    EXPECT_EQ(tables.Keys[157], 100'012'013);
    EXPECT_EQ(tables.Slots[156].KeshMagic, 157);
    // Pixels count three channels a point, from 1001.
    EXPECT_EQ(tables.Keys[169], 700'200'012);
    EXPECT_EQ(tables.Slots[168].Triplet, 1004);
    EXPECT_EQ(tables.Slots[168].Channel, 3);
    EXPECT_EQ(tables.RGBData.size() - 1, 50u + 4);
}

TEST_F(RenderTable, RibbonSlotsSequentialAtACoarseResolutionHasColoursAboveThree) {
    ZephKeshData& ribbon = addRibbon(3).Kesh;
    ribbon.Channel_Mode = 1;
    ribbon.Resolution = 3;
    build();
    command(3, 49, 0, 100);  // groups of 16, so the fourth colour of the first
    EXPECT_EQ(shown({9}), "") << "a slot without a place in its group";
}

TEST_F(RenderTable, BulbPlacesSinglePointsAreCutOffToPixels) {
    ZephFixture& flood = add(kFixtureFlood, {{0, 0}});
    flood.DrawPoints[1] = {kPointBulb, 29, -16};
    addChannel(flood, 1, 3);
    build();
    EXPECT_EQ(std::pair(tables.BulbPool.at(0).X + 0, tables.BulbPool.at(0).Y + 0), std::pair(1, -1));
}

TEST(KeySearch, BothFormsFindWhatABisectionFinds) {
    std::mt19937 random(7);
    for (const int count : {0, 1, 15, 16, 17, 255, 256, 257, 5000}) {
        std::set<std::int32_t> drawn;
        if (count > 20) drawn = {INT32_MIN, INT32_MAX};
        while (std::ssize(drawn) < count)
            drawn.insert(static_cast<std::int32_t>(random()));
        const std::vector<std::int32_t> sorted(drawn.begin(), drawn.end());
        KeySearch search;
        search.build(sorted);
        std::vector<std::int32_t> probes{0, 1, -1, INT32_MAX, INT32_MIN};
        for (const std::int32_t key : sorted) {
            for (const unsigned step : {0U, 1U, ~0U})  // beyond either end it turns over
                probes.push_back(static_cast<std::int32_t>(static_cast<unsigned>(key) + step));
        }
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
