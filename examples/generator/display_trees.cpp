#include "big_tree.h"
#include "display.h"

#include <array>
#include <cmath>

namespace {

void hangBigTree(ZephSimulation& display, AddressBook& addresses) {
    const int prop = addProp(display, "Old tree", "One RGB string a bough, lanterns below");
    const std::vector<TreeLimb> limbs = bigTreeLimbs();
    constexpr std::array kBoughColors{colors::kPink, colors::kViolet, colors::kBlue, colors::kIce, colors::kGreen};
    for (int bough = 1; bough <= 5; ++bough) {
        ZephFixture& fixture =
            addFixture(display, prop, kFixtureStrings, "Bough " + std::to_string(bough), kLevelTrees, {2, 2, 1});
        for (const TreeLimb& limb : limbs) {
            if (limb.bough == bough) addStroke(fixture, {limb.from, limb.to});
        }
        const Address red = addresses.qen();
        const Address green = addresses.qen();
        addRgbChannels(fixture, red, green, addresses.qen(), kBoughColors[static_cast<std::size_t>(bough - 1)]);
    }
    ZephFixture& trunk = addFixture(display, prop, kFixtureStrings, "Trunk", kLevelTrees, {2, 2, 1});
    std::vector<ScenePoint> winding;
    const TreeLimb& stem = limbs.front();
    bool left = true;
    for (double y = stem.from.y - 4; y > stem.to.y; y -= 7, left = !left)
        winding.push_back({stem.from.x + (left ? -9 : 9), y});
    addStroke(trunk, winding);
    addChannel(trunk, addresses.qen(), "Trunk warm", colors::kWarmWhite);
    addChannel(trunk, addresses.qen(), "Trunk red", colors::kRed);

    int lantern = 0;
    for (const TreeLimb& limb : limbs) {
        if (limb.order != 2 || limb.to.y > 530) continue;
        if (++lantern % 2 == 0 || lantern > 13) continue;
        ZephFixture& fixture = addFixture(display, prop, kFixtureBulbs, "Lantern " + std::to_string((lantern + 1) / 2),
                                          kLevelTrees, {6, 2, lantern % 4 == 1 ? 6 : 5});
        addBulb(fixture, {limb.to.x, limb.to.y + 9});
        constexpr std::array kLanternColors{colors::kAmber, colors::kRed, colors::kGold, colors::kPink};
        addChannel(fixture, addresses.bsoft(), fixture.Name, kLanternColors[static_cast<std::size_t>(lantern / 2 % 4)]);
    }
}

void hangFirs(ZephSimulation& display, AddressBook& addresses) {
    const int prop = addProp(display, "Firs", "Garlands and a star on each");
    int number = 0;
    for (const SceneFir& fir : scene::kFirs) {
        ++number;
        ZephFixture& fixture =
            addFixture(display, prop, kFixtureStrings, "Fir " + std::to_string(number), kLevelTrees, {2, 3, 1});
        std::vector<ScenePoint> garland;
        constexpr int kTurns = 11;
        for (int turn = 0; turn <= kTurns; ++turn) {  // from side to side, wider towards the foot
            const double share = static_cast<double>(turn) / kTurns;
            const double half = fir.half * (0.06 + 0.88 * share);
            garland.push_back(
                {fir.foot.x + (turn % 2 == 0 ? -half : half), fir.foot.y - fir.height + (fir.height - 16) * share});
        }
        addStroke(fixture, garland);
        if (number % 2 == 1) {
            ZephChannel& channel = addChannel(fixture, addresses.qen(), fixture.Name, colors::kRed);
            channel.Sub_Type = kSpecialMultiColor;
            channel.Sub_Parm = 3;
            channel.Multi[1] = colors::kRed;
            channel.Multi[2] = colors::kGold;
            channel.Multi[3] = colors::kGreen;
            addChannel(fixture, addresses.qen(), fixture.Name + " white", colors::kColdWhite);
        } else {
            constexpr std::array kGarland{colors::kRed,  colors::kGreen,  colors::kBlue, colors::kAmber,
                                          colors::kPink, colors::kViolet, colors::kIce,  colors::kGold};
            for (const std::int32_t color : kGarland) {
                addChannel(fixture, addresses.qen(),
                           fixture.Name + " circuit " + std::to_string(fixture.ChannelCount + 1), color);
            }
        }
        ZephFixture& star =
            addFixture(display, prop, kFixtureBulbs, "Fir star " + std::to_string(number), kLevelTrees, {8, 2, 9});
        addBulb(star, {fir.foot.x, fir.foot.y - fir.height - 6});
        addChannel(star, addresses.x10(), star.Name, colors::kGold);
    }
}

void hangBushes(ZephSimulation& display, AddressBook& addresses) {
    const int prop = addProp(display, "Bushes", "Net lights");
    int number = 0;
    for (const SceneBush& bush : scene::kBushes) {
        ZephFixture& fixture =
            addFixture(display, prop, kFixtureBulbs, "Bush " + std::to_string(++number), kLevelBushes, {2, 2, 1});
        for (int row = -3; row <= 3; ++row) {
            for (int column = -7; column <= 7; ++column) {
                const double x = (column + (row % 2 == 0 ? 0.0 : 0.5)) / 7.0;
                const double y = row / 3.4;
                if (x * x + y * y < 0.98)
                    addBulb(fixture, {bush.middle.x + x * bush.halfWidth, bush.middle.y + y * bush.halfHeight});
            }
        }
        const Address red = addresses.qen();
        const Address green = addresses.qen();
        addRgbChannels(fixture, red, green, addresses.qen(), number % 2 == 1 ? colors::kGreen : colors::kRed);
    }
}

}  // namespace

void hangTreeLights(ZephSimulation& display, AddressBook& addresses) {
    hangBigTree(display, addresses);
    hangFirs(display, addresses);
    hangBushes(display, addresses);
}
