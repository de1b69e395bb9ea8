#include "disparity_map.h"

#include <algorithm>
#include <cmath>

namespace ovo_frames {

namespace {

uint8_t Level(float disparity, const DisparityRange& range) {
    const float span = range.m_farthest - range.m_nearest;
    if (span <= 0.0f) return DISPARITY_MAP_NEAREST_LEVEL;
    const float depth = std::clamp((disparity - range.m_nearest) / span, 0.0f, 1.0f);
    const float level = DISPARITY_MAP_NEAREST_LEVEL + depth * (DISPARITY_MAP_FARTHEST_LEVEL - DISPARITY_MAP_NEAREST_LEVEL);
    return static_cast<uint8_t>(std::lround(level));
}

}  // namespace

RgbaFrame DisparityMapImage(const DisparityField& field, const DisparityRange& range) {
    RgbaFrame map(2 * field.m_image_width, field.m_image_height);
    if (field.m_block_size < 1) return map;
    for (int32_t y = 0; y < map.m_height; ++y) {
        for (int32_t x = 0; x < map.m_width; ++x) {
            const ShiftEstimate& block = field.At(x / 2 / field.m_block_size, y / field.m_block_size);
            uint8_t* pixel = map.At(x, y);
            if (block.m_known) {
                pixel[0] = pixel[1] = pixel[2] = Level(block.m_shift, range);
            } else {
                std::copy(DISPARITY_MAP_UNKNOWN_RGB, DISPARITY_MAP_UNKNOWN_RGB + 3, pixel);
            }
            pixel[3] = 255;
        }
    }
    return map;
}

}  // namespace ovo_frames
