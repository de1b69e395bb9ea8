#ifndef OVO_TESTS_SUPPORT_EGL_SESSION_H
#define OVO_TESTS_SUPPORT_EGL_SESSION_H

#include <EGL/egl.h>

// A display and contexts on the recording vendor, made through the library's exports.
struct EglSession {
    EGLDisplay m_display = EGL_NO_DISPLAY;

    void Open() { m_display = eglGetDisplay(EGL_DEFAULT_DISPLAY); }

    EGLContext CreateContext(EGLint client_version) {
        const EGLint attributes[] = {EGL_CONTEXT_CLIENT_VERSION, client_version, EGL_NONE};
        return eglCreateContext(m_display, nullptr, EGL_NO_CONTEXT, attributes);
    }

    EGLBoolean MakeCurrent(EGLContext context) {
        EGLSurface surface = context == EGL_NO_CONTEXT ? EGL_NO_SURFACE : Surface();
        return eglMakeCurrent(m_display, surface, surface, context);
    }

    static EGLSurface Surface() { return reinterpret_cast<EGLSurface>(0x5000); }
};

#endif
