#ifndef OVO_CORE_DRIVER_HOOKS_H
#define OVO_CORE_DRIVER_HOOKS_H

#include <pthread.h>

#include <cstdint>

#include "core/entry_tables.h"
#include "core/gl_api.h"

namespace ovo {

// One vendor GL function per GlEntryTable name, in table order.
struct DriverHooks {
#define OVO_GL_ENTRY(index, result, name, params, args) result(GL_APIENTRY* name) params;
#include "core/gl_entry_table.inc"
};
static_assert(sizeof(DriverHooks) == GL_ENTRY_COUNT * sizeof(void*), "one slot per GL name");

// One vendor EGL function per EglEntryTable name, in table order.
struct EglDriverTable {
#define OVO_EGL_ENTRY(index, result, name, params, args) result(EGLAPIENTRY* name) params;
#define OVO_EGL_SLOT(index, name) void (*name)();
#include "core/egl_entry_table.inc"
};
static_assert(sizeof(EglDriverTable) == EGL_ENTRY_COUNT * sizeof(void*), "one slot per EGL name");

// Everything bound from the vendor; one process-wide object in zero-initialised storage.
struct VendorDriver {
    EglDriverTable m_egl;
    DriverHooks m_es1_hooks;
    DriverHooks m_es2_hooks;
    DriverHooks m_no_context_hooks;   // NoContextHooks: every slot does nothing and returns 0
    uint32_t m_client_api_index;      // clientApiIndex: 0 selects ES 1.x, 1 ES 2.0
};

extern VendorDriver g_vendor_driver;
extern pthread_key_t g_driver_hooks_key;  // DriverHooksKey

// The vendor libraries: "<dir>/<base name>_<GPU tag>.so".
constexpr const char VENDOR_LIBRARY_DIR[] = "/system/vendor/lib/egl";
enum VendorLibraryKind : int {
    VENDOR_LIBRARY_EGL = 0,
    VENDOR_LIBRARY_GLES1 = 1,
    VENDOR_LIBRARY_GLES2 = 2,
};

// Opens the vendor library of `kind` under the first GPU tag that has one; null if none.
void* OpenVendorLibrary(int kind);

// Opens the three vendor libraries and fills the EGL table and both GL tables. False as
// soon as one library cannot be opened; the tables filled before it stay filled.
bool ResolveDriver();

// Every eglGetDisplay fills the slots again while other threads may be calling through
// them: relaxed atomic accesses keep that defined, and compile to plain loads and stores.
template <typename Function>
inline Function LoadSlot(const Function& slot) {
    return __atomic_load_n(&slot, __ATOMIC_RELAXED);
}
template <typename Function>
inline void StoreSlot(Function& slot, Function function) {
    __atomic_store_n(&slot, function, __ATOMIC_RELAXED);
}

// The calling thread's GL table: its own, or NoContextHooks when it never bound one.
inline const DriverHooks& CurrentHooks() {
    const void* hooks = pthread_getspecific(g_driver_hooks_key);
    return hooks != nullptr ? *static_cast<const DriverHooks*>(hooks)
                            : g_vendor_driver.m_no_context_hooks;
}

// Binds the calling thread to the table clientApiIndex selects, or to NoContextHooks.
void SelectThreadHooks(bool context_bound);

// The table of a context whose client version gave `client_api_index` (0: ES 1.x, 1: ES 2.0).
const DriverHooks* ClientApiHooks(uint32_t client_api_index);
// The calling thread's own DriverHooksKey value (null for a thread that never set one), and
// setting it: the library puts it back after working in a context of its own choosing.
inline const void* ThreadHooks() { return pthread_getspecific(g_driver_hooks_key); }
inline void SetThreadHooks(const void* hooks) { pthread_setspecific(g_driver_hooks_key, hooks); }

}  // namespace ovo

#endif
