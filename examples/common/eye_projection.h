#ifndef OVO_EXAMPLES_COMMON_EYE_PROJECTION_H
#define OVO_EXAMPLES_COMMON_EYE_PROJECTION_H

#include "common/reference_options.h"

// OpenGL ES 1.1: the current projection P becomes one eye's. Without an eye nothing
// changes. The matrix mode is left as it was.
namespace ovo_sample {

// For a perspective P: T(-s*A, 0, 0) · P · T(s*D, 0, 0) with eye sign s (+1 eye 0, -1 eye 1),
// eye distance D and eye angle A: the eye moves in eye space, its image moves back in clip
// space.
void LoadEyePerspective(const ReferenceOptions& reference);

// For a flat P: T(s*S, 0, 0) · P with the eye shift S, a shift in clip space.
void LoadEyeFlat(const ReferenceOptions& reference);

}  // namespace ovo_sample

#endif
