// Displays that several benchmarks run on, compiled as a simulation compiles them.
#pragma once

#include "engine/render_table.h"
#include "model/document.h"
#include "util/failure.h"
#include "util/message_host.h"

#include <memory>

struct IgnoredFailures : FailureReport {
    void ErrReport(std::string_view, std::string_view, int) override {}
};

struct BenchDisplay {
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    std::unique_ptr<ZephFixtureStates> states = std::make_unique<ZephFixtureStates>();
    ZephSettings settings;
    MessageHost host{stderr};
    IgnoredFailures failures;
    ZephRenderTables tables;

    void compile() {
        ZephBuildRenderTable({settings, host, failures, *simulation, *states, tables});
        require(tables.RenderDataCount > 0, "the display of a benchmark does not compile");
    }
};

// Ribbons of 50 pixels in rows, each on a unit of its own: 157 channel keys each. count 1..1024.
inline void buildRibbons(ZephSimulation& simulation, int count) {
    const ZephSettings settings;
    simulation.Background.EditorWidthTwips = simulation.Background.EditorHeightTwips = 2500 * 15;
    simulation.FixtureCount = count;
    for (int f = 1; f <= count; ++f) {
        ZephFixture& fixture = simulation.Fixtures[f];
        InitializeFixture(settings, fixture);
        fixture.Fixture_Type = kFixtureKesh;
        fixture.Channel_Type = kChannelRgb;
        fixture.BulbShape = 11;
        // Five networks of 240 units each hold them all.
        fixture.Kesh.Network = (f - 1) / 240;
        fixture.Kesh.Base_Unit = (f - 1) % 240 + 1;
        fixture.PointCount = 50;
        for (int p = 1; p <= 50; ++p) {
            fixture.DrawPoints[p] = {kPointBulb, ((f - 1) % 8 * 300 + p * 6) * 15, ((f - 1) / 8 * 19 + 10) * 15};
        }
    }
}
