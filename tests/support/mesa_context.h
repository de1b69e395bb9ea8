#ifndef OVO_TESTS_SUPPORT_MESA_CONTEXT_H
#define OVO_TESTS_SUPPORT_MESA_CONTEXT_H

#include <EGL/egl.h>
#include <gtest/gtest.h>

#include <cstdlib>

// A display of Mesa's surfaceless platform, reached through the library, with a config of
// 8 bits of red and of stencil for `client_version`. Call Open under ASSERT_NO_FATAL_FAILURE.
struct MesaSession {
    EGLDisplay m_display = EGL_NO_DISPLAY;
    EGLConfig m_config = nullptr;
    EGLint m_client_version = 2;

    void Open(EGLint client_version) {
        setenv("EGL_PLATFORM", "surfaceless", 1);
        m_client_version = client_version;
        m_display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
        ASSERT_TRUE(eglInitialize(m_display, nullptr, nullptr));
        const EGLint renderable = client_version == 2 ? EGL_OPENGL_ES2_BIT : EGL_OPENGL_ES_BIT;
        const EGLint attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_RENDERABLE_TYPE,
                                     renderable, EGL_RED_SIZE, 8, EGL_STENCIL_SIZE, 8, EGL_NONE};
        EGLint count = 0;
        ASSERT_TRUE(eglChooseConfig(m_display, attributes, &m_config, 1, &count) && count == 1);
    }

    EGLSurface CreateSurface(EGLint width, EGLint height) const {
        const EGLint size[] = {EGL_WIDTH, width, EGL_HEIGHT, height, EGL_NONE};
        return eglCreatePbufferSurface(m_display, m_config, size);
    }

    EGLContext CreateContext(EGLContext share = EGL_NO_CONTEXT) const {
        const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, m_client_version, EGL_NONE};
        return eglCreateContext(m_display, m_config, share, version);
    }
};

// Tests on an OpenGL ES 2.0 session with a 16 x 16 pbuffer and a context, neither current.
class MesaSessionTest : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_NO_FATAL_FAILURE(m_session.Open(2));
        m_surface = m_session.CreateSurface(16, 16);
        m_context = m_session.CreateContext();
    }

    MesaSession m_session;
    EGLSurface m_surface = EGL_NO_SURFACE;
    EGLContext m_context = EGL_NO_CONTEXT;
};

// Makes an OpenGL ES context of `client_version` current on a pbuffer of Mesa's surfaceless
// platform, reached through the library, with 8 bits of red and of stencil. Call it under
// ASSERT_NO_FATAL_FAILURE.
inline void MakeMesaContextCurrent(EGLint client_version, EGLint width = 16, EGLint height = 16) {
    MesaSession session;
    ASSERT_NO_FATAL_FAILURE(session.Open(client_version));
    EGLSurface surface = session.CreateSurface(width, height);
    ASSERT_TRUE(eglMakeCurrent(session.m_display, surface, surface, session.CreateContext()));
}

#endif
