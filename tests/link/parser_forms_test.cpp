#include "link/payload_parser.h"
#include "tests/support/plain_parser.h"
#include "tests/support/recording_host.h"
#include "tests/support/recording_sink.h"
#include "util/random_source.h"

namespace {

std::string digits(std::size_t number, std::size_t width) {
    const std::string text = std::to_string(number);
    return std::string(width - text.size(), '0') + text;
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
    return "\x01" + digits(static_cast<std::size_t>(count), 3) + digits(payloads.size() + 7, 4) + payloads + "\x04";
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

}  // namespace

TEST(ParserForms, EveryFormReadsRandomAndDamagedStreamsAsThePlainParserDoes) {
    for (const DecodeForm form : {DecodeForm::Plain, DecodeForm::Sse41}) {
        if (!hasDecodeForm(form)) continue;
        SeededRandom random(17);
        CollectingFailures failures;
        ParserSetup setup{.decodeRun = decodeRunOf(form)};
        ZephSetUpPacketParms(setup.PacketParms);
        ChannelStream stream;
        PlainParser plain;
        RecordingSink sink;
        RecordingSink plainSink;
        sink.channels = plainSink.channels = {{"arch_", 1}, {"arch", 2}, {"s", 3}, {"", 4}};
        std::size_t commands = 0;
        for (int round = 0; round < 3000; ++round) {
            std::string text = randomFrame(random);
            for (int damage = ZephReturnRandomNumber(0, 3, random); damage > 0; --damage)
                mutate(random, text);
            stream.ZephStackBuffer.append(text);
            plain.buffer += text;
            ZephProcessPayloads(true, setup, sink, failures, stream);
            plain.process(plainSink);
            ASSERT_EQ(sink.commands, plainSink.commands) << text;
            ASSERT_EQ(stream.ZephStackBuffer.view(), plain.buffer);
            ASSERT_EQ(stream.ZephPayloadSerial, plain.serial);
            ASSERT_EQ(stream.LastTiming, plain.timing);
            commands += sink.commands.size();
            sink.commands.clear();
            plainSink.commands.clear();
        }
        const auto bytes = [](const auto& stored) { return std::string(stored.begin(), stored.end()); };
        const LevelDumps& dumps = stream.Dumps;
        for (const auto& [universe, levels] : plain.dmxDumps)
            EXPECT_EQ(bytes(dumps.ZephDmxDumpTable.levels(universe)), levels);
        for (const auto& [at, levels] : plain.controllerDumps)
            EXPECT_EQ(bytes(dumps.ZephControllerDumpTable.levels(controllerSlot(at.first, at.second))), levels);
        EXPECT_GT(commands, 50'000u);  // the damage must not have hidden the payloads
    }
}
