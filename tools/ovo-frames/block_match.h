#ifndef OVO_TOOLS_OVO_FRAMES_BLOCK_MATCH_H
#define OVO_TOOLS_OVO_FRAMES_BLOCK_MATCH_H

#include <algorithm>
#include <vector>

#include "rgba_frame.h"

// Horizontal block matching of one image against another: how far each part of one image
// lies to the left or right in the other. Costs and levels are mean absolute differences
// per colour channel (red, green, blue; 0 to 255); alpha is left out.
namespace ovo_frames {

constexpr int32_t BLOCK_MATCH_DEFAULT_BLOCK = 16;
constexpr int32_t BLOCK_MATCH_DEFAULT_MAX_SHIFT = 32;

// Where column x of the `from` image lies among the columns of the `to` image before any
// shift: at m_stride * x + m_phase. {1, 0} compares two images of the same size; {2, p}
// compares an eye's image with the full-resolution frame whose columns of parity p it was
// shown on. `to` is m_stride times as wide as `from`, and 0 <= m_phase < m_stride.
struct ColumnMapping {
    int32_t m_stride = 1;
    int32_t m_phase = 0;
};

struct BlockMatchOptions {
    int32_t m_block_size = BLOCK_MATCH_DEFAULT_BLOCK;
    // Shifts from -m_max_shift to +m_max_shift are tried, in columns of `to`; at least 1.
    int32_t m_max_shift = BLOCK_MATCH_DEFAULT_MAX_SHIFT;
    ColumnMapping m_to_columns;
    // The best cost must stay at or below this fraction of the runner-up's (the lowest cost
    // outside the valley around the best) and below it by at least m_min_margin levels.
    // Otherwise the region is flat (every shift matches it about equally well) or a
    // repeating pattern or noise chose the shift.
    float m_max_runner_up_ratio = 0.6f;
    float m_min_margin = 1.0f;
};

struct ShiftEstimate {
    // False for a flat or ambiguous region, when the best whole shift is the last one that
    // could be tried (the true one may lie beyond), and when the best shift leaves part of
    // the region outside `to` and the part inside, matched on its own, is flat, ambiguous
    // or best more than a column away (a flat half matches any flat place): m_shift then
    // means nothing.
    bool m_known = false;
    // In columns of `to`: `from`'s column x matches `to` at m_stride * x + m_phase + m_shift
    // (x_to - x_from for images of the same size). The best whole shift, refined below a
    // column from its cost and its two neighbours' when the region is known and `to` read
    // at the refined shift matches better (lines a pixel wide match at a whole shift only).
    float m_shift = 0.0f;
    // RegionCost at m_shift.
    float m_cost = 0.0f;
};

// A rectangle of pixels of one image.
struct ImageRegion {
    int32_t m_x;
    int32_t m_y;
    int32_t m_width;
    int32_t m_height;
};

// Blocks tile the `from` image from the top left; those on the right and bottom edges may
// be smaller.
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

    ImageRegion BlockAt(int32_t column, int32_t row) const {
        return {column * m_block_size, row * m_block_size, std::min(m_block_size, m_image_width - column * m_block_size),
                std::min(m_block_size, m_image_height - row * m_block_size)};
    }
};

// The mean absolute difference per channel between `from` over `region` and `to` at each
// column's mapped place plus `shift` (columns of `to`), read linearly between the two
// nearest columns of `to` when the shift has a fraction. Only the columns that land inside
// `to` count; infinite when fewer than half of the region's columns do.
float RegionCost(const RgbaFrame& from, const RgbaFrame& to, const ImageRegion& region, const ColumnMapping& columns,
                 float shift);

// For each block of `from`, the whole shift s (|s| <= max shift) at which `to` matches it
// best by RegionCost, then refined. Near the image's sides only the shifts that keep at
// least half of the block's columns inside `to` are tried, over those columns. With `from`
// eye 0, `to` eye 1 and the mapping {1, 0} the shift is x_eye1 - x_eye0 between the
// de-interleaved images (see screen_disparity.h for the disparity on the screen). Heights
// that differ, a width of `to` that the mapping does not give, or a block size or max shift
// below 1 give a field without blocks.
DisparityField MatchBlocks(const RgbaFrame& from, const RgbaFrame& to, const BlockMatchOptions& options);

// The same for bands of `band_rows` rows (the last may be shorter) across the whole width,
// top first: one shift per band, options.m_block_size unused. Empty on the input that gives
// MatchBlocks no blocks, or when band_rows is below 1.
std::vector<ShiftEstimate> MatchBands(const RgbaFrame& from, const RgbaFrame& to, int32_t band_rows,
                                      const BlockMatchOptions& options);

}  // namespace ovo_frames

#endif
