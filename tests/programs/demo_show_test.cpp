#include "link/payload_parser.h"
#include "programs/tool/demo_show.h"
#include "tests/support/engine_rig.h"
#include "util/text.h"

#include <set>

namespace {

// Takes the commands of a show off the wire and notes which keys they meet.
struct KeySink : CommandSink {
    explicit KeySink(const ZephRenderTables& known) : tables(known) {}
    void addLightCommands(std::span<const ZephChannelCommand> commands) override {
        for (const ZephChannelCommand& command : commands) {
            keys.insert(BuildCmdKey(command.Command.DeviceType, command.Command.Network, command.Command.Unit,
                                    command.Command.Circuit));
            effects.insert(command.Command.CommandType == 1 ? 100 : command.Command.EffectType);
        }
    }
    std::int32_t virtualChannelKey(std::string_view latin1Name) const override {
        return ZephReturnVirtualChannelKey(utf8FromLatin1(latin1Name), tables);
    }
    std::set<std::int32_t> keys;
    std::set<std::int32_t> effects;  // subtypes, 100 for a level dump
    const ZephRenderTables& tables;
};

struct Show {
    explicit Show(EngineRig& rig, std::int32_t lengthMs) {
        rig.build();
        cast = gatherShowCast(*rig.simulation, rig.tables, *rig.states);
        pieces = ZephMakeDemoShow(cast, lengthMs);
    }

    // Reads the pieces up to a time through the parser, with the dumps carried out after each.
    void playUntil(std::int32_t ms, CommandSink& sink, FailureReport& failures) {
        ParserSetup setup;
        ZephSetUpPacketParms(setup.PacketParms);
        for (; next < pieces.size() && pieces[next].timeMs <= ms; ++next) {
            stream.ZephStackBuffer.append(pieces[next].bytes);
            ZephProcessPayloads(true, setup, sink, failures, stream);
            ZephProcessDmxStreams(sink, failures, stream.Dumps);
            ZephProcessKeshStreams(sink, failures, stream.Dumps);
        }
    }

    ShowCast cast;
    std::vector<CapturePiece> pieces;
    std::size_t next = 0;
    ChannelStream stream;
};

void addNamed(EngineRig& rig, const char* name) {
    ZephChannel& channel = rig.addPlain(0, 0).Channels[1];
    channel.DeviceType = kDeviceNone;
    channel.Name = name;
}

// One of each way in which a channel can be addressed.
void addOfEverything(EngineRig& rig) {
    rig.addPlain(1, 1);
    rig.addRgb(1, 2);
    rig.addRibbon(20);
    ZephFixture& legacy = rig.addRibbon(40, 12);
    legacy.Kesh.Unit_Mode = legacy.Kesh.Channel_Mode = 1;
    legacy.ZOrder = 7;
    rig.addPixels(999, 30);
    for (const char* name : {"Stern", "Gl\xC3\xBChbirne", "a"})  // u umlaut: one byte on the wire
        addNamed(rig, name);
    for (const std::int32_t device : {2, 3, 4, 5, kDeviceDmx}) {
        ZephChannel& channel = rig.addPlain(7, 9).Channels[1];
        channel.DeviceType = device;
        channel.Network = device == kDeviceDmx ? 3 : 0;
    }
    rig.addPlain(250, 200);  // beyond what a controller dump reaches
}

}  // namespace

TEST(DemoShow, AddressesEveryChannelByEveryKindOfCommandInFramesThatFitADatagram) {
    for (const auto& [lengthMs, crowd] : {std::pair{kShortestShowMs, 0}, {kDefaultShowMs, 0}, {6'000, 80}}) {
        EngineRig rig;
        addOfEverything(rig);
        for (int unit = 60; unit < 60 + crowd; ++unit)
            rig.addRibbon(unit);
        if (crowd > 0) {
            rig.addPlain(1, 2).Channels[1].DeviceType = kDeviceClearedInFile;
            addNamed(rig, "\xE2\x98\x85");  // a star: no byte of the wire stands for it
        }
        Show show(rig, lengthMs);
        EXPECT_EQ(show.cast.unreachable.size(), crowd > 0 ? 2U : 0U);
        std::int32_t lastMs = 0;
        for (const CapturePiece& piece : show.pieces) {
            ASSERT_LE(piece.bytes.size(), 1'400U);
            ASSERT_GE(piece.timeMs, std::exchange(lastMs, piece.timeMs));
        }
        EXPECT_LE(lastMs, lengthMs);
        KeySink sink(rig.tables);
        show.playUntil(lengthMs, sink, rig.failures);
        EXPECT_EQ(sink.keys.size(), show.cast.channels.size());
        const auto met = [&](const ZephRenderData& entry) { return sink.keys.contains(entry.Key); };
        EXPECT_TRUE(crowd > 0 || std::all_of(rig.tables.RenderData.begin() + 1, rig.tables.RenderData.end(), met));
        EXPECT_EQ(sink.effects, (std::set<std::int32_t>{0, 1, 2, 3, 100}));
        EXPECT_EQ(show.stream.ZephStackBuffer.size(), 0U);
        EXPECT_TRUE(rig.failures.reports.empty());
    }
}

// So that a loop joins well; and a ribbon that an effect let go must have come back before.
TEST(DemoShow, EndsInTheDarkWithRibbonsThatTakeOrders) {
    EngineRig rig;
    addOfEverything(rig);
    Show show(rig, 20'000);
    ManualClock clock(EngineRig::kStart);
    RenderTableSink engine(rig.tables, clock);
    std::ptrdiff_t brightest = 0;
    const auto lit = [&] {
        return std::ranges::count_if(rig.surface.plain, [](const ChannelDraw& draw) { return draw.Intensity > 0; }) +
               std::ranges::count_if(rig.surface.groups, [](const auto& group) { return group.draw.Alpha > 0; });
    };
    for (std::int32_t t = 9; t <= 20'000; t += 9) {
        clock.set(EngineRig::kStart + t);
        show.playUntil(t, engine, rig.failures);
        rig.pass(t);
        brightest = std::max(brightest, lit());
    }
    EXPECT_GT(brightest, 100);
    EXPECT_EQ(lit(), 0);
    for (const ZephRGBData& group : rig.tables.RGBData)
        EXPECT_THAT(group.Mode, testing::Not(testing::Contains(4))) << group.Key;
}
