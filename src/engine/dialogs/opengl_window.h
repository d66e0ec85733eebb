// The window of the OpenGL engine: the drawing and, below it, a status bar with the buttons of a simulation. Made at
// entry into simulation by its owner, and destroyed on the way out, after OpenGLSurface::release.
#pragma once

#include "engine/gl_target.h"
#include "util/failure.h"

#include <QSize>
#include <QWidget>

#include <array>
#include <functional>
#include <optional>

class QLabel;
class QPushButton;
class QStatusBar;

// What the owner does when the window is used. Any may be empty.
struct GLWindowActions {
    std::function<void()> stopRequested;      // cmdStop, Esc, or the window was closed; asks, does not tear down
    std::function<void()> cmdSEPlay_MouseUp;  // tells the sequencing program to start
    std::function<void()> cmdSEStop_MouseUp;  // and to stop
    // The drawing has another size, in pixels of the canvas, each pixelRatio pixels of the screen.
    std::function<void(std::int32_t width, std::int32_t height, double pixelRatio)> resized;
};

class frmZephOpenGL : public QWidget {
public:
    explicit frmZephOpenGL(GLWindowActions actions, QWidget* parent = nullptr);
    ~frmZephOpenGL() override;

    // What OpenGLSurface draws on. Usable once ZephCreateRenderWindow has given true, as long as the window lives.
    GLTarget& target();

    void setStatusPanel(int panel, const QString& text);  // 1..4, others are ignored

    // The stop routine: asks the owner to stop, and closes the window.
    void stop();

    // Left and top when it was closed, in pixels of the screen, for the next opening; nothing where their sum is not
    // above 0.
    std::optional<QPoint> notedPlace() const { return notedPlace_; }

    // Tells the size of the drawing once more; to be called after ZephGLStartup.
    void resizeDrawing();

protected:
    void closeEvent(QCloseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    friend bool ZephCreateRenderWindow(QSize canvas, FailureReport& failures, frmZephOpenGL& window);
    class Drawing;

    void addButton(QPushButton* button, const char* name, int panel, const std::function<void()>& action);

    GLWindowActions actions_;
    Drawing* drawing_;    // owned by its container
    QWidget* container_;  // of drawing_
    QStatusBar* StatusBar1_;
    std::array<QLabel*, 5> panels_{};  // 1..4
    std::optional<QPoint> notedPlace_;
};

// Sizes the window for a canvas in pixels, 1..2500, with the status bar below it, puts the buttons into their panels
// and makes the context; then shows the window. False, with a report, where it cannot be had.
[[nodiscard]] bool ZephCreateRenderWindow(QSize canvas, FailureReport& failures, frmZephOpenGL& window);
