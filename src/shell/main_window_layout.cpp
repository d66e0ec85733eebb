// The main window's controls and their places: building them, and changing between the two faces.
#include "shell/look.h"
#include "shell/main_window.h"
#include "shell/startup.h"
#include "util/color.h"
#include "util/units.h"

#include <QAction>
#include <QGuiApplication>
#include <QLabel>
#include <QLayout>
#include <QMenuBar>
#include <QMessageBox>
#include <QProgressBar>
#include <QPushButton>
#include <QScreen>
#include <QScrollArea>
#include <QScrollBar>
#include <QStatusBar>
#include <QToolBar>

namespace {

constexpr int kLeastWidthTwips = 3100;  // of the client area
constexpr int kLeastHeightTwips = 3430;

}  // namespace

void frmZephMain::buildMenus() {
    mnufile_ = menuBar()->addMenu(tr("&File"));
    mnufile_->setObjectName("mnufile");
    mnuFileLoad_ = mnufile_->addAction(openIcon(), tr("&Open..."), this, &frmZephMain::mnuFileLoad_Click);
    mnuFileLoad_->setObjectName("mnuFileLoad");
    mnuFileLoad_->setShortcut(QKeySequence::Open);
    mnufile_->addSeparator();
    mnuFileExit_ = mnufile_->addAction(tr("E&xit"), this, &frmZephMain::mnuFileExit_Click);
    mnuFileExit_->setObjectName("mnuFileExit");

    mnuEdit_ = menuBar()->addMenu(tr("&Edit"));
    mnuEdit_->setObjectName("mnuEdit");
    mnuSimulationMode_ =
        mnuEdit_->addAction(simulationIcon(), tr("&Simulation Mode"), this, &frmZephMain::toggleSimulation);
    mnuSimulationMode_->setObjectName("mnuSimulationMode");
    mnuSimulationMode_->setShortcut(Qt::Key_F5);

    mnuHelp_ = menuBar()->addMenu(tr("&Help"));
    mnuHelp_->setObjectName("mnuHelp");
    mnuHelp_->addAction(tr("&About..."), this, &frmZephMain::mnuHelpAbout_Click)->setObjectName("mnuHelpAbout");
}

void frmZephMain::mnuHelpAbout_Click() {
    const QString name = QString::fromStdString(ZephWindowTitle("")).trimmed();
    QMessageBox::about(this, name, name + tr("\nPlans a light display and previews it under its live channel stream."));
}

void frmZephMain::buildToolBar() {
    CoolBar1_ = addToolBar(tr("Tools"));
    CoolBar1_->setObjectName("CoolBar1");
    CoolBar1_->setMovable(false);
    CoolBar1_->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    CoolBar1_->addAction(mnuFileLoad_);
    CoolBar1_->addSeparator();
    CoolBar1_->addAction(mnuSimulationMode_);
}

void frmZephMain::buildCanvas() {
    picViewport_ = new QScrollArea(this);
    picViewport_->setObjectName("picViewport");
    picViewport_->setAlignment(Qt::AlignCenter);
    picViewport_->setBackgroundRole(QPalette::Dark);
    picViewport_->horizontalScrollBar()->setObjectName("HScroll1");
    picViewport_->verticalScrollBar()->setObjectName("VScroll1");
    picMain_ = new PictureBox;
    picMain_->setObjectName("picMain");
    picViewport_->setWidget(picMain_);
    setCentralWidget(picViewport_);
}

void frmZephMain::buildStatusBar() {
    statusBar()->setObjectName("StatusBar1");
    constexpr std::array<int, 5> kStretch{0, 2, 6, 3, 2};
    for (std::size_t panel = 1; panel < panels_.size(); ++panel) {
        panels_[panel] = new QLabel(this);
        panels_[panel]->setObjectName(QString("StatusBar1Panel%1").arg(panel));
        statusBar()->addWidget(panels_[panel], kStretch[panel]);
    }
    prbQueueLen_ = new QProgressBar(this);
    prbQueueLen_->setObjectName("prbQueueLen");
    prbQueueLen_->setRange(0, kQueueGaugeMax);
    prbQueueLen_->setValue(0);
    prbQueueLen_->setTextVisible(false);
    prbQueueLen_->setFixedSize(140, 14);
    prbQueueLen_->setToolTip(tr("Received text that waits to be worked off"));
    cmdStop_ = new QPushButton(stopIcon(), tr("Stop"), this);
    cmdStop_->setObjectName("cmdStop");
    cmdStop_->setFocusPolicy(Qt::NoFocus);
    connect(cmdStop_, &QPushButton::clicked, this, &frmZephMain::cmdStop_MouseUp);
    statusBar()->addPermanentWidget(prbQueueLen_);
    statusBar()->addPermanentWidget(cmdStop_);
    prbQueueLen_->hide();
    cmdStop_->hide();
}

void frmZephMain::placeAtStart() {
    setMinimumSize(kLeastWidthTwips / TwipsPerPixelX, kLeastHeightTwips / TwipsPerPixelY);
    const QSize wished(program_.settings.Width / TwipsPerPixelX, program_.settings.Height / TwipsPerPixelY);
    const QRect room = QGuiApplication::primaryScreen()->availableGeometry();
    resize(wished.boundedTo(room.size()));
    move(room.topLeft() + QPoint(program_.settings.Left / TwipsPerPixelX, program_.settings.Top / TwipsPerPixelY));
}

void frmZephMain::showQueueGauge(bool shown) {
    prbQueueLen_->setVisible(shown);
}

void frmZephMain::showQueueLength(const QueueGaugeUpdate& update) {
    if (update.color) {
        const ColorParts parts = ZephColorToRGB(*update.color);
        const QColor color(parts.red, parts.green, parts.blue);
        prbQueueLen_->setStyleSheet(QString("QProgressBar { border: 1px solid #101114; background: #1e2026; }"
                                            "QProgressBar::chunk { background: %1; }")
                                        .arg(color.name()));
    }
    if (update.value) prbQueueLen_->setValue(*update.value);
}

void frmZephMain::SetControlsForSimulation(bool on) {
    editorPlace_ = QRect(pos(), size());
    if (!on) return;
    menuBar()->hide();
    CoolBar1_->hide();
    picViewport_->setFrameShape(QFrame::NoFrame);
    cmdStop_->show();
    if (isMaximized() || isFullScreen()) return;
    // As large as the canvas, so that nothing stands around the lights; but no larger than the screen.
    layout()->activate();
    const QSize around = size() - picViewport_->size();
    const QSize frame = frameGeometry().size() - size();
    resize((picMain_->size() + around).boundedTo(screen()->availableGeometry().size() - frame));
}

void frmZephMain::layOutForEditor() {
    menuBar()->show();
    CoolBar1_->show();
    picViewport_->setFrameShape(QFrame::StyledPanel);
    cmdStop_->hide();
    if (editorPlace_.isValid() && !isMaximized() && !isFullScreen()) {
        move(editorPlace_.topLeft());
        resize(editorPlace_.size());
    }
    editorPlace_ = QRect();
}

void frmZephMain::CheckEnable() {
    const ZephSimulation& simulation = *program_.simulation;
    const bool editing = !program_.simulating();
    mnuFileLoad_->setEnabled(editing);
    mnuSimulationMode_->setEnabled(simulation.SimulationOpen && simulation.FixtureCount >= 1);
}
