#include "screen_disparity.h"

namespace ovo_frames {

namespace {

BlockMatchOptions EyeAgainstEye(const BlockMatchOptions& options) {
    BlockMatchOptions same_columns = options;
    same_columns.m_to_columns = ColumnMapping();
    return same_columns;
}

void ToScreen(ColumnParity eye0_columns, std::vector<ShiftEstimate>* estimates) {
    for (ShiftEstimate& estimate : *estimates) estimate.m_shift = ScreenDisparity(estimate.m_shift, eye0_columns);
}

}  // namespace

ColumnMapping EyeScreenColumns(ColumnParity eye_columns) { return {EYE_PIXEL_SCREEN_COLUMNS, eye_columns}; }

float ScreenDisparity(float eye_image_disparity, ColumnParity eye0_columns) {
    // Eye 1's pixel x lies that many screen columns right of eye 0's.
    const auto eye1_column_offset = static_cast<float>(OtherParity(eye0_columns) - eye0_columns);
    return eye_image_disparity + eye1_column_offset / EYE_PIXEL_SCREEN_COLUMNS;
}

DisparityField MeasureScreenDisparity(const RgbaFrame& raw, ColumnParity eye0_columns,
                                      const BlockMatchOptions& options) {
    const EyeImages eyes = Deinterleave(raw, eye0_columns);
    DisparityField field = MatchBlocks(eyes.m_eye0, eyes.m_eye1, EyeAgainstEye(options));
    ToScreen(eye0_columns, &field.m_blocks);
    return field;
}

std::vector<ShiftEstimate> MeasureScreenDisparityBands(const RgbaFrame& raw, ColumnParity eye0_columns,
                                                       int32_t band_rows, const BlockMatchOptions& options) {
    const EyeImages eyes = Deinterleave(raw, eye0_columns);
    std::vector<ShiftEstimate> bands = MatchBands(eyes.m_eye0, eyes.m_eye1, band_rows, EyeAgainstEye(options));
    ToScreen(eye0_columns, &bands);
    return bands;
}

}  // namespace ovo_frames
