#ifndef OVO_EXAMPLES_COMMON_GAME_VIEWPORT_H
#define OVO_EXAMPLES_COMMON_GAME_VIEWPORT_H

#include <cstdint>

#include "common/reference_options.h"

namespace ovo_sample {

// The game's glViewport. When the reference scales viewports, the box becomes
// (trunc(x*SX), trunc(y*SY), trunc(0.5 + w*SX), trunc(h*SY)) in float arithmetic: the
// single image that a game rendered at one size and shown at another gets.
void SetGameViewport(const ReferenceOptions& reference, int32_t x, int32_t y, int32_t width,
                     int32_t height);

}  // namespace ovo_sample

#endif
