// An EGL library that forwards every call to Mesa's libEGL and, at eglSwapBuffers, first
// writes the back buffer to the PNG file named by OVO_SWAP_CAPTURE: the frame exactly as
// the panel would receive it, after everything the GLES library under test drew.
//   OVO_SWAP_CAPTURE       the PNG; a "%d" in it is replaced by the swap's number (from 1),
//                          so that every frame gets a file of its own
//   OVO_SWAP_CAPTURE_STOP  N: frames after the N-th swap are not captured, and once that
//                          swap is done the process is sent SIGTERM, so that a program
//                          that runs until it is told to stop ends at a fixed frame
// After each swap it moves a frame clock on (ovo_frame_clock_advance), where one was
// preloaded into the program.
// It is loaded as the vendor's EGL under the GLES library, or as a program's own EGL to
// capture its frames on Mesa directly; either way it reaches Mesa by its full path, never
// by a name that the library under test may stand in for.
#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <dlfcn.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "back_buffer_capture.h"
#include "core/entry_tables.h"

#define SWAP_CAPTURE_EXPORT __attribute__((visibility("default")))

namespace {

constexpr char SWAP_CAPTURE_VARIABLE[] = "OVO_SWAP_CAPTURE";
constexpr char SWAP_CAPTURE_STOP_VARIABLE[] = "OVO_SWAP_CAPTURE_STOP";

// Mesa's EGL functions by table index, looked up once. Extension functions that Mesa's
// libEGL does not export stay null and answer 0, as the GLES library treats a vendor
// function that it cannot find.
struct MesaEgl {
    void* m_functions[ovo::EGL_ENTRY_COUNT] = {};

    MesaEgl() {
        void* library = dlopen(OVO_MESA_EGL_PATH, RTLD_NOW | RTLD_LOCAL);
        if (library == nullptr) {
            std::fprintf(stderr, "swap capture: cannot load %s: %s\n", OVO_MESA_EGL_PATH, dlerror());
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

// The swap that eglSwapBuffers is about to make, counted from 1; and the last to capture.
struct SwapCount {
    uint64_t m_swaps = 0;
    uint64_t m_stop = 0;  // 0: capture every swap, never stop

    SwapCount() {
        const char* stop = std::getenv(SWAP_CAPTURE_STOP_VARIABLE);
        if (stop != nullptr) m_stop = std::strtoull(stop, nullptr, 10);
    }
};

SwapCount& Swaps() {
    static SwapCount count;
    return count;
}

// OVO_SWAP_CAPTURE with its "%d" replaced by the swap's number.
std::string CapturePath(const char* pattern, uint64_t swap) {
    std::string path = pattern;
    const size_t mark = path.find("%d");
    if (mark != std::string::npos) path.replace(mark, 2, std::to_string(swap));
    return path;
}

void CaptureSwap(EGLDisplay display, EGLSurface surface, uint64_t swap) {
    const char* pattern = std::getenv(SWAP_CAPTURE_VARIABLE);
    if (pattern == nullptr || pattern[0] == '\0') return;
    // Only the current context can read the surface's back buffer.
    if (Mesa<decltype(&eglGetCurrentSurface)>(ovo::EGL_ENTRY_eglGetCurrentSurface)(EGL_DRAW) != surface) return;
    const auto query = Mesa<decltype(&eglQuerySurface)>(ovo::EGL_ENTRY_eglQuerySurface);
    EGLint width = 0;
    EGLint height = 0;
    if (query(display, surface, EGL_WIDTH, &width) == EGL_FALSE ||
        query(display, surface, EGL_HEIGHT, &height) == EGL_FALSE || width <= 0 || height <= 0) {
        return;
    }
    const std::string path = CapturePath(pattern, swap);
    static bool warned = false;
    if (!ovo_swap_capture::CaptureBackBuffer(width, height, path.c_str()) && !warned) {
        std::fprintf(stderr, "swap capture: cannot write %s\n", path.c_str());
        warned = true;
    }
}

// What a function does around its forwarding; by default nothing.
template <uint32_t INDEX>
struct Around {
    template <typename... Arguments>
    static void Before(Arguments...) {}
    template <typename... Arguments>
    static void After(Arguments...) {}
};

template <>
struct Around<ovo::EGL_ENTRY_eglSwapBuffers> {
    static void Before(EGLDisplay display, EGLSurface surface) {
        SwapCount& count = Swaps();
        ++count.m_swaps;
        if (count.m_stop == 0 || count.m_swaps <= count.m_stop) CaptureSwap(display, surface, count.m_swaps);
    }
    static void After(EGLDisplay, EGLSurface) {
        // A clock preloaded into the program that moves one frame per swap.
        using Advance = void (*)();
        static const Advance advance_clock = reinterpret_cast<Advance>(dlsym(RTLD_DEFAULT, "ovo_frame_clock_advance"));
        if (advance_clock != nullptr) advance_clock();
        const SwapCount& count = Swaps();
        if (count.m_stop != 0 && count.m_swaps == count.m_stop) raise(SIGTERM);
    }
};

}  // namespace

extern "C" {

#define OVO_EGL_ENTRY(index, result, name, params, args)                            \
    SWAP_CAPTURE_EXPORT result EGLAPIENTRY name params {                            \
        Around<index>::Before args;                                                 \
        const auto forward = Mesa<result(EGLAPIENTRY*) params>(index);              \
        result answer = forward == nullptr ? static_cast<result>(0) : forward args; \
        Around<index>::After args;                                                  \
        return answer;                                                              \
    }
#include "core/egl_entry_table.inc"

}  // extern "C"
