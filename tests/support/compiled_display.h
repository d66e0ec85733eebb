// A display for tests: a document and what compiling it for a simulation adds.
#pragma once

#include "engine/render_table.h"
#include "tests/support/fixtures.h"
#include "tests/support/recording_host.h"

#include <memory>

struct CompiledDisplay {
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    std::unique_ptr<ZephFixtureStates> states = std::make_unique<ZephFixtureStates>();
    ZephSettings settings;
    RecordingHost host;
    CollectingFailures failures;
    ZephRenderTables tables;

    ZephFixture& add(std::int32_t type, std::initializer_list<Place> places = {{30, 10}, {60, 10}}) {
        return addFixture(*simulation, type, places);
    }
    ZephFixture& addPlain(std::int32_t unit, std::int32_t circuit) {
        ZephFixture& fixture = add(kFixtureStrings);
        addChannel(fixture, unit, circuit);
        return fixture;
    }
    ZephFixture& addRgb(std::int32_t unit, std::int32_t circuit) {
        ZephFixture& fixture = add(kFixtureStrings);
        makeRgb(fixture, unit, circuit);
        return fixture;
    }
    // Bulbs in a row, 30 pixels apart.
    ZephFixture& addRow(std::int32_t type, std::int32_t points) {
        ZephFixture& fixture = add(type, {});
        for (std::int32_t p = 1; p <= points; ++p)
            addPlace(fixture, {30 * p, 10 * simulation->FixtureCount});
        return fixture;
    }
    // A main ribbon in Normal unit mode.
    ZephFixture& addRibbon(std::int32_t unit, std::int32_t points = kMaxRibbonPixels) {
        ZephFixture& fixture = addRow(kFixtureKesh, points);
        fixture.Kesh.Base_Unit = unit;
        return fixture;
    }
    ZephFixture& addPixels(std::int32_t universe, std::int32_t points) {
        ZephFixture& fixture = addRow(kFixtureDmxPixels, points);
        fixture.DMX.Universe = universe;
        return fixture;
    }

    void build() { ZephBuildRenderTable({settings, host, failures, *simulation, *states, tables}); }
};
