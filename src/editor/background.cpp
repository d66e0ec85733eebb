#include "editor/background.h"

#include "util/rounding.h"

#include <QDir>
#include <QFileInfo>

#include <algorithm>
#include <array>

namespace {

constexpr const char* kBlankPicture = "blank.gif";

QImage loadPicture(const QString& path) {
    return QImage(path).convertToFormat(QImage::Format_RGB32);
}

QImage blankPicture(const std::string& programFolder, Host& host) {
    const QImage blank = loadPicture(QDir(QString::fromStdString(programFolder)).filePath(kBlankPicture));
    if (!blank.isNull()) return blank;
    host.messageBox(boxTitle("-Preview Load Error"),
                    "There was a problem loading the blank background.  Please contact support.", BoxIcon::Critical);
    QImage white(1, 1, QImage::Format_RGB32);
    white.fill(Qt::white);
    return white;
}

// In its own size.
QImage backgroundPicture(const ZephSimulation& simulation, const std::string& programFolder, Host& host) {
    if (simulation.Background.BackgroundType == kBackgroundPicture) {
        const QImage picture = loadPicture(QString::fromStdString(backgroundPicturePath(simulation)));
        if (!picture.isNull()) return picture;
        host.messageBox(boxTitle("-Picture Load Error"),
                        "An error occurred while trying to load the background graphic", BoxIcon::Critical);
    }
    return blankPicture(programFolder, host);
}

}  // namespace

std::int32_t brightnessOffset(std::int32_t intensity) noexcept {
    // In hundredths, rounded away from zero: a product in floating point may land beside the whole number.
    const std::int32_t missing = 100 - std::clamp(intensity, 0, 100);
    return -((missing * 255 + 99) / 100);
}

void ZephDrawFastBrightness(std::int32_t offset, QImage& picture) {
    std::array<std::uint8_t, 256> table;
    for (std::size_t byte = 0; byte < table.size(); ++byte) {
        table[byte] = static_cast<std::uint8_t>(clampByte(static_cast<std::int32_t>(byte) + offset));
    }
    for (int y = 0; y < picture.height(); ++y) {
        QRgb* row = reinterpret_cast<QRgb*>(picture.scanLine(y));
        for (int x = 0; x < picture.width(); ++x) {
            const QRgb pixel = row[x];
            row[x] = qRgb(table[static_cast<std::size_t>(qRed(pixel))], table[static_cast<std::size_t>(qGreen(pixel))],
                          table[static_cast<std::size_t>(qBlue(pixel))]);
        }
    }
}

QSize canvasSize(const ZephBackground& background) noexcept {
    return {std::clamp(widthPixels(background), 1, kMaxCanvasPixels),
            std::clamp(heightPixels(background), 1, kMaxCanvasPixels)};
}

QImage ZephResizeAndSetBackgroundIntensity(const QImage& picture, const ZephBackground& background) {
    const QSize canvas = canvasSize(background);
    QImage stretched =
        picture.size() == canvas ? picture : picture.scaled(canvas, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
    stretched = stretched.convertToFormat(QImage::Format_RGB32);
    if (background.PicIntensity != 100) ZephDrawFastBrightness(brightnessOffset(background.PicIntensity), stretched);
    return stretched;
}

std::string backgroundPicturePath(const ZephSimulation& simulation) {
    const QString name = QString::fromStdString(simulation.Background.PicFileName);
    if (QFileInfo(name).isAbsolute()) return name.toStdString();
    return QDir(QString::fromStdString(simulation.FilePath)).filePath(name).toStdString();
}

QImage ZephGLPicture(const ZephSimulation& simulation, const std::string& programFolder, Host& host) {
    if (simulation.Background.BackgroundType != kBackgroundPicture) return {};
    ZephBackground undimmed = simulation.Background;
    undimmed.PicIntensity = 100;
    return ZephResizeAndSetBackgroundIntensity(backgroundPicture(simulation, programFolder, host), undimmed);
}

QImage ZephResetBackground(const ZephSimulation& simulation, const std::string& programFolder, Host& host) {
    return ZephResizeAndSetBackgroundIntensity(backgroundPicture(simulation, programFolder, host),
                                               simulation.Background);
}
