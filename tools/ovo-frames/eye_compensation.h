#ifndef OVO_TOOLS_OVO_FRAMES_EYE_COMPENSATION_H
#define OVO_TOOLS_OVO_FRAMES_EYE_COMPENSATION_H

#include <vector>

#include "block_match.h"

// How well one eye's image, each block moved back by its own shift, reproduces a reference
// of the same content: the game's flat frame, sampled on that eye's columns. A depth shift
// that only moves things sideways leaves small residuals; one that also changed what is
// drawn leaves large ones.
namespace ovo_frames {

// Leaves out the worst 5 % of blocks, where content at a depth edge is seen by one image
// only.
constexpr float COMPENSATION_HIGH_PERCENTILE = 95.0f;

struct CompensationSummary {
    // Per block of the eye: x_eye - x_reference.
    DisparityField m_shifts;
    // Per block, the same order: the mean absolute difference per channel between the eye's
    // block moved back and the reference. A known block is moved by its refined shift (the
    // reference read linearly between columns) or its best whole shift, whichever leaves
    // less; an unknown one (flat, or ambiguous) by its best whole shift, so a flat block of
    // the right colour leaves nothing and one of the wrong colour leaves its difference.
    // Content of the reference that is missing from the eye shows only where the eye has
    // something else that the reference lacks.
    std::vector<float> m_residuals;
    float m_residual_mean = 0.0f;
    // The COMPENSATION_HIGH_PERCENTILE-th percentile of the blocks' residuals.
    float m_residual_high = 0.0f;
    float m_residual_worst = 0.0f;
    float m_unknown_fraction = 0.0f;
};

// `eye` and `reference` have the same size; otherwise, as for MatchBlocks's bad input, the
// summary has no blocks and every figure is 0.
CompensationSummary MeasureCompensation(const RgbaFrame& eye, const RgbaFrame& reference,
                                        const BlockMatchOptions& options);

}  // namespace ovo_frames

#endif
