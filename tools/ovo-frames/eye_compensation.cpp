#include "eye_compensation.h"

#include <algorithm>

#include "disparity_summary.h"
#include "screen_disparity.h"

namespace ovo_frames {

CompensationSummary MeasureCompensation(const RgbaFrame& eye, const RgbaFrame& native, ColumnParity eye_columns,
                                        const BlockMatchOptions& options) {
    CompensationSummary summary;
    BlockMatchOptions on_screen = options;
    on_screen.m_to_columns = EyeScreenColumns(eye_columns);
    // Every part of the eye must be found in the flat frame, so the blocks tile the eye: a
    // block of the flat frame could shift away from a fault of the eye.
    summary.m_shifts = MatchBlocks(eye, native, on_screen);
    DisparityField& field = summary.m_shifts;
    if (field.m_blocks.empty()) return summary;
    int32_t unknown = 0;
    double total = 0.0;
    for (ShiftEstimate& block : field.m_blocks) {
        if (!block.m_known) ++unknown;
        // Matched as x_native - x_eye.
        block.m_shift = -block.m_shift;
        // The block moved back by its shift.
        summary.m_residuals.push_back(block.m_cost);
        total += block.m_cost;
    }
    const auto blocks = static_cast<float>(field.m_blocks.size());
    summary.m_residual_mean = static_cast<float>(total / blocks);
    summary.m_residual_high = PercentileOf(summary.m_residuals, COMPENSATION_HIGH_PERCENTILE);
    summary.m_residual_worst = *std::max_element(summary.m_residuals.begin(), summary.m_residuals.end());
    summary.m_unknown_fraction = static_cast<float>(unknown) / blocks;
    return summary;
}

}  // namespace ovo_frames
