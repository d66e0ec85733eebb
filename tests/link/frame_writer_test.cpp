#include "link/frame_writer.h"
#include "util/failure.h"

namespace {

// The text between SOH and EOT as a frame.
std::string framed(std::string_view body) {
    return "\x01" + std::string(body) + "\x04";
}

}  // namespace

TEST(FrameWriter, WritesWhatTheParserReads) {
    FrameWriter writer;
    writer.namedCommand(0, "arch_1", {.Duration = 500, .EndIntensity = 100});
    writer.command({.EffectType = 3, .Network = 1, .Unit = 2, .Circuit = 7},
                   {.StartIntensity = 255, .EndIntensity = 128});
    EXPECT_EQ(writer.takeFrame(), framed("0020071"
                                         "0000000000000060050.000000100arch_1"
                                         "0003001000020070000.000255128"));
    const std::uint8_t levels[] = {0xFF, 0x80, 0x00};
    writer.dmxDump(5, levels);
    writer.controllerDump(15, 240, levels);
    writer.noOperation();
    EXPECT_EQ(writer.takeFrame(), framed("0030053"
                                         "010000507000003FF8000"
                                         "010001501240003FF8000"
                                         "9900"));
    EXPECT_EQ(writer.takeFrame(), framed("0000007"));
    // Longer durations have fewer places.
    const std::pair<std::int32_t, const char*> durations[] = {
        {1, "0000.100"}, {99'999, "9999.900"}, {100'000, "010000.0"}, {9'999'999, "999999.9"}};
    for (const auto& [ms, text] : durations) {
        writer.command({.Network = 1}, {.Duration = ms});
        EXPECT_EQ(writer.takeFrame().substr(23, 8), text) << ms;
    }
}

TEST(FrameWriter, RefusesWhatDoesNotFitAndKeepsTheFrame) {
    static const std::uint8_t levels[1000] = {};
    void (*const refused[])(FrameWriter&) = {
        [](FrameWriter& writer) { writer.command({}, {}); },
        [](FrameWriter& writer) { writer.command({.EffectType = 4, .Network = 1}, {}); },
        [](FrameWriter& writer) { writer.command({.Network = 1000}, {}); },
        [](FrameWriter& writer) { writer.command({.EffectType = 3, .Network = 1}, {.EndIntensity = 256}); },
        [](FrameWriter& writer) { writer.command({.Network = 1}, {.Duration = 10'000'000}); },
        [](FrameWriter& writer) { writer.namedCommand(0, "a\x04", {}); },
        [](FrameWriter& writer) { writer.dmxDump(1, levels); },
        [](FrameWriter& writer) { writer.controllerDump(0, 241, {}); },
    };
    FrameWriter writer;
    writer.noOperation();
    for (const auto& each : refused)
        EXPECT_THROW(each(writer), Failure) << &each - refused;
    EXPECT_EQ(writer.takeFrame(), framed("00100119900"));

    // A frame over the limits only when it is taken.
    for (int i = 0; i < 1000; ++i)
        writer.noOperation();
    EXPECT_THROW(writer.takeFrame(), Failure);
    EXPECT_EQ(writer.payloadCount(), 1000);
    FrameWriter dumps;
    for (const std::size_t count : {999U, 999U, 999U, 999U, 963U})  // 4 x 2013 + 1941 + 7 = 10000
        dumps.dmxDump(1, std::span(levels).first(count));
    EXPECT_THROW(dumps.takeFrame(), Failure);
}
