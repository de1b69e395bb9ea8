#include "common/pbuffer_context.h"

#include <cstdio>

namespace ovo_sample {

namespace {

constexpr EGLint EGL_CONFIG_CAPACITY = 64;
constexpr EGLint COLOR_BITS = 8;
constexpr EGLint DEPTH_BITS = 16;

bool HasExactColor(EGLDisplay display, EGLConfig config) {
    const EGLint channels[] = {EGL_RED_SIZE, EGL_GREEN_SIZE, EGL_BLUE_SIZE, EGL_ALPHA_SIZE};
    for (EGLint channel : channels) {
        EGLint bits = 0;
        if (!eglGetConfigAttrib(display, config, channel, &bits) || bits != COLOR_BITS) {
            return false;
        }
    }
    return true;
}

}  // namespace

bool PbufferContext::Fail(const char* call) {
    std::fprintf(stderr, "%s: %s failed (EGL error 0x%04X)\n", m_program, call,
                 static_cast<unsigned>(eglGetError()));
    return false;
}

bool PbufferContext::ChooseConfig() {
    const EGLint renderable = m_client_version >= 2 ? EGL_OPENGL_ES2_BIT : EGL_OPENGL_ES_BIT;
    const EGLint attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT,
                                 EGL_RENDERABLE_TYPE, renderable,
                                 EGL_RED_SIZE, COLOR_BITS,
                                 EGL_GREEN_SIZE, COLOR_BITS,
                                 EGL_BLUE_SIZE, COLOR_BITS,
                                 EGL_ALPHA_SIZE, COLOR_BITS,
                                 EGL_DEPTH_SIZE, DEPTH_BITS,
                                 EGL_STENCIL_SIZE, m_stencil_bits,
                                 EGL_NONE};
    EGLConfig configs[EGL_CONFIG_CAPACITY];
    EGLint count = 0;
    if (!eglChooseConfig(m_display, attributes, configs, EGL_CONFIG_CAPACITY, &count)) {
        return Fail("eglChooseConfig");
    }
    // Deeper colour sorts first, so take the first config that is exactly RGBA8, as games
    // that read pixels back do.
    for (EGLint i = 0; i < count; ++i) {
        if (HasExactColor(m_display, configs[i])) {
            m_config = configs[i];
            return true;
        }
    }
    std::fprintf(stderr, "%s: eglChooseConfig found no RGBA8 config with a depth buffer\n",
                 m_program);
    return false;
}

bool PbufferContext::Create(const char* program, EGLint client_version, EGLint stencil_bits,
                            int32_t width, int32_t height) {
    m_program = program;
    m_client_version = client_version;
    m_stencil_bits = stencil_bits;
    return OpenDisplay() && CreateSurface(width, height) && CreateContext(EGL_NO_CONTEXT) &&
           MakeCurrent();
}

bool PbufferContext::OpenDisplay() {
    m_display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
    if (m_display == EGL_NO_DISPLAY) return Fail("eglGetDisplay");
    EGLint major = 0;
    EGLint minor = 0;
    if (!eglInitialize(m_display, &major, &minor)) {
        m_display = EGL_NO_DISPLAY;
        return Fail("eglInitialize");
    }
    if (!eglBindAPI(EGL_OPENGL_ES_API)) return Fail("eglBindAPI");
    return ChooseConfig();
}

void PbufferContext::BorrowDisplay(const PbufferContext& owner) {
    m_program = owner.m_program;
    m_client_version = owner.m_client_version;
    m_stencil_bits = owner.m_stencil_bits;
    m_display = owner.m_display;
    m_config = owner.m_config;
    m_display_borrowed = true;
}

bool PbufferContext::CreateSurface(int32_t width, int32_t height) {
    const EGLint attributes[] = {EGL_WIDTH, width, EGL_HEIGHT, height, EGL_NONE};
    m_surface = eglCreatePbufferSurface(m_display, m_config, attributes);
    return m_surface != EGL_NO_SURFACE || Fail("eglCreatePbufferSurface");
}

bool PbufferContext::CreateContext(EGLContext share_with) {
    const EGLint attributes[] = {EGL_CONTEXT_CLIENT_VERSION, m_client_version, EGL_NONE};
    m_context = eglCreateContext(m_display, m_config, share_with, attributes);
    return m_context != EGL_NO_CONTEXT || Fail("eglCreateContext");
}

bool PbufferContext::MakeCurrent() {
    return eglMakeCurrent(m_display, m_surface, m_surface, m_context) || Fail("eglMakeCurrent");
}

bool PbufferContext::ReleaseCurrent() {
    return eglMakeCurrent(m_display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT) ||
           Fail("eglMakeCurrent(EGL_NO_CONTEXT)");
}

bool PbufferContext::DestroySurface() {
    const EGLSurface surface = m_surface;
    m_surface = EGL_NO_SURFACE;
    return surface == EGL_NO_SURFACE || eglDestroySurface(m_display, surface) ||
           Fail("eglDestroySurface");
}

bool PbufferContext::DestroyContext() {
    const EGLContext context = m_context;
    m_context = EGL_NO_CONTEXT;
    return context == EGL_NO_CONTEXT || eglDestroyContext(m_display, context) ||
           Fail("eglDestroyContext");
}

bool PbufferContext::Terminate() {
    const EGLDisplay display = m_display;
    m_display = EGL_NO_DISPLAY;
    m_surface = EGL_NO_SURFACE;
    m_context = EGL_NO_CONTEXT;
    return eglTerminate(display) || Fail("eglTerminate");
}

bool PbufferContext::SwapBuffers() {
    return eglSwapBuffers(m_display, m_surface) ? true : Fail("eglSwapBuffers");
}

bool PbufferContext::Destroy() {
    if (m_display == EGL_NO_DISPLAY) return true;
    bool ok = ReleaseCurrent();
    ok = DestroyContext() && ok;
    ok = DestroySurface() && ok;
    if (m_display_borrowed) {
        m_display = EGL_NO_DISPLAY;
        return ok;
    }
    return Terminate() && ok;
}

}  // namespace ovo_sample
