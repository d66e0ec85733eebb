#include "engine/gl_offscreen.h"

#include "util/failure.h"

#include <array>
#include <cstring>
#include <string>

#define EGL_NO_X11
#include <EGL/egl.h>
#include <EGL/eglext.h>

namespace {

constexpr int kMostDevices = 16;

bool hasExtension(EGLDisplay display, const char* name) {
    const char* list = eglQueryString(display, EGL_EXTENSIONS);
    return list != nullptr && (" " + std::string(list) + " ").find(" " + std::string(name) + " ") != std::string::npos;
}

template <typename Procedure>
Procedure eglProcedure(const char* name) {
    return reinterpret_cast<Procedure>(eglGetProcAddress(name));
}

}  // namespace

struct GLOffscreen::Context {
    EGLDisplay display = EGL_NO_DISPLAY;
    EGLContext context = EGL_NO_CONTEXT;

    // First without any device, which is how the software driver is reached, then each graphics card.
    Context() {
        const auto platformDisplay = eglProcedure<PFNEGLGETPLATFORMDISPLAYEXTPROC>("eglGetPlatformDisplayEXT");
        require(platformDisplay != nullptr, "No OpenGL context can be made without a screen: EGL has no platforms");
        if (open(platformDisplay(EGL_PLATFORM_SURFACELESS_MESA, EGL_DEFAULT_DISPLAY, nullptr))) return;
        if (const auto queryDevices = eglProcedure<PFNEGLQUERYDEVICESEXTPROC>("eglQueryDevicesEXT")) {
            std::array<EGLDeviceEXT, kMostDevices> devices{};
            EGLint count = 0;
            queryDevices(kMostDevices, devices.data(), &count);
            for (EGLint i = 0; i < count; ++i) {
                if (open(platformDisplay(EGL_PLATFORM_DEVICE_EXT, devices[static_cast<std::size_t>(i)], nullptr)))
                    return;
            }
        }
        throw Failure("No OpenGL 3.3 context can be made: no driver offers one");
    }

    ~Context() { close(); }
    Context(const Context&) = delete;
    Context& operator=(const Context&) = delete;

    bool open(EGLDisplay candidate) {
        if (candidate == EGL_NO_DISPLAY || eglInitialize(candidate, nullptr, nullptr) == EGL_FALSE) return false;
        display = candidate;
        constexpr std::array<EGLint, 7> kAttributes{
            EGL_CONTEXT_MAJOR_VERSION,           3,       EGL_CONTEXT_MINOR_VERSION, 3, EGL_CONTEXT_OPENGL_PROFILE_MASK,
            EGL_CONTEXT_OPENGL_CORE_PROFILE_BIT, EGL_NONE};
        const bool able = eglBindAPI(EGL_OPENGL_API) == EGL_TRUE &&
                          hasExtension(display, "EGL_KHR_no_config_context") &&
                          hasExtension(display, "EGL_KHR_surfaceless_context");
        if (able) context = eglCreateContext(display, EGL_NO_CONFIG_KHR, EGL_NO_CONTEXT, kAttributes.data());
        if (context != EGL_NO_CONTEXT && makeCurrent()) return true;
        close();
        return false;
    }

    bool makeCurrent() const { return eglMakeCurrent(display, EGL_NO_SURFACE, EGL_NO_SURFACE, context) == EGL_TRUE; }

    // The display itself stays: it is one for the whole process, and others may draw on it.
    void close() {
        if (display != EGL_NO_DISPLAY) eglMakeCurrent(display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
        if (context != EGL_NO_CONTEXT) eglDestroyContext(display, context);
        context = EGL_NO_CONTEXT;
        display = EGL_NO_DISPLAY;
    }
};

GLOffscreen::GLOffscreen(std::int32_t width, std::int32_t height)
    : context_(std::make_unique<Context>()), api_(loadGLApi([this](const char* name) { return resolve(name); })),
      size_(width, height) {
    GLuint pixels = 0;
    GLuint frame = 0;
    // Both stay bound, and go with the context.
    api_.GenRenderbuffers(1, &pixels);
    api_.BindRenderbuffer(GL_RENDERBUFFER, pixels);
    api_.RenderbufferStorage(GL_RENDERBUFFER, GL_RGBA8, width, height);
    api_.GenFramebuffers(1, &frame);
    api_.BindFramebuffer(GL_FRAMEBUFFER, frame);
    api_.FramebufferRenderbuffer(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_RENDERBUFFER, pixels);
    require(api_.CheckFramebufferStatus(GL_FRAMEBUFFER) == GL_FRAMEBUFFER_COMPLETE,
            "OpenGL cannot draw on a picture of this size");
}

GLOffscreen::~GLOffscreen() = default;

bool GLOffscreen::makeCurrent() {
    return context_->makeCurrent();
}

GLProcedure GLOffscreen::resolve(const char* name) {
    return eglGetProcAddress(name);
}

void GLOffscreen::swapBuffers() {
    api_.Finish();
}

QImage GLOffscreen::image() {
    if (!makeCurrent()) return {};
    QImage upsideDown(size_, QImage::Format_RGB32);
    api_.PixelStorei(GL_PACK_ALIGNMENT, 4);
    api_.ReadPixels(0, 0, size_.width(), size_.height(), GL_BGRA, GL_UNSIGNED_INT_8_8_8_8_REV, upsideDown.bits());
    return upsideDown.mirrored();
}

std::string GLOffscreen::renderer() const {
    return reinterpret_cast<const char*>(api_.GetString(GL_RENDERER));
}
