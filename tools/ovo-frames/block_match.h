#ifndef OVO_TOOLS_OVO_FRAMES_BLOCK_MATCH_H
#define OVO_TOOLS_OVO_FRAMES_BLOCK_MATCH_H

#include <vector>

#include "rgba_frame.h"

// Horizontal block matching between two images of the same size: how far each part of one
// image lies to the left or right in the other. Costs and levels are mean absolute
// differences per colour channel (red, green, blue; 0 to 255); alpha is left out.
namespace ovo_frames {

constexpr int32_t BLOCK_MATCH_DEFAULT_BLOCK = 16;
constexpr int32_t BLOCK_MATCH_DEFAULT_MAX_SHIFT = 32;

struct BlockMatchOptions {
    int32_t m_block_size = BLOCK_MATCH_DEFAULT_BLOCK;
    // Shifts from -m_max_shift to +m_max_shift are tried; at least 1.
    int32_t m_max_shift = BLOCK_MATCH_DEFAULT_MAX_SHIFT;
    // The best cost must stay at or below this fraction of the runner-up's (the lowest cost
    // outside the valley around the best) and below it by at least m_min_margin levels.
    // Otherwise the region is flat (every shift matches it about equally well) or a
    // repeating pattern or noise chose the shift.
    float m_max_runner_up_ratio = 0.6f;
    float m_min_margin = 1.0f;
};

struct ShiftEstimate {
    // False for a flat or ambiguous region, and when the best whole shift is the last one
    // that could be tried (the true one may lie beyond): m_shift then means nothing.
    bool m_known = false;
    // x_to - x_from in pixels, refined below a pixel from the costs of the best whole shift
    // and its two neighbours.
    float m_shift = 0.0f;
    // The cost at the best whole shift.
    float m_best_cost = 0.0f;
};

// Blocks tile the image from the top left; those on the right and bottom edges may be
// smaller.
struct DisparityField {
    int32_t m_block_size = 0;
    int32_t m_columns = 0;
    int32_t m_rows = 0;
    int32_t m_image_width = 0;
    int32_t m_image_height = 0;
    // Rows of blocks top first, each left to right.
    std::vector<ShiftEstimate> m_blocks;

    const ShiftEstimate& At(int32_t column, int32_t row) const {
        return m_blocks[static_cast<size_t>(row) * static_cast<size_t>(m_columns) + static_cast<size_t>(column)];
    }
};

// For each block of `from`, the shift s (|s| <= max shift) for which `to` at x + s matches
// `from` at x best, by the sum of absolute differences. Near the image's sides only the
// shifts that keep at least half of the block's columns inside `to` are tried, over those
// columns. With `from` eye 0 and `to` eye 1 the shift is the disparity x_eye1 - x_eye0.
// Images of different sizes, or a block size or max shift below 1, give a field without
// blocks.
DisparityField MatchBlocks(const RgbaFrame& from, const RgbaFrame& to, const BlockMatchOptions& options);

// The same for bands of `band_rows` rows (the last may be shorter) across the whole width,
// top first: one shift per band, options.m_block_size unused. Empty on the input that gives
// MatchBlocks no blocks, or when band_rows is below 1.
std::vector<ShiftEstimate> MatchBands(const RgbaFrame& from, const RgbaFrame& to, int32_t band_rows,
                                      const BlockMatchOptions& options);

}  // namespace ovo_frames

#endif
