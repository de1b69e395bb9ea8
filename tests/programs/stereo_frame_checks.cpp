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
// Above this level a pixel counts as covered by the scene (SCENE_3D_SCREEN_COLOURED).
constexpr uint8_t COVERAGE_LEVEL = 16;
// Where the screen-placed colour is dark at an end of a row, the covered part starts
// elsewhere in each image: the rows' ends at each extreme that may show that, not a move.
constexpr float OUTLINE_OUTLIER_PERCENT = 5.0f;

// What each kind of scene must show. Residuals: each eye, block by block moved back,
// against the native frame at full resolution, as the mean absolute difference per channel
// (0 to 255) over the frame and at the 95th percentile of blocks (leaving out the blocks at
// depth edges, which one image sees and the other does not). What only moved sideways
// leaves a level or two where edges fall between pixels; a missing object, a black eye or
// a changed colour leaves tens of levels over whole blocks. The limits sit above the
// largest seen over every program of the kind.
struct SceneChecks {
    SceneKind m_scene;
    bool m_has_depth;
    bool m_compares_outline;  // the geometry's outline instead of its colours
    float m_residual_mean_limit;
    float m_residual_high_limit;
    // Beyond SHIFT_TOLERANCE, in eye pixels, where the scene's things land on whole pixels.
    float m_placement_tolerance;
};

const SceneChecks SCENE_CHECKS[] = {
    // Largest seen: 1.7 and 11.0 (glmark2's refract).
    {SCENE_3D, true, false, 2.0f, 12.0f, 0.0f},
    // Largest seen: 3.3 and 19.1 (glmark2's buffer scenes).
    {SCENE_3D_THIN_LINES, true, false, 4.0f, 24.0f, 0.0f},
    // The outline, whose residuals are not looked at. An eye sees every second screen
    // column: an outline's end lands up to one column, half an eye pixel, off.
    {SCENE_3D_SCREEN_COLOURED, true, true, 0.0f, 0.0f, 0.5f},
    {SCENE_OFFSCREEN, false, false, 2.0f, 12.0f, 0.0f},
    {SCENE_FLAT, false, false, 2.0f, 12.0f, 0.0f},
    // Points are placed on whole screen pixels: each eye up to one screen column, half an
    // eye pixel, from where the shift puts it.
    {SCENE_ES1_FLAT, true, false, 2.0f, 12.0f, 0.5f},
};

// An eye's brightness against the native frame's: an eye that lost its objects, or went
// black, is darker by far more.
constexpr float BRIGHTNESS_RATIO_LIMIT = 0.1f;
// Of the blocks that both eyes matched, the share at each end that may match wrongly.
constexpr float DISPARITY_OUTLIER_PERCENT = 2.0f;

const SceneChecks& ChecksOf(SceneKind scene) {
    for (const SceneChecks& checks : SCENE_CHECKS) {
        if (checks.m_scene == scene) return checks;
    }
    return SCENE_CHECKS[0];
}

bool Covered(const uint8_t* pixel) { return std::max({pixel[0], pixel[1], pixel[2]}) > COVERAGE_LEVEL; }

// Of each row, the first and the last screen column that the scene covers, or -1 for a
// row it leaves empty. Pixel x of `image` lies on screen column stride x + phase.
std::vector<std::pair<int32_t, int32_t>> RowExtents(const RgbaFrame& image, int32_t stride, int32_t phase) {
    std::vector<std::pair<int32_t, int32_t>> extents(static_cast<size_t>(image.m_height), {-1, -1});
    for (int32_t y = 0; y < image.m_height; ++y) {
        for (int32_t x = 0; x < image.m_width; ++x) {
            if (!Covered(image.At(x, y))) continue;
            const int32_t column = stride * x + phase;
            if (extents[y].first < 0) extents[y].first = column;
            extents[y].second = column;
        }
    }
    return extents;
}

// How far an eye moved the outline of what the scene covers, row by row, against the
// native frame: the shifts of each row's left and right end, in eye pixels.
std::vector<float> OutlineShifts(const RgbaFrame& eye, ovo_frames::ColumnParity columns, const RgbaFrame& native) {
    const auto moved = RowExtents(eye, ovo_frames::EYE_PIXEL_SCREEN_COLUMNS, columns);
    const auto still = RowExtents(native, 1, 0);
    std::vector<float> shifts;
    for (size_t row = 0; row < moved.size() && row < still.size(); ++row) {
        if (moved[row].first < 0 || still[row].first < 0) continue;
        for (const int32_t delta : {moved[row].first - still[row].first, moved[row].second - still[row].second}) {
            shifts.push_back(static_cast<float>(delta) / ovo_frames::EYE_PIXEL_SCREEN_COLUMNS);
        }
    }
    return shifts;
}

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

RgbaFrame EvenWidth(const RgbaFrame& frame) {
    if (frame.m_width % 2 == 0) return frame;
    RgbaFrame even(frame.m_width - 1, frame.m_height);
    for (int32_t y = 0; y < frame.m_height; ++y) {
        std::copy_n(frame.At(0, y), static_cast<size_t>(even.m_width) * ovo_frames::FRAME_PIXEL_BYTES, even.At(0, y));
    }
    return even;
}

void ExpectWithin(float shift, const ShiftSpan& span, const char* what, float tolerance = SHIFT_TOLERANCE) {
    EXPECT_GE(shift, span.m_lowest - tolerance) << what;
    EXPECT_LE(shift, span.m_highest + tolerance) << what;
}

// No black eye, nothing gone: an eye is about as bright as the native frame.
void ExpectAsBright(const RgbaFrame& eye, const RgbaFrame& native) {
    const float level = MeanLevel(native);
    EXPECT_NEAR(MeanLevel(eye), level, std::max(1.0f, level * BRIGHTNESS_RATIO_LIMIT)) << "brightness";
}

// One eye, shown on `columns`, against the native frame: moved only sideways, and only as
// far as the profile lets it. The known blocks' shifts, in eye pixels.
std::vector<float> ExpectEyeMatchesNative(const RgbaFrame& eye, const RgbaFrame& native,
                                          ovo_frames::ColumnParity columns, const ShiftSpan& span,
                                          const SceneChecks& checks) {
    // Shifts in screen pixels, as far as an eye pixel search would reach.
    ovo_frames::BlockMatchOptions on_screen;
    on_screen.m_max_shift *= ovo_frames::EYE_PIXEL_SCREEN_COLUMNS;
    const ovo_frames::CompensationSummary summary = ovo_frames::MeasureCompensation(eye, native, columns, on_screen);
    std::vector<float> shifts;
    for (const ovo_frames::ShiftEstimate& block : summary.m_shifts.m_blocks) {
        if (!block.m_known) continue;
        shifts.push_back(block.m_shift / ovo_frames::EYE_PIXEL_SCREEN_COLUMNS);
        ExpectWithin(shifts.back(), span, "a block against the native frame",
                     SHIFT_TOLERANCE + checks.m_placement_tolerance);
    }
    EXPECT_LE(summary.m_residual_mean, checks.m_residual_mean_limit) << "residual";
    EXPECT_LE(summary.m_residual_high, checks.m_residual_high_limit) << "residual";
    ExpectAsBright(eye, native);
    return shifts;
}

// The same by the outline of what the scene covers, for scenes whose colours stay where
// the screen puts them. The outline ends' shifts, in eye pixels.
std::vector<float> ExpectOutlineMatchesNative(const RgbaFrame& eye, const RgbaFrame& native,
                                              ovo_frames::ColumnParity columns, const ShiftSpan& span,
                                              const SceneChecks& checks) {
    const std::vector<float> shifts = OutlineShifts(eye, columns, native);
    EXPECT_FALSE(shifts.empty()) << "nothing covered";
    for (float percent : {OUTLINE_OUTLIER_PERCENT, 100.0f - OUTLINE_OUTLIER_PERCENT}) {
        ExpectWithin(ovo_frames::PercentileOf(shifts, percent), span, "the ends of the outline",
                     SHIFT_TOLERANCE + checks.m_placement_tolerance);
    }
    ExpectAsBright(eye, native);
    return shifts;
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

DisparityPrediction PredictFlatShift(float eye_shift, int window_width) {
    const float eye_pixels = eye_shift * static_cast<float>(window_width) / 4.0f;
    return {{{eye_pixels, eye_pixels}, {-eye_pixels, -eye_pixels}}, {-2.0f * eye_pixels, -2.0f * eye_pixels}};
}

FrameDepth ExpectStereoFrame(const RgbaFrame& native_frame, const RgbaFrame& stereo_frame, SceneKind scene,
                             const DisparityPrediction& prediction) {
    const SceneChecks& checks = ChecksOf(scene);
    FrameDepth depth;
    EXPECT_EQ(stereo_frame.m_width, native_frame.m_width);
    EXPECT_EQ(stereo_frame.m_height, native_frame.m_height);
    if (stereo_frame.m_width != native_frame.m_width || stereo_frame.m_height != native_frame.m_height) return depth;
    // The eyes' columns come in pairs; an odd window's last column is eye 0's alone.
    const RgbaFrame native = EvenWidth(native_frame);
    const RgbaFrame stereo = EvenWidth(stereo_frame);

    // The eyes against each other, band by band across the whole width.
    if (!checks.m_compares_outline) {
        for (const ovo_frames::ShiftEstimate& band : ovo_frames::MeasureScreenDisparityBands(
                 stereo, ovo_frames::COLUMN_PARITY_EVEN, BAND_ROWS, ovo_frames::BlockMatchOptions())) {
            if (!band.m_known) continue;
            ExpectWithin(band.m_shift, prediction.m_disparity, "a band of rows",
                         SHIFT_TOLERANCE + 2.0f * checks.m_placement_tolerance);
            depth.m_separation = std::max(depth.m_separation, std::abs(band.m_shift));
            depth.m_flat_deviation = std::max(depth.m_flat_deviation, std::abs(band.m_shift));
        }
    }

    // Each eye against the native frame: eye 0 moves left, eye 1 right.
    const ovo_frames::EyeImages eyes = ovo_frames::Deinterleave(stereo, ovo_frames::COLUMN_PARITY_EVEN);
    std::vector<float> shifts[2];
    for (int eye = 0; eye < 2; ++eye) {
        SCOPED_TRACE(eye == 0 ? "eye 0" : "eye 1");
        const RgbaFrame& image = eye == 0 ? eyes.m_eye0 : eyes.m_eye1;
        const auto columns = eye == 0 ? ovo_frames::COLUMN_PARITY_EVEN : ovo_frames::COLUMN_PARITY_ODD;
        shifts[eye] = checks.m_compares_outline
                          ? ExpectOutlineMatchesNative(image, native, columns, prediction.m_eyes[eye], checks)
                          : ExpectEyeMatchesNative(image, native, columns, prediction.m_eyes[eye], checks);
    }
    // How far apart the eyes moved: from eye 0's farthest move one way to eye 1's farthest
    // move the other, leaving out the blocks that may have matched wrongly. A flat scene
    // moves neither eye: the typical block, the median, stays in place (a few blocks of
    // smooth colour match anywhere).
    if (!shifts[0].empty() && !shifts[1].empty()) {
        const float behind = ovo_frames::PercentileOf(shifts[1], 100.0f - DISPARITY_OUTLIER_PERCENT) -
                             ovo_frames::PercentileOf(shifts[0], DISPARITY_OUTLIER_PERCENT);
        const float in_front = ovo_frames::PercentileOf(shifts[0], 100.0f - DISPARITY_OUTLIER_PERCENT) -
                               ovo_frames::PercentileOf(shifts[1], DISPARITY_OUTLIER_PERCENT);
        depth.m_separation = std::max({depth.m_separation, behind, in_front});
    }
    for (const std::vector<float>& eye_shifts : shifts) {
        depth.m_flat_deviation = std::max(depth.m_flat_deviation, std::abs(ovo_frames::PercentileOf(eye_shifts, 50.0f)));
    }
    return depth;
}

void ExpectSceneDepth(SceneKind scene, const FrameDepth& deepest) {
    if (ChecksOf(scene).m_has_depth) {
        EXPECT_GE(deepest.m_separation, DEPTH_VISIBLE) << "a 3D scene without depth";
    } else {
        EXPECT_LE(deepest.m_flat_deviation, SHIFT_TOLERANCE) << "a flat scene with depth";
    }
}
