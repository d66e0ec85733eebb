#include "tests/support/limit_document.h"

#include "model/document.h"
#include "util/color.h"
#include "util/units.h"

#include <array>

namespace {

constexpr std::int32_t kUnitsInNetwork = 240;

void prepareCanvas(std::int32_t widthPx, std::int32_t heightPx, ZephSimulation& simulation) {
    simulation.Background.BackgroundType = 1;
    simulation.Background.EditorWidthTwips = widthPx * TwipsPerPixelX;
    simulation.Background.EditorHeightTwips = heightPx * TwipsPerPixelY;
    simulation.Dimmed = 50;
    for (int level = 1; level <= kLevels; ++level)
        simulation.Levels[level].Name = "Level " + std::to_string(level);
    simulation.Levels[1].Name = "Background";
    simulation.Levels[kLevels].Name = "Foreground";
}

// Fixture number n owns controller n: no two fixtures share an address.
ZephChannel controllerChannel(int fixture, int slot) {
    static constexpr std::array<std::int32_t, 6> kColors{packColor(255, 0, 0),   packColor(0, 255, 0),
                                                         packColor(0, 0, 255),   packColor(255, 255, 255),
                                                         packColor(255, 160, 0), packColor(160, 0, 255)};
    ZephChannel channel;
    channel.DeviceType = kDeviceQen;
    channel.Network = (fixture - 1) / kUnitsInNetwork;
    channel.Controller = 1 + (fixture - 1) % kUnitsInNetwork;
    channel.Channel = slot;
    channel.Name = "Unit " + std::to_string(fixture) + " circuit " + std::to_string(slot);
    channel.Color = kColors[static_cast<std::size_t>(fixture + slot) % kColors.size()];
    channel.LED = slot % 2 == 0;
    return channel;
}

void drawLine(std::int32_t points, std::int32_t xPx, std::int32_t yPx, std::int32_t stepPx, std::int32_t stepYPx,
              ZephFixture& fixture) {
    const bool separate = fixture.Fixture_Type == kFixtureBulbs || fixture.Fixture_Type == kFixtureKesh ||
                          fixture.Fixture_Type == kFixtureDmxPixels;
    fixture.PointCount = points;
    for (int p = 1; p <= points; ++p) {
        const std::int32_t type = separate ? kPointBulb : p == 1 ? kPointMove : kPointLine;
        fixture.DrawPoints[p] = {type, (xPx + (p - 1) * stepPx) * TwipsPerPixelX,
                                 (yPx + (p - 1) * stepYPx) * TwipsPerPixelY};
    }
}

ZephFixture plainFixture(std::int32_t type, std::string name) {
    ZephFixture fixture;
    fixture.Fixture_Type = type;
    fixture.Name = std::move(name);
    fixture.BulbSize = 2;
    fixture.BulbSpacing = 4;
    fixture.BulbShape = 1;
    fixture.Channel_Type = kChannelNormal;
    fixture.ZOrder = 1;
    fixture.Max_Opacity = 50;
    return fixture;
}

int appendFixture(ZephFixture fixture, int prop, ZephSimulation& simulation) {
    const int slot = ++simulation.FixtureCount;
    simulation.Fixtures[slot] = std::move(fixture);
    if (prop != 0) ZephAddFixtureToProp(slot, prop, simulation);
    return slot;
}

ZephFixture yardString(int number) {
    ZephFixture fixture = plainFixture(kFixtureStrings, "String " + std::to_string(number));
    fixture.ZOrder = 1 + number % kLevels;
    fixture.BulbShape = 1 + number % 10;
    drawLine(12, 40 + 38 * (number % 10), 80 + 90 * (number / 10), 12, number % 3 - 1, fixture);
    if (number % 7 == 0) fixture.Channel_Type = kChannelRgb;
    fixture.ChannelCount = fixture.Channel_Type == kChannelRgb ? 3 : 1 + number % 4;
    for (int c = 1; c <= fixture.ChannelCount; ++c) {
        ZephChannel& channel = fixture.Channels[c];
        channel = controllerChannel(number, c);
        if (fixture.Channel_Type == kChannelRgb) {
            channel.Color = packColor(c == 1 ? 255 : 0, c == 2 ? 255 : 0, c == 3 ? 255 : 0);
        } else if (number % 5 == 1) {
            channel.Sub_Type = kSpecialStrobes;
            channel.Sub_Parm = 5;
        } else if (number % 5 == 2) {
            channel.Sub_Type = kSpecialMultiColor;
            channel.Sub_Parm = 3;
            channel.Multi[1] = packColor(255, 0, 0);
            channel.Multi[2] = packColor(0, 255, 0);
            channel.Multi[3] = packColor(0, 0, 255);
        }
    }
    return fixture;
}

ZephFixture yardBulbs(int number) {
    ZephFixture fixture = plainFixture(kFixtureBulbs, "Bulbs " + std::to_string(number));
    fixture.BulbSize = 4;
    drawLine(20, 60 + 180 * number, 500, 8, 2, fixture);
    fixture.ChannelCount = 1;
    fixture.Channels[1] = controllerChannel(40 + number, 1);
    return fixture;
}

ZephFixture yardFlood(int number) {
    ZephFixture fixture = plainFixture(kFixtureFlood, "Flood " + std::to_string(number));
    fixture.BulbSize = 32;
    drawLine(1, 200 + 250 * number, 650, 0, 0, fixture);
    fixture.DrawPoints[1].Type = kPointBulb;
    fixture.ChannelCount = 1;
    fixture.Channels[1] = controllerChannel(50 + number, 1);
    return fixture;
}

ZephFixture yardRibbon(int number) {
    ZephFixture fixture = plainFixture(kFixtureKesh, "Ribbon " + std::to_string(number));
    fixture.BulbShape = 11;
    fixture.Channel_Type = kChannelRgb;
    fixture.Kesh.Network = 1;
    fixture.Kesh.Base_Unit = number;
    drawLine(kMaxRibbonPixels, 100 + 550 * (number - 1), 760, 10, 0, fixture);
    return fixture;
}

ZephFixture yardPixels() {
    ZephFixture fixture = plainFixture(kFixtureDmxPixels, "Pixels");
    fixture.BulbShape = 11;
    fixture.Channel_Type = kChannelRgb;
    fixture.DMX.Universe = 1;
    drawLine(100, 100, 860, 10, 0, fixture);
    return fixture;
}

}  // namespace

void buildLimitDocument(ZephSimulation& simulation, const LimitDocumentOptions& options) {
    constexpr std::int32_t kRows = kMaxFixtures / 2;
    constexpr std::int32_t kColumnPx = kMaxCanvasPixels / 2;
    prepareCanvas(kMaxCanvasPixels, kMaxCanvasPixels, simulation);
    const std::int32_t pitchPx = options.bulbSpacing + 2 * options.bulbSize;
    simulation.PropCount = options.props;
    for (int p = 1; p <= options.props; ++p) {
        simulation.Props[p].Name = "Prop " + std::to_string(p);
        simulation.Props[p].Comment = "Sixty-four neighbours";
    }
    for (int f = 1; f <= options.fixtures; ++f) {
        ZephFixture fixture = plainFixture(options.fixtureType, "String " + std::to_string(f));
        fixture.BulbSize = options.bulbSize;
        fixture.BulbSpacing = options.bulbSpacing;
        fixture.BulbShape = options.bulbShape;
        fixture.ZOrder = 1 + (f - 1) % kLevels;
        fixture.Sample = {0, 255, 128, 64};
        const std::int32_t row0 = (f - 1) % kRows;
        const std::int32_t column0 = (f - 1) / kRows;
        drawLine(options.points, column0 * kColumnPx + 100, row0 * pitchPx + pitchPx, pitchPx, 0, fixture);
        // The walk places a bulb that lands on the end of a line; half a pitch of slack keeps the count out of doubt.
        fixture.DrawPoints[options.points].X += pitchPx * TwipsPerPixelX / 2;
        fixture.ChannelCount = options.channels;
        for (int c = 1; c <= options.channels; ++c)
            fixture.Channels[c] = controllerChannel(f, c);
        const int prop = (f - 1) / kMaxFixturesInProp + 1;
        appendFixture(std::move(fixture), prop <= options.props ? prop : 0, simulation);
    }
    simulation.SimulationDirty = false;
    simulation.SimulationOpen = true;
}

void buildTypicalDocument(ZephSimulation& simulation) {
    prepareCanvas(1280, 960, simulation);
    for (const char* name : {"Roof", "Windows", "Trees", "Walk", "Ribbons"})
        simulation.Props[++simulation.PropCount].Name = name;
    simulation.Props[++simulation.PropCount].Name = "Pixels & \"stars\" <garden>";
    for (int n = 1; n <= 30; ++n)
        appendFixture(yardString(n), 1 + (n - 1) / 10, simulation);
    for (int n = 1; n <= 4; ++n)
        appendFixture(yardFlood(n), 0, simulation);
    for (int n = 1; n <= 6; ++n)
        appendFixture(yardBulbs(n), 4, simulation);
    appendFixture(yardRibbon(1), 5, simulation);
    appendFixture(yardRibbon(2), 5, simulation);
    appendFixture(yardPixels(), 6, simulation);
    simulation.SimulationDirty = false;
    simulation.SimulationOpen = true;
}
