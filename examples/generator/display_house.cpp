#include "display.h"

#include <cmath>
#include <initializer_list>

namespace {

std::vector<ScenePoint> around(const SceneBox& box, double margin) {
    const double left = box.left - margin;
    const double right = box.right + margin;
    return {
        {left, box.bottom + margin}, {left, box.top - margin}, {right, box.top - margin}, {right, box.bottom + margin}};
}

// Coloured bulbs in turn on one channel, as a garland out of the box.
void addMultiColorChannel(ZephFixture& fixture, const Address& address,
                          std::initializer_list<std::int32_t> bulbColors) {
    ZephChannel& channel = addChannel(fixture, address, fixture.Name, *bulbColors.begin());
    channel.Sub_Type = kSpecialMultiColor;
    int slot = 0;
    for (const std::int32_t color : bulbColors)
        channel.Multi[++slot] = color;
    channel.Sub_Parm = slot;
}

void hangWash(ZephSimulation& display, AddressBook& addresses) {
    const int prop = addProp(display, "House wash", "Floods that colour the walls");
    const auto flood = [&](const char* name, std::int32_t sample, std::initializer_list<ScenePoint> places) {
        ZephFixture& fixture = addFixture(display, prop, kFixtureFlood, name, kLevelWash, {58, 2, 1});
        fixture.Max_Opacity = 45;
        for (const ScenePoint& place : places)
            addBulb(fixture, place);
        const Address red = addresses.dmx();
        const Address green = addresses.dmx();
        addRgbChannels(fixture, red, green, addresses.dmx(), sample);
    };
    flood("Wash left wing", colors::kBlue, {{340, 470}, {400, 400}, {460, 470}, {400, 540}});
    flood("Wash main house", colors::kViolet, {{556, 470}, {650, 460}, {744, 470}});
    flood("Wash garage", colors::kBlue, {{850, 470}, {900, 430}, {950, 470}});
    const auto glow = [&](const char* name, std::int32_t color, ScenePoint place) {
        ZephFixture& fixture = addFixture(display, prop, kFixtureFlood, name, kLevelWash, {64, 2, 1});
        fixture.Max_Opacity = 40;
        addBulb(fixture, place);
        addChannel(fixture, addresses.digital(), name, color);
    };
    glow("Glow behind left firs", colors::kIce, {60, 560});
    glow("Glow behind right firs", colors::kIce, {1230, 560});
    glow("Glow on the porch", colors::kAmber, {650, 560});
}

void hangWindows(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    const int prop = addProp(display, "Window frames", "Coloured garlands");
    const auto frame = [&](const char* name, const SceneBox& window) {
        ZephFixture& fixture = addFixture(display, prop, kFixtureStrings, name, kLevelWindows, {2, 3, 1});
        addStroke(fixture, around(window, 7));
        addMultiColorChannel(fixture, addresses.dasher(),
                             {colors::kRed, colors::kGreen, colors::kAmber, colors::kBlue, colors::kViolet});
    };
    frame("Gable window", kGableWindow);
    frame("Bay window", kBayWindow);
    frame("Porch window left", kPorchWindowLeft);
    frame("Porch window right", kPorchWindowRight);
    frame("Dormer window left", dormerWindow(0));
    frame("Dormer window right", dormerWindow(1));

    ZephFixture& garage = addFixture(display, prop, kFixtureStrings, "Garage door frame", kLevelWindows, {3, 3, 1});
    addStroke(garage, around(kGarageDoor, 6));
    addChannel(garage, addresses.dasher(), "Garage door red", colors::kRed);
    addChannel(garage, addresses.dasher(), "Garage door green", colors::kGreen);

    ZephFixture& door = addFixture(display, prop, kFixtureStrings, "Door frame", kLevelWindows, {2, 2, 1});
    addStroke(door, around(kDoor, 5));
    addChannel(door, addresses.dasher(), "Door frame", colors::kWarmWhite);

    const int wreath = addProp(display, "Wreath", "On the front door");
    ZephFixture& ring = addFixture(display, wreath, kFixtureStrings, "Wreath ring", kLevelFigures, {2, 1, 1});
    addStroke(ring, ellipse(kWreath, 14, 14, 24));
    addStroke(ring, ellipse(kWreath, 10, 10, 18));
    const Address red = addresses.qen();
    const Address green = addresses.qen();
    addRgbChannels(ring, red, green, addresses.qen(), colors::kGreen);
    ZephFixture& bow = addFixture(display, wreath, kFixtureBulbs, "Wreath bow", kLevelFigures, {5, 2, 2});
    addBulb(bow, {kWreath.x - 4, kWreath.y + 14});
    addBulb(bow, {kWreath.x + 4, kWreath.y + 14});
    addChannel(bow, addresses.qen(), "Wreath bow", colors::kRed);
}

void hangPorch(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    const int prop = addProp(display, "Porch", "Eave and candy striped posts");
    ZephFixture& eave = addFixture(display, prop, kFixtureStrings, "Porch eave", kLevelOutline, {3, 4, 1});
    addStroke(eave, {{kPorchRoof.left, kPorchRoof.bottom - 4}, {kPorchRoof.right, kPorchRoof.bottom - 4}});
    addChannel(eave, addresses.qen(), "Porch eave red", colors::kRed);
    addChannel(eave, addresses.qen(), "Porch eave green", colors::kGreen);
    addChannel(eave, addresses.qen(), "Porch eave blue", colors::kBlue);
    addChannel(eave, addresses.qen(), "Porch eave amber", colors::kAmber);
    int number = 0;
    for (const double post : kPorchPosts) {
        ZephFixture& fixture = addFixture(display, prop, kFixtureStrings, "Porch post " + std::to_string(++number),
                                          kLevelOutline, {2, 1, 1});
        std::vector<ScenePoint> spiral;
        bool left = true;
        for (double y = kPorchRoof.bottom + 8; y < kHouseBase - 8; y += 6, left = !left) {
            spiral.push_back({post + (left ? -5 : 5), y});
        }
        addStroke(fixture, spiral);
        const std::string name = fixture.Name;
        addChannel(fixture, addresses.qen(), name + " red", colors::kRed);
        addChannel(fixture, addresses.qen(), name + " white", colors::kColdWhite);
    }
}

void hangCorners(ZephSimulation& display, AddressBook& addresses) {
    using namespace scene;
    const int prop = addProp(display, "House corners", "Uprights of the walls");
    int number = 0;
    for (const auto& [x, top] :
         {ScenePoint{303, 404}, ScenePoint{497, 404}, ScenePoint{803, 458}, ScenePoint{997, 458}}) {
        ZephFixture& fixture =
            addFixture(display, prop, kFixtureStrings, "Corner " + std::to_string(++number), kLevelOutline, {2, 3, 3});
        addStroke(fixture, {{x, top}, {x, kHouseBase - 4}});
        const std::string name = fixture.Name;
        addChannel(fixture, addresses.qen(), name + " red", colors::kRed);
        addChannel(fixture, addresses.qen(), name + " green", colors::kGreen);
    }
}

}  // namespace

void hangHouseLights(ZephSimulation& display, AddressBook& addresses) {
    hangWash(display, addresses);
    hangCorners(display, addresses);
    hangPorch(display, addresses);
    hangWindows(display, addresses);
}
