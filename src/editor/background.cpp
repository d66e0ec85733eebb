#include "editor/background.h"

#include "editor/picture_file.h"
#include "util/rounding.h"

#include <QDir>

#include <algorithm>

namespace {

constexpr const char* kBlankPicture = "blank.gif";

// number: of the place in the program, "" = none.
QImage blankPicture(const std::string& programFolder, const std::string& number, Host& host) {
    const QDir folder(QString::fromStdString(programFolder));
    const QImage blank = loadPicture(folder.filePath(kBlankPicture).toStdString());
    if (!blank.isNull()) return blank;
    host.messageBox(boxTitle("-Preview Load Error"),
                    "There was a problem loading the blank background" + number + ".  Please contact support.",
                    BoxIcon::Critical);
    return whitePicture();
}

QImage stretched(const QImage& picture, QSize size) {
    if (picture.size() == size) return picture;
    return picture.scaled(size, Qt::IgnoreAspectRatio, Qt::SmoothTransformation).convertToFormat(QImage::Format_RGB32);
}

}  // namespace

std::int32_t brightnessOffset(std::int32_t intensity) noexcept {
    // In hundredths, rounded away from zero: a product in floating point may land beside the whole number.
    const std::int32_t missing = 100 - std::clamp(intensity, 0, 100);
    return -((missing * 255 + 99) / 100);
}

void ZephDrawFastBrightness(std::int32_t offset, QImage& picture) {
    // Held to the bytes that stay one when the offset is added, in a form that the compiler turns into operations on
    // whole registers of bytes: a look-up in a table would be one load a byte.
    const std::int32_t held = std::clamp(offset, -255, 255);
    const auto low = static_cast<std::uint8_t>(std::max(-held, 0));
    const auto high = static_cast<std::uint8_t>(std::min(255 - held, 255));
    const auto add = static_cast<std::uint8_t>(held & 0xFF);
    const int width = picture.width();  // known to stay as it is while bytes are written
    for (int y = 0; y < picture.height(); ++y) {
        std::uint8_t* const bytes = picture.scanLine(y);
        for (int n = 0; n < 4 * width; ++n) {
            bytes[n] = static_cast<std::uint8_t>(std::min(std::max(bytes[n], low), high) + add);
        }
        QRgb* const row = reinterpret_cast<QRgb*>(bytes);
        for (int x = 0; x < width; ++x)
            row[x] |= 0xFF000000;
    }
}

QSize canvasSize(const ZephBackground& background) noexcept {
    return {std::clamp(widthPixels(background), 1, kMaxCanvasPixels),
            std::clamp(heightPixels(background), 1, kMaxCanvasPixels)};
}

QImage pictureAtIntensity(const QImage& Picture3, std::int32_t intensity) {
    QImage dimmed = Picture3;
    if (intensity != 100) ZephDrawFastBrightness(brightnessOffset(intensity), dimmed);
    return dimmed;
}

ZephBackgroundSurfaces ZephResizeAndSetBackgroundIntensity(const QImage& Image1, const ZephBackground& background) {
    ZephBackgroundSurfaces surfaces;
    surfaces.Picture3 = stretched(Image1, canvasSize(background));
    surfaces.picBackground = pictureAtIntensity(surfaces.Picture3, background.PicIntensity);
    return surfaces;
}

ZephBackgroundSurfaces loadBackground(const ZephSimulation& simulation, const std::string& programFolder,
                                      BackgroundTexts texts, Host& host) {
    const auto number = [&](const char* ofChange) {
        return texts == BackgroundTexts::Change ? std::string(ofChange) : std::string();
    };
    if (simulation.Background.BackgroundType != kBackgroundPicture) {
        return ZephResizeAndSetBackgroundIntensity(blankPicture(programFolder, number(" (002)"), host),
                                                   simulation.Background);
    }
    QImage picture = loadPicture(ZephFindBackgroundPicture(simulation));
    const bool failed = picture.isNull();
    if (failed) {
        host.messageBox(boxTitle("-Picture Load Error"),
                        "An error occurred while trying to load the background graphic" + number(" (003)"),
                        BoxIcon::Critical);
        picture = blankPicture(programFolder, number(" (001)"), host);
    }
    ZephBackgroundSurfaces surfaces = ZephResizeAndSetBackgroundIntensity(picture, simulation.Background);
    surfaces.pictureFailed = failed;
    return surfaces;
}

ZephBackgroundSurfaces ZephResetBackground(const ZephSimulation& simulation, const std::string& programFolder,
                                           Host& host) {
    return loadBackground(simulation, programFolder, BackgroundTexts::Reset, host);
}

QImage whitePicture() {
    QImage white(1, 1, QImage::Format_RGB32);
    white.fill(Qt::white);
    return white;
}

QImage previewPicture(const QImage& Image1, QSize canvas, QSize room) {
    if (Image1.isNull() || room.isEmpty()) return {};
    const QSize size = canvas.scaled(room, Qt::KeepAspectRatio).boundedTo(canvas).expandedTo({1, 1});
    return stretched(Image1, size);
}
