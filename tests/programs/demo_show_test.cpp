#include "link/payload_parser.h"
#include "programs/tool/demo_show.h"
#include "tests/support/engine_rig.h"
#include "util/text.h"

#include <set>

namespace {

// Takes the commands of a show off the wire and notes which keys they meet.
class KeySink : public CommandSink {
public:
    explicit KeySink(const ZephRenderTables& tables) : tables_(tables) {}
    void addLightCommands(std::span<const ZephChannelCommand> commands) override {
        for (const ZephChannelCommand& command : commands) {
            keys.insert(BuildCmdKey(command.Command.DeviceType, command.Command.Network, command.Command.Unit,
                                    command.Command.Circuit));
            effects.insert(command.Command.CommandType == 1 ? 100 : command.Command.EffectType);
        }
    }
    std::int32_t virtualChannelKey(std::string_view latin1Name) const override {
        return ZephReturnVirtualChannelKey(utf8FromLatin1(latin1Name), tables_);
    }
    std::set<std::int32_t> keys;
    std::set<std::int32_t> effects;  // subtypes, 100 for a level dump

private:
    const ZephRenderTables& tables_;
};

struct Show {
    explicit Show(EngineRig& rig, std::int32_t lengthMs) {
        rig.build();
        cast = gatherShowCast(*rig.simulation, rig.tables, *rig.states);
        pieces = ZephMakeDemoShow(cast, lengthMs);
    }

    // Reads every piece through the parser, with the dumps carried out after each.
    void play(CommandSink& sink, FailureReport& failures) {
        ChannelStream stream;
        ParserSetup setup;
        ZephSetUpPacketParms(setup.PacketParms);
        for (const CapturePiece& piece : pieces) {
            stream.ZephStackBuffer.append(piece.bytes);
            ZephProcessPayloads(true, setup, sink, failures, stream);
            ZephProcessDmxStreams(sink, failures, stream.Dumps);
            ZephProcessKeshStreams(sink, failures, stream.Dumps);
        }
        leftOver = stream.ZephStackBuffer.size();
    }

    ShowCast cast;
    std::vector<CapturePiece> pieces;
    std::size_t leftOver = 0;
};

// One of each way in which a channel can be addressed.
void addOfEverything(EngineRig& rig) {
    rig.addPlain(1, 1);
    rig.addRgb(1, 2);
    rig.addRibbon(20);
    const int legacy = rig.addRibbon(40, 12);
    rig.simulation->Fixtures[legacy].Kesh.Unit_Mode = 1;
    rig.simulation->Fixtures[legacy].Kesh.Channel_Mode = 1;
    rig.simulation->Fixtures[legacy].ZOrder = 7;
    const int run = rig.addFixture(kFixtureDmxPixels, 30);
    rig.simulation->Fixtures[run].Channel_Type = kChannelRgb;
    rig.simulation->Fixtures[run].DMX.Universe = 999;
    for (const char* name : {"Stern", "Gl\xC3\xBChbirne", "a"}) {  // u umlaut: one byte on the wire
        ZephChannel& channel = rig.addChannel(rig.addFixture(kFixtureBulbs, 1), 0, 0);
        channel.DeviceType = kDeviceNone;
        channel.Name = name;
    }
    for (const std::int32_t device : {2, 3, 4, 5, kDeviceDmx}) {
        ZephChannel& channel = rig.addChannel(rig.addFixture(kFixtureBulbs, 3), 7, 9);
        channel.DeviceType = device;
        channel.Network = device == kDeviceDmx ? 3 : 0;
    }
    rig.addChannel(rig.addFixture(kFixtureFlood, 1), 250, 200);  // beyond what a controller dump reaches
}

}  // namespace

TEST(DemoShow, AddressesEveryChannelAndUsesEveryKindOfCommand) {
    for (const std::int32_t lengthMs : {kShortestShowMs, kDefaultShowMs}) {
        EngineRig rig;
        addOfEverything(rig);
        Show show(rig, lengthMs);
        KeySink sink(rig.tables);
        show.play(sink, rig.failures);
        EXPECT_TRUE(show.cast.unreachable.empty());
        for (std::size_t entry = 1; entry < rig.tables.RenderData.size(); ++entry) {
            EXPECT_TRUE(sink.keys.contains(rig.tables.RenderData[entry].Key)) << rig.tables.RenderData[entry].Key;
        }
        EXPECT_EQ(sink.effects, (std::set<std::int32_t>{0, 1, 2, 3, 100}));
        EXPECT_EQ(show.leftOver, 0U);
        EXPECT_TRUE(rig.failures.reports.empty());
    }
}

TEST(DemoShow, LeavesOutWhatNoCommandCanAddress) {
    EngineRig rig;
    rig.addPlain(1, 1);
    rig.addChannel(rig.addFixture(kFixtureBulbs, 1), 1, 2).DeviceType = kDeviceClearedInFile;
    ZephChannel& foreign = rig.addChannel(rig.addFixture(kFixtureBulbs, 1), 0, 0);
    foreign.DeviceType = kDeviceNone;
    foreign.Name = "\xE2\x98\x85";  // a star: no byte of the wire stands for it
    Show show(rig, kShortestShowMs);
    EXPECT_EQ(show.cast.channels.size(), 1U);
    EXPECT_EQ(show.cast.unreachable.size(), 2U);
    KeySink sink(rig.tables);
    show.play(sink, rig.failures);
    EXPECT_EQ(sink.keys.size(), 1U);
}

TEST(DemoShow, SendsFramesThatFitADatagramInOrderOfTime) {
    EngineRig rig;
    addOfEverything(rig);
    for (int unit = 60; unit < 140; ++unit)  // enough to crowd the wire
        rig.addRibbon(unit);
    Show show(rig, 6'000);
    std::int32_t lastMs = 0;
    for (const CapturePiece& piece : show.pieces) {
        ASSERT_LE(piece.bytes.size(), 1'400U);
        ASSERT_GE(piece.timeMs, lastMs);
        lastMs = piece.timeMs;
    }
    EXPECT_LE(lastMs, 6'000);
    KeySink sink(rig.tables);
    show.play(sink, rig.failures);
    EXPECT_EQ(sink.keys.size(), show.cast.channels.size());
}

TEST(DemoShow, IsTheSameEachTime) {
    EngineRig first;
    EngineRig second;
    addOfEverything(first);
    addOfEverything(second);
    EXPECT_EQ(Show(first, 8'000).pieces, Show(second, 8'000).pieces);
}

// So that a loop joins well; and a ribbon that an effect let go must have come back before.
TEST(DemoShow, EndsInTheDarkWithRibbonsThatTakeOrders) {
    EngineRig rig;
    addOfEverything(rig);
    Show show(rig, 20'000);
    ManualClock clock(EngineRig::kStart);
    RenderTableSink engine(rig.tables, clock);
    ChannelStream stream;
    ParserSetup setup;
    ZephSetUpPacketParms(setup.PacketParms);
    std::size_t next = 0;
    std::size_t brightest = 0;
    const auto lit = [&] {
        std::size_t count = 0;
        for (const auto& call : rig.surface.plain)
            count += call.draw.Intensity > 0 ? 1 : 0;
        for (const auto& call : rig.surface.groups)
            count += call.draw.Alpha > 0 ? 1 : 0;
        return count;
    };
    for (std::int32_t t = 9; t <= 20'000; t += 9) {
        clock.set(EngineRig::kStart + t);
        while (next < show.pieces.size() && show.pieces[next].timeMs <= t) {
            stream.ZephStackBuffer.append(show.pieces[next++].bytes);
        }
        ZephProcessPayloads(true, setup, engine, rig.failures, stream);
        ZephProcessDmxStreams(engine, rig.failures, stream.Dumps);
        ZephProcessKeshStreams(engine, rig.failures, stream.Dumps);
        rig.pass(t);
        brightest = std::max(brightest, lit());
    }
    EXPECT_GT(brightest, 100U);
    EXPECT_EQ(lit(), 0U);
    for (std::size_t group = 1; group < rig.tables.RGBData.size(); ++group) {
        for (int colour = 1; colour <= 3; ++colour) {
            EXPECT_NE(rig.tables.RGBData[group].Mode[static_cast<std::size_t>(colour)], 4)
                << rig.tables.RGBData[group].Key;
        }
    }
}
