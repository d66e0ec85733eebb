// Small tools with which the example's display is put together: fixtures, strokes and addresses. Positions are canvas
// pixels and become twips here.
#pragma once

#include "model/simulation.h"
#include "scene.h"
#include "util/color.h"

#include <string>
#include <vector>

namespace colors {
inline constexpr std::int32_t kRed = packColor(255, 36, 28);
inline constexpr std::int32_t kGreen = packColor(36, 230, 70);
inline constexpr std::int32_t kBlue = packColor(50, 90, 255);
inline constexpr std::int32_t kAmber = packColor(255, 168, 34);
inline constexpr std::int32_t kViolet = packColor(196, 70, 255);
inline constexpr std::int32_t kWarmWhite = packColor(255, 226, 164);
inline constexpr std::int32_t kColdWhite = packColor(222, 236, 255);
inline constexpr std::int32_t kIce = packColor(132, 206, 255);
inline constexpr std::int32_t kGold = packColor(255, 208, 70);
inline constexpr std::int32_t kPink = packColor(255, 96, 150);
}  // namespace colors

struct Address {
    std::int32_t DeviceType = 0;
    std::int32_t Network = 0;
    std::int32_t Controller = 0;
    std::int32_t Channel = 0;
};

// Hands out free channels, device by device.
class AddressBook {
public:
    Address qen();     // network 0, sixteen circuits a unit
    Address dasher();  // the same on Dasher units
    Address bsoft();
    Address digital();  // the digital IO card
    Address x10();
    Address dmx();  // universe 30
    // Base units of ribbons: a Normal one takes one unit of network 1, a Legacy one ten of network 2.
    ZephKeshData ribbon(std::int32_t unitMode, std::int32_t channelMode, std::int32_t resolution);

private:
    std::int32_t qen_ = 0;
    std::int32_t dasher_ = 0;
    std::int32_t bsoft_ = 0;
    std::int32_t digital_ = 0;
    std::int32_t x10_ = 0;
    std::int32_t dmx_ = 0;
    std::int32_t normalRibbons_ = 0;
    std::int32_t legacyRibbons_ = 0;
};

// Levels of the example, in painting order.
enum Level : std::int32_t {
    kLevelWash = 1,
    kLevelOutline,
    kLevelWindows,
    kLevelRoof,
    kLevelTrees,
    kLevelBushes,
    kLevelFence,
    kLevelPath,
    kLevelArches,
    kLevelMegaTree,
    kLevelMatrix,
    kLevelFigures,
    kLevelFront = 16
};

struct FixtureLook {
    std::int32_t size = 2;     // pixels, radius of a bulb
    std::int32_t spacing = 4;  // pixels between bulbs
    std::int32_t shape = 1;
};

// Appends a prop and gives its number.
int addProp(ZephSimulation& display, const std::string& name, const std::string& comment);
// Appends a fixture of the type on the level; prop 0 = it stands alone.
ZephFixture& addFixture(ZephSimulation& display, int prop, std::int32_t type, const std::string& name,
                        std::int32_t level, FixtureLook look);

void addBulb(ZephFixture& fixture, ScenePoint place);
// A line through all points, not joined to what was drawn before.
void addStroke(ZephFixture& fixture, const std::vector<ScenePoint>& points);

// The next channel of a Normal fixture, which it returns.
ZephChannel& addChannel(ZephFixture& fixture, const Address& address, const std::string& name, std::int32_t color);
// A channel without a device, driven by its name.
ZephChannel& addNamedChannel(ZephFixture& fixture, const std::string& name, std::int32_t color);
// Makes the fixture an RGB fixture on three channels; sample is the colour that the editor shows.
void addRgbChannels(ZephFixture& fixture, const Address& red, const Address& green, const Address& blue,
                    std::int32_t sample);
void makePixels(ZephFixture& fixture, std::int32_t sample);

// count places from one point to the other, both included.
std::vector<ScenePoint> spread(ScenePoint from, ScenePoint to, int count);
std::vector<ScenePoint> ellipse(ScenePoint middle, double radiusX, double radiusY, int corners);
