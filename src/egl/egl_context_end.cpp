// Where contexts end: the library's own GL objects of a context go with it, and what it
// kept for a share group with the group's last context. The objects are deleted before the
// vendor's call, in their context, so that the application's call stays the last EGL call.
#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "egl/context_objects.h"
#include "egl/context_registry.h"
#include "egl/current_context.h"
#include "entry/export.h"
#include "present/composition_renderer.h"
#include "stereo/eye_texture.h"
#include "stereo/shader_source_store.h"

namespace ovo {
namespace {

void ForgetShareGroup(uint32_t group) {
    if (group == SHARE_GROUP_NONE) return;
    ShaderSourceStore* sources = StereoManager::instance().m_shader_sources;
    if (sources != nullptr) sources->ForgetGroup(group);
}

bool HoldsObjects(const StereoManager& manager, const ContextFacts& context) {
    const bool eye_textures = manager.m_eye_textures != nullptr &&
                              manager.m_eye_textures->Holds(context.m_context);
    const bool mask_program = context.m_ends_group && manager.m_composer != nullptr &&
                              manager.m_composer->HoldsProgram(context.m_share_group);
    return eye_textures || mask_program;
}

void ReleaseObjects(StereoManager& manager, const ContextFacts& context, bool deletable) {
    if (manager.m_eye_textures != nullptr) {
        manager.m_eye_textures->Release(context.m_context, deletable);
    }
    if (context.m_ends_group && manager.m_composer != nullptr) {
        manager.m_composer->ReleaseProgram(context.m_share_group, deletable);
    }
}

// Only contexts that hold objects are made current.
void EndObjectsOf(StereoManager& manager, const ContextFacts* contexts, size_t count) {
    ContextVisit visit;
    for (size_t i = 0; i < count; ++i) {
        if (HoldsObjects(manager, contexts[i])) {
            ReleaseObjects(manager, contexts[i], visit.Enter(contexts[i]));
        }
    }
}

}  // namespace
}  // namespace ovo

extern "C" {

OVO_EXPORT EGLBoolean EGLAPIENTRY eglDestroyContext(EGLDisplay dpy, EGLContext ctx) {
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    ovo::ContextFacts context;
    if (manager.m_contexts->Lookup(dpy, ctx, &context)) ovo::EndObjectsOf(manager, &context, 1);
    const EGLBoolean result = ovo::vendor_egl::eglDestroyContext(dpy, ctx);
    if (result != EGL_FALSE) {
        ovo::NoteEndedHandle(dpy, ctx);
        ovo::ForgetShareGroup(manager.m_contexts->NoteDestroyed(dpy, ctx));
    }
    return result;
}

// Every context of the display goes with it.
OVO_EXPORT EGLBoolean EGLAPIENTRY eglTerminate(EGLDisplay dpy) {
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    ovo::ContextFacts contexts[ovo::CONTEXT_REGISTRY_CAPACITY];
    ovo::EndObjectsOf(manager, contexts, manager.m_contexts->ContextsOf(dpy, contexts));
    const EGLBoolean result = ovo::vendor_egl::eglTerminate(dpy);
    if (result != EGL_FALSE) {
        ovo::NoteEndedHandle(dpy, nullptr);
        manager.m_contexts->NoteTerminated(dpy, ovo::ForgetShareGroup);
    }
    return result;
}

}  // extern "C"
