// A game that makes a new context for every level, as some do, while a loading context
// that shares its objects lives throughout: CYCLES times a context sharing with the loading
// one is created, made current on a small pbuffer, draws a render texture to its window,
// swaps, is released and destroyed. Run as the one tracked game (com.vectorunit.green)
// with its profile installed, the library makes eye textures in every context and the
// mask's program in the share group; scripts/context-cycles.sh counts what stays alive.
//
//   context_cycles_ovo CYCLES
#include <EGL/egl.h>
#include <GLES2/gl2.h>

#include <cstdio>
#include <cstdlib>

#include "support/render_texture_draw.h"

namespace {

constexpr EGLint WINDOW_SIZE = 32;
constexpr GLsizei RENDER_TEXTURE_SIZE = 16;

int Fail(const char* call, int cycle) {
    std::fprintf(stderr, "context_cycles: %s failed at cycle %d (EGL error 0x%04X)\n", call,
                 cycle, eglGetError());
    return 1;
}

}  // namespace

int main(int argc, char** argv) {
    const int cycles = argc == 2 ? std::atoi(argv[1]) : 0;
    if (cycles <= 0) {
        std::fprintf(stderr, "usage: %s CYCLES\n", argv[0]);
        return 2;
    }
    setenv("EGL_PLATFORM", "surfaceless", 0);
    const EGLDisplay display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
    if (!eglInitialize(display, nullptr, nullptr)) return Fail("eglInitialize", 0);
    const EGLint attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_RENDERABLE_TYPE,
                                 EGL_OPENGL_ES2_BIT, EGL_RED_SIZE, 8, EGL_STENCIL_SIZE, 8,
                                 EGL_NONE};
    EGLConfig config = nullptr;
    EGLint count = 0;
    if (!eglChooseConfig(display, attributes, &config, 1, &count) || count != 1) {
        return Fail("eglChooseConfig", 0);
    }
    const EGLint size[] = {EGL_WIDTH, WINDOW_SIZE, EGL_HEIGHT, WINDOW_SIZE, EGL_NONE};
    const EGLSurface window = eglCreatePbufferSurface(display, config, size);
    const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, 2, EGL_NONE};
    const EGLContext loading = eglCreateContext(display, config, EGL_NO_CONTEXT, version);
    if (window == EGL_NO_SURFACE || loading == EGL_NO_CONTEXT) return Fail("set-up", 0);
    // The game's assets, made once by the loading context and shared with every level's.
    if (!eglMakeCurrent(display, EGL_NO_SURFACE, EGL_NO_SURFACE, loading)) {
        return Fail("eglMakeCurrent(loading)", 0);
    }
    RenderTextureDraw assets;
    assets.Create(RENDER_TEXTURE_SIZE);
    eglMakeCurrent(display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);

    for (int cycle = 1; cycle <= cycles; ++cycle) {
        const EGLContext level = eglCreateContext(display, config, loading, version);
        if (level == EGL_NO_CONTEXT) return Fail("eglCreateContext", cycle);
        if (!eglMakeCurrent(display, window, window, level)) return Fail("eglMakeCurrent", cycle);
        glViewport(0, 0, WINDOW_SIZE, WINDOW_SIZE);
        glClear(GL_COLOR_BUFFER_BIT);
        assets.DrawToWindow();
        if (!eglSwapBuffers(display, window)) return Fail("eglSwapBuffers", cycle);
        if (!eglMakeCurrent(display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT)) {
            return Fail("eglMakeCurrent(none)", cycle);
        }
        if (!eglDestroyContext(display, level)) return Fail("eglDestroyContext", cycle);
    }
    eglDestroyContext(display, loading);
    eglDestroySurface(display, window);
    eglTerminate(display);
    return 0;
}
