#ifndef OVO_STEREO_DEPTH_SHIFT_H
#define OVO_STEREO_DEPTH_SHIFT_H

#include <cstdint>

#include "core/gl_api.h"

namespace ovo {

class ShaderSourceStore;
class StereoManager;

// The uniform that every rewritten vertex shader declares: x is the depth threshold, y
// the shift gain, both negated for eye 1.
constexpr char DEPTH_SHIFT_UNIFORM[] = "uZpDepthShift";
constexpr char DEPTH_SHIFT_DECLARATION[] = "uniform vec2 uZpDepthShift;\n";
// Moves clip-space x by the gain times how far the vertex lies behind the threshold.
constexpr char DEPTH_SHIFT_STATEMENT[] =
    "gl_Position.x = gl_Position.x + (uZpDepthShift.y * min((uZpDepthShift.x * "
    "gl_Position.w) - gl_Position.z, 0.0));\n";

// After the application's glShaderSource: a vertex shader's source is read back and set
// again with the declaration and the statement inserted, and the application's own
// source is kept in `sources` under the share group `group`. A shader in which no place
// for them is found keeps the application's source, and nothing is kept for it.
void InjectDepthShift(GLuint shader, ShaderSourceStore& sources, uint32_t group);

// The current program and the uniform's location in it (-1 when it has none), looked up
// at every draw so that nothing goes stale.
void LookUpDepthShift(StereoManager& manager);
// The uniform's value for `eye` in the current program.
void SetDepthShift(const StereoManager& manager, int eye);
// The uniform set to (threshold, gain). Without a current program nothing is called: the
// call would only raise an error that the application's own calls never caused.
void SetDepthShiftValue(const StereoManager& manager, float threshold, float gain);

}  // namespace ovo

#endif
