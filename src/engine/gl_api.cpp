#include "engine/gl_api.h"

#include "util/failure.h"

namespace {

template <typename Procedure>
void load(const char* name, const GLResolve& resolve, Procedure& procedure) {
    procedure = reinterpret_cast<Procedure>(resolve(name));
    if (procedure == nullptr) throw Failure(std::string("OpenGL lacks ") + name);
}

}  // namespace

GLApi loadGLApi(const GLResolve& resolve) {
    GLApi api;
#define ZEPH_GL_LOAD(name, type) load("gl" #name, resolve, api.name);
    ZEPH_GL_PROCEDURES(ZEPH_GL_LOAD)
#undef ZEPH_GL_LOAD
    return api;
}
