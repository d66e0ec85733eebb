#include "shell/dialogs/sample_view.h"

#include <QPainter>
#include <QPainterPath>

namespace {

constexpr double kRadiusPx = 5;
constexpr double kGlowPx = 12;
constexpr double kSpacingPx = 26;

}  // namespace

SampleView::SampleView(QWidget* parent) : QWidget(parent) {
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
}

void SampleView::setColors(const QColor& background, const QColor& bulbs) {
    background_ = background;
    bulbs_ = bulbs;
    update();
}

QSize SampleView::sizeHint() const {
    return {200, 84};
}

void SampleView::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF frame = QRectF(rect()).adjusted(0.5, 0.5, -0.5, -0.5);
    painter.setPen(palette().color(QPalette::Mid));
    painter.setBrush(background_);
    painter.drawRoundedRect(frame, 4, 4);
    painter.setPen(Qt::NoPen);
    QColor glow = bulbs_;
    glow.setAlpha(60);
    for (double x = frame.left() + kSpacingPx / 2; x < frame.right() - kRadiusPx; x += kSpacingPx) {
        const QPointF bulb(x, frame.center().y());
        painter.setBrush(glow);
        painter.drawEllipse(bulb, kGlowPx, kGlowPx);
        painter.setBrush(bulbs_);
        painter.drawEllipse(bulb, kRadiusPx, kRadiusPx);
    }
}
