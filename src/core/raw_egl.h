#ifndef OVO_CORE_RAW_EGL_H
#define OVO_CORE_RAW_EGL_H

#include "core/driver_hooks.h"

// The EGL forwarders: every call of the library into the vendor EGL goes through one.
namespace ovo::vendor_egl {

// Clients often ask eglGetError or eglQueryString(EGL_NO_DISPLAY, ...) before any
// eglGetDisplay has bound the driver. While a slot is still null the call lands here: it
// binds the driver and answers as the vendor does, or 0 when there is no vendor. Kept out
// of line, so that a bound call stays one load, one test and one indirect call.
namespace unbound {
#define OVO_EGL_ENTRY(index, result, name, params, args) \
    __attribute__((cold, noinline)) result name params;
#define OVO_EGL_NULL(index, result, name, params, args)
#include "core/egl_entry_table.inc"
}  // namespace unbound

#define OVO_EGL_ENTRY(index, result, name, params, args)                           \
    inline result name params {                                                    \
        auto function = LoadSlot(g_vendor_driver.m_egl.name);                      \
        return function != nullptr ? function args : unbound::name args;           \
    }
#define OVO_EGL_NULL(index, result, name, params, args)
#include "core/egl_entry_table.inc"

}  // namespace ovo::vendor_egl

#endif
