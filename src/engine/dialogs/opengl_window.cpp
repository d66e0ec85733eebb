#include "engine/dialogs/opengl_window.h"

#include "util/host.h"

#include <QCloseEvent>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QOpenGLContext>
#include <QPushButton>
#include <QStatusBar>
#include <QVBoxLayout>
#include <QWindow>

namespace {

constexpr const char* kModule = "modZephRenderOPenGL";
constexpr int kFramesPanel = 3;
constexpr int kBarMargin = 8;  // pixels, above and below the panels together

QSurfaceFormat windowFormat() {
    QSurfaceFormat format;
    format.setVersion(3, 3);
    format.setProfile(QSurfaceFormat::CoreProfile);
    format.setSwapBehavior(QSurfaceFormat::DoubleBuffer);
    format.setSwapInterval(0);  // frames are paced by the render cycle, which must not wait for the screen
    return format;
}

}  // namespace

// The part that OpenGL draws on: a window of its own within ours, so that a frame goes to the screen without passing
// through the painting of widgets.
class frmZephOpenGL::Drawing : public QWindow, public GLTarget {
public:
    explicit Drawing(frmZephOpenGL& form) : form_(form) {
        setSurfaceType(QSurface::OpenGLSurface);
        setFormat(windowFormat());
        context_.setFormat(windowFormat());
    }

    void createContext() {
        require(context_.create(), "No OpenGL context can be made");
        const auto version = context_.format().version();
        require(version >= qMakePair(3, 3), "OpenGL 3.3 is needed and the driver offers less");
        require(makeCurrent(), "The OpenGL context cannot be used");
    }

    bool isSeen() const override { return isExposed(); }
    bool makeCurrent() override { return context_.makeCurrent(this); }
    GLProcedure resolve(const char* name) override { return context_.getProcAddress(name); }
    void swapBuffers() override { context_.swapBuffers(this); }

protected:
    void resizeEvent(QResizeEvent*) override { form_.resizeDrawing(); }
    // Keys go to the part that has the focus; what they do is the form's affair.
    void keyPressEvent(QKeyEvent* event) override { form_.keyPressEvent(event); }

private:
    frmZephOpenGL& form_;
    QOpenGLContext context_;
};

frmZephOpenGL::frmZephOpenGL(GLWindowActions actions, QWidget* parent)
    : QWidget(parent, Qt::Window), actions_(std::move(actions)), drawing_(new Drawing(*this)),
      container_(QWidget::createWindowContainer(drawing_, this)), StatusBar1_(new QStatusBar(this)) {
    setObjectName("frmZephOpenGL");
    setWindowTitle(QString::fromUtf8(kProgramName.data(), static_cast<qsizetype>(kProgramName.size())));
    container_->setObjectName("drawing");
    StatusBar1_->setObjectName("StatusBar1");
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(container_, 1);
    layout->addWidget(StatusBar1_);

    constexpr std::array<int, 5> kStretch{0, 1, 1, 1, 1};
    for (std::size_t panel = 1; panel < panels_.size(); ++panel) {
        panels_[panel] = new QLabel(StatusBar1_);
        panels_[panel]->setObjectName(QString("StatusBar1Panel%1").arg(panel));
        StatusBar1_->addWidget(panels_[panel], kStretch[panel]);
    }
    addButton(new QPushButton(tr("Stop")), "cmdStop", 1, [this] { stop(); });
    addButton(new QPushButton(tr("Play Show")), "cmdSEPlay", 2, actions_.cmdSEPlay_MouseUp);
    addButton(new QPushButton(tr("Stop Show")), "cmdSEStop", 4, actions_.cmdSEStop_MouseUp);
}

frmZephOpenGL::~frmZephOpenGL() {
    delete container_;  // and the drawing, which tells us of its size and keys until it is gone
}

void frmZephOpenGL::addButton(QPushButton* button, const char* name, int panel, const std::function<void()>& action) {
    QLabel* label = panels_[static_cast<std::size_t>(panel)];
    auto* row = new QHBoxLayout(label);
    row->setContentsMargins(4, 2, 4, 2);
    row->addWidget(button);
    row->addStretch();
    button->ensurePolished();
    // A bar that grew after the window was sized would take from the drawing.
    StatusBar1_->setFixedHeight(row->sizeHint().height() + kBarMargin);
    button->setObjectName(name);
    button->setFocusPolicy(Qt::NoFocus);  // Esc and the space bar stay with the form
    // Clicked is the left button let go over it.
    if (action) connect(button, &QPushButton::clicked, this, action);
}

GLTarget& frmZephOpenGL::target() {
    return *drawing_;
}

void frmZephOpenGL::setStatusPanel(int panel, const QString& text) {
    if (panel >= 1 && panel <= 4) panels_[static_cast<std::size_t>(panel)]->setText(text);
}

void frmZephOpenGL::stop() {
    close();
}

void frmZephOpenGL::resizeDrawing() {
    if (isMinimized() || !actions_.resized || !drawing_->isVisible()) return;
    actions_.resized(drawing_->width(), drawing_->height(), drawing_->devicePixelRatio());
}

void frmZephOpenGL::closeEvent(QCloseEvent* event) {
    notedPlace_.reset();
    if (x() + y() > 0) notedPlace_ = pos();
    // The next tick ends the simulation: until then a frame may be under way that draws on this window.
    if (actions_.stopRequested) actions_.stopRequested();
    event->accept();
}

void frmZephOpenGL::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Escape) {
        stop();
    } else {
        QWidget::keyPressEvent(event);
    }
}

bool ZephCreateRenderWindow(QSize canvas, FailureReport& failures, frmZephOpenGL& window) try {
    window.setStatusPanel(kFramesPanel, "FPS:");
    window.resize(canvas.width(), canvas.height() + window.StatusBar1_->height());
    window.show();
    window.drawing_->createContext();
    return true;
}
ZEPH_GUARD(failures, kModule, false)
