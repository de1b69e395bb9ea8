#include "egl/context_objects.h"

#include "core/driver_hooks.h"
#include "core/raw_egl.h"

namespace ovo {

ContextVisit::ContextVisit()
    : m_binding(CurrentBinding()),
      m_hooks(ThreadHooks()),
      m_display(m_binding.m_display),
      m_context(m_binding.m_context) {}

bool ContextVisit::Enter(const ContextFacts& context) {
    if (context.m_context != m_context) {
        if (m_binding.m_ending) return false;
        const bool own = context.m_context == m_binding.m_context;
        const EGLBoolean made = vendor_egl::eglMakeCurrent(
            context.m_display, own ? m_binding.m_draw : EGL_NO_SURFACE,
            own ? m_binding.m_read : EGL_NO_SURFACE, context.m_context);
        // A refused make-current leaves the thread's binding as it was.
        if (made != EGL_TRUE) return false;
        m_display = context.m_display;
        m_context = context.m_context;
    }
    SetThreadHooks(ClientApiHooks(context.m_client_api_index));
    return true;
}

ContextVisit::~ContextVisit() {
    if (m_context != m_binding.m_context) {
        if (m_binding.m_context != EGL_NO_CONTEXT) {
            vendor_egl::eglMakeCurrent(m_binding.m_display, m_binding.m_draw, m_binding.m_read,
                                       m_binding.m_context);
        } else {
            vendor_egl::eglMakeCurrent(m_display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
        }
    }
    SetThreadHooks(m_hooks);
}

}  // namespace ovo
