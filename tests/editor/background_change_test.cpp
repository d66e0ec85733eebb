#include "editor/background_change.h"
#include "editor/editor_watcher.h"
#include "editor/new_simulation.h"
#include "tests/support/recording_host.h"
#include "util/rounding.h"
#include "util/units.h"

#include <memory>

namespace {

struct BackgroundChange : testing::Test {
    BackgroundChange() {
        simulation->Background = {0, "", 100, 30, 60};  // twips
        simulation->FixtureCount = 2;
        ZephFixture& fixture = simulation->Fixtures[1];
        fixture.BulbSize = 4;
        for (const auto& [x, y] : {std::pair{1, 1}, {3, 7}, {-1, -5}, {0, 0}, {9, 9}})
            fixture.DrawPoints[++fixture.PointCount] = {kPointLine, x, y};
        --fixture.PointCount;  // the last is past the count
        simulation->Fixtures[2] = fixture;
    }
    bool take(std::int32_t widthTwips, std::int32_t heightTwips) {
        return ZephTakeBackground({0, "", 100, widthTwips, heightTwips}, *simulation);
    }
    std::string points(int fixture) {
        std::string text;
        for (int p = 1; p <= 5; ++p) {
            const ZephDrawPoint& point = simulation->Fixtures[fixture].DrawPoints[p];
            text += std::to_string(point.X) + "," + std::to_string(point.Y) + " ";
        }
        return text;
    }

    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    RecordingHost host;
};

}  // namespace

TEST_F(BackgroundChange, PointsKeepTheirPlaceOnTheNewCanvas) {
    EXPECT_FALSE(take(30, 60));
    EXPECT_TRUE(simulation->SimulationDirty);
    EXPECT_EQ(points(1), "1,1 3,7 -1,-5 0,0 9,9 ");
    // Half as wide again: 1.5, 4.5, -1.5 go to the even neighbour. Half as high: 0.5, 3.5, -2.5.
    EXPECT_TRUE(take(45, 30));
    EXPECT_EQ(points(1), "2,0 4,4 -2,-2 0,0 9,9 ");
    EXPECT_EQ(points(2), points(1));
    EXPECT_EQ(simulation->Fixtures[1].BulbSize, 4);
    // A canvas without a size counts as one pixel.
    simulation->Background.EditorWidthTwips = 0;
    simulation->Background.EditorHeightTwips = -3;
    EXPECT_TRUE(take(2 * TwipsPerPixelX, 3 * TwipsPerPixelY));
    EXPECT_EQ(points(1), "4,0 8,12 -4,-6 0,0 9,9 ");
    // Scaling is exact, and saturates.
    EXPECT_EQ(scaleHalfEven(35, 9, 30), 10);  // 10.5, which 35 x 0.3 need not be
    EXPECT_EQ(scaleHalfEven(-45, 9, 30), -14);
    EXPECT_EQ(scaleHalfEven(2147483647, 2, 1), 2147483647);
    EXPECT_EQ(scaleHalfUp(-3, 1, 2), -1);
}

TEST_F(BackgroundChange, TheLargestCanvasIs2500PixelsEachWay) {
    ZephBackground background;
    setSizePixels({2500, 1}, background);
    EXPECT_TRUE(ZephCheckBackground(background, host));
    background.EditorWidthTwips += TwipsPerPixelX - 1;  // the fraction of a pixel is cut off
    EXPECT_TRUE(ZephCheckBackground(background, host));
    setSizePixels({2501, 2}, background);
    EXPECT_FALSE(ZephCheckBackground(background, host));
    host.boxes.clear();
    setSizePixels({2, 2501}, background);
    EXPECT_FALSE(ZephCheckBackground(background, host));
    EXPECT_EQ(host.boxTexts(), "Qen Visualizer-Maximum Size|Your simulation is too large.  The Maximum size is 2500 by "
                               "2500.\r\nPlease resize your simulation");
    // A size that is the same in pixels keeps the odd twips.
    background.EditorWidthTwips = 37;
    setSizePixels({2, 2501}, background);
    EXPECT_EQ(background.EditorWidthTwips, 37);
}

TEST_F(BackgroundChange, ATypedSizeIsANumberWithinTheLimits) {
    EXPECT_EQ(ZephCheckNewSize("1", "2500", host), QSize(1, 2500));
    EXPECT_TRUE(host.boxes.empty());
    for (const auto& [width, height] : {std::pair{"0", "1"}, {"1", "2501"}, {"", "7"}, {"99999999999", "1"}}) {
        host.boxes.clear();
        EXPECT_EQ(ZephCheckNewSize(width, height, host), std::nullopt) << width << " " << height;
        EXPECT_EQ(host.boxTexts(), "Qen Visualizer-Bad Simulation Size|Invalid simulation size.  Simulation size must "
                                   "be between 1x1 and\r\n2500x2500.");
    }
}

TEST_F(BackgroundChange, ANewSimulationKeepsNothingOfTheOldOne) {
    ZephEditorState editor;
    editor.ZephSelection.Object = 2;
    ZephUndoStores stores;
    editor.ZephClipboard.resize(1);
    stores.UndoPosition = 1;
    EditorStateWatcher watcher(editor, stores);
    editor.ZephAppendTarget = 3;
    watcher.fixtureRemoved(2);
    EXPECT_EQ(editor.ZephAppendTarget, 2) << "the same fixture, which has moved down";
    simulation->FileName = "old.zee";
    simulation->SimulationDirty = simulation->ChecksumMismatch = true;
    simulation->Props[1].Name = "Tree";
    ZephSimulation fresh;
    for (int level = 1; level <= kLevels; ++level)
        fresh.Levels[level].Name = "Level " + std::to_string(level);
    fresh.Levels[1].Name = "Background";
    fresh.Levels[16].Name = "Foreground";
    fresh.Dimmed = 50;
    fresh.Background = {kBackgroundPicture, "/a.jpg", 100, 1500, 900};
    beginSimulation(fresh.Background, *simulation, watcher);
    EXPECT_TRUE(*simulation == fresh);
    EXPECT_EQ(editor.ZephSelection.Object + editor.ZephAppendTarget + stores.UndoPosition, 0);
    EXPECT_TRUE(editor.ZephClipboard.empty());
}
