// lifecycle_es1: es1_scene's OpenGL ES 1.1 scene through one scenario of a game's EGL life
// (what Android does to its surfaces, contexts and display), then its last frames written
// as a PNG; run it without options for the scenarios and the usage. A loading thread's
// textures go on the textured crate.
//   lifecycle_es1 OUTPUT.png --scenario NAME [--frames N] [--size WxH] [--game-size WxH]
//       [--eye 0|1 [--eye-distance D] [--eye-angle A] [--eye-shift S]
//        [--overlay-reference W,H]] [--hud drawn|left-out]
#include "es1_scene/es1_scene.h"
#include "lifecycle/lifecycle_main.h"

int main(int argc, char** argv) {
    using namespace ovo_sample;
    const SampleInfo info = {
        "lifecycle_es1", 1, REFERENCE_OPTION_EYE | REFERENCE_OPTION_OVERLAY | REFERENCE_OPTION_HUD};
    return RunLifecycleSample<Es1Scene, &Es1Scene::UseCrateTexture>(
        info, argc, argv,
        [](const SampleArgs& args) { return Es1Scene(args.m_reference, args.m_size); });
}
