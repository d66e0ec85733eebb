#include "paint_picture.h"
#include "scene.h"
#include "util/random_source.h"

#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <QRadialGradient>

namespace {

QPointF at(ScenePoint point) {
    return {point.x, point.y};
}

QRectF rect(const SceneBox& box) {
    return {box.left, box.top, box.width(), box.height()};
}

const QColor kTrim(172, 176, 196);
const QColor kTrimShade(116, 120, 146);
const QColor kSnow(188, 200, 234);

void fillPolygon(QPainter& painter, std::initializer_list<QPointF> corners, const QBrush& brush) {
    painter.setPen(Qt::NoPen);
    painter.setBrush(brush);
    painter.drawPolygon(QPolygonF(QList<QPointF>(corners)));
}

// Clapboards: a wall colour with a fine shadow under each board. The clip is the wall's outline.
void paintSiding(QPainter& painter, const QPainterPath& outline, const QColor& light, const QColor& dark) {
    painter.save();
    painter.setClipPath(outline);
    const QRectF box = outline.boundingRect();
    QLinearGradient wall(box.topLeft(), box.bottomLeft());
    wall.setColorAt(0, dark);
    wall.setColorAt(1, light);
    painter.fillRect(box, wall);
    for (double y = box.top(); y < box.bottom(); y += 7) {
        painter.fillRect(QRectF(box.left(), y, box.width(), 1.1), QColor(8, 10, 28, 78));
        painter.fillRect(QRectF(box.left(), y + 1.1, box.width(), 0.8), QColor(190, 200, 240, 16));
    }
    painter.restore();
}

// Rows of shingles under a clip, then snow drifting down from the top edge.
void paintShingles(QPainter& painter, const QPolygonF& roof, std::uint64_t seed) {
    QPainterPath outline;
    outline.addPolygon(roof);
    outline.closeSubpath();
    painter.save();
    painter.setClipPath(outline);
    const QRectF box = roof.boundingRect();
    QLinearGradient base(box.topLeft(), box.bottomLeft());
    base.setColorAt(0, QColor(54, 56, 86));
    base.setColorAt(1, QColor(34, 36, 62));
    painter.fillRect(box, base);
    SeededRandom random(seed);
    painter.setPen(Qt::NoPen);
    for (double y = box.top(), row = 0; y < box.bottom(); y += 8, ++row) {
        const double shift = static_cast<int>(row) % 2 == 0 ? 0 : 7;
        for (double x = box.left() - 14 + shift; x < box.right(); x += 14) {
            const int shade = static_cast<int>(26 * random.next());
            painter.fillRect(QRectF(x, y, 13.2, 7.2), QColor(90 + shade, 92 + shade, 128 + shade, 30));
        }
        painter.fillRect(QRectF(box.left(), y + 7.2, box.width(), 0.9), QColor(6, 8, 24, 92));
    }
    QLinearGradient snow(box.topLeft(), box.bottomLeft());
    snow.setColorAt(0, QColor(186, 200, 240, 150));
    snow.setColorAt(0.35, QColor(160, 176, 224, 66));
    snow.setColorAt(1, QColor(150, 168, 220, 22));
    painter.fillRect(box, snow);
    painter.restore();
}

void paintWindow(QPainter& painter, const SceneBox& box, int columns, int rows) {
    const QRectF pane = rect(box);
    painter.setPen(Qt::NoPen);
    painter.save();
    painter.translate(pane.center());
    painter.scale(1, pane.height() / pane.width());
    const double reach = pane.width() * 1.15;
    QRadialGradient glow(QPointF(0, 0), reach);
    glow.setColorAt(0, QColor(255, 190, 96, 110));
    glow.setColorAt(1, QColor(255, 170, 80, 0));
    painter.setBrush(glow);
    painter.drawEllipse(QPointF(0, 0), reach, reach);
    painter.restore();

    painter.fillRect(pane.adjusted(-5, -5, 5, 6), kTrimShade);
    painter.fillRect(pane.adjusted(-4, -4, 4, 4), kTrim);
    QLinearGradient light(pane.topLeft(), pane.bottomLeft());
    light.setColorAt(0, QColor(255, 214, 132));
    light.setColorAt(0.55, QColor(250, 180, 86));
    light.setColorAt(1, QColor(206, 122, 52));
    painter.fillRect(pane, light);
    // Curtains drawn to the sides.
    const double curtain = pane.width() * 0.17;
    for (const bool left : {true, false}) {
        const double edge = left ? pane.left() : pane.right();
        const double inner = left ? edge + curtain : edge - curtain;
        fillPolygon(
            painter,
            {{edge, pane.top()}, {inner + (left ? 5 : -5), pane.top()}, {inner, pane.bottom()}, {edge, pane.bottom()}},
            QColor(150, 62, 40, 120));
    }
    for (int column = 1; column < columns; ++column) {
        const double x = pane.left() + pane.width() * column / columns;
        painter.fillRect(QRectF(x - 1.2, pane.top(), 2.4, pane.height()), kTrim);
    }
    for (int row = 1; row < rows; ++row) {
        const double y = pane.top() + pane.height() * row / rows;
        painter.fillRect(QRectF(pane.left(), y - 1.2, pane.width(), 2.4), kTrim);
    }
    painter.fillRect(QRectF(pane.left() - 7, pane.bottom() + 4, pane.width() + 14, 4), kSnow);
}

// Rafters and the board under them, with a lip of snow.
void paintGableTrim(QPainter& painter, ScenePoint left, ScenePoint apex, ScenePoint right, double width) {
    painter.setBrush(Qt::NoBrush);
    const QPolygonF rafters{{at(left), at(apex), at(right)}};
    painter.setPen(QPen(kTrimShade, width + 3, Qt::SolidLine, Qt::FlatCap, Qt::MiterJoin));
    painter.drawPolyline(rafters.translated(0, 4));
    painter.setPen(QPen(kTrim, width, Qt::SolidLine, Qt::FlatCap, Qt::MiterJoin));
    painter.drawPolyline(rafters.translated(0, 2));
    painter.setPen(QPen(kSnow, width * 0.62, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.drawPolyline(rafters.translated(0, -width * 0.45));
}

QPainterPath gableWall(const SceneGable& gable) {
    const double slope = (gable.leftEave.y - gable.apex.y) / (gable.apex.x - gable.leftEave.x);
    const double shoulder = gable.apex.y + slope * (gable.apex.x - gable.wall.left);
    QPainterPath wall(QPointF(gable.wall.left, gable.wall.bottom));
    wall.lineTo(gable.wall.left, shoulder);
    wall.lineTo(at(gable.apex));
    wall.lineTo(gable.wall.right, shoulder);
    wall.lineTo(gable.wall.right, gable.wall.bottom);
    wall.closeSubpath();
    return wall;
}

void paintChimney(QPainter& painter) {
    const QRectF stack = rect(scene::kChimney);
    painter.fillRect(stack, QColor(84, 54, 60));
    painter.save();
    painter.setClipRect(stack);
    for (double y = stack.top(), row = 0; y < stack.bottom(); y += 6, ++row) {
        painter.fillRect(QRectF(stack.left(), y, stack.width(), 1), QColor(34, 22, 34));
        for (double x = stack.left() + (static_cast<int>(row) % 2 == 0 ? 0 : 6); x < stack.right(); x += 12) {
            painter.fillRect(QRectF(x, y, 1, 6), QColor(34, 22, 34));
        }
    }
    QLinearGradient shade(stack.topLeft(), stack.topRight());
    shade.setColorAt(0, QColor(0, 0, 0, 90));
    shade.setColorAt(0.6, QColor(0, 0, 0, 0));
    painter.fillRect(stack, shade);
    painter.restore();
    painter.fillRect(QRectF(stack.left() - 5, stack.top() - 4, stack.width() + 10, 8), QColor(66, 44, 52));
    painter.setPen(Qt::NoPen);
    painter.setBrush(kSnow);
    painter.drawRoundedRect(QRectF(stack.left() - 6, stack.top() - 10, stack.width() + 12, 8), 4, 4);
    for (int puff = 0; puff < 9; ++puff) {  // smoke, thinner the higher it drifts
        const double radius = 8 + puff * 3.6;
        const QPointF middle(stack.center().x() + puff * 9.5, stack.top() - 20 - puff * 17);
        QRadialGradient smoke(middle, radius);
        smoke.setColorAt(0, QColor(196, 202, 226, 52 - puff * 5));
        smoke.setColorAt(1, QColor(196, 202, 226, 0));
        painter.setBrush(smoke);
        painter.drawEllipse(middle, radius, radius);
    }
}

void paintDormer(QPainter& painter, std::size_t dormer0) {
    using namespace scene;
    const double x = kDormers.at(dormer0);
    const double wall = kDormerHalf - 6;
    QPainterPath front(QPointF(x - wall, kDormerBase));
    front.lineTo(x - wall, kDormerEave - 4);
    front.lineTo(x, kDormerTop);
    front.lineTo(x + wall, kDormerEave - 4);
    front.lineTo(x + wall, kDormerBase);
    front.closeSubpath();
    paintSiding(painter, front, QColor(82, 88, 124), QColor(66, 72, 108));
    paintWindow(painter, dormerWindow(dormer0), 2, 2);
    paintGableTrim(painter, {x - kDormerHalf, kDormerEave}, {x, kDormerTop}, {x + kDormerHalf, kDormerEave}, 5);
}

void paintPorch(QPainter& painter) {
    using namespace scene;
    // The back of the porch lies in the warm light of its lamp.
    QRadialGradient lamp(QPointF(650, 512), 150);
    lamp.setColorAt(0, QColor(255, 196, 110, 120));
    lamp.setColorAt(1, QColor(255, 180, 90, 0));
    painter.fillRect(
        QRectF(kPorchRoof.left + 6, kPorchRoof.bottom, kPorchRoof.width() - 12, kHouseBase - kPorchRoof.bottom), lamp);
    paintWindow(painter, kPorchWindowLeft, 2, 2);
    paintWindow(painter, kPorchWindowRight, 2, 2);

    const QRectF door = rect(kDoor);
    painter.fillRect(door.adjusted(-6, -6, 6, 0), kTrim);
    QLinearGradient red(door.topLeft(), door.topRight());
    red.setColorAt(0, QColor(124, 26, 34));
    red.setColorAt(0.5, QColor(160, 40, 46));
    red.setColorAt(1, QColor(112, 22, 30));
    painter.fillRect(door, red);
    painter.setPen(QPen(QColor(80, 12, 20), 1.4));
    painter.setBrush(Qt::NoBrush);
    painter.drawRect(QRectF(door.left() + 6, door.top() + 50, 13, 24));
    painter.drawRect(QRectF(door.right() - 19, door.top() + 50, 13, 24));
    painter.setPen(Qt::NoPen);
    painter.setBrush(QColor(240, 206, 120));
    painter.drawEllipse(QPointF(door.right() - 6, door.center().y() + 8), 2.2, 2.2);

    // Floor and steps.
    painter.fillRect(QRectF(kPorchRoof.left, kHouseBase - 8, kPorchRoof.width(), 10), QColor(104, 104, 128));
    painter.fillRect(QRectF(kPorchRoof.left, kHouseBase - 8, kPorchRoof.width(), 3), kSnow);
    painter.fillRect(QRectF(606, kHouseBase + 1, 88, 6), QColor(88, 88, 114));

    for (const double post : kPorchPosts) {
        QLinearGradient wood(post - 5, 0, post + 5, 0);
        wood.setColorAt(0, kTrimShade);
        wood.setColorAt(0.45, QColor(196, 198, 212));
        wood.setColorAt(1, kTrimShade);
        painter.fillRect(QRectF(post - 4.5, kPorchRoof.bottom, 9, kHouseBase - 6 - kPorchRoof.bottom), wood);
        painter.fillRect(QRectF(post - 7, kPorchRoof.bottom, 14, 6), kTrim);
    }
    // Railings between the outer posts.
    for (const auto& [from, to] : {std::pair{530.0, 606.0}, std::pair{694.0, 770.0}}) {
        painter.fillRect(QRectF(from, 588, to - from, 3), kTrim);
        for (double x = from + 8; x < to - 3; x += 8)
            painter.fillRect(QRectF(x, 591, 2, 18), kTrimShade);
    }
    const QPolygonF roof{{QPointF(kPorchRoof.left + 26, kPorchRoof.top), QPointF(kPorchRoof.right - 26, kPorchRoof.top),
                          QPointF(kPorchRoof.right, kPorchRoof.bottom - 6),
                          QPointF(kPorchRoof.left, kPorchRoof.bottom - 6)}};
    paintShingles(painter, roof, 71);
    painter.fillRect(QRectF(kPorchRoof.left - 2, kPorchRoof.bottom - 7, kPorchRoof.width() + 4, 7), kTrim);
    painter.fillRect(QRectF(kPorchRoof.left - 2, kPorchRoof.bottom - 10, kPorchRoof.width() + 4, 4), kSnow);
}

void paintGarage(QPainter& painter) {
    using namespace scene;
    paintSiding(painter, gableWall(kGarage), QColor(88, 92, 126), QColor(64, 70, 106));
    const QRectF door = rect(kGarageDoor);
    painter.fillRect(door.adjusted(-6, -6, 6, 0), kTrim);
    QLinearGradient panel(door.topLeft(), door.bottomLeft());
    panel.setColorAt(0, QColor(30, 34, 58));
    panel.setColorAt(1, QColor(44, 48, 74));
    painter.fillRect(door, panel);
    painter.setPen(QPen(QColor(16, 18, 38), 1.2));
    painter.setBrush(Qt::NoBrush);
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < 4; ++column) {
            const double width = door.width() / 4;
            const double height = door.height() / 4;
            painter.drawRect(
                QRectF(door.left() + column * width + 4, door.top() + row * height + 4, width - 8, height - 8));
        }
    }
    paintGableTrim(painter, kGarage.leftEave, kGarage.apex, kGarage.rightEave, 8);
}

void paintLeftWing(QPainter& painter) {
    using namespace scene;
    paintSiding(painter, gableWall(kLeftWing), QColor(98, 104, 142), QColor(70, 78, 116));
    // An arched head over the upper window.
    painter.setPen(Qt::NoPen);
    paintWindow(painter, kGableWindow, 2, 3);
    paintWindow(painter, kBayWindow, 4, 2);
    fillPolygon(painter,
                {{kBayWindow.left - 14, kBayWindow.top - 5},
                 {kBayWindow.left, kBayWindow.top - 20},
                 {kBayWindow.right, kBayWindow.top - 20},
                 {kBayWindow.right + 14, kBayWindow.top - 5}},
                QColor(50, 52, 82));
    fillPolygon(painter,
                {{kBayWindow.left - 14, kBayWindow.top - 8},
                 {kBayWindow.left - 2, kBayWindow.top - 22},
                 {kBayWindow.right + 2, kBayWindow.top - 22},
                 {kBayWindow.right + 14, kBayWindow.top - 8}},
                QColor(170, 184, 226, 150));
    paintGableTrim(painter, kLeftWing.leftEave, kLeftWing.apex, kLeftWing.rightEave, 9);
}

}  // namespace

void paintHouse(QPainter& painter) {
    using namespace scene;
    painter.setPen(Qt::NoPen);
    QRadialGradient shade(QPointF(650, 0), 420);  // the house's shadow on the snow, drawn flat
    shade.setColorAt(0, QColor(16, 22, 54, 150));
    shade.setColorAt(1, QColor(16, 22, 54, 0));
    painter.save();
    painter.translate(0, kHouseBase + 6);
    painter.scale(1, 0.09);
    painter.setBrush(shade);
    painter.drawEllipse(QPointF(650, 0), 420, 420);
    painter.restore();

    QPainterPath mainWall;
    mainWall.addRect(rect(kMainWall));
    paintSiding(painter, mainWall, QColor(90, 96, 134), QColor(58, 64, 100));
    painter.setPen(Qt::NoPen);
    paintChimney(painter);
    paintShingles(painter, QPolygonF{{at(kRidgeLeft), at(kRidgeRight), at(kEaveRight), at(kEaveLeft)}}, 5);
    // The slopes of the wings, seen at the side of their gables.
    painter.setPen(QPen(kSnow, 6, Qt::SolidLine, Qt::RoundCap));
    painter.drawLine(at(kRidgeLeft) + QPointF(0, -1), at(kRidgeRight) + QPointF(0, -1));
    painter.setPen(Qt::NoPen);
    painter.fillRect(QRectF(kEaveLeft.x, kEaveLeft.y - 2, kEaveRight.x - kEaveLeft.x, 8), kTrim);
    painter.fillRect(QRectF(kEaveLeft.x, kEaveLeft.y - 6, kEaveRight.x - kEaveLeft.x, 5), kSnow);
    for (std::size_t dormer0 = 0; dormer0 < kDormers.size(); ++dormer0)
        paintDormer(painter, dormer0);
    paintPorch(painter);
    paintGarage(painter);
    paintLeftWing(painter);
}
