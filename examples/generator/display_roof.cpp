#include "display.h"
#include "util/random_source.h"

#include <cmath>

namespace {

constexpr std::int32_t kNormal = 0;
constexpr std::int32_t kLegacy = 1;
constexpr std::int32_t kTriples = 0;
constexpr std::int32_t kSequential = 1;
constexpr FixtureLook kRibbonLook{2, 2, 11};

void hangRibbon(ZephSimulation& display, int prop, const std::string& name, std::int32_t level,
                const ZephKeshData& unit, std::int32_t sample, const std::vector<ScenePoint>& pixels) {
    ZephFixture& fixture = addFixture(display, prop, kFixtureKesh, name, level, kRibbonLook);
    fixture.Kesh = unit;
    makePixels(fixture, sample);
    for (const ScenePoint& pixel : pixels)
        addBulb(fixture, pixel);
}

std::vector<ScenePoint> pathEdge(int side, int count) {
    std::vector<ScenePoint> places;
    for (int place0 = 0; place0 < count; ++place0) {
        const double t = 0.02 + 0.9 * place0 / (count - 1);
        const ScenePoint middle = scene::pathMiddle(t);
        places.push_back({middle.x + side * (scene::pathHalfWidth(t) + 3), middle.y});
    }
    return places;
}

void hangRibbons(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    const int prop = addProp(display, "Roof line", "Ribbons on rafters, eaves and ridge");
    // One strand drawn in two pieces; its pixels 25 and 26 are hidden behind the corner of the board.
    const std::vector<ScenePoint> rafter = spread(kLeftWing.leftEave, kLeftWing.apex, 50);
    ZephKeshData unit = addresses.ribbon(kNormal, kTriples, 0);
    hangRibbon(display, prop, "Gable left, lower", kLevelOutline, unit, colors::kRed,
               {rafter.begin(), rafter.begin() + 24});
    unit.Physical_Pixel_Number = 27;
    hangRibbon(display, prop, "Gable left, upper", kLevelOutline, unit, colors::kRed,
               {rafter.begin() + 26, rafter.end()});
    hangRibbon(display, prop, "Gable right", kLevelOutline, addresses.ribbon(kLegacy, kSequential, 0), colors::kRed,
               spread(kLeftWing.rightEave, kLeftWing.apex, 50));
    hangRibbon(display, prop, "Main eave", kLevelOutline, addresses.ribbon(kNormal, kSequential, 0), colors::kGreen,
               spread({kLeftWing.rightEave.x + 6, kEaveLeft.y + 2}, {kGarage.leftEave.x + 32, kEaveLeft.y + 2}, 50));
    const double ridgeMiddle = (kRidgeLeft.x + kRidgeRight.x) / 2;
    hangRibbon(display, prop, "Ridge left", kLevelOutline, addresses.ribbon(kNormal, kTriples, 1), colors::kBlue,
               spread({kRidgeLeft.x + 6, kRidgeLeft.y - 2}, {ridgeMiddle - 3, kRidgeLeft.y - 2}, 50));
    hangRibbon(display, prop, "Ridge right", kLevelOutline, addresses.ribbon(kLegacy, kTriples, 4), colors::kBlue,
               spread({kRidgeRight.x - 2, kRidgeLeft.y - 2}, {ridgeMiddle + 3, kRidgeLeft.y - 2}, 50));
    hangRibbon(display, prop, "Garage left", kLevelOutline, addresses.ribbon(kNormal, kTriples, 3), colors::kRed,
               spread(kGarage.leftEave, kGarage.apex, 50));
    hangRibbon(display, prop, "Garage right", kLevelOutline, addresses.ribbon(kNormal, kTriples, 2), colors::kRed,
               spread(kGarage.rightEave, kGarage.apex, 50));
    hangRibbon(display, prop, "Main roof edge", kLevelOutline, addresses.ribbon(kLegacy, kTriples, 6), colors::kBlue,
               spread({kRidgeRight.x + 2, kRidgeRight.y + 4}, {813, 410}, 34));

    const int path = addProp(display, "Path edges", "Ribbons along the garden path");
    hangRibbon(display, path, "Path left edge", kLevelPath, addresses.ribbon(kLegacy, kTriples, 5), colors::kAmber,
               pathEdge(-1, 50));
    hangRibbon(display, path, "Path right edge", kLevelPath, addresses.ribbon(kNormal, kTriples, 7), colors::kAmber,
               pathEdge(1, 50));
}

void hangDormers(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    const int prop = addProp(display, "Dormers", "");
    int number = 0;
    for (const double x : kDormers) {
        ZephFixture& fixture =
            addFixture(display, prop, kFixtureStrings, "Dormer " + std::to_string(++number), kLevelRoof, {2, 2, 1});
        addStroke(fixture, {{x - kDormerHalf, kDormerEave}, {x, kDormerTop}, {x + kDormerHalf, kDormerEave}});
        const Address red = addresses.qen();
        const Address green = addresses.qen();
        addRgbChannels(fixture, red, green, addresses.qen(), colors::kIce);
    }
}

// Steady and flashing bulbs in turn on each icicle.
void hangIcicles(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    const int prop = addProp(display, "Icicles", "Every second bulb flashes");
    SeededRandom random(5);
    const auto row = [&](const char* name, ScenePoint from, ScenePoint to, int count) {
        ZephFixture& fixture = addFixture(display, prop, kFixtureStrings, name, kLevelOutline, {1, 3, 1});
        for (const ScenePoint& top : spread(from, to, count)) {
            addStroke(fixture, {{top.x, top.y + 5}, {top.x, top.y + 12 + std::floor(16 * random.next())}});
        }
        addChannel(fixture, addresses.bsoft(), fixture.Name, colors::kColdWhite);
        ZephChannel& flashing = addChannel(fixture, addresses.bsoft(), fixture.Name + " flash", colors::kIce);
        flashing.Sub_Type = kSpecialStrobes;
        flashing.Sub_Parm = 4;
    };
    row("Icicles main eave", {kLeftWing.rightEave.x + 8, kEaveLeft.y + 5}, {784, kEaveLeft.y + 5}, 34);
    row("Icicles porch", {kPorchRoof.left + 4, kPorchRoof.bottom}, {kPorchRoof.right - 4, kPorchRoof.bottom}, 34);
    row("Icicles garage", {812, 478}, {988, 478}, 24);
}

// Six arms with side twigs.
void hangSnowflake(ZephSimulation& display, AddressBook& addresses, int prop, const std::string& name,
                   ScenePoint middle, double radius) {
    ZephFixture& fixture = addFixture(display, prop, kFixtureStrings, name, kLevelRoof, {2, 1, 1});
    for (int arm = 0; arm < 6; ++arm) {
        const double angle = M_PI / 3 * arm + M_PI / 2;
        const auto along = [&](double share, double turn, double reach) {
            return ScenePoint{middle.x + radius * (share * std::cos(angle) + reach * std::cos(angle + turn)),
                              middle.y - radius * (share * std::sin(angle) + reach * std::sin(angle + turn))};
        };
        addStroke(fixture, {along(0.12, 0, 0), along(1, 0, 0)});
        for (const double turn : {0.8, -0.8})
            addStroke(fixture, {along(0.62, turn, 0.1), along(0.62, turn, 0.36)});
    }
    addChannel(fixture, addresses.qen(), name + " ice", colors::kIce);
    addChannel(fixture, addresses.qen(), name + " white", colors::kColdWhite);
}

void hangRoofOrnaments(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    const int flakes = addProp(display, "Snowflakes", "On the main roof");
    hangSnowflake(display, addresses, flakes, "Snowflake 1", {619, 368}, 25);
    hangSnowflake(display, addresses, flakes, "Snowflake 2", {752, 366}, 32);

    const int star = addProp(display, "Garage star", "With rays");
    ZephFixture& rays = addFixture(display, star, kFixtureStrings, "Garage star rays", kLevelRoof, {2, 2, 1});
    for (int ray = 0; ray < 8; ++ray) {
        const double angle = M_PI / 4 * ray;
        const double reach = ray % 2 == 0 ? 38 : 27;
        addStroke(rays, {{kGarageStar.x + std::cos(angle) * 15, kGarageStar.y - std::sin(angle) * 15},
                         {kGarageStar.x + std::cos(angle) * reach, kGarageStar.y - std::sin(angle) * reach}});
    }
    const Address red = addresses.qen();
    const Address green = addresses.qen();
    addRgbChannels(rays, red, green, addresses.qen(), colors::kGold);
    ZephFixture& heart = addFixture(display, star, kFixtureBulbs, "Garage star", kLevelRoof, {12, 2, 10});
    addBulb(heart, kGarageStar);
    addChannel(heart, addresses.x10(), "Garage star", colors::kGold);

    ZephFixture& gable = addFixture(display, 0, kFixtureBulbs, "Gable star", kLevelRoof, {13, 2, 8});
    addBulb(gable, {kLeftWing.apex.x, kLeftWing.apex.y - 16});
    addChannel(gable, addresses.x10(), "Gable star", colors::kGold);

    ZephFixture& dormers = addFixture(display, 0, kFixtureBulbs, "Dormer stars", kLevelRoof, {7, 2, 7});
    for (const double x : kDormers)
        addBulb(dormers, {x, kDormerTop - 9});
    addChannel(dormers, addresses.x10(), "Dormer stars", colors::kColdWhite);
}

}  // namespace

void hangRoofLights(ZephSimulation& display, AddressBook& addresses) {
    hangRibbons(display, addresses);
    hangDormers(display, addresses);
    hangIcicles(display, addresses);
    hangRoofOrnaments(display, addresses);
}
