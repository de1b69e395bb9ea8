#include <EGL/egl.h>

#include "core/driver_hooks.h"
#include "core/raw_egl.h"
#include "core/stereo_manager.h"
#include "entry/export.h"

extern "C" {

OVO_EXPORT EGLDisplay EGLAPIENTRY eglGetDisplay(EGLNativeDisplayType display_id) {
    if (!ovo::ResolveDriver()) return EGL_NO_DISPLAY;
    ovo::PrepareDisplay();
    return ovo::vendor_egl::eglGetDisplay(display_id);
}

// Applications get every GL function from this library's own exports.
OVO_EXPORT __eglMustCastToProperFunctionPointerType EGLAPIENTRY
eglGetProcAddress(const char* procname) {
    (void)procname;
    return nullptr;
}

}  // extern "C"
