#include "shell/options_band.h"

#include "model/tables.h"
#include "shell/command_icons.h"
#include "shell/dialogs/color_button.h"
#include "shell/window_host.h"

#include <QComboBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QSignalBlocker>
#include <QSlider>
#include <QToolButton>
#include <QToolTip>

namespace {

constexpr int kIconPixels = 20;
// Only the brightness acts on anything that is painted so far; the canvas has neither names nor grid nor handles, so
// the controls for them show the options and stay disabled.
constexpr bool kPaintsNamesGridAndHandles = false;

void showSwatch(QLabel& label, std::int32_t color) {
    label.setStyleSheet(
        QString("background: %1; border: 1px solid palette(mid); border-radius: 3px;").arg(toQColor(color).name()));
}

}  // namespace

OptionsBand::OptionsBand(QWidget* parent) : QWidget(parent) {
    setObjectName("picToolBarButtonContainer");
    cmdTextColor_ = colorButton("cmdTextColor", "Color of Names");
    chkNames_ = colorButton("chkNames", "Hide Names");
    chkNames_->setCheckable(true);
    chkNames_->setIcon(commandIcon("hide-names"));
    cmdGridLineColor_ = colorButton("cmdGridLineColor", "Color of Grid Lines");
    cmbGridLineOption_ = new QComboBox(this);
    cmbGridLineOption_->setObjectName("cmbGridLineOption");
    cmbGridLineOption_->setToolTip(tr("Grid Lines"));
    cmbGridLineOption_->setFocusPolicy(Qt::NoFocus);
    for (const std::string_view line : kGridLines)
        cmbGridLineOption_->addItem(toQString(line));
    for (const auto& [label, name] : {std::pair{&lblToolHandleColor_, "lblToolHandleColor"},
                                      std::pair{&lblVertexHandleColor_, "lblVertexHandleColor"}}) {
        *label = new QLabel(this);
        (*label)->setObjectName(name);
        (*label)->setFixedSize(12, 18);
    }
    cmdToolHandleColor_ = colorButton("cmdToolHandleColor", "Color of Tool Handles");
    cmdToolHandleColor_->setIcon(commandIcon("handle-color"));
    cmdVertexHandleColor_ = colorButton("cmdVertexHandleColor", "Color of Vertex Handles");
    cmdVertexHandleColor_->setIcon(commandIcon("vertex-color"));
    lblIntensity_ = new QLabel(this);
    lblIntensity_->setPixmap(commandIcon("brightness").pixmap(QSize(18, 18), devicePixelRatioF()));
    sldIntensity_ = new QSlider(Qt::Horizontal, this);
    sldIntensity_->setObjectName("sldIntensity");
    sldIntensity_->setRange(0, 100);
    sldIntensity_->setPageStep(10);
    sldIntensity_->setFixedWidth(64);
    sldIntensity_->setFocusPolicy(Qt::NoFocus);
    connect(sldIntensity_, &QSlider::valueChanged, this, [this](int value) {
        sldIntensity_->setToolTip(QString::number(value) + " %");
        if (sldIntensity_->isSliderDown()) {
            QToolTip::showText(QCursor::pos(), sldIntensity_->toolTip(), sldIntensity_);
        }
        if (sldIntensity_Scroll) sldIntensity_Scroll(value);
    });

    auto* row = new QHBoxLayout(this);
    row->setContentsMargins(0, 0, 0, 0);
    row->setSpacing(3);
    for (QWidget* control : std::initializer_list<QWidget*>{
             cmdTextColor_, chkNames_, cmdGridLineColor_, cmbGridLineOption_, cmdToolHandleColor_, lblToolHandleColor_,
             cmdVertexHandleColor_, lblVertexHandleColor_}) {
        row->addWidget(control);
    }
    row->addSpacing(6);
    row->addWidget(lblIntensity_);
    row->addWidget(sldIntensity_);
}

QToolButton* OptionsBand::colorButton(const char* name, const char* tip) {
    auto* button = new QToolButton(this);
    button->setObjectName(name);
    button->setToolTip(tr(tip));
    button->setAutoRaise(true);
    button->setIconSize(QSize(kIconPixels, kIconPixels));
    button->setFocusPolicy(Qt::NoFocus);
    return button;
}

int OptionsBand::intensity() const {
    return sldIntensity_->value();
}

void OptionsBand::show(const OptionsBandState& state) {
    setEnabled(state.picToolBarButtonContainer);
    cmdTextColor_->setEnabled(state.cmdTextColor && kPaintsNamesGridAndHandles);
    cmdToolHandleColor_->setEnabled(state.cmdToolHandleColor && kPaintsNamesGridAndHandles);
    cmdVertexHandleColor_->setEnabled(state.cmdVertexHandleColor && kPaintsNamesGridAndHandles);
    cmdGridLineColor_->setEnabled(state.cmdGridLineColor && kPaintsNamesGridAndHandles);
    cmbGridLineOption_->setEnabled(state.cmbGridLineOption && kPaintsNamesGridAndHandles);
    lblToolHandleColor_->setEnabled(state.lblToolHandleColor);
    lblVertexHandleColor_->setEnabled(state.lblVertexHandleColor);
    sldIntensity_->setEnabled(state.sldIntensity);
    lblIntensity_->setEnabled(state.sldIntensity);
    chkNames_->setEnabled(state.chkNames && kPaintsNamesGridAndHandles);
}

void OptionsBand::show(const OptionsBandValues& values) {
    cmdTextColor_->setIcon(colorIcon("text-color", toQColor(values.TextColor)));
    cmdGridLineColor_->setIcon(colorIcon("grid-color", toQColor(values.GridLineColor)));
    showSwatch(*lblToolHandleColor_, values.ToolHandleColor);
    showSwatch(*lblVertexHandleColor_, values.VertexHandleColor);
    cmbGridLineOption_->setCurrentIndex(values.GridLineOption);
    chkNames_->setChecked(values.chkNames);
    // Shown, not moved by the user: nothing may be marked as changed.
    const QSignalBlocker quiet(sldIntensity_);
    sldIntensity_->setValue(values.sldIntensity);
    sldIntensity_->setToolTip(QString::number(values.sldIntensity) + " %");
}
