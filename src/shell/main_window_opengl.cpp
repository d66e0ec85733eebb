// The main window and the window of the OpenGL engine: one of the two is seen while a simulation runs.
#include "editor/background.h"
#include "engine/dialogs/opengl_window.h"
#include "shell/main_window.h"
#include "shell/sequencer_control.h"

GLTarget* frmZephMain::ZephCreateRenderWindow() {
    GLWindowActions actions;
    // Torn down at the head of the next tick, never inside an event of the window itself.
    actions.stopRequested = [this] { program_.clocks.StopRequested = true; };
    actions.cmdSEPlay_MouseUp = [this] {
        tellSequencer(SequencerCommand::Start, program_.seams.store, program_.failures);
    };
    actions.cmdSEStop_MouseUp = [this] {
        tellSequencer(SequencerCommand::Stop, program_.seams.store, program_.failures);
    };
    actions.resized = [this](std::int32_t width, std::int32_t height, double pixelRatio) {
        program_.glSurface.setViewport(width, height, pixelRatio);
    };
    frmZephOpenGL_ = std::make_unique<frmZephOpenGL>(std::move(actions));
    frmZephOpenGL_->setWindowTitle(windowTitle());
    if (renderWindowPlace_) frmZephOpenGL_->move(*renderWindowPlace_);
    const QSize canvas = canvasSize(program_.simulation->Background);
    if (!::ZephCreateRenderWindow(canvas, program_.failures, *frmZephOpenGL_)) return nullptr;
    host_.attach(frmZephOpenGL_.get(), [this](int panel, const QString& text) {
        StatusBar1_->setPanel(panel, text);
        if (frmZephOpenGL_) frmZephOpenGL_->setStatusPanel(panel, text);
    });
    return &frmZephOpenGL_->target();
}

void frmZephMain::resizeRenderWindow() {
    if (frmZephOpenGL_) frmZephOpenGL_->resizeDrawing();
}

void frmZephMain::closeRenderWindow() {
    if (!frmZephOpenGL_) return;
    frmZephOpenGL_->hide();
    if (const auto place = frmZephOpenGL_->notedPlace()) renderWindowPlace_ = place;
    host_.attach(this, [this](int panel, const QString& text) { StatusBar1_->setPanel(panel, text); });
    // Its own click may have led here, so it goes when that event is over.
    frmZephOpenGL_.release()->deleteLater();
}

void frmZephMain::showMainWindow(bool shown) {
    if (shown == isVisible()) return;
    setVisible(shown);
}

void frmZephMain::ForceForwardIfSimulating() {
    if (!program_.simulating() || !program_.settings.ForceSimulationForward) return;
    QWidget* const window = frmZephOpenGL_ ? static_cast<QWidget*>(frmZephOpenGL_.get()) : this;
    if (window->isActiveWindow()) return;
    if (window->isMinimized()) window->showNormal();
    window->raise();
    window->activateWindow();
}
