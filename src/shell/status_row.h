// StatusBar1: its four panels and, while a simulation runs, the gauge of the receive queue and the buttons that end it
// and that drive the sequencing program.
#pragma once

#include "link/queue_gauge.h"

#include <QStatusBar>

#include <array>
#include <functional>

class QLabel;
class QProgressBar;
class QPushButton;

class StatusRow : public QStatusBar {
public:
    explicit StatusRow(QWidget* parent);

    void setPanel(int panel, const QString& text);  // panel 1..4, others are ignored
    QString panel(int panel) const;                 // the text it shows
    void showQueueGauge(bool shown);
    void showQueueLength(const QueueGaugeUpdate& update);
    void showSimulationButtons(bool shown);

    std::function<void()> cmdStop_MouseUp;
    std::function<void()> cmdSEPlay_MouseUp;
    std::function<void()> cmdSEStop_MouseUp;

private:
    QPushButton* button(const char* name, const char* icon, const char* text, const char* tip,
                        std::function<void()> StatusRow::*pressed);

    std::array<QLabel*, 5> panels_{};  // 1..4
    QProgressBar* prbQueueLen_ = nullptr;
    QPushButton* cmdSEPlay_ = nullptr;
    QPushButton* cmdSEStop_ = nullptr;
    QPushButton* cmdStop_ = nullptr;
};
