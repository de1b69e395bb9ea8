// es1_sprites: an OpenGL ES 1.1 2D sprite game screen, rendered off-screen and written as
// a PNG.
//   es1_sprites OUTPUT.png [--frames N] [--size WxH] [--game-size WxH] [--cpu-seconds S]
#include "common/sample_runner.h"
#include "es1_sprites/sprite_scene.h"

int main(int argc, char** argv) {
    ovo_sample::SpriteScene scene;
    return ovo_sample::RunSample({"es1_sprites", 1}, &scene, argc, argv);
}
