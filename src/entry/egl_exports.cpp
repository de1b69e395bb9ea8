// The EGL functions that only forward, defined against the Khronos prototypes.
#define EGL_EGLEXT_PROTOTYPES 1
#include <EGL/egl.h>
#include <EGL/eglext.h>

#include <type_traits>

#include "core/raw_egl.h"
#include "entry/export.h"

extern "C" {

#define OVO_EGL_ENTRY(index, result, name, params, args) \
    static_assert(std::is_same<decltype(&::name), result(EGLAPIENTRY*) params>::value, #name);
#define OVO_EGL_FORWARD(index, result, name, params, args) \
    OVO_EGL_ENTRY(index, result, name, params, args)        \
    OVO_EXPORT result EGLAPIENTRY name params { return ovo::vendor_egl::name args; }
#include "core/egl_entry_table.inc"

}  // extern "C"
