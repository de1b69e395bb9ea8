#ifndef OVO_TOOLS_OVO_FRAMES_DISPARITY_MAP_H
#define OVO_TOOLS_OVO_FRAMES_DISPARITY_MAP_H

#include "block_match.h"
#include "disparity_summary.h"

namespace ovo_frames {

// Grey levels of the map: the nearest block white, the farthest dark grey (not black, so
// that it stays apart from the unknown blocks' colour), linear in between.
constexpr uint8_t DISPARITY_MAP_NEAREST_LEVEL = 255;
constexpr uint8_t DISPARITY_MAP_FARTHEST_LEVEL = 48;
constexpr uint8_t DISPARITY_MAP_UNKNOWN_RGB[3] = {255, 0, 255};

// The field as an opaque picture of the frame it came from: each block filled with its
// level, disparities beyond `range` (the percentiles leave a few out) taking the end's
// level, and each eye pixel two columns wide, so the map is the interleaved frame's size
// (2 x image width by image height). When the range is a single disparity every known block
// is white.
RgbaFrame DisparityMapImage(const DisparityField& field, const DisparityRange& range);

}  // namespace ovo_frames

#endif
