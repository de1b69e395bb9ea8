#ifndef OVO_EXAMPLES_COMMON_PBUFFER_CONTEXT_H
#define OVO_EXAMPLES_COMMON_PBUFFER_CONTEXT_H

#include <EGL/egl.h>

#include <cstdint>

namespace ovo_sample {

// A game's EGL start-up on an off-screen surface: the default display, an RGBA8 config
// with a depth buffer (and at least `stencil_bits` of stencil), a pbuffer and a current
// context of one OpenGL ES version. The steps below are what Create and Destroy are made
// of; a game that lives longer (leaves and returns, turns, loses its context) takes them
// one by one. Each answers false after printing which EGL call failed.
class PbufferContext {
public:
    // `program` names the sample in error messages. Destroy still releases whatever was
    // made when this fails.
    bool Create(const char* program, EGLint client_version, EGLint stencil_bits, int32_t width,
                int32_t height);

    bool SwapBuffers();

    // Releases the context, the surface and the display.
    bool Destroy();

    // The default display, initialised, with OpenGL ES bound and the config chosen.
    bool OpenDisplay();
    bool CreateSurface(int32_t width, int32_t height);
    // A context that shares its objects with `share_with` (EGL_NO_CONTEXT: none).
    bool CreateContext(EGLContext share_with);
    bool MakeCurrent();
    // eglMakeCurrent with no surface and no context.
    bool ReleaseCurrent();
    bool DestroySurface();
    bool DestroyContext();
    // eglTerminate; the surface and context that are left go with the display.
    bool Terminate();

    // For a second context on another thread: the display, config and version of `owner`,
    // whose display this one then never terminates.
    void BorrowDisplay(const PbufferContext& owner);

    EGLContext Context() const { return m_context; }

private:
    bool ChooseConfig();
    bool Fail(const char* call);

    const char* m_program = "sample";
    EGLint m_client_version = 2;
    EGLint m_stencil_bits = 0;
    bool m_display_borrowed = false;
    EGLDisplay m_display = EGL_NO_DISPLAY;
    EGLConfig m_config = nullptr;
    EGLSurface m_surface = EGL_NO_SURFACE;
    EGLContext m_context = EGL_NO_CONTEXT;
};

}  // namespace ovo_sample

#endif
