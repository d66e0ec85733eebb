// The procedures of OpenGL 3.3 that the output uses, found by name in whatever context is current: a window's, or one
// that has no window. So the drawing depends on neither.
#pragma once

#include <qopengl.h>

#include <functional>

using GLProcedure = void (*)();
using GLResolve = std::function<GLProcedure(const char* name)>;

// X(name, type) for each. The name is without its prefix.
#define ZEPH_GL_PROCEDURES(X)                                                                                          \
    X(ActiveTexture, PFNGLACTIVETEXTUREPROC)                                                                           \
    X(AttachShader, PFNGLATTACHSHADERPROC)                                                                             \
    X(BindBuffer, PFNGLBINDBUFFERPROC)                                                                                 \
    X(BindFramebuffer, PFNGLBINDFRAMEBUFFERPROC)                                                                       \
    X(BindRenderbuffer, PFNGLBINDRENDERBUFFERPROC)                                                                     \
    X(BindTexture, decltype(&glBindTexture))                                                                           \
    X(BindVertexArray, PFNGLBINDVERTEXARRAYPROC)                                                                       \
    X(BlendFunc, decltype(&glBlendFunc))                                                                               \
    X(BufferData, PFNGLBUFFERDATAPROC)                                                                                 \
    X(BufferSubData, PFNGLBUFFERSUBDATAPROC)                                                                           \
    X(CheckFramebufferStatus, PFNGLCHECKFRAMEBUFFERSTATUSPROC)                                                         \
    X(Clear, decltype(&glClear))                                                                                       \
    X(ClearColor, decltype(&glClearColor))                                                                             \
    X(CompileShader, PFNGLCOMPILESHADERPROC)                                                                           \
    X(CreateProgram, PFNGLCREATEPROGRAMPROC)                                                                           \
    X(CreateShader, PFNGLCREATESHADERPROC)                                                                             \
    X(DeleteBuffers, PFNGLDELETEBUFFERSPROC)                                                                           \
    X(DeleteProgram, PFNGLDELETEPROGRAMPROC)                                                                           \
    X(DeleteShader, PFNGLDELETESHADERPROC)                                                                             \
    X(DeleteTextures, decltype(&glDeleteTextures))                                                                     \
    X(DeleteVertexArrays, PFNGLDELETEVERTEXARRAYSPROC)                                                                 \
    X(Disable, decltype(&glDisable))                                                                                   \
    X(DrawArrays, decltype(&glDrawArrays))                                                                             \
    X(DrawElementsInstanced, PFNGLDRAWELEMENTSINSTANCEDPROC)                                                           \
    X(Enable, decltype(&glEnable))                                                                                     \
    X(EnableVertexAttribArray, PFNGLENABLEVERTEXATTRIBARRAYPROC)                                                       \
    X(Finish, decltype(&glFinish))                                                                                     \
    X(FramebufferRenderbuffer, PFNGLFRAMEBUFFERRENDERBUFFERPROC)                                                       \
    X(GenBuffers, PFNGLGENBUFFERSPROC)                                                                                 \
    X(GenFramebuffers, PFNGLGENFRAMEBUFFERSPROC)                                                                       \
    X(GenRenderbuffers, PFNGLGENRENDERBUFFERSPROC)                                                                     \
    X(GenTextures, decltype(&glGenTextures))                                                                           \
    X(GenVertexArrays, PFNGLGENVERTEXARRAYSPROC)                                                                       \
    X(GetError, decltype(&glGetError))                                                                                 \
    X(GetIntegerv, decltype(&glGetIntegerv))                                                                           \
    X(GetProgramiv, PFNGLGETPROGRAMIVPROC)                                                                             \
    X(GetProgramInfoLog, PFNGLGETPROGRAMINFOLOGPROC)                                                                   \
    X(GetString, decltype(&glGetString))                                                                               \
    X(GetUniformLocation, PFNGLGETUNIFORMLOCATIONPROC)                                                                 \
    X(LinkProgram, PFNGLLINKPROGRAMPROC)                                                                               \
    X(MultiDrawElements, PFNGLMULTIDRAWELEMENTSPROC)                                                                   \
    X(PixelStorei, decltype(&glPixelStorei))                                                                           \
    X(ReadPixels, decltype(&glReadPixels))                                                                             \
    X(RenderbufferStorage, PFNGLRENDERBUFFERSTORAGEPROC)                                                               \
    X(ShaderSource, PFNGLSHADERSOURCEPROC)                                                                             \
    X(TexBuffer, PFNGLTEXBUFFERPROC)                                                                                   \
    X(TexImage2D, decltype(&glTexImage2D))                                                                             \
    X(TexParameteri, decltype(&glTexParameteri))                                                                       \
    X(Uniform1f, PFNGLUNIFORM1FPROC)                                                                                   \
    X(Uniform1i, PFNGLUNIFORM1IPROC)                                                                                   \
    X(Uniform2f, PFNGLUNIFORM2FPROC)                                                                                   \
    X(UseProgram, PFNGLUSEPROGRAMPROC)                                                                                 \
    X(VertexAttribDivisor, PFNGLVERTEXATTRIBDIVISORPROC)                                                               \
    X(VertexAttribIPointer, PFNGLVERTEXATTRIBIPOINTERPROC)                                                             \
    X(VertexAttribPointer, PFNGLVERTEXATTRIBPOINTERPROC)                                                               \
    X(Viewport, decltype(&glViewport))

struct GLApi {
#define ZEPH_GL_FIELD(name, type) type name = nullptr;
    ZEPH_GL_PROCEDURES(ZEPH_GL_FIELD)
#undef ZEPH_GL_FIELD
};

// Throws Failure naming the first procedure that the context does not have. The context must be current.
GLApi loadGLApi(const GLResolve& resolve);
