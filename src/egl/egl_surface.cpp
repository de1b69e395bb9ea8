#include <EGL/egl.h>

#include "core/raw_egl.h"
#include "entry/export.h"

extern "C" {

OVO_EXPORT EGLSurface EGLAPIENTRY eglCreateWindowSurface(EGLDisplay dpy, EGLConfig config,
                                                         EGLNativeWindowType win,
                                                         const EGLint* attrib_list) {
    return ovo::vendor_egl::eglCreateWindowSurface(dpy, config, win, attrib_list);
}

OVO_EXPORT EGLBoolean EGLAPIENTRY eglSwapBuffers(EGLDisplay dpy, EGLSurface surface) {
    return ovo::vendor_egl::eglSwapBuffers(dpy, surface);
}

}  // extern "C"
