#include "scene_frame_part.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstdlib>

#include "device_profile.h"
#include "library_symbol.h"
#include "stereo_scene_frames.h"

namespace {

// The panel's size, at which the sample game renders.
constexpr int32_t SCENE_WIDTH = 800;
constexpr int32_t SCENE_HEIGHT = 480;
// llvmpipe compiles code for each new combination of state at its first draw, which the
// first frames pay for and a game's later frames do not.
constexpr int32_t SCENE_WARM_UP_FRAMES = 30;

struct SceneFunctions {
    decltype(&StereoSceneStart) m_start;
    decltype(&StereoSceneDrawFrame) m_draw_frame;
    decltype(&StereoSceneStencilBits) m_stencil_bits;
    decltype(&StereoSceneTakeGlError) m_take_gl_error;
};

bool OpenScene(const char* module_path, SceneFunctions* scene) {
    void* module = OpenLibrary(module_path);
    *scene = {LibrarySymbol<decltype(&StereoSceneStart)>(module, "StereoSceneStart"),
              LibrarySymbol<decltype(&StereoSceneDrawFrame)>(module, "StereoSceneDrawFrame"),
              LibrarySymbol<decltype(&StereoSceneStencilBits)>(module, "StereoSceneStencilBits"),
              LibrarySymbol<decltype(&StereoSceneTakeGlError)>(module, "StereoSceneTakeGlError")};
    return scene->m_start != nullptr && scene->m_draw_frame != nullptr &&
           scene->m_stencil_bits != nullptr && scene->m_take_gl_error != nullptr;
}

void DrawFrames(benchmark::State& state, const SceneFunctions* scene) {
    for (auto _ : state) {
        if (!scene->m_draw_frame()) {
            state.SkipWithError("eglSwapBuffers failed");
            break;
        }
    }
    if (scene->m_take_gl_error() != 0) state.SkipWithError("the scene made a GL error");
}

}  // namespace

bool RegisterSceneBenchmark(const SceneCase& scene_case) {
    const bool installed = scene_case.m_profile != nullptr
                               ? InstallProfile(OVO_BENCH_SCENE_ROOT, scene_case.m_profile)
                               : RemoveProfile(OVO_BENCH_SCENE_ROOT);
    // Mesa headless, unless the caller chose a platform.
    setenv("EGL_PLATFORM", "surfaceless", 0);
    static SceneFunctions scene;
    if (!installed || !OpenScene(scene_case.m_module, &scene) ||
        !scene.m_start(SCENE_WIDTH, SCENE_HEIGHT)) {
        return false;
    }
    // The column mask lives in the stencil buffer, which the library asks for whenever it
    // interleaves: without one the profile did not take.
    if (scene_case.m_profile != nullptr && scene.m_stencil_bits() == 0) {
        std::fprintf(stderr, "stereo_draw_bench: %s: no stencil buffer, so no column mask\n",
                     scene_case.m_name);
        return false;
    }
    for (int32_t frame = 0; frame < SCENE_WARM_UP_FRAMES; ++frame) {
        if (!scene.m_draw_frame()) return false;
    }
    benchmark::RegisterBenchmark(scene_case.m_name, DrawFrames, &scene)
        ->Unit(benchmark::kMillisecond)
        ->UseRealTime()
        ->MeasureProcessCPUTime();
    return true;
}
