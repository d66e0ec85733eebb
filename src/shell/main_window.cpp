// The main window's life: how it comes up, what it does at a tick and when text arrives, how it closes. Its commands
// are in main_window_commands.cpp, its controls in main_window_layout.cpp.
#include "shell/main_window.h"

#include "editor/canvas_drawing.h"
#include "engine/dialogs/opengl_window.h"
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
    tmrAutoSave_.setObjectName("tmrAutoSave");
    connect(&tmrAutoSave_, &QTimer::timeout, this, &frmZephMain::tmrAutoSave_Timer);
    tmrAutoSave_.start(kAutoSaveTickMs);
    program_.seams.socket.dataArrival = [this] { dataArrived(); };
    program_.seams.socket.connectionRequest = [this](std::int64_t request) {
        Winsock1_ConnectionRequest(request, program_.seams.socket, host_, program_.failures);
    };
    qApp->installEventFilter(this);
    placeAtStart();
}

frmZephMain::~frmZephMain() {
    host_.attach(nullptr, nullptr);
    program_.seams.socket.dataArrival = nullptr;
    program_.seams.socket.connectionRequest = nullptr;
}

void frmZephMain::setUpToolBars() {
    program_.editor.PressedDrawButton = ToggleDrawBarButtons(program_.editor.ZephUIState, 0);
    showModeButtons();
}

void frmZephMain::setUpMenus() {
    UpdateRecentFileMenu();
    CheckEnable(true);
    showOptionsBand();
}

void frmZephMain::start() {
    constexpr int kMaximised = 2;
    if (program_.settings.State == kMaximised) {
        showMaximized();
    } else {
        show();
    }
    host_.pumpEvents();
    toolBands_ = ZephInitializeFromRegistryCoolbar(program_.seams.store, program_.failures);
    CoolBar1_->arrange(toolBands_);
    ZephOpenFirst(*this, program_);
}

bool frmZephMain::openCommandLineFile(const std::string& file) {
    return openFile(QString::fromStdString(file), true);
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
    hrTimer1_Timer(
        [this] {
            if (!program_.rendersOpenGL()) canvas_->picMain().showChanged(program_.surface.changedRects());
        },
        program_, *this);
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
    constexpr qint64 kSequencePauseMs = 2000;  // text after a pause of this length begins a sequence
    if (!lastArrival_.isValid() || lastArrival_.elapsed() > kSequencePauseMs) ForceForwardIfSimulating();
    lastArrival_.start();
    const bool openGl = program_.rendersOpenGL();
    StatusBar1_->showQueueLength(Winsock1_DataArrival(program_.simulating(), openGl, program_.seams.socket,
                                                      program_.failures, program_.receive));
}

void frmZephMain::showEvent(QShowEvent*) {
    constexpr int kFrameKnownMs = 200;  // the window manager answers some time after the window is up
    QTimer::singleShot(kFrameKnownMs, this, &frmZephMain::keepFrameOnScreen);
}

void frmZephMain::closeEvent(QCloseEvent* event) {
    if (inTick_) {
        // Not under a pass: the tick asks again when it is done.
        closeRequested_ = true;
        event->ignore();
        return;
    }
    takeIntensity();  // what is saved on leaving is what the slider shows
    const bool leave = Form_Unload(program_, *this, *this);
    event->setAccepted(leave);
    if (leave) QCoreApplication::quit();  // the OpenGL engine hides this window, so being hidden is no reason to quit
}

void frmZephMain::stopTimers() {
    hrTimer1_.stop();
    tmrAdjustBrightness_.stop();
    tmrAutoSave_.stop();
}

QRect frmZephMain::windowPlace() const {
    return isMaximized() || isMinimized() ? normalGeometry() : QRect(pos(), size());
}

int frmZephMain::windowState() const {
    return isMinimized() ? 1 : isMaximized() ? 2 : 0;
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
    showOptionsBand();
}

void frmZephMain::showOptionsBand() {
    CoolBar1_->band().show(ZephSetOptionsToolbandStuff(program_.settings, *program_.simulation));
}

void frmZephMain::setTitle(std::string_view windowTitle) {
    setWindowTitle(toQString(windowTitle));
}
