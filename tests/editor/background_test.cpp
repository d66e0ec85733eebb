#include "editor/background.h"
#include "tests/support/recording_host.h"
#include "util/units.h"

#include <QTemporaryDir>

#include <memory>

namespace {

constexpr QRgb kCream = qRgb(250, 200, 100);

struct Folder {
    Folder() {
        QImage picture(4, 2, QImage::Format_RGB32);
        picture.fill(kCream);
        picture.save(directory.filePath("picture.png"));
        QImage white(1, 1, QImage::Format_RGB32);
        white.fill(Qt::white);
        // The reader goes by content, so a PNG may bear the name.
        white.save(directory.filePath("blank.gif"), "PNG");
        simulation->FilePath = path() + "/";
        simulation->Background = {kBackgroundPicture, "picture.png", 100, 4 * TwipsPerPixelX, 2 * TwipsPerPixelY};
    }
    std::string path() const { return directory.path().toStdString(); }

    QTemporaryDir directory;
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    RecordingHost host;
};

}  // namespace

TEST(Background, BrightnessIsTheFloorOfTheProduct) {
    // floor((100 - i) x -2.55), by hand; at 60 and 20 the product is whole and must not slip to the next number.
    struct Row {
        std::int32_t intensity;
        std::int32_t offset;
    };
    for (const Row& row : {Row{100, 0}, Row{99, -3}, Row{98, -6}, Row{80, -51}, Row{60, -102}, Row{50, -128},
                           Row{20, -204}, Row{1, -253}, Row{0, -255}}) {
        EXPECT_EQ(brightnessOffset(row.intensity), row.offset) << row.intensity;
    }
}

TEST(Background, DarkensEachByteAndStopsAtBlack) {
    Folder folder;
    folder.simulation->Background.PicIntensity = 50;  // 128 less
    const QImage shown = ZephResetBackground(*folder.simulation, folder.path(), folder.host);
    EXPECT_EQ(shown.pixel(3, 1), qRgb(122, 72, 0));
}

TEST(Background, LiesBesideTheEditorFileAndFillsTheCanvas) {
    Folder folder;
    folder.simulation->Background.EditorWidthTwips = 9 * TwipsPerPixelX + 14;  // the fraction of a pixel is cut off
    const QImage shown = ZephResetBackground(*folder.simulation, folder.path(), folder.host);
    EXPECT_EQ(shown.size(), QSize(9, 2));
    EXPECT_EQ(shown.pixel(8, 0), kCream);
    EXPECT_TRUE(folder.host.boxes.empty());
    folder.simulation->FilePath = "/nowhere/";
    folder.simulation->Background.PicFileName = folder.path() + "/picture.png";
    EXPECT_EQ(ZephResetBackground(*folder.simulation, folder.path(), folder.host).pixel(0, 0), kCream);
}

TEST(Background, FallsBackToTheBlankPictureAndThenToWhite) {
    Folder folder;
    folder.simulation->Background.PicFileName = "gone.png";
    EXPECT_EQ(ZephResetBackground(*folder.simulation, folder.path(), folder.host).pixel(3, 1), qRgb(255, 255, 255));
    ASSERT_EQ(folder.host.boxes.size(), 1U);
    EXPECT_EQ(folder.host.boxes[0].title, "Qen Visualizer-Picture Load Error");
    EXPECT_EQ(folder.host.boxes[0].text, "An error occurred while trying to load the background graphic");

    EXPECT_EQ(ZephResetBackground(*folder.simulation, "/nowhere", folder.host).pixel(3, 1), qRgb(255, 255, 255));
    ASSERT_EQ(folder.host.boxes.size(), 3U);
    EXPECT_EQ(folder.host.boxes[2].title, "Qen Visualizer-Preview Load Error");
    EXPECT_EQ(folder.host.boxes[2].text, "There was a problem loading the blank background.  Please contact support.");

    folder.simulation->Background.BackgroundType = 0;  // a plain background never looks for the picture
    EXPECT_EQ(ZephResetBackground(*folder.simulation, folder.path(), folder.host).size(), QSize(4, 2));
    EXPECT_EQ(folder.host.boxes.size(), 3U);
}
