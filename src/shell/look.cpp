#include "shell/look.h"

#include <QApplication>
#include <QPainter>
#include <QPalette>
#include <QProxyStyle>
#include <QStyleFactory>
#include <QStyleOption>

namespace {

struct Tones {
    QColor window, text, faint, base, alternate, button, dark, mid, light, tipBase, tipText, accent, onAccent;
};

// Neutral greys: a tint around the canvas would be seen as a tint of the lights.
const Tones kDarkTones{{43, 45, 48},    {228, 229, 232}, {122, 124, 130}, {28, 29, 32}, {34, 35, 38},
                       {58, 60, 64},    {22, 23, 25},    {74, 76, 82},    {88, 90, 96}, {24, 25, 28},
                       {236, 237, 240}, {232, 163, 61},  {24, 20, 12}};
const Tones kLightTones{{240, 240, 241}, {32, 33, 36},    {150, 152, 157}, {255, 255, 255}, {246, 246, 247},
                        {228, 229, 231}, {203, 204, 208}, {176, 178, 183}, {255, 255, 255}, {255, 255, 255},
                        {32, 33, 36},    {201, 124, 18},  {255, 255, 255}};

// Fusion, corrected for dark grounds: its boxes to tick have borders darker than the window, and its disabled text a
// bright edge that is brighter than the text.
class ReadableFusion : public QProxyStyle {
public:
    using QProxyStyle::QProxyStyle;

    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* returned) const override {
        if (hint == SH_EtchDisabledText) return 0;
        return QProxyStyle::styleHint(hint, option, widget, returned);
    }

    void drawPrimitive(PrimitiveElement element, const QStyleOption* option, QPainter* painter,
                       const QWidget* widget) const override {
        if (element != PE_IndicatorCheckBox && element != PE_IndicatorRadioButton) {
            QProxyStyle::drawPrimitive(element, option, painter, widget);
            return;
        }
        const bool round = element == PE_IndicatorRadioButton;
        const bool enabled = option->state.testFlag(State_Enabled);
        const bool on = option->state.testFlag(State_On);
        const QPalette& palette = option->palette;
        const QColor border =
            palette.color(option->state.testFlag(State_HasFocus) ? QPalette::Highlight : QPalette::PlaceholderText);
        const QRectF box = QRectF(option->rect).adjusted(0.5, 0.5, -0.5, -0.5);
        painter->save();
        painter->setRenderHint(QPainter::Antialiasing);
        painter->setOpacity(enabled ? 1.0 : 0.45);
        painter->setPen(on ? palette.color(QPalette::Highlight) : border);
        painter->setBrush(palette.color(on ? QPalette::Highlight : QPalette::Base));
        const double radius = round ? box.width() / 2 : 3;
        painter->drawRoundedRect(box, radius, radius);
        if (on) drawMark(*painter, box, round, palette.color(QPalette::HighlightedText));
        painter->restore();
    }

private:
    static void drawMark(QPainter& painter, const QRectF& box, bool round, const QColor& ink) {
        const double unit = box.width() / 12;
        const auto at = [&](double x, double y) { return box.topLeft() + QPointF(x, y) * unit; };
        if (round) {
            painter.setPen(Qt::NoPen);
            painter.setBrush(ink);
            painter.drawEllipse(box.center(), 2.5 * unit, 2.5 * unit);
            return;
        }
        painter.setPen(QPen(ink, 1.75 * unit, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
        painter.drawPolyline(QPolygonF{{at(2.7, 6.3), at(5, 8.6), at(9.3, 3.6)}});
    }
};

QPalette paletteOf(const Tones& tones) {
    QPalette palette;
    palette.setColor(QPalette::Window, tones.window);
    palette.setColor(QPalette::WindowText, tones.text);
    palette.setColor(QPalette::Base, tones.base);
    palette.setColor(QPalette::AlternateBase, tones.alternate);
    palette.setColor(QPalette::Text, tones.text);
    palette.setColor(QPalette::PlaceholderText, tones.faint);
    palette.setColor(QPalette::Button, tones.button);
    palette.setColor(QPalette::ButtonText, tones.text);
    palette.setColor(QPalette::ToolTipBase, tones.tipBase);
    palette.setColor(QPalette::ToolTipText, tones.tipText);
    palette.setColor(QPalette::Highlight, tones.accent);
    palette.setColor(QPalette::HighlightedText, tones.onAccent);
    palette.setColor(QPalette::Link, tones.accent);
    palette.setColor(QPalette::Dark, tones.dark);
    palette.setColor(QPalette::Mid, tones.mid);
    palette.setColor(QPalette::Midlight, tones.light);
    // A style sheet on a menu takes the etched text from this colour, past the style's own hint.
    palette.setColor(QPalette::Disabled, QPalette::Light, tones.base);
    for (const QPalette::ColorRole role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText}) {
        palette.setColor(QPalette::Disabled, role, tones.faint);
    }
    return palette;
}

// Flat buttons that show their state by their ground; %1 text with little weight, %2 the accent, %3 border.
QString styleSheetOf(const Tones& tones) {
    return QString("QToolTip { border: 1px solid %3; padding: 4px; }"
                   "QStatusBar::item { border: none; }"
                   "QStatusBar QLabel { padding: 2px 8px; }"
                   "QToolBar { border: none; spacing: 1px; padding: 0px; }"
                   "QToolBar::separator { background: %3; width: 1px; margin: 4px 4px; }"
                   "QToolButton { border: 1px solid transparent; border-radius: 5px; padding: 2px; }"
                   "QToolButton:hover:enabled { background: rgba(%1, 28); }"
                   "QToolButton:pressed:enabled { background: rgba(%1, 52); }"
                   "QToolButton:checked { background: rgba(%2, 70); border-color: rgb(%2); }"
                   "QToolButton:checked:disabled { background: rgba(%2, 30); border-color: rgba(%2, 90); }"
                   "QMenuBar { padding: 2px 4px; }"
                   "QMenu { border: 1px solid %3; padding: 3px; }"
                   "QMenu::separator { height: 1px; background: %3; margin: 4px 8px; }"
                   "QSplitter::handle { background: transparent; width: 6px; }"
                   "QGroupBox { background: rgba(0, 0, 0, 28); border: 1px solid %3;"
                   " border-radius: 5px; margin-top: 1.5em; padding: 4px 2px 2px 2px; }"
                   "QGroupBox::title { subcontrol-origin: margin; left: 2px; color: rgb(%2); }"
                   "QGroupBox::title:disabled { color: %3; }")
        .arg(QString("%1, %2, %3").arg(tones.text.red()).arg(tones.text.green()).arg(tones.text.blue()),
             QString("%1, %2, %3").arg(tones.accent.red()).arg(tones.accent.green()).arg(tones.accent.blue()),
             tones.mid.name());
}

}  // namespace

QIcon simulationIcon() {
    QIcon icon;
    for (const int pixels : {24, 48, 96}) {
        QPixmap pixmap(pixels, pixels);
        pixmap.fill(Qt::transparent);
        QPainter painter(&pixmap);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.scale(pixels / 24.0, pixels / 24.0);
        painter.setPen(Qt::NoPen);
        painter.setBrush(QColor(255, 226, 150, 60));
        painter.drawEllipse(QPointF(12, 12), 11, 11);
        painter.setBrush(kDarkTones.accent);
        painter.drawPolygon(QPolygonF{{QPointF(8, 5), QPointF(19.5, 12), QPointF(8, 19)}});
        painter.end();
        icon.addPixmap(pixmap);
    }
    return icon;
}

void applyLook(QApplication& application) {
    const Tones& tones = qEnvironmentVariable("ZEPH_LOOK") == "light" ? kLightTones : kDarkTones;
    application.setStyle(new ReadableFusion(QStyleFactory::create("Fusion")));
    application.setPalette(paletteOf(tones));
    application.setStyleSheet(styleSheetOf(tones));
}
