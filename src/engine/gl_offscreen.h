// OpenGL without a window: a context and a picture to draw on. Needs neither a screen nor a window system.
#pragma once

#include "engine/gl_target.h"

#include <QImage>

#include <memory>

class GLOffscreen : public GLTarget {
public:
    // width, height: pixels. Throws Failure where no context can be made.
    GLOffscreen(std::int32_t width, std::int32_t height);
    ~GLOffscreen() override;
    GLOffscreen(const GLOffscreen&) = delete;
    GLOffscreen& operator=(const GLOffscreen&) = delete;

    // Frames that nobody will look at need not be drawn; at first all are.
    void setSeen(bool seen) noexcept { seen_ = seen; }

    bool isSeen() const override { return seen_; }
    bool makeCurrent() override;
    GLProcedure resolve(const char* name) override;
    void swapBuffers() override;  // waits until everything is drawn

    QImage image();                // what was drawn, Format_RGB32; null where the context is lost
    std::string renderer() const;  // who draws, as the driver calls itself

private:
    struct Context;
    std::unique_ptr<Context> context_;
    GLApi api_;
    QSize size_;
    bool seen_ = true;
};
