#include "link/payload_parser.h"
#include "tests/support/plain_parser.h"
#include "tests/support/recording_host.h"
#include "tests/support/recording_sink.h"
#include "util/random_source.h"

namespace {

const std::string kSoh = "\x01";
const std::string kEot = "\x04";

// One payload. By columns: cmd 00, sub 00, network 001, device type 00, unit 002, circuit 005, duration 0001.500 in
// hundredths of a second, start level 100, end level 000.
const std::string kOne = "0000001000020050001.500100000";
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

std::string digits(SeededRandom& random, std::int32_t low, std::int32_t high, std::size_t width) {
    return digits(static_cast<std::size_t>(ZephReturnRandomNumber(low, high, random)), width);
}

std::string randomPayload(SeededRandom& random) {
    const auto pick = [&](std::int32_t high) { return ZephReturnRandomNumber(0, high, random); };
    if (pick(15) == 0) return "99" + digits(random, 0, 99, 2);
    if (pick(15) == 0) {
        const std::int32_t count = pick(20);
        std::string dump = "0100" + digits(random, 0, 20, 3) + (pick(1) ? "07" : "01") + digits(random, 0, 250, 3) +
                           "0" + (count < 10 ? "0" : "") + std::to_string(count);
        for (std::int32_t i = 0; i < 2 * count; ++i)
            dump += "0123456789abcdefABCDEF"[pick(21)];
        return dump;
    }
    std::string duration = digits(random, 0, 99'999'999, 8);
    if (pick(3) > 0) duration[static_cast<std::size_t>(pick(1) ? 4 : pick(7))] = '.';
    const std::string levels = digits(random, 0, 260, 3) + digits(random, 0, 260, 3);
    const std::string head = "00" + digits(random, 0, pick(30) == 0 ? 5 : 3, 2);
    if (pick(9) > 0) {
        return head + digits(random, 0, 2, 3) + digits(random, 0, 2, 2) + digits(random, 0, 2, 3) +
               digits(random, 1, 999, 3) + duration + levels;
    }
    const std::string name = std::string(pick(1) ? "arch_" : "star_").substr(0, static_cast<std::size_t>(pick(5)));
    return head + "00000000" + "00" + std::to_string(name.size()) + duration + levels + name;
}

std::string randomFrame(SeededRandom& random) {
    std::string payloads;
    const std::int32_t count = ZephReturnRandomNumber(0, 150, random);
    for (std::int32_t i = 0; i < count; ++i)
        payloads += randomPayload(random);
    return frame(static_cast<std::size_t>(count), payloads);
}

// Damages the text as a bad line or a bad sender would: a byte changed to one that matters, dropped or doubled.
void mutate(SeededRandom& random, std::string& text) {
    constexpr std::string_view bytes("\x01\x04 .0123459/:+-aG\xFF\x00", 20);
    const auto at = static_cast<std::size_t>(ZephReturnRandomNumber(0, static_cast<int>(text.size()) - 1, random));
    const char byte = bytes[static_cast<std::size_t>(ZephReturnRandomNumber(0, 19, random))];
    // Most often changed, since the length then stays right and the payloads are read.
    const std::int32_t kind = ZephReturnRandomNumber(0, 7, random);
    if (kind != 1) text.erase(at, 1);
    if (kind != 0) text.insert(at, 1, byte);
}

struct Parser : testing::Test {
    using List = std::vector<int>;

    Parser() {
        ZephSetUpPacketParms(setup.PacketParms);
        sink.channels = {{"arch_1", 7}, {"b\xC3\xA4r", 8}};
    }
    // What comes of bytes that arrive before a tick.
    std::vector<ZephChannelCommand> commandsOf(const std::string& bytes, bool simulating = true) {
        stream.ZephStackBuffer.append(bytes);
        ZephProcessPayloads(simulating, setup, sink, failures, stream);
        return std::exchange(sink.commands, {});
    }
    List circuitsOf(const std::string& bytes) {
        List numbers;
        for (const ZephChannelCommand& command : commandsOf(bytes))
            numbers.push_back(command.Command.Circuit);
        return numbers;
    }
    std::string_view kept() const { return stream.ZephStackBuffer.view(); }

    ParserSetup setup;
    RecordingSink sink;
    CollectingFailures failures;
    ChannelStream stream;
};

}  // namespace

TEST_F(Parser, ReadsCommandsColumnByColumn) {
    EXPECT_EQ(commandsOf(frame(1, kOne)), std::vector{kOneCommand});
    EXPECT_EQ(kept(), "");
    EXPECT_EQ(stream.ZephPayloadSerial, 1u);
    // Of a named channel the circuit is the length of the name, which follows the levels.
    EXPECT_EQ(commandsOf(frame(3, "0000000000000060050.000000100ARCH_1"
                                  "0003001000020070000.000255128"
                                  "0001000000000030000.000100100b\xE4r")),
              (std::vector<ZephChannelCommand>{{{0, 0, 0, 0, 0, 7}, {500, 0, 100}},
                                               {{0, 3, 1, 0, 2, 7}, {0, 100, 50}},
                                               {{0, 1, 0, 0, 0, 8}, {0, 100, 100}}}));
}

TEST_F(Parser, ReadsRandomAndDamagedStreamsInEveryFormAsThePlainParserDoes) {
    PlainParser plain;
    RecordingSink plainSink;
    sink.channels = plainSink.channels = {{"arch_", 1}, {"arch", 2}, {"s", 3}, {"", 4}};
    for (const DecodeForm form : {DecodeForm::Plain, DecodeForm::Sse41}) {
        if (!hasDecodeForm(form)) continue;
        setup.decodeRun = decodeRunOf(form);
        SeededRandom random(17);
        std::size_t commands = 0;
        for (int round = 0; round < 2000; ++round) {
            std::string text = randomFrame(random) + randomFrame(random);
            for (int damage = ZephReturnRandomNumber(0, 3, random); damage > 0; --damage)
                mutate(random, text);
            plain.buffer += text;
            plain.process(plainSink);
            ASSERT_EQ(commandsOf(text), plainSink.commands) << text;
            ASSERT_EQ(kept(), plain.buffer);
            ASSERT_EQ(stream.ZephPayloadSerial, plain.serial);
            ASSERT_EQ(stream.LastTiming, plain.timing);
            commands += plainSink.commands.size();
            plainSink.commands.clear();
        }
        const auto bytes = [](const auto& stored) { return std::string(stored.begin(), stored.end()); };
        for (const auto& [universe, levels] : plain.dmxDumps)
            EXPECT_EQ(bytes(stream.Dumps.ZephDmxDumpTable.levels(universe)), levels);
        for (const auto& [at, levels] : plain.controllerDumps) {
            const std::int32_t slot = controllerSlot(at.first, at.second);
            EXPECT_EQ(bytes(stream.Dumps.ZephControllerDumpTable.levels(slot)), levels);
        }
        EXPECT_GT(commands, 50'000u);  // the damage must not have hidden the payloads
    }
}

TEST_F(Parser, FindsFramesHoweverTheyArrive) {
    const std::string text = frame(2, kOne + circuit(6)) + frame(1, circuit(7));
    for (std::size_t split = 0; split <= text.size(); ++split) {
        const std::size_t early = circuitsOf(text.substr(0, split)).size();
        EXPECT_EQ(early + circuitsOf(text.substr(split)).size(), 3u) << split;
    }
    EXPECT_EQ(circuitsOf("junk\x04more" + frame(1, kOne)), (List{5}));
    // An SOH that stands last behind junk is lost with it, so the frame that it began is junk as well.
    EXPECT_EQ(circuitsOf("junk" + kSoh), List{});
    EXPECT_EQ(kept(), "");
    EXPECT_EQ(circuitsOf(frame(1, kOne).substr(1) + frame(1, circuit(6))), (List{6}));
    // Without junk before it, it is the beginning of a frame.
    EXPECT_EQ(circuitsOf(kSoh), List{});
    EXPECT_EQ(circuitsOf(frame(1, kOne).substr(1)), (List{5}));
}

TEST_F(Parser, ABadFrameEndsTheCallAndTheNextFrameWaitsForTheNextOne) {
    const std::string one = circuit(1);
    const std::string two = circuit(2);
    const std::tuple<const char*, std::string, List> rows[] = {
        // Bad ones, and what of them is applied.
        {"length too large", kSoh + "001" + "0037" + kOne + kEot, {}},
        {"count above the payloads", frame(3, one + two), {1, 2}},
        {"name cut short", frame(2, one + "0000000000000060050.000000100arch_"), {1}},
        {"short dump", frame(2, one + "01000050700000"), {1}},
        // What is no fault lets the next frame, 9, follow at once.
        {"count 000", frame(0, ""), {9}},
        {"unknown name, its timing unread", frame(3, one + "000000000000006xxxxxxxxyyyzzzarch_2" + two), {1, 2, 9}},
        {"unknown cmd", frame(3, one + "02" + two.substr(2) + circuit(3)), {1, 9}},
    };
    for (const auto& [name, text, applied] : rows) {
        EXPECT_EQ(circuitsOf(text + frame(1, circuit(9))), applied) << name;
        const bool waits = applied.empty() || applied.back() != 9;
        EXPECT_EQ(kept(), waits ? frame(1, circuit(9)) : "") << name;
        EXPECT_EQ(circuitsOf(""), waits ? List{9} : List{}) << name;
    }
    EXPECT_TRUE(failures.reports.empty());
    EXPECT_FALSE(stream.Dumps.ZephDmxDumpPending);
}

TEST_F(Parser, AnUnknownSubDrivesTheChannelWithTheTimingBeforeUntilTheCountIsUsedUp) {
    const std::string bad = "0004" + circuit(8).substr(4);
    // Nothing came before: the timing is zero.
    EXPECT_EQ(commandsOf(frame(1, bad)), (std::vector<ZephChannelCommand>{{{0, 4, 1, 0, 2, 8}, {}}}));
    const ZephChannelCommand again{{0, 4, 1, 0, 2, 8}, kOneCommand.Timing};
    const ZephChannelCommand named{{0, 77, 0, 0, 0, 7}, kOneCommand.Timing};
    EXPECT_EQ(commandsOf(frame(1, kOne) + frame(3, bad + circuit(9) + circuit(10)) +
                         frame(2, "0077000000000060050.000000100arch_1" + circuit(9))),
              (std::vector{kOneCommand, again, again, again, named, named}));
    EXPECT_EQ(stream.ZephPayloadSerial, 7u);
}

TEST_F(Parser, ReadsTheColumnsThatTheTableNames) {
    // A variant of sub 01 with the levels before the duration.
    setup.PacketParms[packetIndex(0, 1)] = {30, 22, 9, 16, 3, 19, 3};
    EXPECT_EQ(commandsOf(frame(2, "00010010000200510005000001.500" + circuit(6))),
              (std::vector<ZephChannelCommand>{{{0, 1, 1, 0, 2, 5}, {15, 100, 50}},
                                               {{0, 0, 1, 0, 2, 6}, kOneCommand.Timing}}));
}

TEST_F(Parser, WithoutASimulationOrAWorkingSinkTheFrameIsLostAndNothingElse) {
    EXPECT_TRUE(commandsOf(frame(1, kOne), false).empty());
    EXPECT_EQ(kept(), "");
    struct FailingSink : CommandSink {
        void addLightCommands(std::span<const ZephChannelCommand>) override { throw Failure("sink"); }
        std::int32_t virtualChannelKey(std::string_view) const override { return 0; }
    } failing;
    stream.ZephStackBuffer.append(frame(1, kOne) + frame(1, circuit(6)));
    ZephProcessPayloads(true, setup, failing, failures, stream);
    EXPECT_EQ(circuitsOf(""), (List{6}));
    EXPECT_TRUE(failures.reports.empty());
}
