// es1_scene: an OpenGL ES 1.1 fixed-function 3D scene with a 2D HUD, rendered off-screen
// and written as a PNG.
//   es1_scene OUTPUT.png [--frames N] [--size WxH] [--game-size WxH] [--cpu-seconds S]
#include "common/sample_runner.h"
#include "es1_scene/es1_scene.h"

int main(int argc, char** argv) {
    ovo_sample::Es1Scene scene;
    return ovo_sample::RunSample({"es1_scene", 1}, &scene, argc, argv);
}
