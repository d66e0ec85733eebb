#include "link/payload_parser.h"
#include "tests/support/recording_host.h"
#include "tests/support/recording_sink.h"

#include <gtest/gtest.h>

namespace {

const std::string kSoh = "\x01";
const std::string kEot = "\x04";

// One payload: network 1, device type 0, unit 2, circuit 5.
const std::string kOne = "00"        // cmd: light command
                         "00"        // sub: plain
                         "001"       // network
                         "00"        // device type
                         "002"       // unit
                         "005"       // circuit
                         "0001.500"  // duration, hundredths of a second
                         "100"       // start level
                         "000";      // end level
const ZephChannelCommand kOneCommand{{0, 0, 1, 0, 2, 5}, {15, 100, 0}};

std::string digits(std::size_t number, std::size_t width) {
    const std::string text = std::to_string(number);
    return std::string(width - text.size(), '0') + text;
}

std::string frame(std::size_t count, const std::string& payloads) {
    return kSoh + digits(count, 3) + digits(payloads.size() + 7, 4) + payloads + kEot;
}

// A circuit's payload, told apart by the circuit's number.
std::string circuit(std::size_t number) {
    return kOne.substr(0, 12) + digits(number, 3) + kOne.substr(15);
}

class Parser : public testing::Test {
protected:
    Parser() {
        ZephSetUpPacketParms(setup.PacketParms);
        sink.channels = {{"arch_1", 7}, {"b\xC3\xA4r", 8}};
    }

    void feed(const std::string& bytes) { stream.ZephStackBuffer.append(bytes); }
    void tick(bool simulating = true) { ZephProcessPayloads(simulating, setup, sink, failures, stream); }

    // The circuits commanded by what was fed since the last call.
    std::vector<int> circuits() {
        std::vector<int> numbers;
        for (const ZephChannelCommand& command : sink.commands)
            numbers.push_back(command.Command.Circuit);
        sink.commands.clear();
        return numbers;
    }
    std::vector<int> circuitsOf(const std::string& bytes) {
        feed(bytes);
        tick();
        return circuits();
    }

    using List = std::vector<int>;
    ParserSetup setup;
    RecordingSink sink;
    CollectingFailures failures;
    ChannelStream stream;
};

}  // namespace

TEST_F(Parser, ReadsACommandColumnByColumn) {
    feed(frame(1, kOne));
    tick();
    EXPECT_EQ(sink.commands, std::vector{kOneCommand});
    EXPECT_TRUE(stream.ZephStackBuffer.empty());
    EXPECT_EQ(stream.ZephPayloadSerial, 1u);
}

TEST_F(Parser, ReadsVirtualChannelsByNameInAnyCaseAndScalesSub03) {
    feed(frame(3, "00"
                  "00"
                  "000"
                  "00"
                  "000"
                  "006"  // length of the key
                  "0050.000"
                  "000"
                  "100"
                  "ARCH_1"
                  "0003001000020070000.000255128"
                  "0001000000000030000.000100100b\xE4r"));
    tick();
    EXPECT_EQ(sink.commands, (std::vector<ZephChannelCommand>{{{0, 0, 0, 0, 0, 7}, {500, 0, 100}},
                                                              {{0, 3, 1, 0, 2, 7}, {0, 100, 50}},
                                                              {{0, 1, 0, 0, 0, 8}, {0, 100, 100}}}));
}

TEST_F(Parser, AFrameSplitAnywhereGivesTheSameCommands) {
    const std::string text = frame(2, kOne + circuit(6)) + frame(1, circuit(7));
    for (std::size_t split = 0; split <= text.size(); ++split) {
        feed(text.substr(0, split));
        tick();
        feed(text.substr(split));
        tick();
        EXPECT_EQ(circuits(), (List{5, 6, 7})) << split;
    }
}

TEST_F(Parser, WorksOffEveryWholeFrameAndKeepsTheHalfOne) {
    const std::string half = frame(1, circuit(3)).substr(0, 20);
    EXPECT_EQ(circuitsOf(frame(1, circuit(1)) + frame(1, circuit(2)) + half), (List{1, 2}));
    EXPECT_EQ(stream.ZephStackBuffer.view(), half);
    EXPECT_EQ(circuitsOf(frame(1, circuit(3)).substr(20)), (List{3}));
}

TEST_F(Parser, SkipsJunkToTheNextFrame) {
    EXPECT_EQ(circuitsOf("junk\x04more" + frame(1, kOne)), (List{5}));
    EXPECT_EQ(circuitsOf("junk only"), List{});
    EXPECT_TRUE(stream.ZephStackBuffer.empty());
    // An SOH that stands last behind junk is lost with it, so the frame that it began is junk as well.
    EXPECT_EQ(circuitsOf("junk" + kSoh), List{});
    EXPECT_TRUE(stream.ZephStackBuffer.empty());
    EXPECT_EQ(circuitsOf(frame(1, kOne).substr(1) + frame(1, circuit(6))), (List{6}));
    // Without junk before it, it is the beginning of a frame.
    EXPECT_EQ(circuitsOf(kSoh), List{});
    EXPECT_EQ(circuitsOf(frame(1, kOne).substr(1)), (List{5}));
}

TEST_F(Parser, ABadFrameEndsTheCallAndTheNextFrameWaitsForTheNextOne) {
    const struct {
        const char* name;
        std::string text;
        List applied;  // of the bad frame itself
    } rows[] = {
        {"empty", kSoh + kEot, {}},
        {"six characters", kSoh + "000000" + kEot, {}},
        {"length too small", kSoh + "001" + "0035" + kOne + kEot, {}},
        {"length too large", kSoh + "001" + "0037" + kOne + kEot, {}},
        {"count no number", kSoh + "0x1" + "0036" + kOne + kEot, {}},
        {"length with a sign", kSoh + "001" + "+036" + kOne + kEot, {}},
        {"count above the payloads", frame(3, circuit(1) + circuit(2)), {1, 2}},
        {"three characters left", frame(2, circuit(1) + "000"), {1}},
        {"short address", frame(2, circuit(1) + circuit(2).substr(0, 14)), {1}},
        {"short levels", frame(2, circuit(1) + circuit(2).substr(0, 28)), {1}},
        {"cmd no number", frame(3, circuit(1) + "x0" + circuit(2).substr(2) + circuit(3)), {1}},
        {"sub no number", frame(3, circuit(1) + "99 0" + circuit(3)), {1}},
        {"network with a blank", frame(2, "0000 01" + circuit(1).substr(7) + circuit(2)), {}},
        {"duration with two points", frame(2, circuit(1).substr(0, 15) + "00.1.000" + "100000" + circuit(2)), {}},
        {"duration with a comma", frame(2, circuit(1).substr(0, 15) + "0001,500" + "100000" + circuit(2)), {}},
        {"level with a point", frame(2, circuit(1).substr(0, 23) + "1.0000" + circuit(2)), {}},
        {"name cut short", frame(2, circuit(1) + "0000000000000060050.000000100arch_"), {1}},
        {"nothing behind a named payload", frame(2, circuit(1) + "0000000000000000050.000000100"), {1}},
        {"short dump", frame(2, circuit(1) + "01000050700000"), {1}},
        {"dump with a bad digit", frame(3, circuit(1) + "010000507000002FF0G" + circuit(2)), {1}},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(circuitsOf(row.text + frame(1, circuit(9))), row.applied) << row.name;
        EXPECT_EQ(stream.ZephStackBuffer.view(), frame(1, circuit(9))) << row.name;
        EXPECT_EQ(circuitsOf(""), (List{9})) << row.name;
    }
    EXPECT_TRUE(failures.reports.empty());
    EXPECT_FALSE(stream.Dumps.ZephDmxDumpPending);
}

TEST_F(Parser, WhatIsNoFaultDoesNotEndTheCall) {
    const std::string unknownName = "0000000000000060050.000000100arch_2";
    const struct {
        const char* name;
        std::string text;
        List applied;
    } rows[] = {
        {"count 000", frame(0, ""), {}},
        {"count 000 with payloads", frame(0, kOne), {}},
        {"more payloads than counted", frame(1, circuit(1) + circuit(2)), {1}},
        {"no operation between", frame(3, circuit(1) + "9900" + circuit(2)), {1, 2}},
        {"unknown name", frame(3, circuit(1) + unknownName + circuit(2)), {1, 2}},
        {"unknown name with an unreadable timing",
         frame(3, circuit(1) + "000000000000006xxxxxxxxyyyzzzarch_2" + circuit(2)),
         {1, 2}},
        {"unknown cmd", frame(3, circuit(1) + "02" + circuit(2).substr(2) + circuit(3)), {1}},
        {"dump of another device type", frame(2, "010000502000002zzzz" + circuit(2)), {2}},
        {"universe 0", frame(2, "010000007000001FF" + circuit(2)), {2}},
        {"network 16", frame(2, "010001601001001FF" + circuit(2)), {2}},
        {"unit 0", frame(2, "010000001000001FF" + circuit(2)), {2}},
        {"unit 241", frame(2, "010000001241001FF" + circuit(2)), {2}},
    };
    for (const auto& row : rows) {
        List expected = row.applied;
        expected.push_back(9);
        EXPECT_EQ(circuitsOf(row.text + frame(1, circuit(9))), expected) << row.name;
    }
    EXPECT_FALSE(stream.Dumps.ZephDmxDumpPending || stream.Dumps.ZephControllerDumpPending);
}

TEST_F(Parser, AnUnknownSubDrivesTheChannelWithTheTimingBeforeUntilTheCountIsUsedUp) {
    const std::string bad = "0004" + circuit(8).substr(4);
    feed(frame(1, bad));  // nothing came before: the timing is zero
    tick();
    EXPECT_EQ(sink.commands, (std::vector<ZephChannelCommand>{{{0, 4, 1, 0, 2, 8}, {}}}));
    sink.commands.clear();
    feed(frame(1, kOne));
    feed(frame(3, bad + circuit(9) + circuit(10)));
    feed(frame(2, "0077"
                  "00000000"
                  "006"
                  "0050.000000100arch_1" +
                      circuit(9)));
    tick();
    const ZephLightTiming before = kOneCommand.Timing;
    EXPECT_EQ(sink.commands, (std::vector<ZephChannelCommand>{kOneCommand,
                                                              {{0, 4, 1, 0, 2, 8}, before},
                                                              {{0, 4, 1, 0, 2, 8}, before},
                                                              {{0, 4, 1, 0, 2, 8}, before},
                                                              {{0, 77, 0, 0, 0, 7}, before},
                                                              {{0, 77, 0, 0, 0, 7}, before}}));
    EXPECT_EQ(stream.ZephPayloadSerial, 7u);
}

TEST_F(Parser, ConvertsDurationsAndLevelsExactly) {
    const struct {
        const char* duration;
        std::int32_t ms;
    } durations[] = {{"0001.500", 15}, {"00000000", 0},        {"0000.000", 0},         {"00000.05", 0},
                     {"00000.15", 2},  {"00000.25", 2},        {"0000.251", 3},         {"0000.249", 2},
                     {".1234567", 1},  {"1234567.", 12345670}, {"99999999", 999999990}, {"9999.999", 100000}};
    for (const auto& row : durations) {
        feed(frame(1, kOne.substr(0, 15) + row.duration + "100000"));
        tick();
        ASSERT_EQ(sink.commands.size(), 1u) << row.duration;
        EXPECT_EQ(sink.commands[0].Timing.Duration, row.ms) << row.duration;
        sink.commands.clear();
    }
    const struct {
        const char* sub;
        const char* level;
        std::int32_t intensity;
    } levels[] = {{"00", "100", 100}, {"00", "101", 100}, {"02", "999", 100}, {"03", "255", 100},
                  {"03", "256", 100}, {"03", "999", 100}, {"03", "128", 50},  {"03", "001", 0},
                  {"03", "002", 1},   {"03", "254", 100}, {"03", "253", 99},  {"01", "050", 50}};
    for (const auto& row : levels) {
        feed(frame(1, std::string("00") + row.sub + kOne.substr(4, 19) + row.level + "000"));
        tick();
        ASSERT_EQ(sink.commands.size(), 1u);
        EXPECT_EQ(sink.commands[0].Timing.StartIntensity, row.intensity) << row.sub << " " << row.level;
        sink.commands.clear();
    }
}

TEST_F(Parser, ReadsTheColumnsThatTheTableNames) {
    // A variant of sub 01 with the levels before the duration.
    setup.PacketParms[packetIndex(0, 1)] = {30, 22, 9, 16, 3, 19, 3};
    feed(frame(2, "000100100002005"
                  "100"
                  "050"
                  "00001.500" +
                      circuit(6)));
    tick();
    EXPECT_EQ(sink.commands, (std::vector<ZephChannelCommand>{{{0, 1, 1, 0, 2, 5}, {15, 100, 50}},
                                                              {{0, 0, 1, 0, 2, 6}, kOneCommand.Timing}}));
}

TEST_F(Parser, OutsideSimulationNothingReachesIt) {
    feed(frame(1, kOne));
    tick(false);
    EXPECT_TRUE(stream.ZephStackBuffer.empty());
    tick();
    EXPECT_TRUE(sink.commands.empty());
}

TEST_F(Parser, AFaultOfTheSinkCostsTheFrameOnly) {
    struct FailingSink : CommandSink {
        void addLightCommands(std::span<const ZephChannelCommand>) override { throw Failure("sink"); }
        std::int32_t virtualChannelKey(std::string_view) const override { return 0; }
    } failing;
    feed(frame(1, kOne) + frame(1, circuit(6)));
    ZephProcessPayloads(true, setup, failing, failures, stream);
    tick();
    EXPECT_EQ(circuits(), (List{6}));
    EXPECT_TRUE(failures.reports.empty());
}

TEST_F(Parser, AHugeBufferIsWorkedOffWithoutLosingAFrame) {
    std::string piece;
    for (std::size_t i = 1; i <= 999; ++i)
        piece += frame(1, circuit(i));
    for (int round = 0; round < 20; ++round) {
        const std::size_t cut = static_cast<std::size_t>(round) * 731 + 1;
        feed(piece.substr(0, cut));
        tick();
        feed(piece.substr(cut));
        const std::vector<int> numbers = circuitsOf("");
        ASSERT_EQ(numbers.size(), 999u) << round;
        EXPECT_EQ(numbers.back(), 999);
    }
    EXPECT_TRUE(stream.ZephStackBuffer.empty());
}
