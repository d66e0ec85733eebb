#include "link/level_dump.h"
#include "tests/support/recording_host.h"
#include "tests/support/recording_sink.h"

#include <gtest/gtest.h>

namespace {

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
};

ZephChannelCommand dumped(std::int32_t network, std::int32_t device, std::int32_t unit, std::int32_t circuit,
                          std::int32_t intensity) {
    return {{1, 0, network, device, unit, circuit}, {0, intensity, intensity}};
}

}  // namespace

TEST_F(DumpTest, UniversesBecomeCommandsOnceInOrder) {
    storeDmx(999, "01");
    storeDmx(5, "FF8000fE");
    storeDmx(1, "");
    ZephProcessDmxStreams(sink, failures, dumps);
    EXPECT_EQ(sink.commands,
              (std::vector<ZephChannelCommand>{dumped(5, 7, 0, 1, 100), dumped(5, 7, 0, 2, 50), dumped(5, 7, 0, 3, 0),
                                               dumped(5, 7, 0, 4, 100), dumped(999, 7, 0, 1, 0)}));
    EXPECT_FALSE(dumps.ZephDmxDumpPending);
    sink.commands.clear();
    storeDmx(7, "03");
    ZephProcessDmxStreams(sink, failures, dumps);
    EXPECT_EQ(sink.commands, (std::vector<ZephChannelCommand>{dumped(7, 7, 0, 1, 1)}));
}

TEST_F(DumpTest, NothingHappensWithoutTheFlag) {
    storeDmx(5, "FF");
    storeController(0, 1, "FF");
    dumps.ZephDmxDumpPending = dumps.ZephControllerDumpPending = false;
    ZephProcessDmxStreams(sink, failures, dumps);
    ZephProcessKeshStreams(sink, failures, dumps);
    EXPECT_TRUE(sink.commands.empty());
}

TEST_F(DumpTest, ControllersAreSentAgainWithEachNewDump) {
    storeController(15, 240, "80");
    storeController(0, 1, "FF");
    ZephProcessKeshStreams(sink, failures, dumps);
    const std::vector<ZephChannelCommand> both{dumped(0, 1, 1, 1, 100), dumped(15, 1, 240, 1, 50)};
    EXPECT_EQ(sink.commands, both);
    sink.commands.clear();
    ZephProcessKeshStreams(sink, failures, dumps);
    EXPECT_TRUE(sink.commands.empty());
    storeController(3, 2, "00");
    ZephProcessKeshStreams(sink, failures, dumps);
    EXPECT_EQ(sink.commands, (std::vector<ZephChannelCommand>{both[0], dumped(3, 1, 2, 1, 0), both[1]}));
}

TEST_F(DumpTest, AControllerEmptiesTheUniverseOfItsNetworksNumber) {
    storeDmx(3, "FF");
    storeDmx(4, "FF");
    storeController(3, 2, "00");
    ZephProcessKeshStreams(sink, failures, dumps);
    sink.commands.clear();
    ZephProcessDmxStreams(sink, failures, dumps);
    EXPECT_EQ(sink.commands, (std::vector<ZephChannelCommand>{dumped(4, 7, 0, 1, 100)}));
}

TEST_F(DumpTest, ABadDigitLeavesTheSlotAndClearingEmptiesAll) {
    storeDmx(5, "FF");
    storeController(1, 1, "FF");
    EXPECT_FALSE(dumps.ZephDmxDumpTable.store(5, "0G"));
    EXPECT_EQ(dumps.ZephDmxDumpTable.levels(5).front(), 255);
    clearLevelDumps(dumps);
    dumps.ZephDmxDumpPending = dumps.ZephControllerDumpPending = true;
    ZephProcessDmxStreams(sink, failures, dumps);
    ZephProcessKeshStreams(sink, failures, dumps);
    EXPECT_TRUE(sink.commands.empty());
}

TEST_F(DumpTest, ASlotHolds999Levels) {
    storeController(15, 240, std::string(2 * 999, 'F'));
    ZephProcessKeshStreams(sink, failures, dumps);
    ASSERT_EQ(sink.commands.size(), 999u);
    EXPECT_EQ(sink.commands.back(), dumped(15, 1, 240, 999, 100));
}
