#ifndef OVO_BENCH_FRAME_SAMPLE_H
#define OVO_BENCH_FRAME_SAMPLE_H

#include <cstdint>
#include <memory>

#include "common/sample_scene.h"

// The sample that a scene module renders; each module defines MakeFrameSample for its own.
struct FrameSample {
    int32_t m_client_version;  // the OpenGL ES version of its context
    std::unique_ptr<ovo_sample::SampleScene> m_scene;
};

// The sample as the game renders it (no eye of its own) at width x height.
FrameSample MakeFrameSample(int32_t width, int32_t height);

#endif
