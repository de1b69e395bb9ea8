// The cost that the library adds to one GL call: the same vendor function called directly
// and through the library's export, for the recording vendor (which does nothing) and Mesa.
#include <EGL/egl.h>
#include <GLES2/gl2.h>
#include <benchmark/benchmark.h>
#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>

#include "vendor/recorder.h"

namespace {

using DepthMaskFunction = void (*)(GLboolean);
using IsEnabledFunction = GLboolean (*)(GLenum);

struct CallPair {
    DepthMaskFunction m_depth_mask;
    IsEnabledFunction m_is_enabled;
};

struct Subject {
    CallPair m_direct;
    CallPair m_through_library;
};

template <typename Function>
Function Symbol(void* library, const char* name) {
    void* found = library != nullptr ? dlsym(library, name) : nullptr;
    if (found == nullptr) {
        std::fprintf(stderr, "forwarding_bench: %s not found\n", name);
        std::exit(1);
    }
    return reinterpret_cast<Function>(found);
}

CallPair Calls(void* library) {
    return {Symbol<DepthMaskFunction>(library, "glDepthMask"),
            Symbol<IsEnabledFunction>(library, "glIsEnabled")};
}

// Opens the library and makes an OpenGL ES 2.0 context current through its own EGL.
bool MakeCurrentThrough(void* library, bool pbuffer) {
    auto get_display = Symbol<decltype(&eglGetDisplay)>(library, "eglGetDisplay");
    auto initialize = Symbol<decltype(&eglInitialize)>(library, "eglInitialize");
    auto choose_config = Symbol<decltype(&eglChooseConfig)>(library, "eglChooseConfig");
    auto create_pbuffer = Symbol<decltype(&eglCreatePbufferSurface)>(library, "eglCreatePbufferSurface");
    auto create_context = Symbol<decltype(&eglCreateContext)>(library, "eglCreateContext");
    auto make_current = Symbol<decltype(&eglMakeCurrent)>(library, "eglMakeCurrent");

    EGLDisplay display = get_display(EGL_DEFAULT_DISPLAY);
    if (display == EGL_NO_DISPLAY) return false;
    EGLConfig config = nullptr;
    EGLSurface surface = reinterpret_cast<EGLSurface>(0x5000);
    if (pbuffer) {
        const EGLint config_attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_RENDERABLE_TYPE,
                                            EGL_OPENGL_ES2_BIT, EGL_NONE};
        const EGLint surface_attributes[] = {EGL_WIDTH, 64, EGL_HEIGHT, 64, EGL_NONE};
        EGLint count = 0;
        if (!initialize(display, nullptr, nullptr) ||
            !choose_config(display, config_attributes, &config, 1, &count) || count < 1) {
            return false;
        }
        surface = create_pbuffer(display, config, surface_attributes);
    }
    const EGLint context_attributes[] = {EGL_CONTEXT_CLIENT_VERSION, 2, EGL_NONE};
    EGLContext context = create_context(display, config, EGL_NO_CONTEXT, context_attributes);
    return context != EGL_NO_CONTEXT && make_current(display, surface, surface, context) == EGL_TRUE;
}

void DepthMask(benchmark::State& state, const CallPair* calls) {
    for (auto _ : state) calls->m_depth_mask(GL_TRUE);
}

void IsEnabled(benchmark::State& state, const CallPair* calls) {
    for (auto _ : state) benchmark::DoNotOptimize(calls->m_is_enabled(GL_DEPTH_TEST));
}

void Register(const char* vendor, const Subject& subject) {
    struct Variant {
        const char* m_name;
        const CallPair* m_calls;
    } variants[] = {{"direct", &subject.m_direct}, {"library", &subject.m_through_library}};
    char name[128];
    for (const Variant& variant : variants) {
        std::snprintf(name, sizeof(name), "%s/glDepthMask/%s", vendor, variant.m_name);
        benchmark::RegisterBenchmark(name, DepthMask, variant.m_calls);
        std::snprintf(name, sizeof(name), "%s/glIsEnabled/%s", vendor, variant.m_name);
        benchmark::RegisterBenchmark(name, IsEnabled, variant.m_calls);
    }
}

}  // namespace

int main(int argc, char** argv) {
    setenv("EGL_PLATFORM", "surfaceless", 0);
    static Subject recording;
    void* recording_library = dlopen(OVO_BENCH_RECORDING_LIBRARY, RTLD_NOW | RTLD_LOCAL);
    if (!MakeCurrentThrough(recording_library, false)) {
        std::fprintf(stderr, "forwarding_bench: no context on the recording vendor\n");
        return 1;
    }
    RecorderGetState()->m_recording = false;
    recording.m_through_library = Calls(recording_library);
    recording.m_direct = Calls(dlopen(OVO_BENCH_RECORDING_GLES2, RTLD_NOW | RTLD_LOCAL));

    static Subject mesa;
    void* mesa_library = dlopen(OVO_BENCH_MESA_LIBRARY, RTLD_NOW | RTLD_LOCAL);
    if (!MakeCurrentThrough(mesa_library, true)) {
        std::fprintf(stderr, "forwarding_bench: no Mesa context through the library\n");
        return 1;
    }
    mesa.m_through_library = Calls(mesa_library);
    mesa.m_direct = Calls(dlopen(OVO_BENCH_MESA_GLES2, RTLD_NOW | RTLD_LOCAL));

    Register("recording", recording);
    Register("mesa", mesa);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
