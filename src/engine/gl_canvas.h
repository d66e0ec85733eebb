// The OpenGL side of the output: programs, buffers and the background picture on the GPU. What the plan knows lies
// there from entry into simulation; a frame sends colours and the bulbs that come as lists. The context is current in
// all calls; one thread.
#pragma once

#include "engine/gl_api.h"
#include "engine/gl_plan.h"
#include "engine/gl_work.h"

#include <QImage>

#include <array>

// The picture behind the lights, drawn over black at an opacity.
struct GLBackground {
    double ZephGLWidth = 0;            // pixels, the size of the drawing
    double ZephGLHeight = 0;           // pixels
    double ZephGLBackgroundAlpha = 0;  // 0..1
    bool ZephGLHasTexture = false;     // false: white
};

class GLCanvas {
public:
    GLCanvas() = default;
    GLCanvas(const GLCanvas&) = delete;
    GLCanvas& operator=(const GLCanvas&) = delete;

    // picture: null = none; else as large as the drawing. listed: listed bulbs that one upload may hold. Throws
    // Failure; what was made until then is given back.
    void create(const GLApi& api, const GLPlan& plan, const QImage& picture, const GLBackground& background,
                std::int32_t listed);
    void destroy();
    void forget();  // the same for a context that is gone, and everything on the GPU with it

    // Size of the window in pixels of the canvas, each of which is pixelRatio pixels of the screen. y runs downward.
    void setViewport(std::int32_t width, std::int32_t height, double pixelRatio);

    void ZephGLBeginFrame();  // clears, paints the background

    // The processor's part of a frame: hands the colours and the listed bulbs over.
    void upload(const GLWork& work);
    // Paints what was handed over last.
    void draw(const GLWork& work);

private:
    enum Buffer { kVertices, kIndices, kSlotColors, kCorners, kCornerIndices, kInstances, kBufferCount };
    enum Array { kNoArray, kBulbArray, kListArray, kArrayCount };

    void createBuffers(const GLPlan& plan, std::int32_t listed);
    void createArrays();
    void createPicture(const QImage& picture);
    void fillBuffer(Buffer buffer, GLenum target, std::size_t bytes, const void* data, GLenum usage);

    GLApi api_;
    std::array<GLuint, kBufferCount> buffers_{};
    std::array<GLuint, kArrayCount> arrays_{};
    GLuint slotTexture_ = 0;
    GLuint picture_ = 0;
    GLuint backgroundProgram_ = 0;
    GLuint bulbProgram_ = 0;  // of the plan's triangles
    GLuint listProgram_ = 0;
    GLBackground background_;
    std::vector<GLShapeRange> shapes_;
    std::size_t slotBytes_ = 0;
    std::size_t instanceBytes_ = 0;
};
