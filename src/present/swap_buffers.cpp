#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "entry/export.h"
#include "present/composition_renderer.h"
#include "present/panel_refresh.h"
#include "stereo/frame_parameters.h"
#include "stereo/overlay_target.h"

extern "C" {

// The library's only per-frame hook.
OVO_EXPORT EGLBoolean EGLAPIENTRY eglSwapBuffers(EGLDisplay dpy, EGLSurface surface) {
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    // The parameters of the next frame, and the overlay composed into this one.
    ovo::BeginFrame(manager);
    EGLBoolean result = ovo::vendor_egl::eglSwapBuffers(dpy, surface);
    // Whatever the vendor answered: the overlay is emptied and the next frame's mask drawn
    // before the application's first draw.
    if (manager.m_profile->m_eye_target) manager.m_overlay->Clear();
    if (manager.m_interleave) manager.m_composer->Present(manager);
    ovo::RefreshPanel(manager);
    return result;
}

}  // extern "C"
