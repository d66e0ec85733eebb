#include "shell/dialogs/color_button.h"

#include "util/color.h"

#include <QColorDialog>
#include <QPainter>

namespace {

constexpr QSize kSwatch(34, 16);
const QColor kSwatchRim(128, 130, 138);  // seen on dark colours and on bright ones

QIcon swatch(const QColor& color) {
    QIcon icon;
    for (const int scale : {1, 2}) {
        QPixmap pixmap(kSwatch * scale);
        pixmap.setDevicePixelRatio(scale);
        pixmap.fill(Qt::transparent);
        QPainter painter(&pixmap);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(QPen(kSwatchRim, 1));
        painter.setBrush(color);
        painter.drawRoundedRect(QRectF({0.5, 0.5}, QSizeF(kSwatch) - QSizeF(1, 1)), 3, 3);
        painter.end();
        icon.addPixmap(pixmap);
    }
    return icon;
}

}  // namespace

QColor toQColor(std::int32_t packed) {
    const ColorParts parts = ZephColorToRGB(packed);
    return {parts.red, parts.green, parts.blue};
}

std::optional<std::int32_t> pickColor(std::int32_t color, const QString& title, QWidget* over) {
    const QColor chosen = QColorDialog::getColor(toQColor(color), over, title);
    if (!chosen.isValid()) return std::nullopt;
    return packColor(chosen.red(), chosen.green(), chosen.blue());
}

ColorButton::ColorButton(const QString& title, ColorPicker picker, std::function<void()> changed, QWidget* parent)
    : QPushButton(parent), title_(title), picker_(std::move(picker)), changed_(std::move(changed)) {
    setIconSize(kSwatch);
    setAutoDefault(false);
    setAccessibleName(title);
    connect(this, &QPushButton::clicked, this, &ColorButton::choose);
    setColor(0);
}

void ColorButton::setColor(std::int32_t packed) {
    color_ = packed;
    setIcon(swatch(toQColor(packed)));
    setText(toQColor(packed).name().toUpper());
}

void ColorButton::choose() {
    const std::optional<std::int32_t> chosen = picker_(color_, title_, window());
    if (!chosen || *chosen == color_) return;
    setColor(*chosen);
    changed_();
}
