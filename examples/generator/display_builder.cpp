#include "display_builder.h"

#include "model/document.h"
#include "util/rounding.h"
#include "util/units.h"

#include <cmath>

namespace {

constexpr std::int32_t kCircuitsPerUnit = 16;
constexpr std::int32_t kDasher = 4;
constexpr std::int32_t kBsoft = 5;
constexpr std::int32_t kDigital = 2;
constexpr std::int32_t kUnitsOfLegacyRibbon = 10;

Address nth(std::int32_t device, std::int32_t index0) {
    return {device, 0, index0 / kCircuitsPerUnit + 1, index0 % kCircuitsPerUnit + 1};
}

void addPoint(ZephFixture& fixture, std::int32_t type, ScenePoint place) {
    require(fixture.PointCount < kMaxPoints, "a fixture of the example has too many points");
    fixture.DrawPoints[++fixture.PointCount] = {type, roundHalfEven(place.x * TwipsPerPixelX),
                                                roundHalfEven(place.y * TwipsPerPixelY)};
}

}  // namespace

Address AddressBook::qen() {
    return nth(kDeviceQen, qen_++);
}
Address AddressBook::dasher() {
    return nth(kDasher, dasher_++);
}
Address AddressBook::bsoft() {
    return nth(kBsoft, bsoft_++);
}
Address AddressBook::digital() {
    return nth(kDigital, digital_++);
}
Address AddressBook::x10() {
    return {kDeviceX10, 0, 16 * 2 + x10_++, 0};  // house C
}
Address AddressBook::dmx() {
    return {kDeviceDmx, 30, 0, ++dmx_};
}

ZephKeshData AddressBook::ribbon(std::int32_t unitMode, std::int32_t channelMode, std::int32_t resolution) {
    const bool legacy = unitMode == 1;
    const std::int32_t unit = legacy ? 1 + kUnitsOfLegacyRibbon * legacyRibbons_++ : ++normalRibbons_;
    return {1, legacy ? 2 : 1, unit, unitMode, channelMode, resolution};
}

int addProp(ZephSimulation& display, const std::string& name, const std::string& comment) {
    ZephProp& prop = display.Props.at(++display.PropCount);
    prop.Name = name;
    prop.Comment = comment;
    return display.PropCount;
}

ZephFixture& addFixture(ZephSimulation& display, int prop, std::int32_t type, const std::string& name,
                        std::int32_t level, FixtureLook look) {
    ZephFixture& fixture = display.Fixtures.at(++display.FixtureCount);
    InitializeFixture(ZephSettings{}, fixture);
    fixture.Fixture_Type = type;
    fixture.Name = name;
    fixture.ZOrder = level;
    fixture.BulbSize = look.size;
    fixture.BulbSpacing = look.spacing;
    fixture.BulbShape = look.shape;
    fixture.Max_Opacity = 100;
    if (prop != 0) {
        require(ZephAddFixtureToProp(display.FixtureCount, prop, display), "a prop of the example is full");
    }
    return fixture;
}

void addBulb(ZephFixture& fixture, ScenePoint place) {
    addPoint(fixture, kPointBulb, place);
}

void addStroke(ZephFixture& fixture, const std::vector<ScenePoint>& points) {
    std::int32_t type = kPointMove;
    for (const ScenePoint& point : points) {
        addPoint(fixture, type, point);
        type = kPointLine;
    }
}

ZephChannel& addChannel(ZephFixture& fixture, const Address& address, const std::string& name, std::int32_t color) {
    ZephChannel& channel = fixture.Channels.at(++fixture.ChannelCount);
    channel.DeviceType = address.DeviceType;
    channel.Network = address.Network;
    channel.Controller = address.Controller;
    channel.Channel = address.Channel;
    channel.Name = name;
    channel.Color = color;
    channel.LED = true;
    return channel;
}

ZephChannel& addNamedChannel(ZephFixture& fixture, const std::string& name, std::int32_t color) {
    return addChannel(fixture, {}, name, color);
}

void addRgbChannels(ZephFixture& fixture, const Address& red, const Address& green, const Address& blue,
                    std::int32_t sample) {
    fixture.Channel_Type = kChannelRgb;
    addChannel(fixture, red, fixture.Name + " (R)", packColor(255, 0, 0));
    addChannel(fixture, green, fixture.Name + " (G)", packColor(0, 255, 0));
    addChannel(fixture, blue, fixture.Name + " (B)", packColor(0, 0, 255));
    const ColorParts parts = ZephColorToRGB(sample);
    fixture.Sample = {0, parts.red, parts.green, parts.blue};
}

void makePixels(ZephFixture& fixture, std::int32_t sample) {
    fixture.Channel_Type = kChannelRgb;
    const ColorParts parts = ZephColorToRGB(sample);
    fixture.Sample = {0, parts.red, parts.green, parts.blue};
}

std::vector<ScenePoint> spread(ScenePoint from, ScenePoint to, int count) {
    std::vector<ScenePoint> places;
    for (int place0 = 0; place0 < count; ++place0) {
        const double share = count == 1 ? 0 : static_cast<double>(place0) / (count - 1);
        places.push_back({from.x + (to.x - from.x) * share, from.y + (to.y - from.y) * share});
    }
    return places;
}

std::vector<ScenePoint> ellipse(ScenePoint middle, double radiusX, double radiusY, int corners) {
    std::vector<ScenePoint> places;
    for (int corner = 0; corner <= corners; ++corner) {
        const double angle = 2 * M_PI * corner / corners - M_PI / 2;
        places.push_back({middle.x + std::cos(angle) * radiusX, middle.y + std::sin(angle) * radiusY});
    }
    return places;
}
