// The controls of the options dialog that stand for one setting each: made with the name they are known by, filled
// from a record of settings, read back into one.
#pragma once

#include "shell/dialogs/color_button.h"
#include "shell/options_logic.h"

#include <utility>
#include <vector>

class QCheckBox;
class QComboBox;
class QSlider;
class QSpinBox;

void fillList(QComboBox& box, const OptionItems& items);

class OptionControls {
public:
    explicit OptionControls(ColorPicker picker) : picker_(std::move(picker)) {}

    // name: the objectName. Each belongs to the layout that it is put in.
    QCheckBox* check(const char* name, const QString& text, FlagField field, const QString& tip = {});
    QComboBox* list(const char* name, LongField field);
    QSlider* slider(const char* name, LongField field);
    QSpinBox* number(const char* name, LongField field);
    ColorButton* color(
        const char* name, const QString& title, LongField field, std::function<void()> changed = [] {});

    void show(const ZephSettings& settings);
    // A list without a choice leaves its setting as it is: the store may hold a number that the list does not offer.
    void take(ZephSettings& settings) const;

private:
    ColorPicker picker_;
    std::vector<std::pair<QCheckBox*, FlagField>> checks_;
    std::vector<std::pair<QComboBox*, LongField>> lists_;
    std::vector<std::pair<QSlider*, LongField>> sliders_;
    std::vector<std::pair<QSpinBox*, LongField>> numbers_;
    std::vector<std::pair<ColorButton*, LongField>> colors_;
};
