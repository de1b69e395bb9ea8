#ifndef OVO_TOOLS_OVO_FRAMES_FRAME_COMPARE_H
#define OVO_TOOLS_OVO_FRAMES_FRAME_COMPARE_H

#include "rgba_frame.h"

namespace ovo_frames {

struct FrameDifference {
    int64_t m_differing_pixels = 0;
    // The largest difference of one channel, over every pixel.
    int32_t m_largest = 0;
    // The first differing pixel in row order; meaningful when m_differing_pixels > 0.
    int32_t m_first_x = 0;
    int32_t m_first_y = 0;
};

// Pixels of two same-sized frames that differ in some channel (alpha included) by more
// than `tolerance`.
FrameDifference CompareFrames(const RgbaFrame& a, const RgbaFrame& b, int32_t tolerance);

}  // namespace ovo_frames

#endif
