// es1_scene: an OpenGL ES 1.1 fixed-function 3D scene with a 2D HUD, rendered off-screen
// and written as a PNG; run it without options for the usage.
//   es1_scene OUTPUT.png [--frames N] [--size WxH] [--game-size WxH] [--cpu-seconds S]
//       [--eye 0|1 [--eye-distance D] [--eye-angle A] [--eye-shift S]
//        [--overlay-reference W,H]] [--viewport-scale SX,SY]
#include "common/sample_runner.h"
#include "es1_scene/es1_scene.h"

int main(int argc, char** argv) {
    using namespace ovo_sample;
    const SampleInfo info = {"es1_scene", 1,
                             REFERENCE_OPTION_EYE | REFERENCE_OPTION_OVERLAY |
                                 REFERENCE_OPTION_VIEWPORT_SCALE};
    SampleArgs args;
    if (!ParseSampleArgs(info, argc, argv, &args)) return SAMPLE_EXIT_USAGE;
    Es1Scene scene(args.m_reference, args.m_size);
    return RunSample(info, args, &scene);
}
