// Render tables put together by hand for drawing tests and benchmarks: each channel of each fixture has a key of its
// own, in the order of fixtures, and its bulbs lie where the document puts them.
#pragma once

#include "engine/bulb_walk.h"
#include "engine/render_table.h"
#include "util/units.h"

inline void addHandEntry(const ZephRenderSlot& slot, ZephRenderTables& tables) {
    const auto count = static_cast<std::int32_t>(tables.RenderData.size());
    tables.Keys.push_back(count);
    tables.RenderData.push_back({count, static_cast<std::int32_t>(tables.Slots.size()), 1, 1U << slot.Level});
    tables.Live.push_back({});
    tables.Slots.push_back(slot);
}

inline void addHandGroup(const ZephFixture& fixture, std::int32_t number, std::int32_t triplet,
                         ZephRenderTables& tables) {
    tables.RGBData.push_back({.Key = number * 1000 + triplet});
    const auto index = static_cast<std::int32_t>(tables.RGBData.size()) - 1;
    for (std::int32_t color = 1; color <= 3; ++color) {
        addHandEntry({number, color, fixture.ZOrder, index, triplet, 0}, tables);
    }
}

inline void placeHandBulbs(const ZephFixture& fixture, ZephFixtureState& state, ZephRenderTables& tables) {
    const auto begin = [&](std::int32_t location) {
        state.LocationCount = location;
        state.BulbLocations[static_cast<std::size_t>(location)] = {static_cast<std::int32_t>(tables.BulbPool.size()), 0,
                                                                   -1};
    };
    const auto add = [&](const ZephBulbLocation& bulb) {
        tables.BulbPool.push_back(bulb);
        ++state.BulbLocations[static_cast<std::size_t>(state.LocationCount)].Count;
    };
    if (fixture.Fixture_Type == kFixtureStrings) {
        for (std::int32_t channel = 1; channel <= walkedChannels(fixture); ++channel) {
            begin(channel);
            walkBulbs(fixture, channel, [&](const WalkedBulb& bulb) { add({0, bulb.X, bulb.Y}); });
        }
    } else {
        begin(1);
        for (std::int32_t p = 1; p <= fixture.PointCount; ++p) {
            const ZephDrawPoint& point = fixture.DrawPoints[p];
            add({point.Type, point.X / TwipsPerPixelX, point.Y / TwipsPerPixelY});
        }
    }
}

// Ribbons get a group a point, triplets from 1; DMX pixels from 1001.
inline void buildHandTables(const ZephSimulation& document, ZephRenderTables& tables, ZephFixtureStates& states) {
    tables = {};
    tables.RGBData.resize(1);
    addHandEntry({}, tables);
    tables.RenderData[0] = {};
    for (std::int32_t n = 1; n <= document.FixtureCount; ++n) {
        const ZephFixture& fixture = document.Fixtures[n];
        states[n] = {};
        placeHandBulbs(fixture, states[n], tables);
        if (fixture.Channel_Type != kChannelRgb) {
            for (std::int32_t channel = 1; channel <= fixture.ChannelCount; ++channel) {
                addHandEntry({n, channel, fixture.ZOrder, 0, 0, 0}, tables);
            }
        } else if (fixture.Fixture_Type == kFixtureKesh || fixture.Fixture_Type == kFixtureDmxPixels) {
            const std::int32_t first = fixture.Fixture_Type == kFixtureKesh ? 1 : 1001;
            for (std::int32_t p = 0; p < fixture.PointCount; ++p)
                addHandGroup(fixture, n, first + p, tables);
        } else {
            addHandGroup(fixture, n, 0, tables);
        }
    }
    tables.RenderDataCount = static_cast<std::int32_t>(tables.RenderData.size()) - 1;
}
