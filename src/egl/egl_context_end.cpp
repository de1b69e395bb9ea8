// Where contexts end: what the library kept for a share group goes with its last context.
#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "egl/current_context.h"
#include "entry/export.h"
#include "stereo/shader_source_store.h"

namespace ovo {
namespace {

void ForgetShareGroup(uint32_t group) {
    if (group == SHARE_GROUP_NONE) return;
    ShaderSourceStore* sources = StereoManager::instance().m_shader_sources;
    if (sources != nullptr) sources->ForgetGroup(group);
}

}  // namespace
}  // namespace ovo

extern "C" {

OVO_EXPORT EGLBoolean EGLAPIENTRY eglDestroyContext(EGLDisplay dpy, EGLContext ctx) {
    const EGLBoolean result = ovo::vendor_egl::eglDestroyContext(dpy, ctx);
    if (result != EGL_FALSE) {
        ovo::NoteEndedHandle(dpy, ctx);
        ovo::ForgetShareGroup(ovo::StereoManager::instance().m_contexts->NoteDestroyed(dpy, ctx));
    }
    return result;
}

// Every context of the display goes with it.
OVO_EXPORT EGLBoolean EGLAPIENTRY eglTerminate(EGLDisplay dpy) {
    const EGLBoolean result = ovo::vendor_egl::eglTerminate(dpy);
    if (result != EGL_FALSE) {
        ovo::NoteEndedHandle(dpy, nullptr);
        ovo::StereoManager::instance().m_contexts->NoteTerminated(dpy, ovo::ForgetShareGroup);
    }
    return result;
}

}  // extern "C"
