// The main window's controls and their places: building them, and changing between the two faces.
#include "shell/main_window.h"
#include "shell/sequencer_control.h"
#include "shell/window_place.h"
#include "util/units.h"

#include <QGuiApplication>
#include <QLayout>
#include <QMenuBar>
#include <QScreen>
#include <QSplitter>
#include <QVBoxLayout>

namespace {

constexpr int kLeastWidthTwips = 3100;  // of the client area
constexpr int kLeastHeightTwips = 3430;
constexpr int kListPixels = 220;

}  // namespace

void frmZephMain::build() {
    commands_ = std::make_unique<CommandActions>(
        *this, *menuBar(), [this](Command command) { runCommand(command); },
        [this](int index) { mnuRecentFiles_Click(index); });
    auto* client = new QWidget(this);
    CoolBar1_ = new CoolBar(*commands_, client);
    splitter_ = new QSplitter(Qt::Horizontal, client);
    objects_ = new ObjectPanel(splitter_);
    canvas_ = new CanvasViewport(splitter_);
    splitter_->setChildrenCollapsible(false);
    splitter_->setStretchFactor(1, 1);
    splitter_->setSizes({kListPixels, 10 * kListPixels});
    auto* rows = new QVBoxLayout(client);
    rows->setContentsMargins(0, 0, 0, 0);
    rows->setSpacing(0);
    rows->addWidget(CoolBar1_);
    rows->addWidget(splitter_, 1);
    setCentralWidget(client);
    StatusBar1_ = new StatusRow(this);
    setStatusBar(StatusBar1_);
    setContextMenuPolicy(Qt::NoContextMenu);
}

void frmZephMain::connectControls() {
    StatusBar1_->cmdStop_MouseUp = [this] { cmdStop_MouseUp(); };
    StatusBar1_->cmdSEPlay_MouseUp = [this] {
        tellSequencer(SequencerCommand::Start, program_.seams.store, program_.failures);
    };
    StatusBar1_->cmdSEStop_MouseUp = [this] {
        tellSequencer(SequencerCommand::Stop, program_.seams.store, program_.failures);
    };
    CoolBar1_->band().sldIntensity_Scroll = [this](int) { sldIntensity_Scroll(); };
    objects_->flgObjectSelect_Click = [this](int row) {
        flgObjectSelect_Click(objects_->objectOfRow(row), modes_.context());
    };
    objects_->chkCmdFixtureOrProp_MouseUp = [this](int button, bool left) {
        chkCmdFixtureOrProp_MouseUp(button, left, modes_.context());
    };
    objects_->chkSimplePropMode_Click = [this](bool simple) { chkSimplePropMode_Click(simple, modes_.context()); };
    connect(&canvas_->picMain(), &QWidget::customContextMenuRequested, this,
            [this](const QPoint& pos) { showContextMenu(canvas_->picMain().mapToGlobal(pos)); });
}

void frmZephMain::placeAtStart() {
    setMinimumSize(kLeastWidthTwips / TwipsPerPixelX, kLeastHeightTwips / TwipsPerPixelY);
    const ZephSettings& settings = program_.settings;
    const QScreen* screen =
        QGuiApplication::screenAt(QPoint(settings.Left / TwipsPerPixelX, settings.Top / TwipsPerPixelY));
    if (screen == nullptr) screen = QGuiApplication::primaryScreen();  // the one that it stood on has gone
    const QRect place = ZephWindowPlace(settings, screen->availableGeometry());
    move(place.topLeft());
    resize(place.size());
}

// With the frame that the window manager draws around it, the lower edge of a tall window, and its status bar, would
// lie below the screen. A window that is not too large stays wherever its user has put it.
void frmZephMain::keepFrameOnScreen() {
    if (program_.simulating() || isMaximized() || isFullScreen() || isMinimized()) return;
    const QRect room = screen()->availableGeometry();
    const QSize most = room.size() - (frameGeometry().size() - size());
    if (size().boundedTo(most) == size()) return;
    const QRect place = placedInside(QRect(pos(), size()), QRect(room.topLeft(), most));
    resize(place.size());
    move(place.topLeft());
}

void frmZephMain::showQueueGauge(bool shown) {
    StatusBar1_->showQueueGauge(shown);
}

void frmZephMain::showEditorControls(bool shown) {
    menuBar()->setVisible(shown);
    CoolBar1_->setVisible(shown);
    objects_->setVisible(shown);
    StatusBar1_->showSimulationButtons(!shown);
    canvas_->setBorder(shown);
}

void frmZephMain::SetControlsForSimulation(bool on) {
    editorPlace_ = QRect(pos(), size());
    if (!on) return;
    showEditorControls(false);
    if (!isMaximized() && !isFullScreen()) {
        // As large as the canvas, so that nothing stands around the lights; but no larger than the screen.
        layout()->activate();
        centralWidget()->layout()->activate();
        const QSize around(0, size().height() - centralWidget()->height());
        const QSize frame = frameGeometry().size() - size();
        const QSize canvas = canvas_->picMain().size();
        resize((canvas + around).boundedTo(screen()->availableGeometry().size() - frame));
    }
    canvas_->setScrollUnit(ScrollUnit::Pixels);
}

void frmZephMain::layOutForEditor() {
    showEditorControls(true);
    if (editorPlace_.isValid() && !isMaximized() && !isFullScreen()) {
        move(editorPlace_.topLeft());
        resize(editorPlace_.size());
    }
    editorPlace_ = QRect();
    canvas_->setScrollUnit(ScrollUnit::Percent);
}
