#ifndef OVO_EXAMPLES_COMMON_PBUFFER_CONTEXT_H
#define OVO_EXAMPLES_COMMON_PBUFFER_CONTEXT_H

#include <EGL/egl.h>

#include <cstdint>

namespace ovo_sample {

// A game's EGL start-up on an off-screen surface: the default display, an RGBA8 config
// with a depth buffer (and at least `stencil_bits` of stencil), a pbuffer and a current
// context of one OpenGL ES version.
class PbufferContext {
public:
    // `program` names the sample in error messages. False after printing which EGL call
    // failed; Destroy still releases whatever was made.
    bool Create(const char* program, EGLint client_version, EGLint stencil_bits, int32_t width,
                int32_t height);

    // False after printing the failure.
    bool SwapBuffers();

    // Releases the context, the surface and the display; false after printing a failure.
    bool Destroy();

private:
    bool ChooseConfig(EGLint client_version, EGLint stencil_bits, EGLConfig* config);
    bool Fail(const char* call);

    const char* m_program = "sample";
    EGLDisplay m_display = EGL_NO_DISPLAY;
    EGLSurface m_surface = EGL_NO_SURFACE;
    EGLContext m_context = EGL_NO_CONTEXT;
};

}  // namespace ovo_sample

#endif
