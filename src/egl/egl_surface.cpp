#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "entry/export.h"

extern "C" {

OVO_EXPORT EGLSurface EGLAPIENTRY eglCreateWindowSurface(EGLDisplay dpy, EGLConfig config,
                                                         EGLNativeWindowType win,
                                                         const EGLint* attrib_list) {
    // The overlay target is reset here, whatever the vendor answers, once it exists.
    return ovo::vendor_egl::eglCreateWindowSurface(dpy, config, win, attrib_list);
}

}  // extern "C"
