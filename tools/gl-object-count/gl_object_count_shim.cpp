// The vendor's EGL, OpenGL ES 1.x and 2.0 libraries in one, for soak runs: every call goes
// to Mesa's. The calls that make and delete programs, shaders, textures, framebuffers,
// renderbuffers and buffers are wrapped here, below the GLES library under test, so that
// the objects it makes for itself count with the game's and the count does not rely on the
// library's own bookkeeping. Every other name the GLES library looks up is found in Mesa's
// libraries, which this one depends on.
//
// eglSwapBuffers first waits for the frame to be drawn, as a device's swap of a window
// surface flushes and waits for a free buffer. Mesa's swap of a pbuffer does neither:
// llvmpipe then queues frame after frame, and even with a flush what its scenes in flight
// hold moves the readings by up to 200 MB (figures in README.md, "Soak").
//
// Every COUNT_REPORT_EVERY-th eglSwapBuffers (or every OVO_GL_COUNT_EVERY-th) appends one
// line to the file named by OVO_GL_COUNT:
//   swap N rss_kb K programs P shaders S textures T framebuffers F renderbuffers R buffers B
// and so does the end of the process, after everything else has run, with the number of
// names ever made (of all kinds) in front:
//   exit made M rss_kb K programs P ...
// As the GLES libraries alone it counts too (without the swap's wait and its lines): a
// copy of the library whose vendor EGL is another stand-in has it as its GLES vendor.
#include <EGL/egl.h>
#include <GLES2/gl2.h>
#include <dlfcn.h>
#include <fcntl.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <cstdlib>

#include "live_objects.h"
#include "resident_memory.h"

#define GL_COUNT_EXPORT __attribute__((visibility("default")))

namespace {

using ovo_gl_count::LiveObjects;
using ovo_gl_count::ObjectKind;

constexpr char COUNT_FILE_VARIABLE[] = "OVO_GL_COUNT";
constexpr char COUNT_EVERY_VARIABLE[] = "OVO_GL_COUNT_EVERY";
// Late enough that the start-up frames have made what a game keeps.
constexpr unsigned long COUNT_REPORT_EVERY = 500;
constexpr size_t COUNT_LINE_CAPACITY = 512;
constexpr size_t COUNT_EVENT_CAPACITY = 32;

// Never destroyed: the report at exit reads it after the static destructors have run.
LiveObjects& Objects() {
    static LiveObjects* const objects = new LiveObjects();
    return *objects;
}

void* MesaEgl() {
    static void* const library = dlopen("libEGL.so.1", RTLD_NOW | RTLD_LOCAL);
    return library;
}

// Mesa's function `name`, looked up explicitly: a direct call from here would bind to the
// GLES library under test, which exports the same names. A soak run cannot go on without
// it, so its absence ends the process with the reason.
void* MesaFunction(const char* name) {
    void* function = nullptr;
    if (void* egl = MesaEgl()) {
        function = dlsym(egl, name);
        if (function == nullptr) {
            const auto get_proc =
                reinterpret_cast<decltype(&eglGetProcAddress)>(dlsym(egl, "eglGetProcAddress"));
            if (get_proc != nullptr) function = reinterpret_cast<void*>(get_proc(name));
        }
    }
    if (function == nullptr) {
        std::fprintf(stderr, "gl-object-count: Mesa's libEGL.so.1 gives no %s\n", name);
        std::abort();
    }
    return function;
}

template <typename Function>
Function Mesa(const char* name) {
    return reinterpret_cast<Function>(MesaFunction(name));
}

// The report line that starts with `event`, ending in a newline; its length, or 0 when it
// does not fit.
size_t FormatReport(const char* event, char* line, size_t capacity) {
    int length = std::snprintf(line, capacity, "%s rss_kb %ld", event,
                               ovo_gl_count::ResidentKilobytes());
    for (size_t kind = 0; kind < ovo_gl_count::OBJECT_KIND_COUNT; ++kind) {
        if (length < 0 || static_cast<size_t>(length) >= capacity) return 0;
        const int added =
            std::snprintf(line + length, capacity - static_cast<size_t>(length), " %s %zu",
                          ovo_gl_count::OBJECT_KIND_NAMES[kind],
                          Objects().Count(static_cast<ObjectKind>(kind)));
        length = added < 0 ? -1 : length + added;
    }
    if (length < 0 || static_cast<size_t>(length) + 1 >= capacity) return 0;
    line[length++] = '\n';
    return static_cast<size_t>(length);
}

// Short runs (a test's) report more often.
unsigned long ReportEvery() {
    const char* text = std::getenv(COUNT_EVERY_VARIABLE);
    const unsigned long every = text != nullptr ? std::strtoul(text, nullptr, 10) : 0;
    return every > 0 ? every : COUNT_REPORT_EVERY;
}

void AppendReport(const char* path, const char* event) {
    char line[COUNT_LINE_CAPACITY];
    const size_t length = FormatReport(event, line, sizeof(line));
    const int file = open(path, O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
    const bool written = length > 0 && file >= 0 &&
                         write(file, line, length) == static_cast<ssize_t>(length);
    if (file >= 0) close(file);
    static bool warned = false;
    if (!written && !warned) {
        std::fprintf(stderr, "gl-object-count: cannot write %s\n", path);
        warned = true;
    }
}

// Run as the process ends, once every exit handler (the GLES library's among them) is done.
__attribute__((destructor)) void ReportAtExit() {
    const char* path = std::getenv(COUNT_FILE_VARIABLE);
    if (path == nullptr || path[0] == '\0') return;
    char event[COUNT_EVENT_CAPACITY];
    std::snprintf(event, sizeof(event), "exit made %zu", Objects().Made());
    AppendReport(path, event);
}

}  // namespace

extern "C" {

GL_COUNT_EXPORT EGLBoolean EGLAPIENTRY eglSwapBuffers(EGLDisplay display, EGLSurface surface) {
    static const auto mesa = Mesa<decltype(&eglSwapBuffers)>("eglSwapBuffers");
    static const auto finish = Mesa<decltype(&glFinish)>("glFinish");
    static std::atomic<unsigned long> swaps{0};
    static const unsigned long every = ReportEvery();
    finish();
    const EGLBoolean swapped = mesa(display, surface);
    const unsigned long swap = ++swaps;
    const char* path = std::getenv(COUNT_FILE_VARIABLE);
    if (path != nullptr && path[0] != '\0' && swap % every == 0) {
        char event[COUNT_EVENT_CAPACITY];
        std::snprintf(event, sizeof(event), "swap %lu", swap);
        AppendReport(path, event);
    }
    return swapped;
}

#define GL_COUNT_GEN(name, kind)                                                        \
    GL_COUNT_EXPORT void GL_APIENTRY name(GLsizei n, GLuint* names) {                   \
        static const auto mesa = Mesa<void(GL_APIENTRYP)(GLsizei, GLuint*)>(#name);     \
        mesa(n, names);                                                                 \
        Objects().Add(kind, n, names);                                                  \
    }
#define GL_COUNT_DELETE(name, kind)                                                     \
    GL_COUNT_EXPORT void GL_APIENTRY name(GLsizei n, const GLuint* names) {             \
        static const auto mesa = Mesa<void(GL_APIENTRYP)(GLsizei, const GLuint*)>(#name); \
        mesa(n, names);                                                                 \
        Objects().Remove(kind, n, names);                                               \
    }

GL_COUNT_GEN(glGenTextures, ObjectKind::TEXTURE)
GL_COUNT_DELETE(glDeleteTextures, ObjectKind::TEXTURE)
GL_COUNT_GEN(glGenBuffers, ObjectKind::BUFFER)
GL_COUNT_DELETE(glDeleteBuffers, ObjectKind::BUFFER)
// OpenGL ES 1.x has framebuffers and renderbuffers by their OES names only.
GL_COUNT_GEN(glGenFramebuffers, ObjectKind::FRAMEBUFFER)
GL_COUNT_DELETE(glDeleteFramebuffers, ObjectKind::FRAMEBUFFER)
GL_COUNT_GEN(glGenFramebuffersOES, ObjectKind::FRAMEBUFFER)
GL_COUNT_DELETE(glDeleteFramebuffersOES, ObjectKind::FRAMEBUFFER)
GL_COUNT_GEN(glGenRenderbuffers, ObjectKind::RENDERBUFFER)
GL_COUNT_DELETE(glDeleteRenderbuffers, ObjectKind::RENDERBUFFER)
GL_COUNT_GEN(glGenRenderbuffersOES, ObjectKind::RENDERBUFFER)
GL_COUNT_DELETE(glDeleteRenderbuffersOES, ObjectKind::RENDERBUFFER)

GL_COUNT_EXPORT GLuint GL_APIENTRY glCreateProgram() {
    static const auto mesa = Mesa<decltype(&glCreateProgram)>("glCreateProgram");
    const GLuint program = mesa();
    Objects().Add(ObjectKind::PROGRAM, 1, &program);
    return program;
}

GL_COUNT_EXPORT GLuint GL_APIENTRY glCreateShader(GLenum type) {
    static const auto mesa = Mesa<decltype(&glCreateShader)>("glCreateShader");
    const GLuint shader = mesa(type);
    Objects().Add(ObjectKind::SHADER, 1, &shader);
    return shader;
}

GL_COUNT_EXPORT void GL_APIENTRY glDeleteProgram(GLuint program) {
    static const auto mesa = Mesa<decltype(&glDeleteProgram)>("glDeleteProgram");
    mesa(program);
    Objects().Remove(ObjectKind::PROGRAM, 1, &program);
}

GL_COUNT_EXPORT void GL_APIENTRY glDeleteShader(GLuint shader) {
    static const auto mesa = Mesa<decltype(&glDeleteShader)>("glDeleteShader");
    mesa(shader);
    Objects().Remove(ObjectKind::SHADER, 1, &shader);
}

}  // extern "C"
