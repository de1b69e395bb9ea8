#include <dlfcn.h>

#include <cstdio>
#include <cstring>

#include "core/driver_hooks.h"
#include "core/missing_driver_function.h"
#include "core/raw_egl.h"
#include "platform/device_path.h"

namespace ovo {

VendorDriver g_vendor_driver;
pthread_key_t g_driver_hooks_key;

namespace {

constexpr const char* VENDOR_LIBRARY_BASE_NAMES[] = {"libEGL", "libGLESv1_CM", "libGLESv2"};
constexpr const char* GPU_TAGS[] = {"mali", "POWERVR_SGX540_120", "adreno200", "mtk", "SGX530"};

// Room for the longest vendor library path (57 characters) below the device root.
constexpr size_t VENDOR_PATH_CAPACITY = 64 + DEVICE_PATH_CAPACITY;
constexpr size_t SCRATCH_NAME_CAPACITY = 256;
constexpr char OES_SUFFIX[] = "OES";
constexpr size_t OES_SUFFIX_LENGTH = sizeof(OES_SUFFIX) - 1;

using ProcResolver = __eglMustCastToProperFunctionPointerType (*)(const char*);

pthread_once_t g_static_init_once = PTHREAD_ONCE_INIT;

void InitialiseOnce() {
    pthread_key_create(&g_driver_hooks_key, nullptr);
    DriverHooks& hooks = g_vendor_driver.m_no_context_hooks;
#define OVO_GL_ENTRY(index, result, name, params, args) \
    hooks.name = &MissingDriverFunction<decltype(hooks.name)>::Call;
#include "core/gl_entry_table.inc"
    pthread_setspecific(g_driver_hooks_key, &hooks);
}

__attribute__((constructor)) void InitialiseAtLoad() { pthread_once(&g_static_init_once, InitialiseOnce); }

template <typename Pointer>
Pointer FoundOrMissing(void* found) {
    return found != nullptr ? reinterpret_cast<Pointer>(found)
                            : &MissingDriverFunction<Pointer>::Call;
}

void* Resolve(ProcResolver resolver, const char* name) {
    return resolver != nullptr ? reinterpret_cast<void*>(resolver(name)) : nullptr;
}

// The GL lookup of one name: by symbol, through the vendor's resolver, then with the
// "OES" suffix taken off or put on, since vendors export either form of many names.
void* LookupGl(void* library, ProcResolver resolver, const char* name, char* scratch) {
    if (void* found = dlsym(library, name)) return found;
    if (void* found = Resolve(resolver, name)) return found;
    size_t length = std::strlen(name);
    bool has_suffix = length >= OES_SUFFIX_LENGTH &&
                      std::strcmp(name + length - OES_SUFFIX_LENGTH, OES_SUFFIX) == 0;
    if (has_suffix && length >= 4 && length <= SCRATCH_NAME_CAPACITY + 1) {
        std::memcpy(scratch, name, length - OES_SUFFIX_LENGTH);
        scratch[length - OES_SUFFIX_LENGTH] = '\0';
        return dlsym(library, scratch);
    }
    if (!has_suffix && length >= 4 && length <= SCRATCH_NAME_CAPACITY - OES_SUFFIX_LENGTH - 1) {
        std::memcpy(scratch, name, length);
        std::memcpy(scratch + length, OES_SUFFIX, OES_SUFFIX_LENGTH + 1);
        return dlsym(library, scratch);
    }
    return nullptr;
}

void FillGlHooks(DriverHooks& hooks, void* library, ProcResolver resolver) {
    char scratch[SCRATCH_NAME_CAPACITY];
#define OVO_GL_ENTRY(index, result, name, params, args) \
    StoreSlot(hooks.name,                               \
              FoundOrMissing<decltype(hooks.name)>(LookupGl(library, resolver, #name, scratch)));
#include "core/gl_entry_table.inc"
}

void FillEglTable(EglDriverTable& table, void* library, ProcResolver resolver) {
    auto lookup = [&](const char* name) {
        void* found = dlsym(library, name);
        return found != nullptr ? found : Resolve(resolver, name);
    };
#define OVO_EGL_ENTRY(index, result, name, params, args) \
    StoreSlot(table.name, FoundOrMissing<decltype(table.name)>(lookup(#name)));
#define OVO_EGL_SLOT(index, name) OVO_EGL_ENTRY(index, void, name, (), ())
#include "core/egl_entry_table.inc"
}

}  // namespace

void* OpenVendorLibrary(int kind) {
    if (kind < VENDOR_LIBRARY_EGL || kind > VENDOR_LIBRARY_GLES2) return nullptr;
    char directory[DEVICE_PATH_CAPACITY];
    if (!MakeDevicePath(VENDOR_LIBRARY_DIR, directory, sizeof(directory))) return nullptr;
    char path[VENDOR_PATH_CAPACITY];
    for (const char* tag : GPU_TAGS) {
        std::snprintf(path, sizeof(path), "%s/%s_%s.so", directory,
                      VENDOR_LIBRARY_BASE_NAMES[kind], tag);
        if (void* library = dlopen(path, RTLD_NOW | RTLD_LOCAL)) return library;
    }
    return nullptr;
}

bool ResolveDriver() {
    void* egl = OpenVendorLibrary(VENDOR_LIBRARY_EGL);
    if (egl == nullptr) return false;
    auto resolver = reinterpret_cast<ProcResolver>(dlsym(egl, "eglGetProcAddress"));
    FillEglTable(g_vendor_driver.m_egl, egl, resolver);

    void* gles1 = OpenVendorLibrary(VENDOR_LIBRARY_GLES1);
    if (gles1 == nullptr) return false;
    FillGlHooks(g_vendor_driver.m_es1_hooks, gles1, resolver);

    void* gles2 = OpenVendorLibrary(VENDOR_LIBRARY_GLES2);
    if (gles2 == nullptr) return false;
    FillGlHooks(g_vendor_driver.m_es2_hooks, gles2, resolver);
    return true;
}

template <typename Result>
Result NoVendorAnswer() {
    return Result();
}

namespace vendor_egl::unbound {
#define OVO_EGL_ENTRY(index, result, name, params, args)                       \
    result name params {                                                       \
        ResolveDriver();                                                       \
        auto function = LoadSlot(g_vendor_driver.m_egl.name);                  \
        return function != nullptr ? function args : NoVendorAnswer<result>(); \
    }
#define OVO_EGL_NULL(index, result, name, params, args)
#include "core/egl_entry_table.inc"
}  // namespace vendor_egl::unbound

void SelectThreadHooks(bool context_bound) {
    const DriverHooks* hooks = context_bound ? ClientApiHooks(g_vendor_driver.m_client_api_index)
                                             : &g_vendor_driver.m_no_context_hooks;
    SetThreadHooks(hooks);
}

const DriverHooks* ClientApiHooks(uint32_t client_api_index) {
    return client_api_index == 1 ? &g_vendor_driver.m_es2_hooks : &g_vendor_driver.m_es1_hooks;
}


}  // namespace ovo
