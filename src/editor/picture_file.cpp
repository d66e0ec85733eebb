#include "editor/picture_file.h"

#include <QDir>
#include <QFileInfo>
#include <QImageReader>
#include <QPainter>

namespace {

// Photos of the largest cameras pass the 128 MB that the reader grants by itself; a damaged header asks for much more.
constexpr int kMostMegabytes = 1024;

}  // namespace

QImage loadPicture(const std::string& file) {
    if (file.empty()) return {};
    QImageReader::setAllocationLimit(kMostMegabytes);
    QImageReader reader(QString::fromStdString(file));
    reader.setDecideFormatFromContent(true);
    reader.setAutoTransform(true);
    QImage picture = reader.read();
    picture.setDevicePixelRatio(1);  // a name that ends in "@2x" would halve it
    if (!picture.hasAlphaChannel()) return std::move(picture).convertToFormat(QImage::Format_RGB32);
    QImage opaque(picture.size(), QImage::Format_RGB32);
    opaque.fill(Qt::white);
    QPainter(&opaque).drawImage(0, 0, picture);
    return opaque;
}

std::string ZephFindBackgroundPicture(const ZephSimulation& simulation) {
    const QString name = QString::fromStdString(simulation.Background.PicFileName);
    if (name.isEmpty()) return {};
    const QDir folder(QString::fromStdString(simulation.FilePath));
    const QString stored = folder.absoluteFilePath(name);
    // A document that was never saved lies nowhere, so nothing lies beside it.
    if (QFileInfo(stored).isFile() || simulation.FilePath.empty()) return stored.toStdString();
    const QStringList parts = QString(name).replace('\\', '/').split('/', Qt::SkipEmptyParts);
    for (qsizetype first = 0; first < parts.size(); ++first) {
        const QString moved = folder.absoluteFilePath(parts.mid(first).join('/'));
        if (QFileInfo(moved).isFile()) return moved.toStdString();
    }
    return stored.toStdString();
}
