#include "paint_picture.h"
#include "scene.h"
#include "util/random_source.h"

#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <QRadialGradient>

#include <cmath>

namespace {

constexpr double kHorizon = 590;

void paintStars(QPainter& painter) {
    SeededRandom random(24);
    painter.setPen(Qt::NoPen);
    for (int star = 0; star < 420; ++star) {
        const double x = random.next() * scene::kWidth;
        const double y = std::pow(random.next(), 1.4) * (kHorizon - 90);
        const double bright = std::pow(random.next(), 3.0);
        const double radius = 0.45 + 1.0 * bright;
        const int warm = random.next() > 0.7 ? 30 : 0;
        painter.setBrush(QColor(225 + warm, 230, 255 - warm, static_cast<int>(70 + 170 * bright)));
        painter.drawEllipse(QPointF(x, y), radius, radius);
        if (bright > 0.72) {
            painter.setBrush(QColor(200, 215, 255, 26));
            painter.drawEllipse(QPointF(x, y), 5, 5);
        }
    }
}

void paintMoon(QPainter& painter) {
    const QPointF middle(1046, 118);
    QRadialGradient halo(middle, 190);
    halo.setColorAt(0, QColor(220, 228, 255, 96));
    halo.setColorAt(0.25, QColor(180, 196, 245, 40));
    halo.setColorAt(1, QColor(150, 170, 230, 0));
    painter.setBrush(halo);
    painter.drawEllipse(middle, 190, 190);
    QRadialGradient face(middle + QPointF(-9, -9), 48);
    face.setColorAt(0, QColor(255, 252, 240));
    face.setColorAt(1, QColor(214, 218, 226));
    painter.setBrush(face);
    painter.drawEllipse(middle, 36, 36);
    painter.setBrush(QColor(178, 184, 200, 90));
    for (const auto& [dx, dy, radius] :
         {std::array{-12.0, -7.0, 8.0}, std::array{9.0, 5.0, 10.0}, std::array{-5.0, 15.0, 5.0},
          std::array{14.0, -14.0, 4.5}, std::array{-20.0, 9.0, 3.5}}) {
        painter.drawEllipse(middle + QPointF(dx, dy), radius, radius * 0.9);
    }
}

// A far wood: a row of small dark firs along a hill.
void paintWood(QPainter& painter, std::uint64_t seed, double base, double wave, double size, const QColor& color) {
    SeededRandom random(seed);
    painter.setBrush(color);
    QPainterPath wood(QPointF(-20, kHorizon + 60));
    for (double x = -20; x < scene::kWidth + 20;) {
        const double width = size * (0.5 + random.next());
        const double ground = base + wave * std::sin(x / 210 + static_cast<double>(seed));
        wood.lineTo(x, ground);
        wood.lineTo(x + width / 2, ground - width * (1.3 + random.next()));
        wood.lineTo(x + width, ground);
        x += width * 0.8;
    }
    wood.lineTo(scene::kWidth + 20, kHorizon + 60);
    painter.drawPath(wood);
}

}  // namespace

void paintSky(QPainter& painter) {
    QLinearGradient sky(0, 0, 0, kHorizon);
    sky.setColorAt(0, QColor(6, 9, 28));
    sky.setColorAt(0.45, QColor(16, 24, 58));
    sky.setColorAt(0.8, QColor(40, 46, 92));
    sky.setColorAt(1, QColor(84, 70, 112));
    painter.fillRect(QRectF(0, 0, scene::kWidth, scene::kHeight), sky);
    painter.setPen(Qt::NoPen);
    paintStars(painter);
    paintMoon(painter);
    // Two thin veils of cloud lit by the moon.
    for (const auto& [x, y, width] : {std::array{880.0, 176.0, 420.0}, std::array{300.0, 110.0, 360.0}}) {
        painter.save();
        painter.translate(x, y);
        painter.scale(1, 0.07);
        QRadialGradient veil(QPointF(0, 0), width);
        veil.setColorAt(0, QColor(160, 172, 220, 46));
        veil.setColorAt(1, QColor(160, 172, 220, 0));
        painter.setBrush(veil);
        painter.drawEllipse(QPointF(0, 0), width, width);
        painter.restore();
    }
}

void paintHills(QPainter& painter) {
    painter.setPen(Qt::NoPen);
    QLinearGradient hill(0, 480, 0, 640);
    hill.setColorAt(0, QColor(58, 66, 112));
    hill.setColorAt(1, QColor(74, 82, 126));
    QPainterPath ridge(QPointF(0, 640));
    ridge.lineTo(0, 522);
    ridge.cubicTo(170, 470, 330, 520, 520, 532);
    ridge.cubicTo(760, 548, 900, 470, 1080, 494);
    ridge.cubicTo(1180, 508, 1240, 520, 1280, 512);
    ridge.lineTo(1280, 640);
    painter.setBrush(hill);
    painter.drawPath(ridge);
    paintWood(painter, 3, 548, 10, 11, QColor(36, 44, 82));
    paintWood(painter, 8, 584, 7, 20, QColor(22, 28, 58));

    // The lawn under snow, bluish in the moonlight and darker towards the viewer.
    QLinearGradient snow(0, 576, 0, scene::kHeight);
    snow.setColorAt(0, QColor(112, 124, 172));
    snow.setColorAt(0.3, QColor(92, 106, 158));
    snow.setColorAt(1, QColor(50, 62, 112));
    QPainterPath lawn(QPointF(0, scene::kHeight));
    lawn.lineTo(0, 606);
    lawn.cubicTo(200, 588, 420, 604, 640, 602);
    lawn.cubicTo(860, 600, 1090, 584, 1280, 612);
    lawn.lineTo(scene::kWidth, scene::kHeight);
    painter.setBrush(snow);
    painter.drawPath(lawn);
    SeededRandom random(91);
    for (int drift = 0; drift < 46; ++drift) {  // soft drifts, so that the snow is not a flat sheet
        const double y = 630 + 170 * random.next();
        const double reach = 60 + 150 * random.next();
        painter.save();
        painter.translate(random.next() * scene::kWidth, y);
        painter.scale(1, 0.11);
        QRadialGradient soft(QPointF(0, 0), reach);
        const bool light = random.next() > 0.45;
        soft.setColorAt(0, light ? QColor(176, 192, 236, 44) : QColor(30, 40, 86, 50));
        soft.setColorAt(1, light ? QColor(176, 192, 236, 0) : QColor(30, 40, 86, 0));
        painter.setBrush(soft);
        painter.drawEllipse(QPointF(0, 0), reach, reach);
        painter.restore();
    }
    for (int glint = 0; glint < 260; ++glint) {
        painter.setBrush(QColor(225, 234, 255, static_cast<int>(30 + 90 * random.next())));
        painter.drawEllipse(QPointF(random.next() * scene::kWidth, 618 + 182 * random.next()), 0.7, 0.6);
    }
}

QImage paintPicture() {
    QImage picture(scene::kWidth, scene::kHeight, QImage::Format_RGB32);
    QPainter painter(&picture);
    painter.setRenderHint(QPainter::Antialiasing);
    paintSky(painter);
    paintHills(painter);
    paintHouse(painter);
    paintGarden(painter);
    return picture;
}
