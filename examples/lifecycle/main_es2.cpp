// lifecycle_es2: es2_scene's OpenGL ES 2.0 scene through one scenario of a game's EGL life
// (what Android does to its surfaces, contexts and display), then its last frames written
// as a PNG; run it without options for the scenarios and the usage. A loading thread's
// textures become the floor.
//   lifecycle_es2 OUTPUT.png --scenario NAME [--frames N] [--size WxH] [--game-size WxH]
//       [--eye 0|1 [--eye-distance D] [--eye-angle A]]
#include "es2_scene/es2_scene.h"
#include "lifecycle/lifecycle_main.h"

int main(int argc, char** argv) {
    using namespace ovo_sample;
    return RunLifecycleSample<Es2Scene, &Es2Scene::UseFloorTexture>(
        {"lifecycle_es2", 2, REFERENCE_OPTION_EYE}, argc, argv,
        [](const SampleArgs& args) { return Es2Scene(args.m_reference); });
}
