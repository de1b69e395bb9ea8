// The disparity measurement on frames with a made disparity on the screen: textured stripes
// at known depths (whole and sub-pixel, none among them), flat and repeating stripes that
// must stay unknown, and each eye moved back against the flat frame.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "block_match.h"
#include "disparity_map.h"
#include "disparity_summary.h"
#include "eye_compensation.h"
#include "screen_disparity.h"
#include "stereo_scene.h"

namespace {

using ovo_frames::COLUMN_PARITY_EVEN;
using ovo_frames::COLUMN_PARITY_ODD;
using ovo_frames::ColumnParity;
using ovo_frames::DisparityField;
using ovo_frames::ShiftEstimate;
using ovo_test::STRIPE_BARS;
using ovo_test::STRIPE_FLAT;
using ovo_test::STRIPE_LINES;
using ovo_test::Stripe;

constexpr int32_t BLOCK = 16;
constexpr int32_t EYE_WIDTH = 160;
// Worst misses measured on this noise over disparities from -8 to 8 in eighths, both
// parities: 0.06 eye pixels between the eyes, 0.07 screen pixels for an eye against the flat
// frame (0 on the lines).
constexpr float SHIFT_TOLERANCE = 0.1f;
constexpr float SCREEN_SHIFT_TOLERANCE = 0.1f;

// A stripe of one block row, and whether its disparity can be measured.
struct Expected {
    Stripe m_stripe;
    bool m_known;
};

std::vector<Stripe> StripesOf(const std::vector<Expected>& rows) {
    std::vector<Stripe> stripes;
    for (const Expected& row : rows) stripes.push_back(row.m_stripe);
    return stripes;
}

// A region whose content, moved by the disparity and a pixel more either way, leaves the
// other eye may come out unknown; whatever is known must be right.
void ExpectShift(const ShiftEstimate& estimate, const Expected& expected, int32_t first_x, int32_t width) {
    const float disparity = expected.m_stripe.m_disparity;
    const bool inside = first_x + disparity - 1.0f >= 0.0f && first_x + width + disparity + 1.0f <= EYE_WIDTH;
    if (inside || !expected.m_known) {
        EXPECT_EQ(estimate.m_known, expected.m_known);
    }
    if (estimate.m_known) {
        EXPECT_NEAR(estimate.m_shift, disparity, SHIFT_TOLERANCE);
    }
}

TEST(Disparity, BlocksAndBandsFindTheMadeDisparityOnTheScreenOrSayUnknown) {
    const struct {
        const char* m_name;
        ColumnParity m_eye0_columns;
        int32_t m_max_shift;
        std::vector<Expected> m_rows;
    } cases[] = {
        {"whole shifts, eye 0 even", COLUMN_PARITY_EVEN, 32,
         {{{BLOCK, 3.0f}, true}, {{BLOCK, -5.0f}, true}, {{BLOCK, 0.0f}, true}, {{BLOCK, 31.0f}, true}}},
        {"whole shifts, eye 0 odd", COLUMN_PARITY_ODD, 32,
         {{{BLOCK, 0.0f}, true}, {{BLOCK, -4.0f}, true}, {{BLOCK, 1.0f}, true}}},
        {"sub-pixel shifts, eye 0 odd", COLUMN_PARITY_ODD, 32,
         {{{BLOCK, 0.25f}, true}, {{BLOCK, -2.5f}, true}, {{BLOCK, 7.75f}, true}, {{BLOCK, -0.6f}, true}}},
        {"sub-pixel shifts, eye 0 even", COLUMN_PARITY_EVEN, 32,
         {{{BLOCK, 0.5f}, true}, {{BLOCK, -0.5f}, true}, {{BLOCK, -3.25f}, true}}},
        {"flat and repeating content", COLUMN_PARITY_EVEN, 32,
         {{{BLOCK, 4.0f, STRIPE_FLAT}, false}, {{BLOCK, 1.5f}, true}, {{BLOCK, 2.0f, STRIPE_BARS}, false}}},
        {"beyond the searched shifts", COLUMN_PARITY_ODD, 8,
         {{{BLOCK, 12.0f}, false}, {{BLOCK, -20.0f}, false}, {{BLOCK, -6.25f}, true}}},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.m_name);
        const ovo_frames::RgbaFrame raw = ovo_test::MakeStereoFrame(EYE_WIDTH, StripesOf(test.m_rows), test.m_eye0_columns);
        ovo_frames::BlockMatchOptions options;
        options.m_max_shift = test.m_max_shift;
        const DisparityField field = ovo_frames::MeasureScreenDisparity(raw, test.m_eye0_columns, options);
        ASSERT_EQ(field.m_columns, EYE_WIDTH / BLOCK);
        ASSERT_EQ(field.m_rows, static_cast<int32_t>(test.m_rows.size()));
        const std::vector<ShiftEstimate> bands =
            ovo_frames::MeasureScreenDisparityBands(raw, test.m_eye0_columns, BLOCK, options);
        ASSERT_EQ(bands.size(), test.m_rows.size());
        for (int32_t row = 0; row < field.m_rows; ++row) {
            SCOPED_TRACE("block row " + std::to_string(row));
            for (int32_t column = 0; column < field.m_columns; ++column) {
                ExpectShift(field.At(column, row), test.m_rows[row], column * BLOCK, BLOCK);
            }
            ExpectShift(bands[row], test.m_rows[row], test.m_max_shift, EYE_WIDTH - 2 * test.m_max_shift);
        }
    }
}

DisparityField FieldOf(const std::vector<float>& shifts, int32_t unknown) {
    DisparityField field;
    for (float shift : shifts) field.m_blocks.push_back({true, shift, 0.0f});
    field.m_blocks.insert(field.m_blocks.end(), static_cast<size_t>(unknown), ShiftEstimate{});
    return field;
}

TEST(Disparity, RangeLeavesOutTheOutlyingTwoPercentOfKnownBlocks) {
    std::vector<float> many(98, 1.5f);
    many.push_back(-30.0f);
    many.push_back(30.0f);
    const struct {
        const char* m_name;
        std::vector<float> m_shifts;
        int32_t m_unknown;
        float m_nearest;
        float m_farthest;
    } cases[] = {
        {"a stray block each way among 100", many, 7, 1.5f, 1.5f},
        {"a few blocks keep their ends", {4.0f, -2.0f, 0.5f}, 0, -2.0f, 4.0f},
        {"none known", {}, 5, 0.0f, 0.0f},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.m_name);
        const ovo_frames::DisparityRange range = ovo_frames::MeasureRange(FieldOf(test.m_shifts, test.m_unknown));
        EXPECT_EQ(range.m_known_blocks, static_cast<int32_t>(test.m_shifts.size()));
        EXPECT_EQ(range.m_unknown_blocks, test.m_unknown);
        EXPECT_EQ(range.m_nearest, test.m_nearest);
        EXPECT_EQ(range.m_farthest, test.m_farthest);
    }
}

TEST(Disparity, HistogramCountsKnownBlocksByNearestWholePixel) {
    const ovo_frames::DisparityHistogram histogram =
        ovo_frames::HistogramOf(FieldOf({-1.4f, -0.6f, 0.2f, 0.4f, 2.6f, 3.4f}, 4));
    EXPECT_EQ(histogram.m_lowest, -1);
    EXPECT_EQ(histogram.m_counts, (std::vector<int32_t>{2, 2, 0, 0, 2}));
    EXPECT_TRUE(ovo_frames::HistogramOf(FieldOf({}, 3)).m_counts.empty());
}

// One eye of a made frame, and the columns that eye 0 has.
struct EyeCase {
    const char* m_name;
    ColumnParity m_eye0_columns;
    int32_t m_eye;
};

const EyeCase EYE_CASES[] = {
    {"eye 0 on the even columns", COLUMN_PARITY_EVEN, 0},
    {"eye 1 on the odd columns", COLUMN_PARITY_EVEN, 1},
    {"eye 0 on the odd columns", COLUMN_PARITY_ODD, 0},
    {"eye 1 on the even columns", COLUMN_PARITY_ODD, 1},
};

ovo_frames::RgbaFrame EyeOf(const ovo_frames::RgbaFrame& raw, const EyeCase& test) {
    const ovo_frames::EyeImages eyes = ovo_frames::Deinterleave(raw, test.m_eye0_columns);
    return test.m_eye == 0 ? eyes.m_eye0 : eyes.m_eye1;
}

ColumnParity ColumnsOfEye(const EyeCase& test) {
    return test.m_eye == 0 ? test.m_eye0_columns : ovo_frames::OtherParity(test.m_eye0_columns);
}

// x_eye - x_native in screen pixels of a stripe of disparity d (eye pixels): each eye's
// content lies d screen pixels from the flat frame's, eye 0's to the left.
float EyeShift(const EyeCase& test, const Stripe& stripe) {
    return test.m_eye == 0 ? -stripe.m_disparity : stripe.m_disparity;
}

TEST(Disparity, EachEyeMovedBackMatchesTheFlatFrameExceptWhatIsDrawnDifferently) {
    const std::vector<Stripe> stripes = {{BLOCK, 3.5f}, {BLOCK, -5.0f}, {BLOCK, 0.0f, STRIPE_FLAT}, {BLOCK, 9.0f}};
    const ovo_frames::RgbaFrame native = ovo_test::MakeFlatFrame(EYE_WIDTH, stripes);
    // Drawn otherwise: block 2 of the textured row 1 without green, block 4 of the flat row
    // 2 lighter by 40.
    const size_t textured_damage = 1 * EYE_WIDTH / BLOCK + 2;
    const size_t flat_damage = 2 * EYE_WIDTH / BLOCK + 4;
    // Reading this sharp noise (about 85 levels from one eye pixel to the next) linearly
    // between screen columns leaves up to 2.8 levels at sub-pixel shifts; unmoved, the eyes
    // differ from the flat frame by about 70.
    constexpr float CLEAN_RESIDUAL = 4.0f;
    for (const EyeCase& eye_case : EYE_CASES) {
        for (const bool damaged : {false, true}) {
            SCOPED_TRACE(std::string(eye_case.m_name) + (damaged ? ", drawn otherwise" : ""));
            ovo_frames::RgbaFrame eye = EyeOf(ovo_test::MakeStereoFrame(EYE_WIDTH, stripes, eye_case.m_eye0_columns), eye_case);
            for (int32_t y = 0; damaged && y < BLOCK; ++y) {
                for (int32_t x = 0; x < BLOCK; ++x) {
                    eye.At(2 * BLOCK + x, BLOCK + y)[1] = 0;
                    for (int32_t channel = 0; channel < 3; ++channel) eye.At(4 * BLOCK + x, 2 * BLOCK + y)[channel] += 40;
                }
            }
            const ovo_frames::CompensationSummary summary =
                ovo_frames::MeasureCompensation(eye, native, ColumnsOfEye(eye_case), {});
            const DisparityField& field = summary.m_shifts;
            ASSERT_EQ(summary.m_residuals.size(), stripes.size() * EYE_WIDTH / BLOCK);
            for (size_t index = 0; index < field.m_blocks.size(); ++index) {
                const Stripe& stripe = stripes[index / field.m_columns];
                const bool is_damaged = damaged && (index == textured_damage || index == flat_damage);
                EXPECT_EQ(summary.m_residuals[index] >= 30.0f, is_damaged) << index << ": " << summary.m_residuals[index];
                if (damaged && index == textured_damage) continue;
                EXPECT_EQ(field.m_blocks[index].m_known, stripe.m_content != STRIPE_FLAT) << index;
                if (field.m_blocks[index].m_known) {
                    EXPECT_NEAR(field.m_blocks[index].m_shift, EyeShift(eye_case, stripe), SCREEN_SHIFT_TOLERANCE) << index;
                }
            }
            // The block without green may come out unknown.
            EXPECT_NEAR(summary.m_unknown_fraction, 0.25f, 1.5f / 40.0f);
            EXPECT_LT(summary.m_residual_high, CLEAN_RESIDUAL);
            EXPECT_LE(summary.m_residual_mean, summary.m_residual_high);
            EXPECT_EQ(summary.m_residual_worst >= 30.0f, damaged);
        }
    }
    // The flat frame must be twice as wide as the eye.
    EXPECT_TRUE(ovo_frames::MeasureCompensation(ovo_frames::ColumnsOf(native, COLUMN_PARITY_EVEN),
                                                ovo_frames::ColumnsOf(native, COLUMN_PARITY_ODD), COLUMN_PARITY_EVEN, {})
                    .m_residuals.empty());
}

// Content moved by an odd number of screen pixels brings a line that the flat frame has on
// the other eye's columns onto this eye's: compared with the flat frame's columns of the
// eye alone, such a line is missing there and the block seems drawn otherwise.
TEST(Disparity, ThinLinesMovedByWholeScreenPixelsLeaveNoResidual) {
    const std::vector<Stripe> stripes = {{BLOCK, 1.0f, STRIPE_LINES}, {BLOCK, -3.0f, STRIPE_LINES},
                                         {BLOCK, 2.0f, STRIPE_LINES}, {BLOCK, 0.0f, STRIPE_LINES},
                                         {BLOCK, 5.0f, STRIPE_LINES}, {BLOCK, 7.0f, STRIPE_FLAT}};
    const ovo_frames::RgbaFrame native = ovo_test::MakeFlatFrame(EYE_WIDTH, stripes);
    for (const EyeCase& eye_case : EYE_CASES) {
        SCOPED_TRACE(eye_case.m_name);
        const ovo_frames::RgbaFrame eye = EyeOf(ovo_test::MakeStereoFrame(EYE_WIDTH, stripes, eye_case.m_eye0_columns), eye_case);
        const ovo_frames::CompensationSummary summary =
            ovo_frames::MeasureCompensation(eye, native, ColumnsOfEye(eye_case), {});
        const DisparityField& field = summary.m_shifts;
        ASSERT_EQ(field.m_rows, static_cast<int32_t>(stripes.size()));
        for (int32_t row = 0; row < field.m_rows; ++row) {
            SCOPED_TRACE("block row " + std::to_string(row));
            const Stripe& stripe = stripes[static_cast<size_t>(row)];
            int32_t known = 0;
            for (int32_t column = 0; column < field.m_columns; ++column) {
                const ShiftEstimate& block = field.At(column, row);
                EXPECT_LT(summary.m_residuals[static_cast<size_t>(row * field.m_columns + column)], 0.5f) << column;
                if (!block.m_known) continue;
                ++known;
                EXPECT_NEAR(block.m_shift, EyeShift(eye_case, stripe), SCREEN_SHIFT_TOLERANCE) << column;
            }
            // A block may see too few lines to tell one shift from another; most see enough.
            if (stripe.m_content == STRIPE_FLAT) {
                EXPECT_EQ(known, 0);
            } else {
                EXPECT_GE(known, field.m_columns / 2);
            }
        }
    }
}

TEST(Disparity, MapShadesBlocksFromNearestWhiteToFarthestGreyUnknownMagenta) {
    const std::vector<Stripe> stripes = {{BLOCK, -2.0f}, {BLOCK, 1.0f}, {BLOCK, 4.0f}, {BLOCK, 0.0f, STRIPE_FLAT}};
    const DisparityField field = ovo_frames::MeasureScreenDisparity(
        ovo_test::MakeStereoFrame(EYE_WIDTH, stripes, COLUMN_PARITY_EVEN), COLUMN_PARITY_EVEN, {});
    const ovo_frames::RgbaFrame map = ovo_frames::DisparityMapImage(field, ovo_frames::MeasureRange(field));
    ASSERT_EQ(map.m_width, 2 * EYE_WIDTH);
    ASSERT_EQ(map.m_height, 4 * BLOCK);
    // Halfway between the ends' levels 255 and 48.
    const int32_t expected_grey[] = {255, 152, 48};
    for (int32_t x = 0; x < map.m_width; x += 7) {
        for (int32_t row = 0; row < 3; ++row) {
            const uint8_t* pixel = map.At(x, row * BLOCK + 5);
            EXPECT_NEAR(pixel[0], expected_grey[row], 3) << x;
            EXPECT_EQ(pixel[1], pixel[0]);
        }
        const uint8_t* unknown = map.At(x, 3 * BLOCK + 9);
        EXPECT_EQ(std::vector<uint8_t>(unknown, unknown + 4), (std::vector<uint8_t>{255, 0, 255, 255}));
    }
}

}  // namespace
