// The largest display that the limits allow, shared by tests and benchmarks. Built by rule, so that every run on every
// machine sees the same records.
#pragma once

#include "model/simulation.h"

struct LimitDocumentOptions {
    std::int32_t fixtures = kMaxFixtures;  // 1..1024
    std::int32_t points = kMaxPoints;      // a fixture, 2..256
    std::int32_t channels = kMaxChannels;  // a fixture, 0..16
    std::int32_t props = 16;               // each takes 64 fixtures, as long as there are any
    std::int32_t bulbSize = 2;             // pixels, the radius
    std::int32_t fixtureType = kFixtureStrings;
};

// Fills an empty document on a canvas of 2500 x 2500 pixels. Fixtures lie in two columns, one pitch (2 x bulbSize)
// a row. A fixture's points stand one pitch apart on a level line and the last half a pitch farther, so
// a light string has exactly as many bulbs as points, none of them on the line's end. With the defaults: 262,144 round
// bulbs in 16,384 channels of 16 bulbs each, every channel with a controller address of its own.
void buildLimitDocument(ZephSimulation& simulation, const LimitDocumentOptions& options = {});
