#ifndef OVO_CORE_RAW_EGL_H
#define OVO_CORE_RAW_EGL_H

#include "core/driver_hooks.h"

// The EGL forwarders: every call of the library into the vendor EGL goes through one.
// Before the driver is bound a slot is null, and the call answers 0 instead of crashing.
namespace ovo::vendor_egl {

template <typename Result>
Result Unbound() {
    return Result();
}

#define OVO_EGL_ENTRY(index, result, name, params, args)                           \
    inline result name params {                                                    \
        auto function = g_vendor_driver.m_egl.name;                                \
        return function != nullptr ? function args : Unbound<result>();            \
    }
#define OVO_EGL_NULL(index, result, name, params, args)
#include "core/egl_entry_table.inc"

}  // namespace ovo::vendor_egl

#endif
