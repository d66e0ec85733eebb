#include "display.h"

#include <array>
#include <cmath>

namespace {

void hangArches(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    constexpr int kSegments = 8;
    constexpr std::array kSamples{colors::kRed, colors::kAmber, colors::kGreen, colors::kIce, colors::kViolet};
    for (int arch0 = 0; arch0 < kArches; ++arch0) {
        const int prop = addProp(display, "Arch " + std::to_string(arch0 + 1), "Eight segments, left to right");
        for (int segment0 = 0; segment0 < kSegments; ++segment0) {
            ZephFixture& fixture =
                addFixture(display, prop, kFixtureStrings,
                           "Arch " + std::to_string(arch0 + 1) + " segment " + std::to_string(segment0 + 1),
                           kLevelArches, {2, 1, 1});
            for (const double inset : {0.0, 6.0}) {
                std::vector<ScenePoint> stroke;
                for (int step = 0; step <= 4; ++step) {
                    const double angle = M_PI * (1 - (segment0 + 0.02 + 0.24 * step) / kSegments);
                    stroke.push_back({archMiddle(arch0) + std::cos(angle) * (kArchHalf - inset),
                                      kArchBase - std::sin(angle) * (kArchHeight - inset)});
                }
                addStroke(fixture, stroke);
            }
            const Address red = addresses.dmx();
            const Address green = addresses.dmx();
            addRgbChannels(fixture, red, green, addresses.dmx(), kSamples[static_cast<std::size_t>(arch0)]);
        }
    }
}

void hangCanes(ZephSimulation& display, AddressBook& addresses) {
    const int prop = addProp(display, "Candy canes", "On both sides of the path");
    int number = 0;
    for (const double t : {0.1, 0.26, 0.42, 0.58, 0.75}) {
        for (const int side : {-1, 1}) {
            const ScenePoint middle = scene::pathMiddle(t);
            const ScenePoint foot{middle.x + side * (scene::pathHalfWidth(t) + 12 + 6 * t), middle.y + 2};
            const double height = 34 + 40 * t;
            const double hook = 6 + 6 * t;
            ZephFixture& fixture = addFixture(display, prop, kFixtureStrings, "Candy cane " + std::to_string(++number),
                                              kLevelPath, {2, 1, 1});
            std::vector<ScenePoint> cane{foot, {foot.x, foot.y - height}};
            for (int step = 1; step <= 7; ++step) {  // the hook bends towards the path
                const double angle = M_PI * step / 7 * 1.1;
                cane.push_back(
                    {foot.x - side * hook * (1 - std::cos(angle)), foot.y - height - hook * std::sin(angle)});
            }
            addStroke(fixture, cane);
            const std::string name = fixture.Name;
            addChannel(fixture, addresses.qen(), name + " red", colors::kRed);
            addChannel(fixture, addresses.qen(), name + " white", colors::kColdWhite);
        }
    }
}

// Large single lights between the canes, a shape a pair.
void hangStakes(ZephSimulation& display, AddressBook& addresses) {
    const int prop = addProp(display, "Path stakes", "");
    struct Pair {
        double t;
        std::int32_t shape;
        std::int32_t color;
    };
    constexpr std::array kPairs{Pair{0.18, 2, colors::kGreen}, Pair{0.34, 3, colors::kAmber},
                                Pair{0.5, 4, colors::kPink}, Pair{0.665, 5, colors::kIce},
                                Pair{0.84, 6, colors::kViolet}};
    for (const Pair& pair : kPairs) {
        ZephFixture& fixture = addFixture(display, prop, kFixtureBulbs, "Stakes " + std::to_string(pair.shape - 1),
                                          kLevelPath, {pair.t > 0.6 ? 6 : 5, 2, pair.shape});
        for (const int side : {-1, 1}) {
            const ScenePoint middle = scene::pathMiddle(pair.t);
            addBulb(fixture, {middle.x + side * (scene::pathHalfWidth(pair.t) + 16), middle.y - 5});
        }
        addChannel(fixture, addresses.digital(), fixture.Name, pair.color);
    }
}

std::vector<ScenePoint> deerLine(ScenePoint foot, std::initializer_list<ScenePoint> outline) {
    std::vector<ScenePoint> placed;
    for (const ScenePoint& point : outline)
        placed.push_back({foot.x + point.x, foot.y - point.y});
    return placed;
}

void hangDeer(ZephSimulation& display, AddressBook& addresses) {
    const int prop = addProp(display, "Reindeer", "Driven by name");
    int number = 0;
    for (const ScenePoint& foot : scene::kDeer) {
        const std::string name = "Reindeer " + std::to_string(++number);
        ZephFixture& fixture = addFixture(display, prop, kFixtureStrings, name, kLevelFigures, {1, 2, 1});
        addStroke(fixture, deerLine(foot, {{-24, 34},
                                           {-26, 44},
                                           {-12, 48},
                                           {8, 46},
                                           {15, 52},
                                           {19, 64},
                                           {28, 67},
                                           {38, 60},
                                           {35, 56},
                                           {27, 55},
                                           {23, 44},
                                           {17, 33},
                                           {-6, 30},
                                           {-24, 34}}));
        addStroke(fixture, deerLine(foot, {{-24, 34}, {-22, 18}, {-27, 0}}));
        addStroke(fixture, deerLine(foot, {{-17, 32}, {-14, 16}, {-17, 0}}));
        addStroke(fixture, deerLine(foot, {{9, 31}, {12, 16}, {7, 0}}));
        addStroke(fixture, deerLine(foot, {{16, 33}, {21, 17}, {18, 0}}));
        addStroke(fixture, deerLine(foot, {{23, 67}, {19, 77}, {12, 83}}));
        addStroke(fixture, deerLine(foot, {{19, 77}, {22, 87}}));
        addStroke(fixture, deerLine(foot, {{26, 68}, {30, 78}, {27, 88}}));
        addStroke(fixture, deerLine(foot, {{30, 78}, {38, 84}}));
        addStroke(fixture, deerLine(foot, {{-26, 44}, {-32, 47}}));
        addNamedChannel(fixture, name, colors::kWarmWhite);
        ZephFixture& nose = addFixture(display, prop, kFixtureBulbs, name + " nose", kLevelFront, {3, 2, 1});
        addBulb(nose, {foot.x + 38, foot.y - 60});
        addChannel(nose, addresses.x10(), name + " nose", colors::kRed);
    }
}

void hangSnowman(ZephSimulation& display) {
    const int prop = addProp(display, "Snowman", "Driven by name");
    const double x = scene::kSnowman.x;
    double bottom = scene::kSnowman.y;
    ZephFixture& body = addFixture(display, prop, kFixtureStrings, "Snowman body", kLevelFigures, {2, 2, 1});
    for (const double radius : {27.0, 20.0, 14.0}) {
        addStroke(body, ellipse({x, bottom - radius}, radius, radius, 30));
        bottom -= radius * 1.68;
    }
    addNamedChannel(body, "Snowman body", colors::kColdWhite);
    const double head = scene::kSnowman.y - 27 * 1.68 - 20 * 1.68 - 14;
    ZephFixture& scarf = addFixture(display, prop, kFixtureStrings, "Snowman scarf", kLevelFigures, {2, 0, 1});
    addStroke(scarf, {{x - 14, head + 12}, {x, head + 16}, {x + 14, head + 12}});
    addStroke(scarf, {{x + 6, head + 15}, {x + 10, head + 34}});
    addNamedChannel(scarf, "Snowman scarf", colors::kRed);
    ZephFixture& hat = addFixture(display, prop, kFixtureStrings, "Snowman hat", kLevelFigures, {1, 2, 1});
    addStroke(hat, {{x - 16, head - 13},
                    {x - 10, head - 15},
                    {x - 10, head - 33},
                    {x + 10, head - 33},
                    {x + 10, head - 15},
                    {x + 16, head - 13}});
    addNamedChannel(hat, "Snowman hat", colors::kBlue);
}

}  // namespace

void hangGardenLights(ZephSimulation& display, AddressBook& addresses) {
    hangArches(display, addresses);
    hangCanes(display, addresses);
    hangStakes(display, addresses);
    hangDeer(display, addresses);
    hangSnowman(display);
}
