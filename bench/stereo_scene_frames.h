#ifndef OVO_BENCH_STEREO_SCENE_FRAMES_H
#define OVO_BENCH_STEREO_SCENE_FRAMES_H

#include <cstdint>

// A sample scene in a module of its own, linked with one copy of the library, so that the
// scene's EGL and GL calls bind to that copy and to nothing else in the benchmark. There is
// one module per sample; the benchmark opens one with dlopen and calls these.
extern "C" {

// Makes a width x height pbuffer current through the library with a context of the
// sample's OpenGL ES version and builds the scene at that size; false after printing why.
bool StereoSceneStart(int32_t width, int32_t height);

// Draws the next frame, swaps and waits until the frame is rendered; false when the swap
// failed.
bool StereoSceneDrawFrame();

// The current draw surface's stencil bits.
int32_t StereoSceneStencilBits();

// The first pending GL error, 0 when there is none.
uint32_t StereoSceneTakeGlError();
}

#endif
