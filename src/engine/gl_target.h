// Where OpenGL draws to: a window, or a picture without one. Owns the context.
#pragma once

#include "engine/gl_api.h"

class GLTarget {
public:
    virtual ~GLTarget() = default;
    virtual bool isSeen() const = 0;  // false: frames need not be drawn, as nobody could see them
    virtual bool makeCurrent() = 0;   // false: the context is lost, or its window is closed
    virtual GLProcedure resolve(const char* name) = 0;
    virtual void swapBuffers() = 0;  // what was drawn is to be seen
};
