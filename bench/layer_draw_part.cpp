#include "layer_draw_part.h"

#include <EGL/egl.h>
#include <GLES/gl.h>
#include <GLES2/gl2.h>
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
using DrawElementsFunction = void (*)(GLenum, GLsizei, GLenum, const void*);
using ViewportFunction = void (*)(GLint, GLint, GLsizei, GLsizei);

constexpr EGLint LAYER_SURFACE_WIDTH = 800;
constexpr EGLint LAYER_SURFACE_HEIGHT = 480;

// The sample scene's projection, column-major: a 50 degree vertical field of view at
// 800x480, near plane 1, far plane 60.
constexpr GLfloat LAYER_PERSPECTIVE[16] = {1.28671f, 0, 0, 0,  0, 2.14451f, 0, 0,
                                           0, 0, -1.03390f, -1,  0, 0, -2.03390f, 0};

// The OpenGL ES 2.0 game's current program and the depth-shift uniform's location in it.
constexpr GLint LAYER_PROGRAM = 9;
constexpr GLint LAYER_DEPTH_SHIFT_LOCATION = 4;

// One triangle, from an element array buffer.
constexpr GLsizei LAYER_VERTEX_COUNT = 3;
const void* const LAYER_INDICES = nullptr;

// One of the two draw functions, of the library or of the vendor.
struct DrawFunction {
    LayerDrawCall m_call;
    void* m_function;
};

void Issue(const DrawFunction& draw) {
    if (draw.m_call == LAYER_DRAW_ARRAYS) {
        reinterpret_cast<DrawArraysFunction>(draw.m_function)(GL_TRIANGLES, 0, LAYER_VERTEX_COUNT);
    } else {
        reinterpret_cast<DrawElementsFunction>(draw.m_function)(GL_TRIANGLES, LAYER_VERTEX_COUNT,
                                                               GL_UNSIGNED_SHORT, LAYER_INDICES);
    }
}

void DrawLoop(benchmark::State& state, DrawFunction draw) {
    for (auto _ : state) Issue(draw);
}

bool IsEs2(LayerGame game) { return game == LAYER_GAME_ES2; }

void AnswerGameQueries(LayerGame game) {
    if (game == LAYER_GAME_ES1_PERSPECTIVE) {
        recorded_calls::AnswerBytes(ovo::GL_ENTRY_glGetFloatv, GL_PROJECTION_MATRIX,
                                    LAYER_PERSPECTIVE, sizeof(LAYER_PERSPECTIVE));
    } else if (IsEs2(game)) {
        recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_CURRENT_PROGRAM,
                                       {LAYER_PROGRAM});
        recorded_calls::AnswerResult(ovo::GL_ENTRY_glGetUniformLocation, LAYER_PROGRAM,
                                     LAYER_DEPTH_SHIFT_LOCATION);
    }
}

bool MakeCurrent(void* library, EGLint client_version) {
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
    const EGLint attributes[] = {EGL_CONTEXT_CLIENT_VERSION, client_version, EGL_NONE};
    const EGLContext context = create_context(display, nullptr, EGL_NO_CONTEXT, attributes);
    // The recording vendor takes any surface.
    const EGLSurface surface = reinterpret_cast<EGLSurface>(0x5000);
    if (display == EGL_NO_DISPLAY || context == EGL_NO_CONTEXT ||
        make_current(display, surface, surface, context) != EGL_TRUE) {
        std::fprintf(stderr,
                     "stereo_draw_bench: no OpenGL ES %d context on the recording vendor\n",
                     client_version);
        return false;
    }
    viewport(0, 0, LAYER_SURFACE_WIDTH, LAYER_SURFACE_HEIGHT);
    return true;
}

// What one draw through the library makes the vendor do; false when the recorder's log
// could not hold all of it.
bool ObserveSignature(const LayerCase& layer_case, const DrawFunction& draw,
                      LayerSignature* seen) {
    const bool es2 = IsEs2(layer_case.m_game);
    const int32_t api = es2 ? RECORDER_API_GLES2 : RECORDER_API_GLES1;
    const uint32_t eye_setup = es2 ? ovo::GL_ENTRY_glUniform2f : ovo::GL_ENTRY_glTranslatef;
    const uint32_t vendor_draw = layer_case.m_draw_call == LAYER_DRAW_ARRAYS
                                     ? ovo::GL_ENTRY_glDrawArrays
                                     : ovo::GL_ENTRY_glDrawElements;
    RecorderState& recorder = *RecorderGetState();
    recorder.m_call_count = 0;
    recorder.m_recording = true;
    Issue(draw);
    recorder.m_recording = false;
    if (recorder.m_call_count > RECORDER_CAPACITY) return false;
    *seen = {0, 0, false};
    for (uint32_t i = 0; i < recorder.m_call_count; ++i) {
        const RecordedCall& call = recorder.m_calls[i];
        if (call.m_api != api) continue;
        if (call.m_index == vendor_draw) seen->m_vendor_draws += 1;
        if (call.m_index == eye_setup) seen->m_eye_setups += 1;
        if (call.m_index == ovo::GL_ENTRY_glGetFloatv && call.m_arguments[0] == GL_TEXTURE_MATRIX) {
            seen->m_reads_texture_matrix = true;
        }
    }
    return true;
}

bool HasSignature(const LayerCase& layer_case, const DrawFunction& draw) {
    LayerSignature seen;
    if (!ObserveSignature(layer_case, draw, &seen)) {
        std::fprintf(stderr,
                     "stereo_draw_bench: %s: one draw made more vendor calls than the recorder "
                     "keeps\n",
                     layer_case.m_name);
        return false;
    }
    const LayerSignature& expected = layer_case.m_signature;
    if (seen.m_vendor_draws != expected.m_vendor_draws ||
        seen.m_eye_setups != expected.m_eye_setups ||
        seen.m_reads_texture_matrix != expected.m_reads_texture_matrix) {
        const char* eye_setup = IsEs2(layer_case.m_game) ? "uniform values" : "translations";
        std::fprintf(stderr,
                     "stereo_draw_bench: %s: one draw made %u vendor draws and %u %s and %s the "
                     "texture matrix; %s on this path makes %u, %u and %s\n",
                     layer_case.m_name, seen.m_vendor_draws, seen.m_eye_setups, eye_setup,
                     seen.m_reads_texture_matrix ? "read" : "did not read", layer_case.m_layer,
                     expected.m_vendor_draws, expected.m_eye_setups,
                     expected.m_reads_texture_matrix ? "reads it" : "does not");
        return false;
    }
    return true;
}

}  // namespace

const char* LayerDrawCallName(LayerDrawCall draw_call) {
    return draw_call == LAYER_DRAW_ARRAYS ? "glDrawArrays" : "glDrawElements";
}

bool RegisterLayerBenchmarks(const LayerCase& layer_case) {
    if (!InstallProfile(OVO_BENCH_LAYER_ROOT, layer_case.m_profile)) return false;
    AnswerGameQueries(layer_case.m_game);
    const bool es2 = IsEs2(layer_case.m_game);
    void* library = OpenLibrary(OVO_BENCH_LAYER_LIBRARY);
    if (library == nullptr || !MakeCurrent(library, es2 ? 2 : 1)) return false;
    const char* name = LayerDrawCallName(layer_case.m_draw_call);
    void* vendor = OpenLibrary(es2 ? OVO_BENCH_LAYER_VENDOR_GLES2 : OVO_BENCH_LAYER_VENDOR_GLES1);
    const DrawFunction through_library = {layer_case.m_draw_call,
                                          LibrarySymbol<void*>(library, name)};
    const DrawFunction direct = {layer_case.m_draw_call, LibrarySymbol<void*>(vendor, name)};
    if (through_library.m_function == nullptr || direct.m_function == nullptr) return false;
    if (!HasSignature(layer_case, through_library)) return false;
    const std::string prefix = layer_case.m_name;
    benchmark::RegisterBenchmark((prefix + "/direct").c_str(), DrawLoop, direct);
    benchmark::RegisterBenchmark((prefix + "/library").c_str(), DrawLoop, through_library);
    return true;
}
