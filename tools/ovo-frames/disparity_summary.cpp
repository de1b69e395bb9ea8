#include "disparity_summary.h"

#include <algorithm>
#include <cmath>

namespace ovo_frames {

namespace {

std::vector<float> KnownShifts(const DisparityField& field) {
    std::vector<float> shifts;
    for (const ShiftEstimate& block : field.m_blocks) {
        if (block.m_known) shifts.push_back(block.m_shift);
    }
    return shifts;
}

}  // namespace

float PercentileOf(std::vector<float> values, float percent) {
    if (values.empty()) return 0.0f;
    const float clamped = std::clamp(percent, 0.0f, 100.0f);
    const auto index = static_cast<size_t>(std::lround(clamped / 100.0f * static_cast<float>(values.size() - 1)));
    std::nth_element(values.begin(), values.begin() + static_cast<std::ptrdiff_t>(index), values.end());
    return values[index];
}

DisparityRange MeasureRange(const DisparityField& field, float outlier_percent) {
    std::vector<float> shifts = KnownShifts(field);
    DisparityRange range;
    range.m_known_blocks = static_cast<int32_t>(shifts.size());
    range.m_unknown_blocks = static_cast<int32_t>(field.m_blocks.size() - shifts.size());
    range.m_nearest = PercentileOf(shifts, outlier_percent);
    range.m_farthest = PercentileOf(std::move(shifts), 100.0f - outlier_percent);
    return range;
}

float PercentOfWidth(float pixels, int32_t width) {
    return width > 0 ? 100.0f * pixels / static_cast<float>(width) : 0.0f;
}

DisparityHistogram HistogramOf(const DisparityField& field) {
    std::vector<int32_t> bins;
    for (float shift : KnownShifts(field)) bins.push_back(static_cast<int32_t>(std::lround(shift)));
    DisparityHistogram histogram;
    if (bins.empty()) return histogram;
    const auto [lowest, highest] = std::minmax_element(bins.begin(), bins.end());
    histogram.m_lowest = *lowest;
    histogram.m_counts.assign(static_cast<size_t>(*highest - *lowest + 1), 0);
    for (int32_t bin : bins) ++histogram.m_counts[static_cast<size_t>(bin - histogram.m_lowest)];
    return histogram;
}

ComfortVerdict CheckComfort(const DisparityRange& range, int32_t eye_width, const ComfortBudget& budget) {
    ComfortVerdict verdict;
    if (range.m_known_blocks == 0) return verdict;
    verdict.m_too_near = PercentOfWidth(range.m_nearest, eye_width) < -budget.m_near_percent;
    verdict.m_too_far = PercentOfWidth(range.m_farthest, eye_width) > budget.m_far_percent;
    return verdict;
}

}  // namespace ovo_frames
