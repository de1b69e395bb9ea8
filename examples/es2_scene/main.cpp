// es2_scene: a small OpenGL ES 2.0 3D level, rendered off-screen and written as a PNG.
//   es2_scene OUTPUT.png [--frames N]
#include "common/sample_runner.h"
#include "es2_scene/es2_scene.h"

int main(int argc, char** argv) {
    ovo_sample::Es2Scene scene;
    return ovo_sample::RunSample({"es2_scene", 2}, &scene, argc, argv);
}
