#ifndef OVO_TOOLS_OVO_FRAMES_EYE_COMPENSATION_H
#define OVO_TOOLS_OVO_FRAMES_EYE_COMPENSATION_H

#include <vector>

#include "block_match.h"
#include "column_ops.h"

// How well one eye's image, each block moved back by its own shift, reproduces the game's
// flat frame of the same content at full resolution. A depth shift that only moves things
// sideways leaves small residuals; one that also changed what is drawn leaves large ones.
// The eye is compared with every column of the flat frame, not only with those of its own
// parity: content that moved by an odd number of screen pixels (a one-pixel line of a grid
// or of text) now lies on the eye's columns although the flat frame had it on the others.
namespace ovo_frames {

// Leaves out the worst 5 % of blocks, where content at a depth edge is seen by one image
// only.
constexpr float COMPENSATION_HIGH_PERCENTILE = 95.0f;

struct CompensationSummary {
    // Per block of the eye: x_eye - x_native in screen pixels, where the eye's pixel x lies
    // on screen column 2x + parity.
    DisparityField m_shifts;
    // Per block, the same order: the mean absolute difference per channel between the eye's
    // block moved back by its shift and the flat frame (its ShiftEstimate::m_cost). A known
    // block is moved by its refined shift (the flat frame read linearly between columns) or
    // its best whole shift, whichever leaves less; an unknown one (flat, or ambiguous) by its
    // best whole shift, so a flat block of the right colour leaves nothing and one of the
    // wrong colour leaves its difference.
    // Content of the flat frame that is missing from the eye shows only where the eye has
    // something else that the flat frame lacks.
    std::vector<float> m_residuals;
    float m_residual_mean = 0.0f;
    // The COMPENSATION_HIGH_PERCENTILE-th percentile of the blocks' residuals.
    float m_residual_high = 0.0f;
    float m_residual_worst = 0.0f;
    float m_unknown_fraction = 0.0f;
};

// `eye` is the image shown on the screen columns of `eye_columns` ((W / 2) x H) and
// `native` the flat frame (W x H). options.m_max_shift is in screen pixels; the column
// mapping of the options is replaced by the eye's. Other sizes, as for MatchBlocks's bad
// input, give a summary without blocks and every figure 0.
CompensationSummary MeasureCompensation(const RgbaFrame& eye, const RgbaFrame& native, ColumnParity eye_columns,
                                        const BlockMatchOptions& options);

}  // namespace ovo_frames

#endif
