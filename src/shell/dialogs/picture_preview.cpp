#include "shell/dialogs/picture_preview.h"

#include "editor/background.h"
#include "util/rounding.h"

#include <QPainter>

namespace {

constexpr QSize kField(384, 288);
constexpr int kMarginPx = 8;

}  // namespace

PicturePreview::PicturePreview(QWidget* parent) : QWidget(parent) {
    setObjectName("picPreview");
    setMinimumSize(kField);
    setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Expanding);
}

QString PicturePreview::sizeText(const QSize& size) {
    return QString("%1 x %2").arg(size.width()).arg(size.height());
}

void PicturePreview::showPicture(const QSize& canvas, const QImage& Image1, int intensity) {
    // While the brightness alone changes, a large photo is not stretched anew.
    if (stretched_.isNull() || canvas_ != canvas || source_ != Image1.cacheKey()) {
        const QSize room = (size() - QSize(2 * kMarginPx, 2 * kMarginPx)) * devicePixelRatioF();
        stretched_ = previewPicture(Image1, canvas, room);
        canvas_ = canvas;
        source_ = Image1.cacheKey();
    }
    shown_ = stretched_.isNull() ? QImage() : pictureAtIntensity(stretched_, intensity);
    update();
}

void PicturePreview::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(palette().color(QPalette::Mid));
    painter.setBrush(palette().color(QPalette::Dark));
    painter.drawRoundedRect(QRectF(rect()).adjusted(0.5, 0.5, -0.5, -0.5), 5, 5);
    if (shown_.isNull()) return;
    const double ratio = devicePixelRatioF();
    const QPoint corner(floorToInt((width() - shown_.width() / ratio) / 2),
                        floorToInt((height() - shown_.height() / ratio) / 2));
    QImage picture = shown_;
    picture.setDevicePixelRatio(ratio);
    painter.drawImage(corner, picture);
}
