#include "editor/background.h"
#include "editor/picture_file.h"
#include "tests/support/folder.h"
#include "tests/support/recording_host.h"
#include "util/units.h"

#include <QBuffer>
#include <QPainter>

#include <memory>

namespace {

constexpr QRgb kCream = qRgb(250, 200, 100);

// A display of 4 x 2 pixels in a folder with its picture and the blank one.
struct Background : testing::Test {
    Background() {
        QImage picture(4, 2, QImage::Format_RGB32);
        picture.fill(kCream);
        picture.save(folder.qPath("picture.png"));
        picture.fill(Qt::white);
        // The reader goes by content, so a PNG may bear the name.
        picture.save(folder.qPath("blank.gif"), "PNG");
        simulation->FilePath = folder.path();
        simulation->Background = {kBackgroundPicture, "picture.png", 100, 4 * TwipsPerPixelX, 2 * TwipsPerPixelY};
    }
    QImage shown() { return ZephResetBackground(*simulation, folder.path(), host).picBackground; }
    QImage read(const char* name) const { return loadPicture(folder.path(name)); }

    Folder folder;
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    RecordingHost host;
};

// A JPEG of 16 x 8 pixels, red on the left and blue on the right, whose EXIF block tells that it is to be turned
// clockwise: its left becomes its top.
QByteArray turnedPhoto() {
    QImage picture(16, 8, QImage::Format_RGB32);
    picture.fill(Qt::red);
    QPainter(&picture).fillRect(8, 0, 8, 8, Qt::blue);
    QByteArray jpeg;
    QBuffer buffer(&jpeg);
    buffer.open(QIODevice::WriteOnly);
    picture.save(&buffer, "JPG", 100);
    // One entry in big-endian order: tag 0x0112, a short, of 6.
    QByteArray exif("\xFF\xE1\x00\x22"
                    "Exif\0\0MM\0*\0\0\0\x08\0\x01\x01\x12\0\x03\0\0\0\x01\0\6\0\0\0\0\0\0",
                    36);
    return jpeg.insert(2, exif);
}

}  // namespace

TEST(Brightness, IsTheFloorOfTheProductAndStopsAtBlack) {
    // floor((100 - i) x -2.55), by hand; at 60 and 20 the product is whole and must not slip to the next number.
    for (const auto& [intensity, offset] : {std::pair{100, 0}, {99, -3}, {60, -102}, {50, -128}, {20, -204}, {0, -255}})
        EXPECT_EQ(brightnessOffset(intensity), offset) << intensity;
    QImage picture(37, 1, QImage::Format_RGB32);
    picture.fill(qRgb(0, 99, 250));
    for (const auto& [offset, expected] :
         {std::pair{5, qRgb(5, 104, 255)}, {6, qRgb(6, 105, 255)}, {-99, qRgb(0, 0, 151)}, {0, qRgb(0, 99, 250)}}) {
        QImage changed = picture;
        ZephDrawFastBrightness(offset, changed);
        EXPECT_EQ(changed.pixel(36, 0), expected) << offset;
    }
}

TEST_F(Background, LiesBesideTheEditorFileAndFillsTheCanvas) {
    simulation->Background.EditorWidthTwips = 9 * TwipsPerPixelX + 14;  // the fraction of a pixel is cut off
    EXPECT_EQ(shown().size(), QSize(9, 2));
    EXPECT_EQ(shown().pixel(8, 0), kCream);
    simulation->FilePath = "/nowhere/";
    simulation->Background.PicFileName = folder.path("picture.png");
    simulation->Background.PicIntensity = 50;  // 128 less
    const ZephBackgroundSurfaces surfaces = ZephResetBackground(*simulation, folder.path(), host);
    EXPECT_EQ(surfaces.picBackground.pixel(0, 0), qRgb(122, 72, 0));
    EXPECT_EQ(surfaces.Picture3.pixel(0, 0), kCream);
    const QImage full = pictureAtIntensity(surfaces.Picture3, 100);
    EXPECT_EQ(full.cacheKey(), surfaces.Picture3.cacheKey());  // not even copied
    EXPECT_EQ(previewPicture(surfaces.Picture3, QSize(400, 100), QSize(80, 80)).size(), QSize(80, 20));
    EXPECT_EQ(host.boxTexts(), "");
}

TEST_F(Background, FallsBackToTheBlankPictureAndThenToWhite) {
    const std::string picture =
        "Qen Visualizer-Picture Load Error|An error occurred while trying to load the background graphic";
    const std::string blank = "Qen Visualizer-Preview Load Error|There was a problem loading the blank background";
    simulation->Background.PicFileName = "gone.png";
    EXPECT_EQ(shown().pixel(3, 1), qRgb(255, 255, 255));
    EXPECT_EQ(host.boxTexts(), picture);

    host.boxes.clear();
    EXPECT_EQ(ZephResetBackground(*simulation, "/nowhere", host).picBackground.pixel(3, 1), qRgb(255, 255, 255));
    EXPECT_EQ(host.boxTexts(), picture + "\n" + blank + ".  Please contact support.");

    // On a change the numbers tell where it failed.
    host.boxes.clear();
    EXPECT_TRUE(loadBackground(*simulation, "/nowhere", BackgroundTexts::Change, host).pictureFailed);
    simulation->Background.BackgroundType = 1;  // a plain background never looks for the picture
    loadBackground(*simulation, "/nowhere", BackgroundTexts::Change, host);
    EXPECT_EQ(host.boxTexts(), picture + " (003)\n" + blank + " (001).  Please contact support.\n" + blank +
                                   " (002).  Please contact support.");
}

TEST_F(Background, APhotoStandsAsTheCameraWasHeld) {
    for (const char* name : {"turned.jpg", "turned.png"}) {  // the content tells what it is
        folder.write(name, turnedPhoto());
        const QImage turned = read(name);
        ASSERT_EQ(turned.size(), QSize(8, 16)) << name;
        EXPECT_GT(qRed(turned.pixel(4, 2)), 200) << name;
        EXPECT_GT(qBlue(turned.pixel(4, 13)), 200) << name;
    }
}

TEST_F(Background, ReadsEveryFormatAndShowsWhiteThroughHoles) {
    QImage picture(6, 3, QImage::Format_RGB32);
    picture.fill(kCream);
    for (const char* name : {"any@2x.bmp", "any@2x.png", "any@2x.jpg", "any@2x.tif"}) {  // no picture for 2x screens
        ASSERT_TRUE(picture.save(folder.qPath(name))) << name;
        EXPECT_EQ(read(name).size(), QSize(6, 3)) << name;
        EXPECT_EQ(read(name).devicePixelRatio(), 1.0) << name;
        EXPECT_EQ(read(name).format(), QImage::Format_RGB32) << name;
    }
    folder.write("any.gif", QByteArray("GIF89a\1\0\1\0\x80\0\0\xFA\xC8\x64\0\0\0,\0\0\0\0\1\0\1\0\0\2\2\x44\1\0;", 35));
    EXPECT_EQ(read("any.gif").pixel(0, 0), kCream);
    QImage holes(2, 1, QImage::Format_ARGB32);
    holes.fill(Qt::transparent);
    holes.setPixel(1, 0, kCream);
    holes.save(folder.qPath("holes.png"));
    EXPECT_EQ(read("holes.png").pixel(0, 0), qRgb(255, 255, 255));
    EXPECT_EQ(read("holes.png").pixel(1, 0), kCream);
    for (const char* none : {"none.gif", ""})
        EXPECT_TRUE(read(none).isNull()) << none;
}

TEST_F(Background, AMovedDisplayFindsItsPictureBesideOrBelowIt) {
    ASSERT_TRUE(QDir(folder.qPath()).mkpath("pics/summer"));
    for (const char* name : {"front.jpg", "pics/front.jpg", "pics/summer/tree.jpg"})
        folder.write(name, "");
    const std::pair<std::string, std::string> rows[] = {
        {folder.path("front.jpg"), folder.path("front.jpg")},
        {"pics/front.jpg", folder.path("pics/front.jpg")},
        {"/old/house/front.jpg", folder.path("front.jpg")},
        {"/old/house/pics/front.jpg", folder.path("pics/front.jpg")},  // the longest end that is there
        {"C:\\House\\pics\\summer\\tree.jpg", folder.path("pics/summer/tree.jpg")},
        {"/old/pics/gone.jpg", "/old/pics/gone.jpg"},
    };
    for (const auto& [stored, found] : rows) {
        simulation->Background.PicFileName = stored;
        EXPECT_EQ(ZephFindBackgroundPicture(*simulation), found) << stored;
    }
    simulation->FilePath.clear();  // never saved: there is no place to look in
    simulation->Background.PicFileName = "/old/house/front.jpg";
    EXPECT_EQ(ZephFindBackgroundPicture(*simulation), "/old/house/front.jpg");
}
