#include "display.h"

#include <array>
#include <cmath>

namespace {

constexpr FixtureLook kPixelLook{2, 2, 11};

ZephFixture& addRun(ZephSimulation& display, int prop, const std::string& name, std::int32_t level,
                    std::int32_t universe, std::int32_t firstPixel, std::int32_t sample) {
    ZephFixture& fixture = addFixture(display, prop, kFixtureDmxPixels, name, level, kPixelLook);
    fixture.DMX = {firstPixel, universe};
    makePixels(fixture, sample);
    return fixture;
}

// Sixteen strands of fifty, three to a universe with five pixels of slack between them.
void hangMegaTree(ZephSimulation& display) {
    using namespace scene;
    constexpr int kStrands = 16;
    constexpr int kPixels = 50;
    constexpr int kFirstUniverse = 41;
    constexpr std::array kSamples{colors::kRed, colors::kGold, colors::kGreen, colors::kIce};
    const int prop = addProp(display, "Mega tree", "Sixteen strands of fifty pixels");
    display.Props[prop].QvColumn = kStrands;
    display.Props[prop].QvRow = kPixels;
    for (int strand0 = 0; strand0 < kStrands; ++strand0) {
        ZephFixture& fixture = addRun(display, prop, "Mega tree strand " + std::to_string(strand0 + 1), kLevelMegaTree,
                                      kFirstUniverse + strand0 / 3, 1 + strand0 % 3 * (kPixels + 5),
                                      kSamples[static_cast<std::size_t>(strand0 % 4)]);
        const double angle = M_PI * (1 - (strand0 + 0.5) / kStrands);  // the half that faces the street
        for (int pixel0 = 0; pixel0 < kPixels; ++pixel0) {
            const double share = 1 - static_cast<double>(pixel0) / (kPixels + 1);  // 1 at the foot
            addBulb(fixture, {kMegaTree.x + std::cos(angle) * kMegaTreeHalf * share,
                              kMegaTree.y - kMegaTreeHeight * (1 - share) + std::sin(angle) * 16 * share - 12});
        }
    }
}

void crownMegaTree(ZephSimulation& display) {
    using namespace scene;
    const int prop = addProp(display, "North Star", "On the mega tree, driven by name");
    const ScenePoint top{kMegaTree.x, kMegaTree.y - kMegaTreeHeight - 18};
    ZephFixture& rays = addFixture(display, prop, kFixtureStrings, "North Star rays", kLevelMegaTree, {2, 2, 1});
    for (int ray = 0; ray < 10; ++ray) {
        const double angle = M_PI / 5 * ray + M_PI / 2;
        const double reach = ray % 2 == 0 ? 38 : 22;
        addStroke(rays, {{top.x + std::cos(angle) * 16, top.y - std::sin(angle) * 16},
                         {top.x + std::cos(angle) * reach, top.y - std::sin(angle) * reach}});
    }
    addNamedChannel(rays, "North Star rays", colors::kWarmWhite);
    ZephFixture& star = addFixture(display, prop, kFixtureBulbs, "North Star", kLevelFront, {16, 2, 8});
    addBulb(star, top);
    addNamedChannel(star, "North Star", colors::kGold);
}

// 24 x 18 pixels on the garage door, six rows to a universe, drawn as two boards of three rows.
void hangMatrix(ZephSimulation& display) {
    using namespace scene;
    constexpr int kColumns = 24;
    constexpr int kRowsOfBoard = 3;
    constexpr int kBoards = 6;
    constexpr double kPitch = 6.2;
    const int prop = addProp(display, "Matrix", "On the garage door");
    display.Props[prop].QvMatrixInd = 1;
    display.Props[prop].QvColumn = kColumns;
    display.Props[prop].QvRow = kRowsOfBoard * kBoards;
    const ScenePoint middle = kGarageDoor.centre();
    for (int board0 = 0; board0 < kBoards; ++board0) {
        ZephFixture& fixture = addRun(display, prop, "Matrix board " + std::to_string(board0 + 1), kLevelMatrix,
                                      51 + board0 / 2, 1 + board0 % 2 * kColumns * kRowsOfBoard, colors::kIce);
        fixture.Novaline.QvRow = kRowsOfBoard;
        fixture.Novaline.QvColumn = kColumns;
        for (int row = 0; row < kRowsOfBoard; ++row) {
            for (int column = 0; column < kColumns; ++column) {
                addBulb(fixture,
                        {middle.x + (column - (kColumns - 1) / 2.0) * kPitch,
                         middle.y + (board0 * kRowsOfBoard + row - (kRowsOfBoard * kBoards - 1) / 2.0) * kPitch});
            }
        }
    }
}

// Swags along both fences on one universe; three pixels hang unseen behind the house between them.
void hangFence(ZephSimulation& display) {
    using namespace scene;
    constexpr int kPixels = 80;
    const int prop = addProp(display, "Fence", "One universe in two pieces");
    int piece = 0;
    for (const SceneFence& fence : kFences) {
        ZephFixture& fixture = addRun(display, prop, piece == 0 ? "Fence left" : "Fence right", kLevelFence, 20,
                                      piece == 0 ? 1 : kPixels + 4, colors::kGreen);
        ++piece;
        for (const ScenePoint& place : spread(fence.from, fence.to, kPixels)) {
            const double along = std::fmod(place.x - fence.from.x, 44) / 44;
            addBulb(fixture, {place.x, place.y + 5 + 18 * along * (1 - along) * 2.6});
        }
    }
}

}  // namespace

void hangPixels(ZephSimulation& display) {
    hangFence(display);
    hangMegaTree(display);
    crownMegaTree(display);
    hangMatrix(display);
}

void buildDisplay(ZephSimulation& display) {
    display.Background.BackgroundType = kBackgroundPicture;
    display.Background.PicFileName = "house.png";  // beside the editor file, wherever that lies
    display.Background.PicIntensity = 92;          // a little darker, so that the lights lead
    display.Background.EditorWidthTwips = scene::kWidth * 15;
    display.Background.EditorHeightTwips = scene::kHeight * 15;
    for (int level = 1; level <= kLevels; ++level) {
        display.Levels[level] = {true, true, "Level " + std::to_string(level)};
    }
    constexpr std::array kNames{
        "Background", "House outline", "Windows and doors", "Roof ornaments", "Trees",  "Bushes", "Fence",
        "Path",       "Arches",        "Mega tree",         "Matrix",         "Figures"};
    for (std::size_t name = 0; name < kNames.size(); ++name)
        display.Levels[static_cast<int>(name) + 1].Name = kNames[name];
    display.Levels[kLevels].Name = "Foreground";
    display.Dimmed = 50;

    AddressBook addresses;
    hangHouseLights(display, addresses);
    hangRoofLights(display, addresses);
    hangTreeLights(display, addresses);
    hangPixels(display);
    hangGardenLights(display, addresses);
    display.SimulationDirty = false;
}
