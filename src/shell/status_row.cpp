#include "shell/status_row.h"

#include "shell/command_icons.h"
#include "util/color.h"

#include <QLabel>
#include <QProgressBar>
#include <QPushButton>

namespace {

QFrame* separator(QWidget* parent) {
    auto* line = new QFrame(parent);
    line->setFrameShape(QFrame::VLine);
    line->setForegroundRole(QPalette::Mid);
    return line;
}

}  // namespace

StatusRow::StatusRow(QWidget* parent) : QStatusBar(parent) {
    setObjectName("StatusBar1");
    setSizeGripEnabled(false);
    constexpr std::array<int, 5> kStretch{0, 1, 6, 3, 2};
    for (std::size_t panel = 1; panel < panels_.size(); ++panel) {
        panels_[panel] = new QLabel(this);
        panels_[panel]->setObjectName(QString("StatusBar1Panel%1").arg(panel));
        // A long text is cut off rather than widening the window.
        panels_[panel]->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
        if (panel > 1) addWidget(separator(this));
        addWidget(panels_[panel], kStretch[panel]);
    }
    prbQueueLen_ = new QProgressBar(this);
    prbQueueLen_->setObjectName("prbQueueLen");
    prbQueueLen_->setRange(0, kQueueGaugeMax);
    prbQueueLen_->setValue(0);
    prbQueueLen_->setTextVisible(false);
    prbQueueLen_->setFixedSize(120, 14);
    prbQueueLen_->setToolTip(tr("Received text that waits to be worked off"));
    addPermanentWidget(prbQueueLen_);
    prbQueueLen_->hide();
    cmdSEPlay_ =
        button("cmdSEPlay", "sequence-play", "Play", "Start the sequencing program", &StatusRow::cmdSEPlay_MouseUp);
    cmdSEStop_ =
        button("cmdSEStop", "sequence-stop", "Halt", "Stop the sequencing program", &StatusRow::cmdSEStop_MouseUp);
    cmdStop_ = button("cmdStop", "stop", "Stop", "End the simulation (Esc)", &StatusRow::cmdStop_MouseUp);
}

QPushButton* StatusRow::button(const char* name, const char* icon, const char* text, const char* tip,
                               std::function<void()> StatusRow::*pressed) {
    auto* made = new QPushButton(commandIcon(icon), tr(text), this);
    made->setObjectName(name);
    made->setToolTip(tr(tip));
    made->setFocusPolicy(Qt::NoFocus);
    connect(made, &QPushButton::clicked, this, [this, pressed] {
        if (this->*pressed) (this->*pressed)();
    });
    addPermanentWidget(made);
    made->hide();
    return made;
}

void StatusRow::setPanel(int panel, const QString& text) {
    if (panel < 1 || panel > 4) return;
    QLabel& label = *panels_[static_cast<std::size_t>(panel)];
    label.setText(text);
    label.setToolTip(text);
}

QString StatusRow::panel(int panel) const {
    return panels_.at(static_cast<std::size_t>(panel))->text();
}

void StatusRow::showQueueGauge(bool shown) {
    prbQueueLen_->setVisible(shown);
}

void StatusRow::showQueueLength(const QueueGaugeUpdate& update) {
    if (update.color) {
        const ColorParts parts = ZephColorToRGB(*update.color);
        const QColor color(parts.red, parts.green, parts.blue);
        prbQueueLen_->setStyleSheet(
            QString("QProgressBar { border: 1px solid palette(mid); background: palette(base); }"
                    "QProgressBar::chunk { background: %1; }")
                .arg(color.name()));
    }
    if (update.value) prbQueueLen_->setValue(*update.value);
}

void StatusRow::showSimulationButtons(bool shown) {
    for (QPushButton* shownButton : {cmdSEPlay_, cmdSEStop_, cmdStop_})
        shownButton->setVisible(shown);
    cmdSEPlay_->setEnabled(static_cast<bool>(cmdSEPlay_MouseUp));
    cmdSEStop_->setEnabled(static_cast<bool>(cmdSEStop_MouseUp));
}
