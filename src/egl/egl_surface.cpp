#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "egl/current_context.h"
#include "entry/export.h"
#include "stereo/overlay_target.h"

extern "C" {

OVO_EXPORT EGLSurface EGLAPIENTRY eglCreateWindowSurface(EGLDisplay dpy, EGLConfig config,
                                                         EGLNativeWindowType win,
                                                         const EGLint* attrib_list) {
    EGLSurface surface = ovo::vendor_egl::eglCreateWindowSurface(dpy, config, win, attrib_list);
    // Whatever the vendor answered, the overlay's objects are made again at the next
    // make-current.
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    if (manager.m_profile->m_eye_target) manager.m_overlay->Reset();
    return surface;
}

// A surface destroyed while current lives on until the thread leaves it.
OVO_EXPORT EGLBoolean EGLAPIENTRY eglDestroySurface(EGLDisplay dpy, EGLSurface surface) {
    const EGLBoolean result = ovo::vendor_egl::eglDestroySurface(dpy, surface);
    if (result != EGL_FALSE) ovo::NoteEndedHandle(dpy, surface);
    return result;
}

}  // extern "C"
