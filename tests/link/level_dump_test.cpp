#include "link/level_dump.h"
#include "tests/support/recording_host.h"
#include "tests/support/recording_sink.h"

namespace {

using Commands = std::vector<ZephChannelCommand>;

struct DumpTest : testing::Test {
    RecordingSink sink;
    CollectingFailures failures;
    LevelDumps dumps;

    void storeDmx(std::int32_t universe, std::string_view digits) {
        ASSERT_TRUE(dumps.ZephDmxDumpTable.store(universe, digits));
        dumps.ZephDmxDumpPending = true;
    }
    void storeController(std::int32_t network, std::int32_t unit, std::string_view digits) {
        ASSERT_TRUE(dumps.ZephControllerDumpTable.store(controllerSlot(network, unit), digits));
        dumps.ZephControllerDumpPending = true;
    }
    Commands dmx() {
        ZephProcessDmxStreams(sink, failures, dumps);
        return std::exchange(sink.commands, {});
    }
    Commands controllers() {
        ZephProcessKeshStreams(sink, failures, dumps);
        return std::exchange(sink.commands, {});
    }
};

ZephChannelCommand dumped(std::int32_t network, std::int32_t device, std::int32_t unit, std::int32_t circuit,
                          std::int32_t intensity) {
    return {{1, 0, network, device, unit, circuit}, {0, intensity, intensity}};
}

}  // namespace

TEST_F(DumpTest, UniversesBecomeCommandsOnceInOrder) {
    storeDmx(999, "01");
    storeDmx(5, "80fE");
    storeDmx(1, "");
    EXPECT_EQ(dmx(), (Commands{dumped(5, 7, 0, 1, 50), dumped(5, 7, 0, 2, 100), dumped(999, 7, 0, 1, 0)}));
    EXPECT_FALSE(dumps.ZephDmxDumpPending);
    storeDmx(7, "03");
    EXPECT_EQ(dmx(), (Commands{dumped(7, 7, 0, 1, 1)}));
}

TEST_F(DumpTest, ControllersAreSentAgainWithEachNewDumpAndEmptyTheUniverseOfTheirNetworksNumber) {
    storeController(15, 240, "80");
    storeController(0, 1, "FF");
    const ZephChannelCommand first = dumped(0, 1, 1, 1, 100);
    const ZephChannelCommand last = dumped(15, 1, 240, 1, 50);
    EXPECT_EQ(controllers(), (Commands{first, last}));
    EXPECT_EQ(controllers(), Commands{});
    storeDmx(3, "FF");
    storeDmx(4, "FF");
    storeController(3, 2, "00");
    EXPECT_EQ(controllers(), (Commands{first, dumped(3, 1, 2, 1, 0), last}));
    EXPECT_EQ(dmx(), (Commands{dumped(4, 7, 0, 1, 100)}));
}

TEST_F(DumpTest, ABadDigitLeavesTheSlotAndClearingEmptiesAll) {
    storeDmx(5, std::string(2 * 999, 'F'));
    EXPECT_FALSE(dumps.ZephDmxDumpTable.store(5, "0G"));
    const Commands all = dmx();
    ASSERT_EQ(all.size(), 999u);
    EXPECT_EQ(all.back(), dumped(5, 7, 0, 999, 100));
    storeDmx(5, "FF");
    storeController(15, 240, "FF");
    clearLevelDumps(dumps);
    dumps.ZephDmxDumpPending = dumps.ZephControllerDumpPending = true;
    EXPECT_EQ(dmx(), Commands{});
    EXPECT_EQ(controllers(), Commands{});
}
