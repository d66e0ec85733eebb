#include "shell/main_window.h"

#include "editor/canvas_drawing.h"
#include "model/data_directories.h"
#include "shell/startup.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QFileDialog>
#include <QKeyEvent>
#include <QLabel>
#include <QScreen>
#include <QScrollArea>
#include <QScrollBar>

namespace {

constexpr int kEditorFolder = 1;

}  // namespace

frmZephMain::frmZephMain(Program& program, WindowHost& host) : program_(program), host_(host) {
    setObjectName("frmZephMain");
    setWindowTitle(QString::fromStdString(ZephWindowTitle("")));
    buildMenus();
    buildToolBar();
    buildCanvas();
    buildStatusBar();
    host_.attach(this, [this](int panel, const QString& text) {
        if (panel >= 1 && panel <= 4) panels_[static_cast<std::size_t>(panel)]->setText(text);
    });
    hrTimer1_.setObjectName("hrTimer1");
    hrTimer1_.setTimerType(Qt::PreciseTimer);
    connect(&hrTimer1_, &QTimer::timeout, this, &frmZephMain::tick);
    program_.seams.socket.dataArrival = [this] { dataArrived(); };
    program_.seams.socket.connectionRequest = [this](std::int64_t request) {
        Winsock1_ConnectionRequest(request, program_.seams.socket, host_, program_.failures);
    };
    qApp->installEventFilter(this);
    placeAtStart();
    CheckEnable();
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

bool frmZephMain::openFile(const QString& path, bool quiet) {
    setEditorFile(path.toStdString(), *program_.simulation);
    const bool loaded = LoadEditorFile(quiet, program_, *this, *this);
    if (!loaded) {
        program_.simulation->FilePath.clear();
        program_.simulation->FileName.clear();
    }
    CheckEnable();
    return loaded;
}

void frmZephMain::mnuFileLoad_Click() {
    ZephSwitchMode(kStateSelectFixture, program_, *this);
    if (program_.simulation->SimulationDirty) {
        const BoxAnswer answer = host_.messageBox(
            boxTitle("-Load?"), "This editor session has not been saved.  Are you sure you want to load a new one?",
            BoxIcon::Question, BoxButtons::YesNo);
        if (answer != BoxAnswer::Yes) return;
    }
    const QString folder =
        QString::fromStdString(ZephReturnDataDirectory(kEditorFolder, program_.paths, program_.settings));
    const QString file =
        QFileDialog::getOpenFileName(this, tr("Load File"), folder, tr("Zeph Editor Environment Files (ZEE) (*.zee)"));
    if (!file.isEmpty()) openFile(file, false);
    CheckEnable();
}

void frmZephMain::mnuFileExit_Click() {
    if (isMinimized()) showNormal();
    close();
}

void frmZephMain::cmdStop_MouseUp() {
    requestEnd();
}

void frmZephMain::toggleSimulation() {
    if (program_.simulating()) {
        requestEnd();
    } else {
        ::mnuSimulationMode_Click(program_, *this);
    }
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
    hrTimer1_Timer([this] { picMain_->showChanged(program_.surface.changedRects()); }, program_, *this);
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
    const QueueGaugeUpdate update =
        Winsock1_DataArrival(program_.simulating(), openGl, program_.seams.socket, program_.failures, program_.receive);
    showQueueLength(update);
}

bool frmZephMain::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::KeyPress && program_.simulating() && isActiveWindow() &&
        static_cast<QKeyEvent*>(event)->key() == Qt::Key_Escape) {
        requestEnd();
        return true;
    }
    return QMainWindow::eventFilter(watched, event);
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
    picMain_->showImage(frame);
}

void frmZephMain::redrawObjects() {
    ZephRedrawObjects(
        {*program_.simulation, program_.settings, program_.curve, *program_.bulbs, program_.picBackground},
        program_.picBuffer);
    picMain_->showImage(program_.picBuffer);
}

void frmZephMain::showDocument() {
    picViewport_->horizontalScrollBar()->setValue(0);
    picViewport_->verticalScrollBar()->setValue(0);
}

void frmZephMain::setTitle(std::string_view windowTitle) {
    setWindowTitle(toQString(windowTitle));
}
