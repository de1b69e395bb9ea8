#ifndef OVO_TESTS_SUPPORT_MESA_CONTEXT_H
#define OVO_TESTS_SUPPORT_MESA_CONTEXT_H

#include <EGL/egl.h>
#include <gtest/gtest.h>

#include <cstdlib>

// Makes an OpenGL ES context of `client_version` current on a pbuffer of Mesa's surfaceless
// platform, reached through the library, with 8 bits of red and of stencil. Call it under
// ASSERT_NO_FATAL_FAILURE.
inline void MakeMesaContextCurrent(EGLint client_version, EGLint width = 16, EGLint height = 16) {
    setenv("EGL_PLATFORM", "surfaceless", 1);
    EGLDisplay display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
    ASSERT_TRUE(eglInitialize(display, nullptr, nullptr));
    const EGLint renderable = client_version == 2 ? EGL_OPENGL_ES2_BIT : EGL_OPENGL_ES_BIT;
    const EGLint attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_RENDERABLE_TYPE, renderable,
                                 EGL_RED_SIZE, 8, EGL_STENCIL_SIZE, 8, EGL_NONE};
    EGLConfig config;
    EGLint count = 0;
    ASSERT_TRUE(eglChooseConfig(display, attributes, &config, 1, &count) && count == 1);
    const EGLint size[] = {EGL_WIDTH, width, EGL_HEIGHT, height, EGL_NONE};
    EGLSurface surface = eglCreatePbufferSurface(display, config, size);
    const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, client_version, EGL_NONE};
    EGLContext context = eglCreateContext(display, config, EGL_NO_CONTEXT, version);
    ASSERT_TRUE(eglMakeCurrent(display, surface, surface, context));
}

#endif
