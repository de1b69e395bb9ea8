#include "stereo_scene_frames.h"

#include <GLES2/gl2.h>

#include "common/frame_capture.h"
#include "common/pbuffer_context.h"
#include "frame_sample.h"

namespace {

struct SceneRun {
    ovo_sample::PbufferContext m_context;
    FrameSample m_sample;
    int32_t m_frame = 0;
};

SceneRun& Run() {
    static SceneRun run;
    return run;
}

}  // namespace

bool StereoSceneStart(int32_t width, int32_t height) {
    SceneRun& run = Run();
    run.m_sample = MakeFrameSample(width, height);
    // As a game asks: no stencil buffer. The library asks for one when it interleaves.
    if (!run.m_context.Create("stereo_draw_bench", run.m_sample.m_client_version, 0, width,
                              height)) {
        return false;
    }
    return run.m_sample.m_scene->Init("stereo_draw_bench", width, height);
}

bool StereoSceneDrawFrame() {
    SceneRun& run = Run();
    run.m_sample.m_scene->DrawFrame(run.m_frame++);
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
