#include "eye_compensation.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "disparity_summary.h"

namespace ovo_frames {

namespace {

constexpr int32_t RGB_CHANNELS = 3;

// The mean absolute difference per channel between `eye` over a block and `reference` at
// x + shift, read linearly between its two nearest columns; infinite when no column of the
// block has both inside `reference`.
float ResidualAtShift(const RgbaFrame& eye, const RgbaFrame& reference, int32_t column, int32_t row,
                      int32_t block_size, float shift) {
    const int32_t first_x = column * block_size;
    const int32_t end_x = std::min(first_x + block_size, eye.m_width);
    const int32_t end_y = std::min((row + 1) * block_size, eye.m_height);
    const auto whole = static_cast<int32_t>(std::floor(shift));
    const float fraction = shift - static_cast<float>(whole);
    double sum = 0.0;
    int64_t samples = 0;
    for (int32_t y = row * block_size; y < end_y; ++y) {
        for (int32_t x = first_x; x < end_x; ++x) {
            const int32_t left = x + whole;
            if (left < 0 || left + 1 >= reference.m_width) continue;
            const uint8_t* seen = eye.At(x, y);
            const uint8_t* a = reference.At(left, y);
            const uint8_t* b = reference.At(left + 1, y);
            for (int32_t channel = 0; channel < RGB_CHANNELS; ++channel) {
                const float sample = (1.0f - fraction) * a[channel] + fraction * b[channel];
                sum += std::fabs(seen[channel] - sample);
            }
            samples += RGB_CHANNELS;
        }
    }
    if (samples == 0) return std::numeric_limits<float>::infinity();
    return static_cast<float>(sum / static_cast<double>(samples));
}

}  // namespace

CompensationSummary MeasureCompensation(const RgbaFrame& eye, const RgbaFrame& reference,
                                        const BlockMatchOptions& options) {
    CompensationSummary summary;
    // Every part of the eye must be found in the reference, so the blocks tile the eye: a
    // block of the reference could shift away from a fault of the eye.
    summary.m_shifts = MatchBlocks(eye, reference, options);
    DisparityField& field = summary.m_shifts;
    if (field.m_blocks.empty()) return summary;
    int32_t unknown = 0;
    double total = 0.0;
    for (int32_t row = 0; row < field.m_rows; ++row) {
        for (int32_t column = 0; column < field.m_columns; ++column) {
            ShiftEstimate& block = field.m_blocks[static_cast<size_t>(row * field.m_columns + column)];
            float residual = block.m_best_cost;
            if (block.m_known) {
                residual = std::min(residual, ResidualAtShift(eye, reference, column, row, field.m_block_size, block.m_shift));
            } else {
                ++unknown;
            }
            // Matched as x_reference - x_eye.
            block.m_shift = -block.m_shift;
            summary.m_residuals.push_back(residual);
            total += residual;
        }
    }
    const auto blocks = static_cast<float>(field.m_blocks.size());
    summary.m_residual_mean = static_cast<float>(total / blocks);
    summary.m_residual_high = PercentileOf(summary.m_residuals, COMPENSATION_HIGH_PERCENTILE);
    summary.m_residual_worst = *std::max_element(summary.m_residuals.begin(), summary.m_residuals.end());
    summary.m_unknown_fraction = static_cast<float>(unknown) / blocks;
    return summary;
}

}  // namespace ovo_frames
