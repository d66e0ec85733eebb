#include "shell/dialogs/option_controls.h"

#include <QCheckBox>
#include <QComboBox>
#include <QSlider>
#include <QSpinBox>

namespace {

constexpr int kVisibleItems = 18;

}  // namespace

void fillList(QComboBox& box, const OptionItems& items) {
    box.clear();
    for (const OptionItem& item : items)
        box.addItem(QString::fromStdString(item.Text), item.Data);
    box.setMaxVisibleItems(kVisibleItems);
}

QCheckBox* OptionControls::check(const char* name, const QString& text, FlagField field, const QString& tip) {
    auto* box = new QCheckBox(text);
    box->setObjectName(name);
    box->setToolTip(tip);
    checks_.emplace_back(box, field);
    return box;
}

QComboBox* OptionControls::list(const char* name, LongField field) {
    auto* box = new QComboBox;
    box->setObjectName(name);
    fillList(*box, ZephOptionItems(field));
    lists_.emplace_back(box, field);
    return box;
}

QSlider* OptionControls::slider(const char* name, LongField field) {
    auto* slider = new QSlider(Qt::Horizontal);
    slider->setObjectName(name);
    const SettingRange range = settingRange(field);
    slider->setRange(range.Min, range.Max);
    slider->setPageStep(5);
    sliders_.emplace_back(slider, field);
    return slider;
}

QSpinBox* OptionControls::number(const char* name, LongField field) {
    auto* box = new QSpinBox;
    box->setObjectName(name);
    const SettingRange range = settingRange(field);
    box->setRange(range.Min, range.Max);
    numbers_.emplace_back(box, field);
    return box;
}

ColorButton* OptionControls::color(const char* name, const QString& title, LongField field,
                                   std::function<void()> changed) {
    auto* button = new ColorButton(title, picker_, std::move(changed));
    button->setObjectName(name);
    colors_.emplace_back(button, field);
    return button;
}

void OptionControls::show(const ZephSettings& settings) {
    for (const auto& [box, field] : checks_)
        box->setChecked(settings.*field);
    for (const auto& [box, field] : lists_) {
        box->setPlaceholderText(QString::fromStdString(ZephOptionText(field, settings.*field)));
        box->setCurrentIndex(box->findData(settings.*field));
    }
    for (const auto& [slider, field] : sliders_)
        slider->setValue(settings.*field);
    for (const auto& [box, field] : numbers_)
        box->setValue(settings.*field);
    for (const auto& [button, field] : colors_)
        button->setColor(settings.*field);
}

void OptionControls::take(ZephSettings& settings) const {
    for (const auto& [box, field] : checks_)
        settings.*field = box->isChecked();
    for (const auto& [box, field] : lists_) {
        if (box->currentIndex() >= 0) settings.*field = box->currentData().toInt();
    }
    for (const auto& [slider, field] : sliders_)
        settings.*field = slider->value();
    for (const auto& [box, field] : numbers_)
        settings.*field = box->value();
    for (const auto& [button, field] : colors_)
        settings.*field = button->color();
}
