#include "engine/gl_programs.h"

#include "util/failure.h"

#include <array>

// A bulb in whose slot nothing is lit is moved out of sight whole, before it costs a single pixel.
const ProgramSource kBulbSource{R"(#version 330 core
layout(location = 0) in vec2 place;
layout(location = 1) in uint slot;
uniform vec2 view;
uniform samplerBuffer slots;
flat out vec4 light;
void main() {
    light = texelFetch(slots, int(slot));
    gl_Position = light.a == 0.0 ? vec4(2.0, 2.0, 2.0, 1.0) : vec4(place.x * view.x - 1.0, 1.0 - place.y * view.y, 0.0, 1.0);
}
)",
                                R"(#version 330 core
flat in vec4 light;
out vec4 color;
void main() { color = light; }
)"};

const ProgramSource kListSource{R"(#version 330 core
layout(location = 0) in vec2 corner;
layout(location = 1) in vec2 centre;
layout(location = 2) in vec4 lit;
uniform vec2 view;
flat out vec4 light;
void main() {
    light = lit;
    vec2 place = centre + corner;
    gl_Position = vec4(place.x * view.x - 1.0, 1.0 - place.y * view.y, 0.0, 1.0);
}
)",
                                kBulbSource.fragment};

const ProgramSource kBackgroundSource{R"(#version 330 core
uniform vec2 view;
uniform vec2 size;
out vec2 at;
void main() {
    at = vec2(gl_VertexID & 1, gl_VertexID >> 1);
    vec2 place = at * size;
    gl_Position = vec4(place.x * view.x - 1.0, 1.0 - place.y * view.y, 0.0, 1.0);
}
)",
                                      R"(#version 330 core
in vec2 at;
uniform float alpha;
uniform bool textured;
uniform sampler2D picture;
out vec4 color;
void main() { color = vec4(textured ? texture(picture, at).rgb : vec3(1.0), alpha); }
)"};

namespace {

GLuint makeShader(const GLApi& api, GLenum kind, const char* text) {
    const GLuint shader = api.CreateShader(kind);
    api.ShaderSource(shader, 1, &text, nullptr);
    api.CompileShader(shader);  // whether it went well is asked of the program
    return shader;
}

}  // namespace

GLuint makeProgram(const GLApi& api, const ProgramSource& source) {
    const std::array shaders{makeShader(api, GL_VERTEX_SHADER, source.vertex),
                             makeShader(api, GL_FRAGMENT_SHADER, source.fragment)};
    const GLuint program = api.CreateProgram();
    for (const GLuint shader : shaders)
        api.AttachShader(program, shader);
    api.LinkProgram(program);
    for (const GLuint shader : shaders)
        api.DeleteShader(shader);  // goes with the program
    GLint linked = GL_FALSE;
    api.GetProgramiv(program, GL_LINK_STATUS, &linked);
    if (linked == GL_TRUE) return program;
    std::array<char, 1024> log{};
    api.GetProgramInfoLog(program, static_cast<GLsizei>(log.size() - 1), nullptr, log.data());
    api.DeleteProgram(program);
    throw Failure(std::string("OpenGL cannot link the programs: ") + log.data());
}
