#include "shell/dialogs/sample_view.h"

#include "util/rounding.h"

#include <QPainter>

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
    return {200, 64};
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
    const int bulbs = floorToInt(frame.width() / kSpacingPx);
    for (int n = 0; n < bulbs; ++n) {
        const QPointF bulb = frame.center() + QPointF((n - (bulbs - 1) / 2.0) * kSpacingPx, 0);
        painter.setBrush(glow);
        painter.drawEllipse(bulb, kGlowPx, kGlowPx);
        painter.setBrush(bulbs_);
        painter.drawEllipse(bulb, kRadiusPx, kRadiusPx);
    }
}
