#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "egl/stencil_attributes.h"
#include "entry/export.h"

extern "C" {

OVO_EXPORT EGLBoolean EGLAPIENTRY eglChooseConfig(EGLDisplay dpy, const EGLint* attrib_list,
                                                  EGLConfig* configs, EGLint config_size,
                                                  EGLint* num_config) {
    // Interleaving draws each eye through a stencil mask, so every config needs stencil.
    if (!ovo::StereoManager::instance().m_interleave) {
        return ovo::vendor_egl::eglChooseConfig(dpy, attrib_list, configs, config_size, num_config);
    }
    EGLint* with_stencil = ovo::CopyWithStencil(attrib_list);
    EGLBoolean result =
        ovo::vendor_egl::eglChooseConfig(dpy, with_stencil, configs, config_size, num_config);
    delete[] with_stencil;
    return result;
}

}  // extern "C"
