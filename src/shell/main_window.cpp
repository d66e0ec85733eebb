// The main window's life: how it comes up, what it does at a tick and when text arrives, how it closes. Its commands
// are in main_window_commands.cpp, its controls in main_window_layout.cpp.
#include "shell/main_window.h"

#include "editor/canvas_drawing.h"
#include "shell/recent_files.h"
#include "shell/startup.h"

#include <QApplication>
#include <QCloseEvent>

namespace {

constexpr int kAdjustBrightnessMs = 250;

}  // namespace

frmZephMain::frmZephMain(Program& program, WindowHost& host) : program_(program), host_(host) {
    setObjectName("frmZephMain");
    setWindowTitle(QString::fromStdString(ZephWindowTitle("")));
    build();
    connectControls();
    host_.attach(this, [this](int panel, const QString& text) { StatusBar1_->setPanel(panel, text); });
    hrTimer1_.setObjectName("hrTimer1");
    hrTimer1_.setTimerType(Qt::PreciseTimer);
    connect(&hrTimer1_, &QTimer::timeout, this, &frmZephMain::tick);
    tmrAdjustBrightness_.setObjectName("tmrAdjustBrightness");
    tmrAdjustBrightness_.setInterval(kAdjustBrightnessMs);
    connect(&tmrAdjustBrightness_, &QTimer::timeout, this, &frmZephMain::tmrAdjustBrightness_Timer);
    program_.seams.socket.dataArrival = [this] { dataArrived(); };
    program_.seams.socket.connectionRequest = [this](std::int64_t request) {
        Winsock1_ConnectionRequest(request, program_.seams.socket, host_, program_.failures);
    };
    qApp->installEventFilter(this);
    placeAtStart();
    UpdateRecentFileMenu();
    program_.editor.SimplePropMode = program_.settings.SimplePropDisplay;
    program_.editor.PressedDrawButton = ToggleDrawBarButtons(program_.editor.ZephUIState, 0);
    showModeButtons();
    CheckEnable(true);
    CoolBar1_->band().show(ZephSetOptionsToolbandStuff(program_.settings, *program_.simulation));
}

frmZephMain::~frmZephMain() {
    host_.attach(nullptr, nullptr);
    program_.seams.socket.dataArrival = nullptr;
    program_.seams.socket.connectionRequest = nullptr;
}

void frmZephMain::start() {
    show();
    host_.pumpEvents();
    if (!program_.parms.FileToOpen.empty()) openFile(QString::fromStdString(program_.parms.FileToOpen), true);
}

void frmZephMain::requestEnd() {
    if (inTick_) {
        endRequested_ = true;
        return;
    }
    EndSimulation(program_, *this);
}

void frmZephMain::tick() {
    // The tick lets waiting events run, and the timer's next event may be among them.
    if (inTick_ || !program_.simulating()) return;
    inTick_ = true;
    hrTimer1_Timer([this] { canvas_->picMain().showChanged(program_.surface.changedRects()); }, program_, *this);
    inTick_ = false;
    if (endRequested_) {
        endRequested_ = false;
        EndSimulation(program_, *this);
    }
    if (closeRequested_) {
        closeRequested_ = false;
        close();
    }
}

void frmZephMain::dataArrived() {
    const bool openGl = program_.RenderEngine == kEngineOpenGL;
    StatusBar1_->showQueueLength(Winsock1_DataArrival(program_.simulating(), openGl, program_.seams.socket,
                                                      program_.failures, program_.receive));
}

void frmZephMain::closeEvent(QCloseEvent* event) {
    if (program_.simulating()) {
        const bool leave = !program_.settings.EndStopsSimulation;
        if (inTick_ || !leave) {
            closeRequested_ = leave;
            requestEnd();
            event->ignore();
            return;
        }
        requestEnd();
    }
    hrTimer1_.stop();
    tmrAdjustBrightness_.stop();
    program_.seams.socket.Close();
    ZephGetDataFromStack(program_.seams.socket, program_.failures, program_.receive);
    event->accept();
}

void frmZephMain::setTimer(bool on, int intervalMs) {
    if (on) {
        hrTimer1_.start(intervalMs);
    } else {
        hrTimer1_.stop();
    }
}

void frmZephMain::showFrames(const QImage& frame) {
    canvas_->picMain().showImage(frame);
    canvas_->layOut();
}

void frmZephMain::redrawObjects() {
    ZephRedrawObjects(
        {*program_.simulation, program_.settings, program_.curve, *program_.bulbs, program_.picBackground},
        program_.picBuffer);
    showFrames(program_.picBuffer);
}

void frmZephMain::showDocument() {
    canvas_->scrollToOrigin();
    CoolBar1_->band().show(ZephSetOptionsToolbandStuff(program_.settings, *program_.simulation));
}

void frmZephMain::setTitle(std::string_view windowTitle) {
    setWindowTitle(toQString(windowTitle));
}
