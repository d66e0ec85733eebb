#include "model/channel_identity.h"
#include "model/document.h"
#include "model/tables.h"
#include "tests/support/fixtures.h"
#include "tests/support/loading.h"

using testing::ElementsAre;

namespace {

struct Display {
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    CountingWatcher watcher;

    Display(int fixtures, int props) {
        while (simulation->FixtureCount < fixtures)
            addFixture(*simulation, kFixtureStrings);
        simulation->PropCount = props;
        for (int p = 1; p <= props; ++p)
            simulation->Props[p].Name = "P" + std::to_string(p);
    }
    std::vector<int> members(int prop) const {
        const ZephProp& record = simulation->Props[prop];
        return {record.Object.begin(), record.Object.begin() + record.AssignedCount};
    }
    std::string names() const {
        std::string all;
        for (int f = 1; f <= simulation->FixtureCount; ++f)
            all += (f > 1 ? " " : "") + simulation->Fixtures[f].Name;
        return all;
    }
};

}  // namespace

TEST(Props, AFixtureAddedToAFullPropPointsAtItButIsNotListed) {
    Display display(65, 1);
    for (int f = 1; f <= 64; ++f)
        EXPECT_TRUE(ZephAddFixtureToProp(f, 1, *display.simulation));
    EXPECT_FALSE(ZephAddFixtureToProp(65, 1, *display.simulation));
    EXPECT_EQ(display.members(1).size(), 64u);
    const ZephFixture& surplus = display.simulation->Fixtures[65];
    EXPECT_EQ(surplus.AssignedItem, 1);
    EXPECT_EQ(surplus.AssignedItemName, "P1");

    display.simulation->SimulationDirty = false;
    EXPECT_FALSE(ZephDeleteFixtureFromProp(65, 1, *display.simulation));
    EXPECT_TRUE(display.simulation->SimulationDirty) << "even by a miss";
    EXPECT_EQ(surplus.AssignedItem, 1);
    EXPECT_FALSE(ZephDisassociateFromProp(65, 1, *display.simulation));
    EXPECT_EQ(surplus.AssignedItem, 0);
    EXPECT_TRUE(ZephDeleteFixtureFromProp(64, 1, *display.simulation));
    EXPECT_EQ(display.members(1).size(), 63u);
}

TEST(Deleting, AFixtureRenumbersEveryMemberAboveIt) {
    Display display(10, 2);
    for (const int f : {4, 5, 6, 10})
        ZephAddFixtureToProp(f, 2, *display.simulation);
    ZephDeleteThisFixture(5, false, *display.simulation, display.watcher);
    EXPECT_THAT(display.members(2), ElementsAre(4, 5, 9));
    EXPECT_EQ(display.names(), "F1 F2 F3 F4 F6 F7 F8 F9 F10");
    EXPECT_EQ(display.simulation->Fixtures[5].AssignedItem, 2);
    EXPECT_EQ(display.simulation->Fixtures[10].Name, "") << "the freed record is cleared";
    EXPECT_THAT(display.watcher.removed, ElementsAre(5));

    display.watcher.lists = 0;
    EXPECT_TRUE(ZephDeleteFixturesByProp(4, *display.simulation, display.watcher));
    EXPECT_EQ(display.names(), "F1 F2 F3 F7 F8 F9");
    EXPECT_EQ(display.simulation->PropCount, 2);
    EXPECT_EQ(display.watcher.lists, 1) << "once for all of them";
}

TEST(Deleting, APropMovesTheLaterOnesDownAndFreesItsMembers) {
    Display display(3, 3);
    for (const int n : {1, 2, 3})
        ZephAddFixtureToProp(n, n, *display.simulation);
    display.simulation->Props[kMaxProps].Locked = true;
    EXPECT_TRUE(ZephDeleteThisProp(2, *display.simulation));
    EXPECT_FALSE(display.simulation->Props[kMaxProps].Locked) << "moves down, and is not there twice";
    EXPECT_EQ(display.simulation->PropCount, 2);
    EXPECT_EQ(display.simulation->Props[2].Name, "P3");
    for (const auto& [fixture, prop] : {std::pair{1, 1}, {2, 0}, {3, 2}})
        EXPECT_EQ(display.simulation->Fixtures[fixture].AssignedItem, prop);
    EXPECT_EQ(display.simulation->Fixtures[3].AssignedItemName, "P3");
}

TEST(FixturesPerChannel, WarnsAtSixteenInTheGivenWords) {
    Display display(16, 0);
    ZephFixture edited;
    addChannel(edited, 0, 0);
    ZephChannel& channel = addChannel(edited, 3, 4);
    channel.Name = "Roof";
    channel.Network = 2;
    // The bound of the search is the count of fixture 2, since the channel in question is the second.
    display.simulation->Fixtures[2].ChannelCount = 1;
    for (int f = 1; f <= 15; ++f)
        display.simulation->Fixtures[f].Channels[1] = channel;
    RecordingHost host;
    ZephCheckFixturesPerChannel(*display.simulation, edited, host);
    EXPECT_EQ(host.boxTexts(), "");
    display.simulation->Fixtures[1000].Channels[1] = channel;  // beyond the count, and still counted
    ZephCheckFixturesPerChannel(*display.simulation, edited, host);
    EXPECT_EQ(host.boxTexts(), "Qen Visualizer-Max Simulation Fixtures|This channel...\r\n\r\nName:Roof\r\n"
                               "Device:Qen\r\nNet:Aux B\r\nUnit:3\r\nCircuit:4\r\n\r\n"
                               "...is in use by more than 16 fixtures.\r\n\r\n"
                               "Your data will be saved, however only the first 16 fixtures will be simulated.");
    display.simulation->Fixtures[2].ChannelCount = 0;
    ZephCheckFixturesPerChannel(*display.simulation, edited, host);
    EXPECT_EQ(host.boxes.size(), 1u);
}

TEST(Tables, NumbersReadAsTheirNames) {
    EXPECT_EQ(ZephReturnX10HouseCode(0) + ZephReturnX10UnitCode(0), "A1");
    EXPECT_EQ(ZephReturnX10HouseCode(255) + ZephReturnX10UnitCode(255), "P16");
    EXPECT_EQ(networkName(15), "Aux O");
    EXPECT_EQ(universeName(999), "Unv 999");
    Display display(3, 0);
    display.simulation->Fixtures[1].Name = "New Fixture 1";
    display.simulation->Fixtures[2].Name = "new fixture 2";
    EXPECT_EQ(ZephReturnNewFixtureName(*display.simulation), "New Fixture 2") << "the first free one by exact case";
    // Ribbon resolutions have an uneven row.
    ZephFixture fixture;
    fixture.Kesh.Resolution = 5;
    EXPECT_EQ(KeshResolutionToResolutionCount(3), 17);
    for (const auto& [count, resolution] : {std::pair{16, 3}, {17, 2}, {3, 5}})
        EXPECT_EQ(KeshResolutionCountToResolution(fixture, count), resolution);
}
