#include "frame_compare.h"

#include <cstdlib>

namespace ovo_frames {

FrameDifference CompareFrames(const RgbaFrame& a, const RgbaFrame& b, int32_t tolerance) {
    FrameDifference difference;
    for (int32_t y = 0; y < a.m_height; ++y) {
        for (int32_t x = 0; x < a.m_width; ++x) {
            int32_t largest = 0;
            for (size_t channel = 0; channel < FRAME_PIXEL_BYTES; ++channel) {
                const int32_t delta = std::abs(a.At(x, y)[channel] - b.At(x, y)[channel]);
                if (delta > largest) largest = delta;
            }
            if (largest > difference.m_largest) difference.m_largest = largest;
            if (largest <= tolerance) continue;
            if (difference.m_differing_pixels == 0) {
                difference.m_first_x = x;
                difference.m_first_y = y;
            }
            ++difference.m_differing_pixels;
        }
    }
    return difference;
}

}  // namespace ovo_frames
