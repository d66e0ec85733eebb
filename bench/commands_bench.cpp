// From the stream's text to commands filed in the render table, and the key look-up by itself, beside what one would
// write first: substrings and stoi, a binary search over the records, the standard library's maps.
#include "bench/bench_display.h"
#include "bench/bench_report.h"
#include "engine/light_commands.h"
#include "link/frame_writer.h"
#include "link/payload_parser.h"
#include "tests/support/plain_parser.h"

#include <algorithm>
#include <cstdio>
#include <map>
#include <random>
#include <unordered_map>

namespace {

constexpr std::int32_t kCommands = 200'000;

// One wide record an entry, as a table without a key array has them.
struct WideRecord {
    std::int32_t key = 0;
    std::array<ZephRenderSlot, 17> slots{};
    ZephRenderLive live{};
    bool newCommand = false;
};

struct PlainSink : CommandSink {
    explicit PlainSink(const ZephRenderTables& tables) : records(tables.Keys.size() - 1) {
        for (std::size_t e = 0; e < records.size(); ++e)
            records[e].key = tables.Keys[e + 1];
    }
    void addLightCommands(std::span<const ZephChannelCommand> commands) override {
        for (const ZephChannelCommand& command : commands) {
            const ZephLightCommand& address = command.Command;
            const std::int32_t key =
                address.DeviceType * 100'000'000 + address.Network * 1'000'000 + address.Unit * 1'000 + address.Circuit;
            const auto found = std::lower_bound(records.begin(), records.end(), key,
                                                [](const WideRecord& r, std::int32_t k) { return r.key < k; });
            if (found == records.end() || found->key != key) continue;
            found->live.EffectType = static_cast<std::uint8_t>(address.EffectType);
            found->live.Duration = command.Timing.Duration;
            found->live.StartIntensity = static_cast<std::uint8_t>(command.Timing.StartIntensity);
            found->live.EndIntensity = static_cast<std::uint8_t>(command.Timing.EndIntensity);
            found->newCommand = true;
        }
    }
    std::int32_t virtualChannelKey(std::string_view) const override { return 0; }

    std::vector<WideRecord> records;
};

// Commands to keys of the table, in no order, in frames that fit a datagram.
std::string streamFor(const ZephRenderTables& tables) {
    std::mt19937 random(5);
    std::string stream;
    FrameWriter writer;
    for (std::int32_t i = 0; i < kCommands; ++i) {
        const std::int32_t key = tables.Keys[1 + random() % (tables.Keys.size() - 1)];
        writer.command({.EffectType = i % 3,
                        .Network = key / 1'000'000 % 100,
                        .DeviceType = key / 100'000'000,
                        .Unit = key / 1'000 % 1'000,
                        .Circuit = key % 1'000},
                       {.Duration = i * 13 % 5000, .StartIntensity = i % 101, .EndIntensity = 100 - i % 101});
        if (writer.payloadCount() == 48) stream += writer.takeFrame();
    }
    return stream + writer.takeFrame();
}

double plainWay(const std::string& stream, const ZephRenderTables& tables) {
    PlainSink sink(tables);
    PlainParser plain;
    return medianMicroseconds(5, [&] {
        for (std::size_t at = 0; at < stream.size();) {
            const std::size_t end = stream.find('\x04', at) + 1;
            plain.buffer = stream.substr(at, end - at);
            plain.process(sink);
            at = end;
        }
    });
}

double ourWay(const std::string& stream, BenchDisplay& display) {
    const SystemClock clock;
    RenderTableSink sink(display.tables, clock);
    ParserSetup setup;
    ZephSetUpPacketParms(setup.PacketParms);
    ChannelStream channels;
    return medianMicroseconds(
        31,
        [&] {
            channels.ZephStackBuffer.append(stream);
            // As a pass does: the next commands are new again.
            std::ranges::fill(display.tables.CommandState, kCommandActive);
            display.tables.NewEntryCount = 0;
        },
        [&] { ZephProcessPayloads(true, setup, sink, display.failures, channels); });
}

void lookUps(const ZephRenderTables& tables, BenchReport& report) {
    std::mt19937 random(6);
    std::vector<std::int32_t> probes(100'000);
    for (std::int32_t& probe : probes)
        probe = tables.Keys[1 + random() % (tables.Keys.size() - 1)];
    std::vector<std::int32_t> found(probes.size());
    const std::string group = "Look 100,000 keys up among " + std::to_string(tables.RenderDataCount);
    std::unordered_map<std::int32_t, std::int32_t> hashed;
    std::map<std::int32_t, std::int32_t> tree;
    for (std::size_t e = 1; e < tables.Keys.size(); ++e) {
        hashed[tables.Keys[e]] = tree[tables.Keys[e]] = static_cast<std::int32_t>(e);
    }
    const auto each = [&](auto&& look) {
        return medianMicroseconds(11, [&] {
            for (std::size_t i = 0; i < probes.size(); ++i)
                found[i] = look(probes[i]);
            keepResult(found.front());
        });
    };
    report.row(group, "std::lower_bound", each([&](std::int32_t key) {
                   return static_cast<std::int32_t>(std::lower_bound(tables.Keys.begin() + 1, tables.Keys.end(), key) -
                                                    tables.Keys.begin());
               }));
    report.row(group, "std::map", each([&](std::int32_t key) { return tree.find(key)->second; }));
    report.row(group, "std::unordered_map", each([&](std::int32_t key) { return hashed.find(key)->second; }));
    report.row(group, "search tree of cache lines", medianMicroseconds(11, [&] {
                   tables.Search.findMany(probes, found.data());
                   keepResult(found.front());
               }));
}

void measure(BenchDisplay& display, const char* goal, double millions, double timesPlain, BenchReport& report) {
    const std::string stream = streamFor(display.tables);
    const double plain = plainWay(stream, display.tables);
    const double ours = ourWay(stream, display);
    const std::string group =
        std::to_string(kCommands) + " commands to " + std::to_string(display.tables.RenderDataCount) + " keys";
    report.row(group, "substrings, stoi, lower_bound over records", plain);
    report.row(group, "text to filed command", ours);
    const double rate = kCommands / ours;
    char figure[96];
    std::snprintf(figure, sizeof figure, "%.1f million a second, %.1f x the plain way", rate, plain / ours);
    char wanted[96];
    if (timesPlain > 0) {
        std::snprintf(wanted, sizeof wanted, "at least %.0f million a second and %.0f x", millions, timesPlain);
    } else {
        std::snprintf(wanted, sizeof wanted, "at least %.0f million a second", millions);
    }
    report.goal(goal, figure, wanted, rate >= millions && plain / ours >= timesPlain);
    lookUps(display.tables, report);
}

}  // namespace

void benchCommands(BenchReport& report) {
    BenchDisplay few;
    const ZephSettings settings;
    few.simulation->FixtureCount = 125;
    for (int f = 1; f <= 125; ++f) {  // 125 x 16 = 2,000 keys
        ZephFixture& fixture = few.simulation->Fixtures[f];
        InitializeFixture(settings, fixture);
        fixture.ChannelCount = 16;
        for (int c = 1; c <= 16; ++c) {
            fixture.Channels[c].DeviceType = kDeviceQen;
            fixture.Channels[c].Controller = f;
            fixture.Channels[c].Channel = c;
        }
    }
    few.compile();
    measure(few, "commands", 40, 10, report);

    BenchDisplay many;
    buildRibbons(*many.simulation, kMaxFixtures);
    many.compile();
    measure(many, "commands-many", 20, 0, report);
}
