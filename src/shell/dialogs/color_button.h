// A button that shows a colour and lets the user choose another one.
#pragma once

#include <QPushButton>

#include <cstdint>
#include <functional>
#include <optional>

// Asks for a colour, packed; nothing if the user keeps the one there is. title: what the colour is for.
using ColorPicker = std::function<std::optional<std::int32_t>(std::int32_t color, const QString& title, QWidget* over)>;

// The platform's dialog.
std::optional<std::int32_t> pickColor(std::int32_t color, const QString& title, QWidget* over);

QColor toQColor(std::int32_t packed);

class ColorButton : public QPushButton {
public:
    // title: what the colour is for. changed: called after the user chose another one.
    ColorButton(const QString& title, ColorPicker picker, std::function<void()> changed, QWidget* parent = nullptr);

    std::int32_t color() const { return color_; }  // packed
    void setColor(std::int32_t packed);

private:
    void choose();

    QString title_;
    ColorPicker picker_;
    std::function<void()> changed_;
    std::int32_t color_ = 0;
};
