#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "entry/export.h"
#include "present/panel_refresh.h"

extern "C" {

// The library's only per-frame hook.
OVO_EXPORT EGLBoolean EGLAPIENTRY eglSwapBuffers(EGLDisplay dpy, EGLSurface surface) {
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    // The per-frame stereo parameters (BeginFrame) are taken here, before the swap, once
    // the stereo layers exist.
    EGLBoolean result = ovo::vendor_egl::eglSwapBuffers(dpy, surface);
    // Then, whatever the vendor answered: the overlay target is emptied and the
    // composition renderer draws the next frame's mask, once those exist.
    ovo::RefreshPanel(manager);
    return result;
}

}  // extern "C"
