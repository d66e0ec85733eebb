// A display with an engine around it, run on a clock set by hand, with a surface that records its calls.
#pragma once

#include "engine/light_commands.h"
#include "engine/render_cycle.h"
#include "tests/support/compiled_display.h"

#include <deque>

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

// Keeps the calls of the last frame, and their order as text: "3=60" is a channel of fixture 3 at that intensity,
// "3.7=128" its group 7 at that opacity.
class RecordingSurface : public LightSurface {
public:
    struct Group {
        GroupDraw draw;
        std::array<std::int32_t, 3> levels;
        std::vector<int> bulbs;
    };

    void beginFrame() override {
        plain.clear();
        lit.clear();
        groups.clear();
        text.clear();
    }
    void drawChannel(const ChannelDraw& draw) override {
        plain.push_back(draw);
        if (draw.BulbLit) lit.assign(draw.BulbLit, draw.BulbLit + flashingBulbs);
        note(std::to_string(draw.Fixture), draw.Intensity);
    }
    void drawGroup(const GroupDraw& draw, ZephRGBData& group) override {
        groups.push_back({draw, {group.Level[1], group.Level[2], group.Level[3]}, {}});
        if (draw.Bulbs) groups.back().bulbs.assign(draw.Bulbs, draw.Bulbs + draw.BulbCount);
        note(std::to_string(draw.Fixture) + "." + std::to_string(draw.Triplet), draw.Alpha);
    }
    void endFrame() override {}

    int flashingBulbs = 0;
    std::vector<ChannelDraw> plain;
    std::vector<int> lit;  // of the last flashing channel, a flag a bulb
    std::vector<Group> groups;
    std::string text;

private:
    void note(const std::string& what, int strength) {
        text += (text.empty() ? "" : " ") + what + "=" + std::to_string(strength);
    }
};

struct EngineRig : CompiledDisplay {
    static constexpr std::int32_t kStart = 100'000;

    ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    ZephRenderClocks clocks = clocksAtEntry(kStart);
    ListRandom random;
    RecordingSurface surface;

    RenderContext context() { return {*simulation, curve, tables, *states, clocks, random, surface, failures}; }
    ZephKeshState& ribbon(int fixture = 1) { return (*states)[fixture].Kesh; }

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
    // What passes at these times draw, each after a comma.
    std::string shown(std::initializer_list<std::int32_t> timesMs) {
        std::string text;
        for (const std::int32_t atMs : timesMs) {
            pass(atMs);
            text += (text.empty() ? "" : ", ") + surface.text;
        }
        return text;
    }
};
