#include "stereo_frame_checks.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "block_match.h"
#include "column_ops.h"
#include "disparity_summary.h"
#include "eye_compensation.h"
#include "screen_disparity.h"

namespace {

using ovo_frames::RgbaFrame;

// Measured shifts are refined below a pixel from three matching costs, and a block or band
// that holds several depths settles between them.
constexpr float SHIFT_TOLERANCE = 0.5f;
// A 3D scene must show at least this much disparity in its farthest blocks: a frame whose
// eyes match everywhere within a pixel was not drawn in stereo.
constexpr float DEPTH_VISIBLE = 1.0f;
// Bands of rows, each matched across the whole width.
constexpr int32_t BAND_ROWS = 32;
// Each eye, block by block moved back, against the native frame at full resolution: mean
// absolute difference per channel (0 to 255). What only moved sideways leaves a level
// or two where edges fall between columns; a missing object, a black eye or a changed
// colour leaves tens of levels over whole blocks. The high percentile leaves out the 5 % of
// blocks at depth edges, which one image sees and the other does not.
constexpr float RESIDUAL_MEAN_LIMIT = 2.0f;
constexpr float RESIDUAL_HIGH_LIMIT = 12.0f;
// An eye's brightness against the native frame's: an eye that lost its objects, or went
// black, is darker by far more.
constexpr float BRIGHTNESS_RATIO_LIMIT = 0.1f;
// Of the blocks that both eyes matched, the share at each end that may match wrongly.
constexpr float DISPARITY_OUTLIER_PERCENT = 2.0f;

float EyeShift(int eye, float eye_distance, float eye_angle, float depth) {
    return eye == 0 ? eye_distance * std::min(eye_angle - depth, 0.0f)
                    : -eye_distance * std::min(-eye_angle - depth, 0.0f);
}

// Over every depth of clip space: the extremes of a function that is linear between the
// depths listed.
template <typename Shift>
ShiftSpan SpanOver(float eye_angle, float eye_pixels_per_unit, Shift shift) {
    ShiftSpan span = {shift(-1.0f), shift(-1.0f)};
    for (float depth : {1.0f, eye_angle, -eye_angle}) {
        const float value = shift(std::clamp(depth, -1.0f, 1.0f));
        span.m_lowest = std::min(span.m_lowest, value);
        span.m_highest = std::max(span.m_highest, value);
    }
    return {span.m_lowest * eye_pixels_per_unit, span.m_highest * eye_pixels_per_unit};
}

float MeanLevel(const RgbaFrame& frame) {
    double sum = 0.0;
    for (size_t i = 0; i < frame.m_pixels.size(); i += ovo_frames::FRAME_PIXEL_BYTES) {
        sum += frame.m_pixels[i] + frame.m_pixels[i + 1] + frame.m_pixels[i + 2];
    }
    const size_t pixels = frame.m_pixels.size() / ovo_frames::FRAME_PIXEL_BYTES;
    return pixels == 0 ? 0.0f : static_cast<float>(sum / (3.0 * static_cast<double>(pixels)));
}

void ExpectWithin(float shift, const ShiftSpan& span, const char* what) {
    EXPECT_GE(shift, span.m_lowest - SHIFT_TOLERANCE) << what;
    EXPECT_LE(shift, span.m_highest + SHIFT_TOLERANCE) << what;
}

// One eye, shown on `columns`, against the native frame: moved only sideways, and only as
// far as the profile lets it.
ovo_frames::CompensationSummary ExpectEyeMatchesNative(const RgbaFrame& eye, const RgbaFrame& native,
                                                       ovo_frames::ColumnParity columns, const ShiftSpan& span,
                                                       const char* which) {
    SCOPED_TRACE(which);
    // Shifts in screen pixels, as far as an eye pixel search would reach.
    ovo_frames::BlockMatchOptions on_screen;
    on_screen.m_max_shift *= ovo_frames::EYE_PIXEL_SCREEN_COLUMNS;
    ovo_frames::CompensationSummary summary = ovo_frames::MeasureCompensation(eye, native, columns, on_screen);
    for (ovo_frames::ShiftEstimate& block : summary.m_shifts.m_blocks) {
        block.m_shift /= ovo_frames::EYE_PIXEL_SCREEN_COLUMNS;
        if (block.m_known) ExpectWithin(block.m_shift, span, "a block against the native frame");
    }
    EXPECT_LE(summary.m_residual_mean, RESIDUAL_MEAN_LIMIT);
    EXPECT_LE(summary.m_residual_high, RESIDUAL_HIGH_LIMIT);
    const float level = MeanLevel(native);
    EXPECT_NEAR(MeanLevel(eye), level, std::max(1.0f, level * BRIGHTNESS_RATIO_LIMIT));
    return summary;
}

// Block by block, eye 1's shift from the native frame less eye 0's.
std::vector<float> Disparities(const ovo_frames::CompensationSummary& eye0,
                               const ovo_frames::CompensationSummary& eye1) {
    std::vector<float> disparities;
    for (size_t i = 0; i < eye0.m_shifts.m_blocks.size() && i < eye1.m_shifts.m_blocks.size(); ++i) {
        const ovo_frames::ShiftEstimate& left = eye0.m_shifts.m_blocks[i];
        const ovo_frames::ShiftEstimate& right = eye1.m_shifts.m_blocks[i];
        if (left.m_known && right.m_known) disparities.push_back(right.m_shift - left.m_shift);
    }
    return disparities;
}

}  // namespace

DisparityPrediction PredictDisparity(float eye_distance, float eye_angle, int window_width) {
    const float eye_pixels_per_unit = static_cast<float>(window_width) / 4.0f;
    DisparityPrediction prediction{};
    for (int eye = 0; eye < 2; ++eye) {
        prediction.m_eyes[eye] = SpanOver(eye_angle, eye_pixels_per_unit, [&](float depth) {
            return EyeShift(eye, eye_distance, eye_angle, depth);
        });
    }
    prediction.m_disparity = SpanOver(eye_angle, eye_pixels_per_unit, [&](float depth) {
        return EyeShift(1, eye_distance, eye_angle, depth) - EyeShift(0, eye_distance, eye_angle, depth);
    });
    return prediction;
}

void ExpectStereoFrame(const RgbaFrame& native, const RgbaFrame& stereo, SceneDepth depth,
                       const DisparityPrediction& prediction) {
    ASSERT_EQ(stereo.m_width, native.m_width);
    ASSERT_EQ(stereo.m_height, native.m_height);
    const ovo_frames::EyeImages eyes = ovo_frames::Deinterleave(stereo, ovo_frames::COLUMN_PARITY_EVEN);

    // The eyes against each other, band by band across the whole width.
    for (const ovo_frames::ShiftEstimate& band : ovo_frames::MeasureScreenDisparityBands(
             stereo, ovo_frames::COLUMN_PARITY_EVEN, BAND_ROWS, ovo_frames::BlockMatchOptions())) {
        if (band.m_known) ExpectWithin(band.m_shift, prediction.m_disparity, "a band of rows");
    }

    const ovo_frames::CompensationSummary eye0 = ExpectEyeMatchesNative(
        eyes.m_eye0, native, ovo_frames::COLUMN_PARITY_EVEN, prediction.m_eyes[0], "eye 0");
    const ovo_frames::CompensationSummary eye1 = ExpectEyeMatchesNative(
        eyes.m_eye1, native, ovo_frames::COLUMN_PARITY_ODD, prediction.m_eyes[1], "eye 1");
    const std::vector<float> disparities = Disparities(eye0, eye1);
    const float nearest = ovo_frames::PercentileOf(disparities, DISPARITY_OUTLIER_PERCENT);
    const float farthest = ovo_frames::PercentileOf(disparities, 100.0f - DISPARITY_OUTLIER_PERCENT);
    if (depth == SCENE_DEPTH_3D) {
        EXPECT_GE(farthest, DEPTH_VISIBLE) << "a 3D scene without depth";
    } else {
        EXPECT_LE(std::max(std::abs(nearest), std::abs(farthest)), SHIFT_TOLERANCE) << "a flat scene with depth";
    }
}
