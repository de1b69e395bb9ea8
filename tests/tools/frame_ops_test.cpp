// The column operations of ovo-frames on small frames with known column patterns.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "column_ops.h"
#include "frame_compare.h"

namespace {

using ovo_frames::COLUMN_PARITY_EVEN;
using ovo_frames::COLUMN_PARITY_ODD;
using ovo_frames::ColumnParity;
using ovo_frames::RgbaFrame;

using Rows = std::vector<std::string>;

constexpr uint8_t LETTER_BLUE = 7;

// One pixel per letter: red is the letter, green the row, so a pixel from the wrong row
// shows as well.
RgbaFrame FromLetters(const Rows& rows) {
    RgbaFrame frame(static_cast<int32_t>(rows[0].size()), static_cast<int32_t>(rows.size()));
    for (int32_t y = 0; y < frame.m_height; ++y) {
        for (int32_t x = 0; x < frame.m_width; ++x) {
            uint8_t* pixel = frame.At(x, y);
            pixel[0] = static_cast<uint8_t>(rows[y][x]);
            pixel[1] = static_cast<uint8_t>(y);
            pixel[2] = LETTER_BLUE;
            pixel[3] = 255;
        }
    }
    return frame;
}

// The letters back; '?' for a pixel that is not a letter of its own row.
Rows ToLetters(const RgbaFrame& frame) {
    Rows rows(frame.m_height, std::string(frame.m_width, '?'));
    for (int32_t y = 0; y < frame.m_height; ++y) {
        for (int32_t x = 0; x < frame.m_width; ++x) {
            const uint8_t* pixel = frame.At(x, y);
            if (pixel[1] == y && pixel[2] == LETTER_BLUE && pixel[3] == 255) rows[y][x] = static_cast<char>(pixel[0]);
        }
    }
    return rows;
}

const char* Name(ColumnParity parity) { return parity == COLUMN_PARITY_EVEN ? "even" : "odd"; }

TEST(ColumnOps, InterleaveTakesEye0sColumnsOfItsParityAndEye1sOthers) {
    const RgbaFrame eye0 = FromLetters({"abcde", "fghij"});
    const RgbaFrame eye1 = FromLetters({"ABCDE", "FGHIJ"});
    const struct {
        ColumnParity m_eye0_columns;
        Rows m_expected;
    } cases[] = {
        {COLUMN_PARITY_EVEN, {"aBcDe", "fGhIj"}},
        {COLUMN_PARITY_ODD, {"AbCdE", "FgHiJ"}},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(Name(test.m_eye0_columns));
        EXPECT_EQ(ToLetters(ovo_frames::Interleave(eye0, eye1, test.m_eye0_columns)), test.m_expected);
    }
}

// The mask's area counts from the window's lower-left corner, the frame's rows from the top;
// an area larger than the frame covers all of it.
TEST(ColumnOps, OutsideTheMaskAreaOnlyTheOutsideEyeShows) {
    const RgbaFrame eye0 = FromLetters({"abcde", "fghij", "klmno"});
    const RgbaFrame eye1 = FromLetters({"ABCDE", "FGHIJ", "KLMNO"});
    const struct {
        const char* m_label;
        ovo_frames::MaskArea m_area;
        Rows m_expected;
    } cases[] = {
        {"lower rows, eye 0 outside", {5, 2, 0}, {"abcde", "fGhIj", "kLmNo"}},
        {"left columns, eye 1 outside", {3, 3, 1}, {"aBcDE", "fGhIJ", "kLmNO"}},
        {"corner, eye 0 outside", {2, 1, 0}, {"abcde", "fghij", "kLmno"}},
        {"larger than the frame", {8, 6, 1}, {"aBcDe", "fGhIj", "kLmNo"}},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.m_label);
        EXPECT_EQ(ToLetters(ovo_frames::Interleave(eye0, eye1, COLUMN_PARITY_EVEN, &test.m_area)),
                  test.m_expected);
    }
}

TEST(ColumnOps, PreviewPutsEachEyeAtFullWidthEye0OnTheLeft) {
    const RgbaFrame raw = FromLetters({"aBcDeF", "gHiJkL"});
    const struct {
        ColumnParity m_eye0_columns;
        Rows m_expected;
    } cases[] = {
        {COLUMN_PARITY_EVEN, {"aacceeBBDDFF", "ggiikkHHJJLL"}},
        {COLUMN_PARITY_ODD, {"BBDDFFaaccee", "HHJJLLggiikk"}},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(Name(test.m_eye0_columns));
        EXPECT_EQ(ToLetters(ovo_frames::Preview(raw, test.m_eye0_columns)), test.m_expected);
    }
}

TEST(ColumnOps, AnaglyphTakesRedFromEye0sLumaAndCyanFromEye1s) {
    // Luma (Rec. 601): red 76, green 150, blue 29, white 255, black 0.
    RgbaFrame raw(4, 1);
    const uint8_t columns[4][4] = {{255, 0, 0, 255}, {0, 0, 255, 90}, {255, 255, 255, 255}, {0, 255, 0, 0}};
    for (int32_t x = 0; x < 4; ++x) std::copy(columns[x], columns[x] + 4, raw.At(x, 0));
    const struct {
        ColumnParity m_eye0_columns;
        std::vector<uint8_t> m_expected;
    } cases[] = {
        {COLUMN_PARITY_EVEN, {76, 29, 29, 255, 76, 29, 29, 255, 255, 150, 150, 255, 255, 150, 150, 255}},
        {COLUMN_PARITY_ODD, {29, 76, 76, 255, 29, 76, 76, 255, 150, 255, 255, 255, 150, 255, 255, 255}},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(Name(test.m_eye0_columns));
        EXPECT_EQ(ovo_frames::Anaglyph(raw, test.m_eye0_columns).m_pixels, test.m_expected);
    }
}

TEST(FrameCompare, CountsPixelsBeyondTheToleranceAndFindsTheFirstInRowOrder) {
    struct Change {
        int32_t m_x;
        int32_t m_y;
        size_t m_channel;
        int32_t m_delta;
    };
    const struct {
        const char* m_name;
        std::vector<Change> m_changes;
        int32_t m_tolerance;
        int64_t m_differing;
        int32_t m_largest;
        int32_t m_first_x;
        int32_t m_first_y;
    } cases[] = {
        {"equal", {}, 0, 0, 0, 0, 0},
        {"within the tolerance", {{1, 1, 0, -3}}, 3, 0, 3, 0, 0},
        {"just beyond it", {{1, 1, 0, -4}}, 3, 1, 4, 1, 1},
        {"alpha counts", {{2, 0, 3, -1}}, 0, 1, 1, 2, 0},
        {"first by row, not by column", {{0, 1, 1, 9}, {2, 0, 2, 5}, {2, 1, 0, 20}}, 0, 3, 20, 2, 0},
        {"one pixel in several channels", {{1, 0, 0, 5}, {1, 0, 2, 6}}, 0, 1, 6, 1, 0},
    };
    const RgbaFrame a = FromLetters({"abc", "def"});
    for (const auto& test : cases) {
        SCOPED_TRACE(test.m_name);
        RgbaFrame b = a;
        for (const Change& change : test.m_changes) {
            b.At(change.m_x, change.m_y)[change.m_channel] += change.m_delta;
        }
        const ovo_frames::FrameDifference difference = ovo_frames::CompareFrames(a, b, test.m_tolerance);
        EXPECT_EQ(difference.m_differing_pixels, test.m_differing);
        EXPECT_EQ(difference.m_largest, test.m_largest);
        if (test.m_differing == 0) continue;
        EXPECT_EQ(difference.m_first_x, test.m_first_x);
        EXPECT_EQ(difference.m_first_y, test.m_first_y);
    }
}

}  // namespace
