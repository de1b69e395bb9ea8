#include "es1_scene/es1_scene.h"
#include "frame_sample.h"

FrameSample MakeFrameSample(int32_t width, int32_t height) {
    return {1, std::make_unique<ovo_sample::Es1Scene>(ovo_sample::ReferenceOptions{},
                                                      ovo_sample::PixelSize{width, height})};
}
