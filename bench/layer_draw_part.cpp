#include "layer_draw_part.h"

#include <EGL/egl.h>
#include <GLES/gl.h>
#include <benchmark/benchmark.h>

#include <cstdio>
#include <string>

#include "core/entry_tables.h"
#include "device_profile.h"
#include "library_symbol.h"
#include "support/recorded_calls.h"
#include "vendor/recorder.h"

namespace {

using DrawArraysFunction = void (*)(GLenum, GLint, GLsizei);
using ViewportFunction = void (*)(GLint, GLint, GLsizei, GLsizei);

constexpr EGLint LAYER_SURFACE_WIDTH = 800;
constexpr EGLint LAYER_SURFACE_HEIGHT = 480;

// The sample scene's projection, column-major: a 50 degree vertical field of view at
// 800x480, near plane 1, far plane 60.
constexpr GLfloat LAYER_PERSPECTIVE[16] = {1.28671f, 0, 0, 0,  0, 2.14451f, 0, 0,
                                           0, 0, -1.03390f, -1,  0, 0, -2.03390f, 0};

bool MakeEs1Current(void* library) {
    auto get_display = LibrarySymbol<decltype(&eglGetDisplay)>(library, "eglGetDisplay");
    auto create_context = LibrarySymbol<decltype(&eglCreateContext)>(library, "eglCreateContext");
    auto make_current = LibrarySymbol<decltype(&eglMakeCurrent)>(library, "eglMakeCurrent");
    auto viewport = LibrarySymbol<ViewportFunction>(library, "glViewport");
    if (get_display == nullptr || create_context == nullptr || make_current == nullptr ||
        viewport == nullptr) {
        return false;
    }
    RecorderState& recorder = *RecorderGetState();
    recorder.m_surface_width = LAYER_SURFACE_WIDTH;
    recorder.m_surface_height = LAYER_SURFACE_HEIGHT;
    const EGLDisplay display = get_display(EGL_DEFAULT_DISPLAY);
    const EGLint attributes[] = {EGL_CONTEXT_CLIENT_VERSION, 1, EGL_NONE};
    const EGLContext context = create_context(display, nullptr, EGL_NO_CONTEXT, attributes);
    // The recording vendor takes any surface.
    const EGLSurface surface = reinterpret_cast<EGLSurface>(0x5000);
    if (display == EGL_NO_DISPLAY || context == EGL_NO_CONTEXT ||
        make_current(display, surface, surface, context) != EGL_TRUE) {
        std::fprintf(stderr,
                     "stereo_draw_bench: no OpenGL ES 1.x context on the recording vendor\n");
        return false;
    }
    viewport(0, 0, LAYER_SURFACE_WIDTH, LAYER_SURFACE_HEIGHT);
    return true;
}

// What one draw through the library makes the vendor do; false when the recorder's log
// could not hold all of it.
bool ObserveSignature(DrawArraysFunction draw, LayerSignature* seen) {
    RecorderState& recorder = *RecorderGetState();
    recorder.m_call_count = 0;
    recorder.m_recording = true;
    draw(GL_TRIANGLES, 0, 3);
    recorder.m_recording = false;
    if (recorder.m_call_count > RECORDER_CAPACITY) return false;
    *seen = {0, 0, false};
    for (uint32_t i = 0; i < recorder.m_call_count; ++i) {
        const RecordedCall& call = recorder.m_calls[i];
        if (call.m_api != RECORDER_API_GLES1) continue;
        if (call.m_index == ovo::GL_ENTRY_glDrawArrays) seen->m_vendor_draws += 1;
        if (call.m_index == ovo::GL_ENTRY_glTranslatef) seen->m_translations += 1;
        if (call.m_index == ovo::GL_ENTRY_glGetFloatv && call.m_arguments[0] == GL_TEXTURE_MATRIX) {
            seen->m_reads_texture_matrix = true;
        }
    }
    return true;
}

bool HasSignature(const LayerCase& layer_case, DrawArraysFunction draw) {
    LayerSignature seen;
    if (!ObserveSignature(draw, &seen)) {
        std::fprintf(stderr,
                     "stereo_draw_bench: %s: one draw made more vendor calls than the recorder "
                     "keeps\n",
                     layer_case.m_name);
        return false;
    }
    const LayerSignature& expected = layer_case.m_signature;
    if (seen.m_vendor_draws != expected.m_vendor_draws ||
        seen.m_translations != expected.m_translations ||
        seen.m_reads_texture_matrix != expected.m_reads_texture_matrix) {
        std::fprintf(stderr,
                     "stereo_draw_bench: %s: one draw made %u vendor draws and %u translations and "
                     "%s the texture matrix; %s on this path makes %u, %u and %s\n",
                     layer_case.m_name, seen.m_vendor_draws, seen.m_translations,
                     seen.m_reads_texture_matrix ? "read" : "did not read", layer_case.m_layer,
                     expected.m_vendor_draws, expected.m_translations,
                     expected.m_reads_texture_matrix ? "reads it" : "does not");
        return false;
    }
    return true;
}

void DrawArrays(benchmark::State& state, DrawArraysFunction draw) {
    for (auto _ : state) draw(GL_TRIANGLES, 0, 3);
}

}  // namespace

bool RegisterLayerBenchmarks(const LayerCase& layer_case) {
    if (!InstallProfile(OVO_BENCH_LAYER_ROOT, layer_case.m_profile)) return false;
    if (layer_case.m_perspective) {
        recorded_calls::AnswerBytes(ovo::GL_ENTRY_glGetFloatv, GL_PROJECTION_MATRIX,
                                    LAYER_PERSPECTIVE, sizeof(LAYER_PERSPECTIVE));
    }
    void* library = OpenLibrary(OVO_BENCH_LAYER_LIBRARY);
    if (library == nullptr || !MakeEs1Current(library)) return false;
    auto through_library = LibrarySymbol<DrawArraysFunction>(library, "glDrawArrays");
    auto direct = LibrarySymbol<DrawArraysFunction>(OpenLibrary(OVO_BENCH_LAYER_VENDOR_GLES1),
                                                    "glDrawArrays");
    if (through_library == nullptr || direct == nullptr) return false;
    if (!HasSignature(layer_case, through_library)) return false;
    const std::string name = layer_case.m_name;
    benchmark::RegisterBenchmark((name + "/direct").c_str(), DrawArrays, direct);
    benchmark::RegisterBenchmark((name + "/library").c_str(), DrawArrays, through_library);
    return true;
}
