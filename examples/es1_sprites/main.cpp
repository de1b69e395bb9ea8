// es1_sprites: an OpenGL ES 1.1 2D sprite game screen, rendered off-screen and written as
// a PNG; run it without options for the usage.
//   es1_sprites OUTPUT.png [--frames N] [--size WxH] [--game-size WxH] [--cpu-seconds S]
//       [--eye 0|1 [--eye-distance D] [--eye-angle A] [--eye-shift S]]
//       [--viewport-scale SX,SY]
#include "common/sample_runner.h"
#include "es1_sprites/sprite_scene.h"

int main(int argc, char** argv) {
    using namespace ovo_sample;
    const SampleInfo info = {"es1_sprites", 1,
                             REFERENCE_OPTION_EYE | REFERENCE_OPTION_VIEWPORT_SCALE};
    SampleArgs args;
    if (!ParseSampleArgs(info, argc, argv, &args)) return SAMPLE_EXIT_USAGE;
    SpriteScene scene(args.m_reference);
    return RunSample(info, args, &scene);
}
