#include "egl/current_context.h"

namespace ovo {

namespace {
thread_local EglBinding g_binding = {EGL_NO_DISPLAY, EGL_NO_SURFACE, EGL_NO_SURFACE,
                                     EGL_NO_CONTEXT, false, false};
}  // namespace

const EglBinding& CurrentBinding() { return g_binding; }

EGLContext CurrentContext() { return g_binding.m_context; }

void NoteCurrentBinding(EGLDisplay display, EGLSurface draw, EGLSurface read,
                        EGLContext context) {
    // The same draw surface made current again keeps its stencil, and so its mask.
    const bool masked = g_binding.m_surface_masked && context != EGL_NO_CONTEXT &&
                        g_binding.m_context != EGL_NO_CONTEXT && draw == g_binding.m_draw;
    g_binding = EglBinding{display, draw, read, context, false, masked};
}

void NoteSurfaceMasked() { g_binding.m_surface_masked = true; }

void NoteEndedHandle(EGLDisplay display, const void* handle) {
    if (g_binding.m_context == EGL_NO_CONTEXT || display != g_binding.m_display) return;
    if (handle == nullptr || handle == g_binding.m_context || handle == g_binding.m_draw ||
        handle == g_binding.m_read) {
        g_binding.m_ending = true;
    }
}

}  // namespace ovo
