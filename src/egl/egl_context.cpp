#include <EGL/egl.h>
#include <initializer_list>

#include "config/version_report.h"
#include "core/driver_hooks.h"
#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "egl/current_context.h"
#include "entry/export.h"
#include "stereo/overlay_target.h"

namespace ovo {
namespace {

// The DriverHooks table that contexts made current from now on use: 1 for a context that
// asked for OpenGL ES 2.0, else 0. The first ES 2.0 context of an enabled process also
// brings in the ES 2.0 layer.
uint32_t ClientApiIndex(StereoManager& manager, const EGLint* attributes) {
    uint32_t index = 0;
    if (attributes == nullptr) return index;
    for (; attributes[0] != EGL_NONE; attributes += 2) {
        if (attributes[0] != EGL_CONTEXT_CLIENT_VERSION) continue;
        if (attributes[1] == 1) {
            index = 0;
        } else if (attributes[1] == 2) {
            index = 1;
            if (manager.m_profile->m_enabled) manager.InstallEs2Layer();
        }
    }
    return index;
}

void WriteVersionReport(const StereoManager& manager, uint32_t client_api_index) {
    VersionReport report(nullptr);
    report.SetPackageName(manager.m_process_name);
    report.SetGlVersion(client_api_index == 1 ? 1 : 0);
    report.Write();
}

// The surface's size where the profile and the rectangles still have none. Without a
// surface to ask (make-current failed, or made no surface current) the size stays 0, and
// no query runs: it would put an error of its own where eglGetError must report the
// application's call.
void CaptureSurfaceSize(StereoManager& manager, EGLDisplay display, EGLSurface draw,
                        bool made_current) {
    EGLint width = 0;
    EGLint height = 0;
    if (made_current && draw != EGL_NO_SURFACE) {
        vendor_egl::eglQuerySurface(display, draw, EGL_WIDTH, &width);
        vendor_egl::eglQuerySurface(display, draw, EGL_HEIGHT, &height);
    }
    StereoProfile& profile = *manager.m_profile;
    if (profile.m_target_width == 0 && profile.m_screen_height == 0) {
        profile.m_target_width = width;
        profile.m_target_height = height;
        profile.m_screen_width = width;
        profile.m_screen_height = height;
        profile.m_width = profile.m_screen_width;
        profile.m_height = profile.m_screen_height;
    }
    for (GlRect* rect : {&manager.m_viewport, &manager.m_scissor}) {
        if (rect->m_width == 0 && rect->m_height == 0) {
            rect->m_width = width;
            rect->m_height = height;
        }
    }
    manager.UpdateScale();
}

}  // namespace
}  // namespace ovo

extern "C" {

OVO_EXPORT EGLContext EGLAPIENTRY eglCreateContext(EGLDisplay dpy, EGLConfig config,
                                                   EGLContext share_context,
                                                   const EGLint* attrib_list) {
    EGLContext context = ovo::vendor_egl::eglCreateContext(dpy, config, share_context, attrib_list);
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    // The overlay's objects are made again in whatever context is made current next.
    if (manager.m_profile->m_eye_target) manager.m_overlay->Reset();
    if (context == EGL_NO_CONTEXT) return context;
    uint32_t index = ovo::ClientApiIndex(manager, attrib_list);
    manager.m_contexts->NoteCreated(dpy, context, share_context, index);
    ovo::g_vendor_driver.m_client_api_index = index;
    if (manager.m_profile->m_enabled) ovo::WriteVersionReport(manager, index);
    return context;
}

OVO_EXPORT EGLBoolean EGLAPIENTRY eglMakeCurrent(EGLDisplay dpy, EGLSurface draw, EGLSurface read,
                                                 EGLContext ctx) {
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    const bool has_context = ctx != EGL_NO_CONTEXT;
    const bool eye_target = manager.m_profile->m_eye_target;
    // The overlay's objects go while the old context is still current.
    if (!has_context && eye_target) manager.m_overlay->Release();
    EGLBoolean result = ovo::vendor_egl::eglMakeCurrent(dpy, draw, read, ctx);
    if (result == EGL_TRUE) {
        ovo::SelectThreadHooks(has_context);
        ovo::NoteCurrentBinding(dpy, draw, read, ctx);
    }
    // The rest runs even when the vendor refused, as long as a context was named.
    if (!has_context) return result;
    if (eye_target) manager.m_overlay->Create();
    ovo::CaptureSurfaceSize(manager, dpy, draw, result == EGL_TRUE);
    return result;
}

// Leaves the thread with nothing current, as eglMakeCurrent without a context does.
OVO_EXPORT EGLBoolean EGLAPIENTRY eglReleaseThread() {
    const EGLBoolean result = ovo::vendor_egl::eglReleaseThread();
    if (result != EGL_FALSE) {
        ovo::SelectThreadHooks(false);
        ovo::NoteCurrentBinding(EGL_NO_DISPLAY, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
    }
    return result;
}

}  // extern "C"
