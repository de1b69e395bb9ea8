// es2_scene: a small OpenGL ES 2.0 3D level, rendered off-screen and written as a PNG; run
// it without options for the usage.
//   es2_scene OUTPUT.png [--frames N] [--size WxH] [--game-size WxH] [--cpu-seconds S]
//       [--eye 0|1 [--eye-distance D] [--eye-angle A] [--texture-pass once|per-eye]]
//       [--viewport-scale SX,SY]
#include "common/sample_runner.h"
#include "es2_scene/es2_scene.h"

int main(int argc, char** argv) {
    using namespace ovo_sample;
    const SampleInfo info = {"es2_scene", 2,
                             REFERENCE_OPTION_EYE | REFERENCE_OPTION_TEXTURE_PASS |
                                 REFERENCE_OPTION_VIEWPORT_SCALE};
    SampleArgs args;
    if (!ParseSampleArgs(info, argc, argv, &args)) return SAMPLE_EXIT_USAGE;
    Es2Scene scene(args.m_reference);
    return RunSample(info, args, &scene);
}
