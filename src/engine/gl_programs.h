// The shader programs of the OpenGL output.
#pragma once

#include "engine/gl_api.h"

// Places of what the vertex shaders read.
inline constexpr GLuint kPlaceAttribute = 0;   // of a vertex, pixels
inline constexpr GLuint kSlotAttribute = 1;    // where its colour is looked up
inline constexpr GLuint kCentreAttribute = 1;  // of a listed bulb, pixels
inline constexpr GLuint kColorAttribute = 2;   // of a listed bulb

struct ProgramSource {
    const char* vertex;
    const char* fragment;
};

// Uniforms "view" (2 / width, 2 / height of the window in pixels) in all; see each.
extern const ProgramSource kBackgroundSource;  // "size", "alpha", "textured", "picture"
extern const ProgramSource kBulbSource;        // "slots"
extern const ProgramSource kListSource;

// Throws Failure with what the driver has to say.
GLuint makeProgram(const GLApi& api, const ProgramSource& source);
