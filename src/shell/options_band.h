// picToolBarButtonContainer: the band with the colours of names, handles and grid, the grid's form, the button that
// hides names and the brightness of the background.
#pragma once

#include "editor/command_states.h"
#include "editor/tool_bar_texts.h"

#include <QWidget>

#include <functional>

class QComboBox;
class QLabel;
class QSlider;
class QToolButton;

class OptionsBand : public QWidget {
public:
    explicit OptionsBand(QWidget* parent);

    void show(const OptionsBandState& state);
    void show(const OptionsBandValues& values);

    // What the user moved sldIntensity to, per cent.
    std::function<void(int)> sldIntensity_Scroll;
    int intensity() const;

private:
    QToolButton* colorButton(const char* name, const char* tip);

    QToolButton* cmdTextColor_ = nullptr;
    QToolButton* cmdGridLineColor_ = nullptr;
    QComboBox* cmbGridLineOption_ = nullptr;
    QLabel* lblToolHandleColor_ = nullptr;
    QToolButton* cmdToolHandleColor_ = nullptr;
    QLabel* lblVertexHandleColor_ = nullptr;
    QToolButton* cmdVertexHandleColor_ = nullptr;
    QToolButton* chkNames_ = nullptr;
    QLabel* lblIntensity_ = nullptr;
    QSlider* sldIntensity_ = nullptr;
};
