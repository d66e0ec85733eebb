// Reading the channel stream: the parser alone, in each of its forms, beside the plain way with substrings and
// std::stoi. The sink only counts, so that the engine's share is not in these figures.
#include "bench/bench_display.h"
#include "bench/bench_report.h"
#include "link/frame_writer.h"
#include "link/payload_parser.h"
#include "tests/support/plain_parser.h"
#include "util/failure.h"

#include <cstdio>
#include <string>

namespace {

constexpr std::size_t kCommands = 200'000;

struct CountingSink : CommandSink {
    void addLightCommands(std::span<const ZephChannelCommand> commands) override {
        count += commands.size();
        keepResult(commands.back());
    }
    std::int32_t virtualChannelKey(std::string_view) const override { return 0; }

    std::size_t count = 0;
};

// Chases and fades over 2,000 channels, in frames that fit a datagram.
std::string chases() {
    std::string stream;
    FrameWriter writer;
    for (std::int32_t i = 0; i < static_cast<std::int32_t>(kCommands); ++i) {
        const std::int32_t channel = i * 7 % 2000;
        writer.command({.EffectType = i % 4,
                        .Network = channel % 4,
                        .DeviceType = 1,
                        .Unit = 1 + channel / 4 % 25,
                        .Circuit = 1 + channel / 100},
                       {.Duration = i * 13 % 5000, .StartIntensity = i % 101, .EndIntensity = 100 - i % 101});
        if (writer.payloadCount() == 48) stream += writer.takeFrame();
    }
    return stream + writer.takeFrame();
}

}  // namespace

void benchParser(BenchReport& report) {
    const std::string stream = chases();
    const std::string group = "Parse " + std::to_string(kCommands) + " light commands";
    CountingSink sink;
    IgnoredFailures failures;
    PlainParser plain;
    // Frame by frame, as datagrams bring them: erasing the front of a long buffer would be unfair to the plain way.
    report.row(group, "substrings and std::stoi", medianMicroseconds(5, [&] {
                   for (std::size_t at = 0; at < stream.size();) {
                       const std::size_t end = stream.find('\x04', at) + 1;
                       plain.buffer = stream.substr(at, end - at);
                       plain.process(sink);
                       at = end;
                   }
               }));

    const struct {
        DecodeForm form;
        const char* name;
    } forms[] = {{DecodeForm::Plain, "parser, character by character"},
                 {DecodeForm::Sse41, "parser, two 16-byte loads"}};
    for (const auto& [form, name] : forms) {
        if (!hasDecodeForm(form)) continue;
        ParserSetup setup{.decodeRun = decodeRunOf(form)};
        ZephSetUpPacketParms(setup.PacketParms);
        ChannelStream channels;
        sink.count = 0;
        const double time = medianMicroseconds(
            31, [&] { channels.ZephStackBuffer.append(stream); },
            [&] { ZephProcessPayloads(true, setup, sink, failures, channels); });
        require(sink.count == 31 * kCommands, "the parser lost commands");
        report.row(group, name, time);
        if (form != fastestDecodeForm()) continue;
        char figure[64];
        const double nanoseconds = time * 1000 / kCommands;
        std::snprintf(figure, sizeof figure, "%.1f ns a command, parser alone", nanoseconds);
        report.goal("parser", figure, "under 12 ns", nanoseconds < 12);
    }
}
