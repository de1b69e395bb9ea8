#include "es2_scene/es2_scene.h"
#include "frame_sample.h"

FrameSample MakeFrameSample(int32_t, int32_t) {
    return {2, std::make_unique<ovo_sample::Es2Scene>(ovo_sample::ReferenceOptions{})};
}
