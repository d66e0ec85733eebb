#include "editor/background.h"
#include "editor/picture_file.h"
#include "tests/support/recording_host.h"
#include "util/units.h"

#include <QBuffer>
#include <QDir>
#include <QFile>
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

// A JPEG of 16 x 8 pixels, red on the left and blue on the right, whose EXIF block tells how the camera was held.
void writePhoto(const QString& file, char orientation) {
    QImage picture(16, 8, QImage::Format_RGB32);
    picture.fill(Qt::red);
    for (int y = 0; y < 8; ++y)
        for (int x = 8; x < 16; ++x)
            picture.setPixel(x, y, qRgb(0, 0, 255));
    QByteArray jpeg;
    QBuffer buffer(&jpeg);
    buffer.open(QIODevice::WriteOnly);
    picture.save(&buffer, "JPG", 100);
    // One entry in big-endian order: tag 0x0112, a short.
    QByteArray exif("\xFF\xE1\x00\x22"
                    "Exif\0\0MM\0*\0\0\0\x08\0\x01\x01\x12\0\x03\0\0\0\x01\0?\0\0\0\0\0\0",
                    36);
    exif[29] = orientation;
    QFile written(file);
    ASSERT_TRUE(written.open(QIODevice::WriteOnly));
    written.write(jpeg.insert(2, exif));
}

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
    const QImage shown = ZephResetBackground(*folder.simulation, folder.path(), folder.host).picBackground;
    EXPECT_EQ(shown.pixel(3, 1), qRgb(122, 72, 0));
    QImage picture(37, 1, QImage::Format_RGB32);
    picture.fill(qRgb(0, 99, 250));
    const struct {
        std::int32_t offset;
        QRgb expected;
    } rows[] = {{5, qRgb(5, 104, 255)}, {6, qRgb(6, 105, 255)}, {255, qRgb(255, 255, 255)},
                {-99, qRgb(0, 0, 151)}, {-255, qRgb(0, 0, 0)},  {0, qRgb(0, 99, 250)}};
    for (const auto& row : rows) {
        QImage changed = picture;
        ZephDrawFastBrightness(row.offset, changed);
        EXPECT_EQ(changed.pixel(36, 0), row.expected) << row.offset;
    }
}

TEST(Background, LiesBesideTheEditorFileAndFillsTheCanvas) {
    Folder folder;
    folder.simulation->Background.EditorWidthTwips = 9 * TwipsPerPixelX + 14;  // the fraction of a pixel is cut off
    const QImage shown = ZephResetBackground(*folder.simulation, folder.path(), folder.host).picBackground;
    EXPECT_EQ(shown.size(), QSize(9, 2));
    EXPECT_EQ(shown.pixel(8, 0), kCream);
    EXPECT_TRUE(folder.host.boxes.empty());
    folder.simulation->FilePath = "/nowhere/";
    folder.simulation->Background.PicFileName = folder.path() + "/picture.png";
    EXPECT_EQ(ZephResetBackground(*folder.simulation, folder.path(), folder.host).picBackground.pixel(0, 0), kCream);
}

TEST(Background, FallsBackToTheBlankPictureAndThenToWhite) {
    Folder folder;
    folder.simulation->Background.PicFileName = "gone.png";
    EXPECT_EQ(ZephResetBackground(*folder.simulation, folder.path(), folder.host).picBackground.pixel(3, 1),
              qRgb(255, 255, 255));
    ASSERT_EQ(folder.host.boxes.size(), 1U);
    EXPECT_EQ(folder.host.boxes[0].title, "Qen Visualizer-Picture Load Error");
    EXPECT_EQ(folder.host.boxes[0].text, "An error occurred while trying to load the background graphic");

    EXPECT_EQ(ZephResetBackground(*folder.simulation, "/nowhere", folder.host).picBackground.pixel(3, 1),
              qRgb(255, 255, 255));
    ASSERT_EQ(folder.host.boxes.size(), 3U);
    EXPECT_EQ(folder.host.boxes[2].title, "Qen Visualizer-Preview Load Error");
    EXPECT_EQ(folder.host.boxes[2].text, "There was a problem loading the blank background.  Please contact support.");

    folder.simulation->Background.BackgroundType = 0;  // a plain background never looks for the picture
    EXPECT_EQ(ZephResetBackground(*folder.simulation, folder.path(), folder.host).picBackground.size(), QSize(4, 2));
    EXPECT_EQ(folder.host.boxes.size(), 3U);
}

TEST(Background, TheNumbersOfAChangeTellWhereItFailed) {
    Folder folder;
    folder.simulation->Background.PicFileName = "gone.png";
    EXPECT_TRUE(loadBackground(*folder.simulation, "/nowhere", BackgroundTexts::Change, folder.host).pictureFailed);
    folder.simulation->Background.BackgroundType = 1;
    loadBackground(*folder.simulation, "/nowhere", BackgroundTexts::Change, folder.host);
    ASSERT_EQ(folder.host.boxes.size(), 3U);
    EXPECT_EQ(folder.host.boxes[0].text, "An error occurred while trying to load the background graphic (003)");
    const std::string blank = "There was a problem loading the blank background (00";
    EXPECT_EQ(folder.host.boxes[1].text, blank + "1).  Please contact support.");
    EXPECT_EQ(folder.host.boxes[2].text, blank + "2).  Please contact support.");
}

TEST(Background, KeepsThePictureAtItsOwnBrightnessBesideTheDarkenedOne) {
    Folder folder;
    folder.simulation->Background.PicIntensity = 50;
    const ZephBackgroundSurfaces surfaces = ZephResetBackground(*folder.simulation, folder.path(), folder.host);
    EXPECT_EQ(surfaces.Picture3.pixel(0, 0), kCream);
    EXPECT_EQ(surfaces.picBackground.pixel(0, 0), qRgb(122, 72, 0));
    const QImage full = pictureAtIntensity(surfaces.Picture3, 100);
    EXPECT_EQ(full.cacheKey(), surfaces.Picture3.cacheKey());  // not even copied
    EXPECT_EQ(previewPicture(surfaces.Picture3, QSize(400, 100), QSize(80, 80)).size(), QSize(80, 20));
}

TEST(PictureFile, APhotoStandsAsTheCameraWasHeld) {
    Folder folder;
    const auto at = [&](const char* name) { return folder.directory.filePath(name); };
    writePhoto(at("upright.jpg"), 1);
    writePhoto(at("turned.jpg"), 6);  // to be turned clockwise: its left becomes its top
    writePhoto(at("turned.png"), 6);  // the content tells what it is
    const QImage upright = loadPicture(at("upright.jpg").toStdString());
    EXPECT_EQ(upright.size(), QSize(16, 8));
    for (const char* name : {"turned.jpg", "turned.png"}) {
        const QImage turned = loadPicture(at(name).toStdString());
        ASSERT_EQ(turned.size(), QSize(8, 16)) << name;
        EXPECT_GT(qRed(turned.pixel(4, 2)), 200) << name;
        EXPECT_GT(qBlue(turned.pixel(4, 13)), 200) << name;
    }
    // And so on the canvas.
    folder.simulation->Background = {kBackgroundPicture, "turned.jpg", 100, 8 * TwipsPerPixelX, 16 * TwipsPerPixelY};
    EXPECT_GT(qBlue(ZephResetBackground(*folder.simulation, folder.path(), folder.host).picBackground.pixel(4, 13)),
              200);
}

TEST(PictureFile, ReadsEveryFormatAndShowsWhiteThroughHoles) {
    Folder folder;
    QImage picture(6, 3, QImage::Format_RGB32);
    picture.fill(kCream);
    for (const char* format : {"bmp", "png", "jpg", "tif"}) {
        const QString file = folder.directory.filePath(QString("any@2x.%1").arg(format));  // no picture for 2x screens
        ASSERT_TRUE(picture.save(file)) << format;
        const QImage read = loadPicture(file.toStdString());
        EXPECT_EQ(read.size(), QSize(6, 3)) << format;
        EXPECT_EQ(read.devicePixelRatio(), 1.0) << format;
        EXPECT_EQ(read.format(), QImage::Format_RGB32) << format;
    }
    const QByteArray gif("GIF89a\1\0\1\0\x80\0\0\xFA\xC8\x64\0\0\0,\0\0\0\0\1\0\1\0\0\2\2\x44\1\0;", 35);
    QFile file(folder.directory.filePath("any.gif"));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(gif);
    file.close();
    EXPECT_EQ(loadPicture(file.fileName().toStdString()).pixel(0, 0), kCream);

    QImage holes(2, 1, QImage::Format_ARGB32);
    holes.fill(Qt::transparent);
    holes.setPixel(1, 0, kCream);
    holes.save(folder.directory.filePath("holes.png"));
    const QImage opaque = loadPicture(folder.directory.filePath("holes.png").toStdString());
    EXPECT_EQ(opaque.pixel(0, 0), qRgb(255, 255, 255));
    EXPECT_EQ(opaque.pixel(1, 0), kCream);

    file.remove();
    for (const QString& none : {file.fileName(), folder.directory.path(), QString("/nowhere/at.all"), QString()})
        EXPECT_TRUE(loadPicture(none.toStdString()).isNull()) << none.toStdString();
}

TEST(PictureFile, AMovedDisplayFindsItsPictureBesideOrBelowIt) {
    Folder folder;
    ASSERT_TRUE(QDir(folder.directory.path()).mkpath("pics/summer"));
    const auto touch = [&](const char* name) {
        QFile file(folder.directory.filePath(name));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        return file.fileName().toStdString();
    };
    const std::string beside = touch("front.jpg");
    const std::string below = touch("pics/front.jpg");
    const std::string deeper = touch("pics/summer/tree.jpg");
    const struct {
        std::string stored;
        std::string found;
    } rows[] = {
        {beside, beside},
        {"pics/front.jpg", below},
        {"/old/house/front.jpg", beside},
        {"/old/house/pics/front.jpg", below},  // the longest end that is there
        {"C:\\House\\pics\\summer\\tree.jpg", deeper},
        {"/old/pics/gone.jpg", "/old/pics/gone.jpg"},
        {"", ""},
    };
    for (const auto& row : rows) {
        folder.simulation->Background.PicFileName = row.stored;
        EXPECT_EQ(ZephFindBackgroundPicture(*folder.simulation), row.found) << row.stored;
    }
    folder.simulation->FilePath.clear();  // never saved: there is no place to look in
    folder.simulation->Background.PicFileName = "/old/house/front.jpg";
    EXPECT_EQ(ZephFindBackgroundPicture(*folder.simulation), "/old/house/front.jpg");
}
