#include "stereo_scene_frames.h"

#include <GLES/gl.h>

#include <memory>

#include "common/frame_capture.h"
#include "common/pbuffer_context.h"
#include "es1_scene/es1_scene.h"

namespace {

struct SceneRun {
    ovo_sample::PbufferContext m_context;
    std::unique_ptr<ovo_sample::Es1Scene> m_scene;
    int32_t m_frame = 0;
};

SceneRun& Run() {
    static SceneRun run;
    return run;
}

}  // namespace

bool StereoSceneStart(int32_t width, int32_t height) {
    SceneRun& run = Run();
    if (!run.m_context.Create("stereo_draw_bench", 1, width, height)) return false;
    run.m_scene = std::make_unique<ovo_sample::Es1Scene>(ovo_sample::ReferenceOptions{},
                                                         ovo_sample::PixelSize{width, height});
    return run.m_scene->Init("stereo_draw_bench", width, height);
}

bool StereoSceneDrawFrame() {
    SceneRun& run = Run();
    run.m_scene->DrawFrame(run.m_frame++);
    const bool swapped = run.m_context.SwapBuffers();
    // Mesa renders nothing at a pbuffer's swap, and llvmpipe drops queued work that the
    // next frame's clear covers; a window's swap would show the frame. So each frame is
    // finished, and all of its rendering counted.
    glFinish();
    return swapped;
}

int32_t StereoSceneStencilBits() {
    GLint bits = 0;
    glGetIntegerv(GL_STENCIL_BITS, &bits);
    return bits;
}

uint32_t StereoSceneTakeGlError() { return ovo_sample::TakeGlError(); }
