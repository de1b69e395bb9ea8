#ifndef OVO_TOOLS_OVO_FRAMES_SCREEN_DISPARITY_H
#define OVO_TOOLS_OVO_FRAMES_SCREEN_DISPARITY_H

#include <vector>

#include "block_match.h"
#include "column_ops.h"

// Where the eyes' pixels lie on the screen, and the disparity of an interleaved frame as
// the viewer sees it. Eye pixel x of the eye on the columns of parity p lies on screen
// column 2x + p, so the eyes' pixels of the same index are a screen column apart: content
// at one place on the screen shows at eye 0's index x / 2 and eye 1's (x - 1) / 2 when eye 0
// has the even columns. A shift measured between the de-interleaved images is therefore
// half an eye pixel short of the disparity on the screen (half a pixel over when eye 0 has
// the odd columns); flat content would seem to lie in front of the screen.
namespace ovo_frames {

// An eye pixel is two screen columns wide.
constexpr int32_t EYE_PIXEL_SCREEN_COLUMNS = 2;

// The eye's columns among the screen's, as block matching maps them.
ColumnMapping EyeScreenColumns(ColumnParity eye_columns);

// The disparity on the screen, x_eye1 - x_eye0 in eye pixels (negative in front of the
// screen), of content found `eye_image_disparity` eye pixels further right in eye 1's
// de-interleaved image than in eye 0's: that plus a half when eye 0 has the even columns,
// minus a half when it has the odd ones.
float ScreenDisparity(float eye_image_disparity, ColumnParity eye0_columns);

// MatchBlocks of eye 0 against eye 1 of the interleaved frame `raw` (even width), every
// shift turned into the disparity on the screen by ScreenDisparity. The options' column
// mapping is not used; m_max_shift is in eye pixels, and so is the block size.
DisparityField MeasureScreenDisparity(const RgbaFrame& raw, ColumnParity eye0_columns,
                                      const BlockMatchOptions& options);

// The same for bands of `band_rows` rows across the whole width, as MatchBands.
std::vector<ShiftEstimate> MeasureScreenDisparityBands(const RgbaFrame& raw, ColumnParity eye0_columns,
                                                       int32_t band_rows, const BlockMatchOptions& options);

}  // namespace ovo_frames

#endif
