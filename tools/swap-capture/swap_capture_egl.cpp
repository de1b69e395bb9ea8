// An EGL library that forwards every call to Mesa's libEGL and, at eglSwapBuffers, first
// writes the back buffer to the PNG file named by OVO_SWAP_CAPTURE: the frame exactly as
// the panel would receive it, after everything the GLES library under test drew.
#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>

#include "back_buffer_capture.h"
#include "core/entry_tables.h"

#define SWAP_CAPTURE_EXPORT __attribute__((visibility("default")))

namespace {

constexpr char SWAP_CAPTURE_VARIABLE[] = "OVO_SWAP_CAPTURE";

// Mesa's EGL functions by table index, looked up once. Extension functions that Mesa's
// libEGL does not export stay null and answer 0, as the GLES library treats a vendor
// function that it cannot find.
struct MesaEgl {
    void* m_functions[ovo::EGL_ENTRY_COUNT] = {};

    MesaEgl() {
        void* library = dlopen("libEGL.so.1", RTLD_NOW | RTLD_LOCAL);
        if (library == nullptr) {
            std::fprintf(stderr, "swap capture: cannot load libEGL.so.1: %s\n", dlerror());
            return;
        }
#define OVO_EGL_ENTRY(index, result, name, params, args) m_functions[index] = dlsym(library, #name);
#include "core/egl_entry_table.inc"
    }
};

const MesaEgl& Egl() {
    static const MesaEgl egl;
    return egl;
}

template <typename Function>
Function Mesa(uint32_t index) {
    return reinterpret_cast<Function>(Egl().m_functions[index]);
}

// What a function does before it forwards; by default nothing.
template <uint32_t INDEX>
struct BeforeForward {
    template <typename... Arguments>
    static void Run(Arguments...) {}
};

template <>
struct BeforeForward<ovo::EGL_ENTRY_eglSwapBuffers> {
    static void Run(EGLDisplay display, EGLSurface surface) {
        const char* path = std::getenv(SWAP_CAPTURE_VARIABLE);
        if (path == nullptr || path[0] == '\0') return;
        // Only the current context can read the surface's back buffer.
        if (Mesa<decltype(&eglGetCurrentSurface)>(ovo::EGL_ENTRY_eglGetCurrentSurface)(EGL_DRAW) != surface) return;
        const auto query = Mesa<decltype(&eglQuerySurface)>(ovo::EGL_ENTRY_eglQuerySurface);
        EGLint width = 0;
        EGLint height = 0;
        if (query(display, surface, EGL_WIDTH, &width) == EGL_FALSE ||
            query(display, surface, EGL_HEIGHT, &height) == EGL_FALSE || width <= 0 || height <= 0) {
            return;
        }
        static bool warned = false;
        if (!ovo_swap_capture::CaptureBackBuffer(width, height, path) && !warned) {
            std::fprintf(stderr, "swap capture: cannot write %s\n", path);
            warned = true;
        }
    }
};

}  // namespace

extern "C" {

#define OVO_EGL_ENTRY(index, result, name, params, args)                  \
    SWAP_CAPTURE_EXPORT result EGLAPIENTRY name params {                  \
        BeforeForward<index>::Run args;                                   \
        const auto forward = Mesa<result(EGLAPIENTRY*) params>(index);    \
        return forward == nullptr ? static_cast<result>(0) : forward args;              \
    }
#include "core/egl_entry_table.inc"

}  // extern "C"
