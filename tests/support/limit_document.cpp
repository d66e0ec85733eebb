#include "tests/support/limit_document.h"

#include "tests/support/fixtures.h"
#include "util/color.h"

#include <array>

namespace {

constexpr std::int32_t kUnitsInNetwork = 240;
constexpr std::int32_t kRound = 1;  // row of the bulb type table

// Fixture number n owns controller n: no two fixtures share an address.
void addControllerChannel(ZephFixture& fixture, int number, int slot) {
    static constexpr std::array<std::int32_t, 6> kColors{packColor(255, 0, 0),   packColor(0, 255, 0),
                                                         packColor(0, 0, 255),   packColor(255, 255, 255),
                                                         packColor(255, 160, 0), packColor(160, 0, 255)};
    ZephChannel& channel = addChannel(fixture, 1 + (number - 1) % kUnitsInNetwork, slot,
                                      kColors[static_cast<std::size_t>(number + slot) % kColors.size()]);
    channel.Network = (number - 1) / kUnitsInNetwork;
    channel.Name = "Unit " + std::to_string(number) + " circuit " + std::to_string(slot);
    channel.LED = slot % 2 == 0;
}

}  // namespace

void buildLimitDocument(ZephSimulation& simulation, const LimitDocumentOptions& options) {
    constexpr std::int32_t kRows = kMaxFixtures / 2;
    constexpr std::int32_t kColumnPx = kMaxCanvasPixels / 2;
    const std::int32_t pitchPx = 2 * options.bulbSize;
    simulation.Background = {1, "", 100, kMaxCanvasPixels * TwipsPerPixelX, kMaxCanvasPixels * TwipsPerPixelY};
    simulation.Dimmed = 50;
    for (int level = 1; level <= kLevels; ++level)
        simulation.Levels[level].Name = "Level " + std::to_string(level);
    simulation.PropCount = options.props;
    for (int p = 1; p <= options.props; ++p) {
        simulation.Props[p].Name = "Prop " + std::to_string(p);
        simulation.Props[p].Comment = "Sixty-four neighbours";
    }
    for (int f = 1; f <= options.fixtures; ++f) {
        ZephFixture& fixture = addFixture(simulation, options.fixtureType);
        fixture.Name = "String " + std::to_string(f);
        fixture.Channel_Type = kChannelNormal;
        fixture.BulbSize = options.bulbSize;
        fixture.BulbSpacing = 0;
        fixture.BulbShape = kRound;
        fixture.ZOrder = 1 + (f - 1) % kLevels;
        fixture.Sample = {0, 255, 128, 64};
        const Place first{(f - 1) / kRows * kColumnPx + 100, ((f - 1) % kRows + 1) * pitchPx};
        for (int p = 0; p < options.points; ++p)
            addPlace(fixture, {first.X + p * pitchPx, first.Y});
        // The walk places a bulb that lands on the end of a line; half a pitch of slack keeps the count out of doubt.
        fixture.DrawPoints[options.points].X += pitchPx * TwipsPerPixelX / 2;
        for (int c = 1; c <= options.channels; ++c)
            addControllerChannel(fixture, f, c);
        const int prop = (f - 1) / kMaxFixturesInProp + 1;
        if (prop <= options.props) ZephAddFixtureToProp(f, prop, simulation);
    }
    simulation.SimulationDirty = false;
    simulation.SimulationOpen = true;
}
