// Documents for tests in a line or two: fixtures at places in pixels, channels with addresses.
#pragma once

#include "model/document.h"
#include "util/units.h"

#include <initializer_list>

struct Place {
    std::int32_t X = 0;  // pixels
    std::int32_t Y = 0;
};

inline void addPoint(ZephFixture& fixture, std::int32_t type, const Place& place) {
    fixture.DrawPoints[++fixture.PointCount] = {type, place.X * TwipsPerPixelX, place.Y * TwipsPerPixelY};
}

// The next bulb, or the next point of a light string's one stroke.
inline void addPlace(ZephFixture& fixture, const Place& place) {
    const std::int32_t stroke = fixture.PointCount == 0 ? kPointMove : kPointLine;
    addPoint(fixture, fixture.Fixture_Type == kFixtureStrings ? stroke : kPointBulb, place);
}

// A new fixture behind the others, as the settings of a first run make one: round bulbs of size 2, level 1, without
// channels. Light strings are one stroke through the places, others have a bulb at each.
inline ZephFixture& addFixture(ZephSimulation& document, std::int32_t type, std::initializer_list<Place> places = {}) {
    ZephFixture& fixture = document.Fixtures[++document.FixtureCount];
    InitializeFixture({}, fixture);
    fixture.Fixture_Type = type;
    fixture.Name = "F" + std::to_string(document.FixtureCount);
    if (type >= kFixtureKesh) fixture.Channel_Type = kChannelRgb;
    for (const Place& place : places)
        addPlace(fixture, place);
    return fixture;
}

// A Qen channel on network 0.
inline ZephChannel& addChannel(ZephFixture& fixture, std::int32_t unit, std::int32_t circuit,
                               std::int32_t color = kWhite) {
    ZephChannel& channel = fixture.Channels[++fixture.ChannelCount];
    channel = {};
    channel.DeviceType = kDeviceQen;
    channel.Controller = unit;
    channel.Channel = circuit;
    channel.Color = color;
    return channel;
}

// Three circuits from the given one.
inline void makeRgb(ZephFixture& fixture, std::int32_t unit, std::int32_t circuit) {
    fixture.Channel_Type = kChannelRgb;
    for (std::int32_t color = 0; color < 3; ++color)
        addChannel(fixture, unit, circuit + color);
}
