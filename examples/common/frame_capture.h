#ifndef OVO_EXAMPLES_COMMON_FRAME_CAPTURE_H
#define OVO_EXAMPLES_COMMON_FRAME_CAPTURE_H

#include <cstdint>
#include <vector>

namespace ovo_sample {

// The current draw surface's RGBA8 pixels with the top row first (glReadPixels gives the
// bottom row first).
std::vector<uint8_t> ReadFrame(int32_t width, int32_t height);

// The first pending GL error, 0 when there is none; clears all pending errors.
uint32_t TakeGlError();

}  // namespace ovo_sample

#endif
