#include "shell/look.h"

#include <QApplication>
#include <QPainter>
#include <QPalette>
#include <QStyleFactory>

namespace {

const QColor kAccent(232, 163, 61);

// Draws on a field of 24 x 24.
template <typename Draw>
QIcon drawnIcon(Draw&& draw) {
    QIcon icon;
    for (const int scale : {1, 2}) {
        QPixmap pixmap(24 * scale, 24 * scale);
        pixmap.fill(Qt::transparent);
        QPainter painter(&pixmap);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.scale(scale, scale);
        painter.setPen(Qt::NoPen);
        draw(painter);
        painter.end();
        icon.addPixmap(pixmap);
    }
    return icon;
}

}  // namespace

QIcon openIcon() {
    return drawnIcon([](QPainter& painter) {
        painter.setBrush(QColor(168, 122, 52));
        painter.drawRoundedRect(QRectF(3, 5, 9, 6), 1.5, 1.5);
        painter.drawRoundedRect(QRectF(3, 7, 17, 12), 1.5, 1.5);
        painter.setBrush(QColor(240, 196, 108));
        painter.drawPolygon(QPolygonF{{QPointF(6, 11), QPointF(23, 11), QPointF(19.5, 19.5), QPointF(3, 19.5)}});
    });
}

QIcon simulationIcon() {
    return drawnIcon([](QPainter& painter) {
        painter.setBrush(QColor(255, 226, 150, 60));
        painter.drawEllipse(QPointF(12, 12), 11, 11);
        painter.setBrush(kAccent);
        painter.drawPolygon(QPolygonF{{QPointF(8, 5), QPointF(19.5, 12), QPointF(8, 19)}});
    });
}

QIcon stopIcon() {
    return drawnIcon([](QPainter& painter) {
        painter.setBrush(QColor(226, 92, 74));
        painter.drawRoundedRect(QRectF(5, 5, 14, 14), 2, 2);
    });
}

void applyLook(QApplication& application) {
    application.setStyle(QStyleFactory::create("Fusion"));
    const QColor ground(43, 45, 52);
    const QColor text(226, 228, 234);
    const QColor faint(124, 128, 140);
    QPalette palette;
    palette.setColor(QPalette::Window, ground);
    palette.setColor(QPalette::WindowText, text);
    palette.setColor(QPalette::Base, QColor(30, 32, 38));
    palette.setColor(QPalette::AlternateBase, QColor(36, 38, 45));
    palette.setColor(QPalette::Text, text);
    palette.setColor(QPalette::PlaceholderText, faint);
    palette.setColor(QPalette::Button, QColor(56, 59, 68));
    palette.setColor(QPalette::ButtonText, text);
    palette.setColor(QPalette::ToolTipBase, QColor(250, 240, 214));
    palette.setColor(QPalette::ToolTipText, QColor(40, 34, 24));
    palette.setColor(QPalette::Highlight, kAccent);
    palette.setColor(QPalette::HighlightedText, QColor(24, 20, 12));
    palette.setColor(QPalette::Link, kAccent);
    palette.setColor(QPalette::Dark, QColor(23, 24, 29));
    for (const QPalette::ColorRole role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText}) {
        palette.setColor(QPalette::Disabled, role, faint);
    }
    application.setPalette(palette);
    application.setStyleSheet("QToolTip { border: 1px solid #b08a4a; padding: 3px; }"
                              "QStatusBar::item { border: none; }"
                              "QStatusBar QLabel { padding: 2px 8px; }"
                              "QToolBar { border: none; spacing: 4px; padding: 3px 6px; }"
                              "QMenuBar { padding: 2px 4px; }");
}
