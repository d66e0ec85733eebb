// A small display and an engine around it, run on a clock set by hand, with a surface that records its calls.
#pragma once

#include "engine/light_commands.h"
#include "engine/render_cycle.h"
#include "model/document.h"
#include "tests/support/recording_host.h"

#include <deque>
#include <memory>

class ListRandom : public RandomSource {
public:
    double next() override {
        if (values.empty()) return otherwise;
        const double value = values.front();
        values.pop_front();
        return value;
    }
    std::deque<double> values;
    double otherwise = 0.0;
};

class RecordingSurface : public LightSurface {
public:
    struct Plain {
        ChannelDraw draw;
        std::vector<int> lit;  // of a flashing channel, a flag a bulb
    };
    struct Group {
        GroupDraw draw;
        std::array<std::int32_t, 3> levels;
        std::vector<int> bulbs;
    };

    void beginFrame() override {
        ++frames;
        plain.clear();
        groups.clear();
        order.clear();
    }
    void drawChannel(const ChannelDraw& draw) override {
        Plain call{draw, {}};
        if (draw.BulbLit) call.lit.assign(draw.BulbLit, draw.BulbLit + flashingBulbs);
        plain.push_back(call);
        order.push_back("c" + std::to_string(draw.Fixture));
    }
    void drawGroup(const GroupDraw& draw, ZephRGBData& group) override {
        Group call{draw, {group.Level[1], group.Level[2], group.Level[3]}, {}};
        if (draw.Bulbs) call.bulbs.assign(draw.Bulbs, draw.Bulbs + draw.BulbCount);
        groups.push_back(call);
        order.push_back("g" + std::to_string(draw.Fixture) + "." + std::to_string(draw.Triplet));
    }
    void endFrame() override {}

    int frames = 0;
    int flashingBulbs = 0;
    std::vector<Plain> plain;
    std::vector<Group> groups;
    std::vector<std::string> order;
};

struct EngineRig {
    static constexpr std::int32_t kStart = 100'000;

    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    std::unique_ptr<ZephFixtureStates> states = std::make_unique<ZephFixtureStates>();
    ZephSettings settings;
    ZephRenderTables tables;
    ZephDimmingCurve curve = [] {
        ZephDimmingCurve identity;
        for (std::size_t i = 0; i < identity.size(); ++i)
            identity[i] = static_cast<std::uint8_t>(i);
        return identity;
    }();
    ZephRenderClocks clocks = clocksAtEntry(kStart);
    ListRandom random;
    RecordingSurface surface;
    RecordingHost host;
    CollectingFailures failures;

    // A light string of one horizontal stroke, without channels. Levels and sizes as a new fixture has them.
    int addFixture(std::int32_t type, int points = 2) {
        const int f = ++simulation->FixtureCount;
        ZephFixture& fixture = simulation->Fixtures[f];
        InitializeFixture(settings, fixture);
        fixture.Fixture_Type = type;
        fixture.Name = "F" + std::to_string(f);
        fixture.PointCount = points;
        for (int p = 1; p <= points; ++p) {
            const std::int32_t kind = type != kFixtureStrings ? kPointBulb : p == 1 ? kPointMove : kPointLine;
            fixture.DrawPoints[p] = {kind, p * 15 * 30, f * 15 * 10};
        }
        return f;
    }

    // Adds a Qen channel on network 0.
    ZephChannel& addChannel(int fixture, std::int32_t unit, std::int32_t circuit) {
        ZephFixture& record = simulation->Fixtures[fixture];
        ZephChannel& channel = record.Channels[++record.ChannelCount];
        channel.DeviceType = kDeviceQen;
        channel.Controller = unit;
        channel.Channel = circuit;
        channel.Color = kWhite;
        return channel;
    }

    int addPlain(std::int32_t unit, std::int32_t circuit) {
        const int fixture = addFixture(kFixtureStrings);
        addChannel(fixture, unit, circuit);
        return fixture;
    }

    // An RGB light string on three circuits from the given one.
    int addRgb(std::int32_t unit, std::int32_t circuit) {
        const int fixture = addFixture(kFixtureStrings);
        simulation->Fixtures[fixture].Channel_Type = kChannelRgb;
        for (int c = 0; c < 3; ++c)
            addChannel(fixture, unit, circuit + c);
        return fixture;
    }

    // A main ribbon in Normal unit mode on network 0.
    int addRibbon(std::int32_t unit, int points = 50) {
        const int fixture = addFixture(kFixtureKesh, points);
        simulation->Fixtures[fixture].Channel_Type = kChannelRgb;
        simulation->Fixtures[fixture].Kesh.Base_Unit = unit;
        return fixture;
    }

    void build() { ZephBuildRenderTable({settings, host, failures, *simulation, *states, tables}); }

    RenderContext context() { return {*simulation, curve, tables, *states, clocks, random, surface, failures}; }

    void command(std::int32_t unit, std::int32_t circuit, std::int32_t start, std::int32_t end,
                 std::int32_t durationMs = 0, std::int32_t effect = 0, std::int32_t atMs = 0) {
        const ZephLightCommand address{0, effect, 0, kDeviceQen, unit, circuit};
        ZephAddLightCommand(address, {durationMs, start, end}, kStart + atMs, tables);
    }

    // One pass at t ms after the start; the shimmer clock advances as the supervisor would have it.
    void pass(std::int32_t atMs) {
        clocks.ShimmerClock += kStart + atMs - clocks.LastTick;
        clocks.LastTick = kStart + atMs;
        RenderContext run = context();
        ZephRenderLights(kStart + atMs, run);
    }

    std::vector<std::int32_t> intensities() const {
        std::vector<std::int32_t> list;
        for (const RecordingSurface::Plain& call : surface.plain)
            list.push_back(call.draw.Intensity);
        return list;
    }
};
