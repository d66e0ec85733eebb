#include "big_tree.h"
#include "paint_picture.h"
#include "scene.h"
#include "util/random_source.h"

#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <QRadialGradient>

#include <cmath>

namespace {

void softShadow(QPainter& painter, double x, double y, double halfWidth) {
    painter.save();
    painter.translate(x, y);
    painter.scale(1, 0.16);
    QRadialGradient shade(QPointF(0, 0), halfWidth);
    shade.setColorAt(0, QColor(14, 20, 52, 150));
    shade.setColorAt(1, QColor(14, 20, 52, 0));
    painter.setPen(Qt::NoPen);
    painter.setBrush(shade);
    painter.drawEllipse(QPointF(0, 0), halfWidth, halfWidth);
    painter.restore();
}

void paintPath(QPainter& painter) {
    QPolygonF edge;
    for (double t = 0; t <= 1.001; t += 0.05) {
        const ScenePoint middle = scene::pathMiddle(t);
        edge << QPointF(middle.x - scene::pathHalfWidth(t), middle.y);
    }
    for (double t = 1; t >= -0.001; t -= 0.05) {
        const ScenePoint middle = scene::pathMiddle(t);
        edge << QPointF(middle.x + scene::pathHalfWidth(t), middle.y);
    }
    QLinearGradient stone(0, scene::kHouseBase, 0, scene::kHeight);
    stone.setColorAt(0, QColor(128, 112, 112));
    stone.setColorAt(0.25, QColor(84, 80, 100));
    stone.setColorAt(1, QColor(48, 48, 74));
    painter.setPen(QPen(QColor(150, 166, 214, 130), 3));
    painter.setBrush(stone);
    painter.drawPolygon(edge);
    painter.save();
    QPainterPath clip;
    clip.addPolygon(edge);
    painter.setClipPath(clip);
    SeededRandom random(17);
    double row = 0;
    for (double y = scene::kHouseBase + 6; y < scene::kHeight; ++row) {  // flagstones grow towards the viewer
        const double height = 5 + (y - scene::kHouseBase) * 0.075;
        for (double x = 430 + (static_cast<int>(row) % 2) * height; x < 800; x += height * 2.1) {
            const int shade = static_cast<int>(24 * random.next());
            painter.setPen(QPen(QColor(20, 22, 44, 120), 1));
            painter.setBrush(QColor(120 + shade, 118 + shade, 140 + shade, 40));
            painter.drawRoundedRect(QRectF(x, y, height * 2, height - 1), 2, 2);
        }
        y += height;
    }
    painter.restore();
    // The porch lamp reaches the first flagstones.
    painter.save();
    painter.translate(650, scene::kHouseBase + 10);
    painter.scale(1, 0.35);
    QRadialGradient lamp(QPointF(0, 0), 130);
    lamp.setColorAt(0, QColor(255, 190, 110, 88));
    lamp.setColorAt(1, QColor(255, 180, 90, 0));
    painter.setPen(Qt::NoPen);
    painter.setBrush(lamp);
    painter.drawEllipse(QPointF(0, 0), 130, 130);
    painter.restore();
}

void paintDriveway(QPainter& painter) {
    QLinearGradient tar(0, scene::kHouseBase, 0, scene::kHeight);
    tar.setColorAt(0, QColor(64, 70, 112));
    tar.setColorAt(1, QColor(36, 42, 80));
    painter.setPen(Qt::NoPen);
    painter.setBrush(tar);
    painter.drawPolygon(QPolygonF{{QPointF(828, scene::kHouseBase - 2), QPointF(972, scene::kHouseBase - 2),
                                   QPointF(1060, scene::kHeight), QPointF(790, scene::kHeight)}});
    for (const auto& [top, bottom] : {std::pair{866.0, 862.0}, std::pair{934.0, 986.0}}) {  // tyre tracks in the snow
        painter.setPen(QPen(QColor(22, 26, 58, 110), 7));
        painter.drawLine(QPointF(top, scene::kHouseBase + 2), QPointF(bottom, scene::kHeight));
    }
    painter.setPen(QPen(QColor(150, 166, 214, 90), 3));
    painter.drawLine(QPointF(828, scene::kHouseBase), QPointF(790, scene::kHeight));
    painter.drawLine(QPointF(972, scene::kHouseBase), QPointF(1060, scene::kHeight));
}

void paintFir(QPainter& painter, const SceneFir& fir, std::uint64_t seed) {
    softShadow(painter, fir.foot.x, fir.foot.y, fir.half * 1.5);
    painter.fillRect(QRectF(fir.foot.x - 4, fir.foot.y - 16, 8, 18), QColor(38, 28, 36));
    SeededRandom random(seed);
    constexpr int kTiers = 7;
    for (int tier = kTiers; tier >= 1; --tier) {  // from the lowest branches up
        const double share = static_cast<double>(tier) / kTiers;
        const double top = fir.foot.y - 10 - fir.height * (1 - share * 0.78 + 0.12) * 0.94;
        const double bottom = fir.foot.y - 10 - fir.height * (1 - share) * 0.94;
        const double half = fir.half * (0.22 + 0.78 * share);
        QPainterPath branch(QPointF(fir.foot.x, top));
        for (const int side : {1, -1}) {
            if (side < 0) branch.moveTo(fir.foot.x, top);
            branch.quadTo(fir.foot.x + side * half * 0.35, bottom - 12, fir.foot.x + side * half, bottom);
            for (int tip = 3; tip >= 0; --tip) {
                branch.lineTo(fir.foot.x + side * half * (tip + 0.5) / 4, bottom - 5 - 3 * random.next());
                branch.lineTo(fir.foot.x + side * half * tip / 4, bottom + 2 * random.next());
            }
            branch.closeSubpath();
        }
        painter.setPen(Qt::NoPen);
        QLinearGradient needles(0, top, 0, bottom);
        needles.setColorAt(0, QColor(40, 66, 76));
        needles.setColorAt(1, QColor(16, 34, 50));
        painter.setBrush(needles);
        painter.drawPath(branch);
        painter.setPen(QPen(QColor(180, 196, 236, 110), 2.4, Qt::SolidLine, Qt::RoundCap));
        for (const int side : {1, -1}) {  // snow on the tips
            painter.drawLine(QPointF(fir.foot.x + side * half * 0.55, bottom - 8),
                             QPointF(fir.foot.x + side * half * 0.94, bottom - 2));
        }
    }
}

void paintBigTree(QPainter& painter) {
    softShadow(painter, scene::kBigTree.x, scene::kBigTree.y, 100);
    for (const TreeLimb& limb : bigTreeLimbs()) {
        painter.setPen(QPen(QColor(34, 28, 44), limb.thickness, Qt::SolidLine, Qt::RoundCap));
        painter.drawLine(QPointF(limb.from.x, limb.from.y), QPointF(limb.to.x, limb.to.y));
    }
    for (const TreeLimb& limb : bigTreeLimbs()) {  // moonlight on the right, snow on what lies flat
        painter.setPen(
            QPen(QColor(120, 124, 164, 120), std::max(0.8, limb.thickness * 0.22), Qt::SolidLine, Qt::RoundCap));
        const QPointF aside(limb.thickness * 0.26, -limb.thickness * 0.12);
        painter.drawLine(QPointF(limb.from.x, limb.from.y) + aside, QPointF(limb.to.x, limb.to.y) + aside);
    }
}

void paintFence(QPainter& painter, const SceneFence& fence) {
    const double length = fence.to.x - fence.from.x;
    const auto topAt = [&](double x) {
        return fence.from.y + (fence.to.y - fence.from.y) * (x - fence.from.x) / length;
    };
    for (const double drop : {9.0, 24.0}) {
        painter.setPen(QPen(QColor(138, 144, 178), 4));
        painter.drawLine(QPointF(fence.from.x, fence.from.y + drop), QPointF(fence.to.x, fence.to.y + drop));
    }
    painter.setPen(Qt::NoPen);
    for (double x = fence.from.x; x <= fence.to.x + 0.5; x += 11) {
        const double top = topAt(x);
        QLinearGradient wood(x - 3, 0, x + 3, 0);
        wood.setColorAt(0, QColor(160, 166, 196));
        wood.setColorAt(1, QColor(104, 110, 146));
        painter.setBrush(wood);
        painter.drawPolygon(QPolygonF{{QPointF(x - 3, top + 36), QPointF(x - 3, top + 4), QPointF(x, top),
                                       QPointF(x + 3, top + 4), QPointF(x + 3, top + 36)}});
    }
}

void paintBush(QPainter& painter, const SceneBush& bush, std::uint64_t seed) {
    SeededRandom random(seed);
    painter.setPen(Qt::NoPen);
    for (int leaf = 0; leaf < 110; ++leaf) {
        const double angle = random.next() * 6.283;
        const double reach = std::sqrt(random.next());
        const double x = bush.middle.x + std::cos(angle) * reach * bush.halfWidth;
        const double y = bush.middle.y + std::sin(angle) * reach * bush.halfHeight;
        const int light = static_cast<int>(30 * random.next() + 20 * (bush.middle.y - y) / bush.halfHeight);
        painter.setBrush(QColor(24 + std::max(0, light) / 2, 44 + std::max(0, light), 48 + std::max(0, light)));
        painter.drawEllipse(QPointF(x, y), 6, 4.6);
    }
    painter.setBrush(QColor(180, 194, 234, 90));
    painter.drawEllipse(QPointF(bush.middle.x, bush.middle.y - bush.halfHeight * 0.9), bush.halfWidth * 0.7, 5);
}

void paintSnowman(QPainter& painter) {
    softShadow(painter, scene::kSnowman.x, scene::kSnowman.y, 52);
    const double x = scene::kSnowman.x;
    double bottom = scene::kSnowman.y;
    for (const double radius : {27.0, 20.0, 14.0}) {
        const QPointF middle(x, bottom - radius);
        QRadialGradient snow(middle + QPointF(radius * 0.3, -radius * 0.35), radius * 1.5);
        snow.setColorAt(0, QColor(206, 214, 242));
        snow.setColorAt(1, QColor(104, 116, 168));
        painter.setPen(Qt::NoPen);
        painter.setBrush(snow);
        painter.drawEllipse(middle, radius, radius);
        bottom -= radius * 1.68;
    }
    const double head = scene::kSnowman.y - 27 * 1.68 - 20 * 1.68 - 14;
    painter.setBrush(QColor(22, 22, 40));
    painter.drawRect(QRectF(x - 16, head - 15, 32, 4));
    painter.drawRect(QRectF(x - 10, head - 33, 20, 20));
    painter.drawEllipse(QPointF(x - 5, head - 3), 1.8, 1.8);
    painter.drawEllipse(QPointF(x + 5, head - 3), 1.8, 1.8);
    for (const double button : {26.0, 34.0, 44.0})
        painter.drawEllipse(QPointF(x, head + button), 1.8, 1.8);
    painter.setBrush(QColor(230, 126, 50));
    painter.drawPolygon(QPolygonF{{QPointF(x, head), QPointF(x + 13, head + 3), QPointF(x, head + 4)}});
    painter.setPen(QPen(QColor(46, 34, 44), 2.4, Qt::SolidLine, Qt::RoundCap));
    painter.drawLine(QPointF(x - 17, head + 28), QPointF(x - 40, head + 12));
    painter.drawLine(QPointF(x + 17, head + 28), QPointF(x + 40, head + 14));
}

void paintMegaTreePole(QPainter& painter) {
    softShadow(painter, scene::kMegaTree.x, scene::kMegaTree.y, scene::kMegaTreeHalf * 1.2);
    painter.setPen(QPen(QColor(70, 76, 110), 5));
    painter.drawLine(QPointF(scene::kMegaTree.x, scene::kMegaTree.y - 4),
                     QPointF(scene::kMegaTree.x, scene::kMegaTree.y - scene::kMegaTreeHeight));
}

}  // namespace

void paintGarden(QPainter& painter) {
    paintDriveway(painter);
    paintPath(painter);
    std::uint64_t seed = 40;
    for (const SceneFir& fir : scene::kFirs)
        paintFir(painter, fir, ++seed);
    for (const SceneFence& fence : scene::kFences)
        paintFence(painter, fence);
    for (const SceneBush& bush : scene::kBushes)
        paintBush(painter, bush, ++seed);
    paintBigTree(painter);
    paintMegaTreePole(painter);
    paintSnowman(painter);
}
