#ifndef OVO_TOOLS_OVO_FRAMES_COLUMN_OPS_H
#define OVO_TOOLS_OVO_FRAMES_COLUMN_OPS_H

#include "rgba_frame.h"

// The panel shows the two eye images interleaved by pixel column: one eye on the even
// columns (0, 2, 4, ...), the other on the odd ones.
namespace ovo_frames {

enum ColumnParity : int32_t {
    COLUMN_PARITY_EVEN = 0,
    COLUMN_PARITY_ODD = 1,
};

// Where the column mask reaches in a window: its lower-left m_width x m_height pixels
// (a mask drawn for a target smaller than the window, or of the other orientation).
// Outside it the stencil keeps the value it was cleared to, and only `m_outside_eye`
// (0 or 1) draws there.
struct MaskArea {
    int32_t m_width;
    int32_t m_height;
    int32_t m_outside_eye;
};

// The other eye's columns.
ColumnParity OtherParity(ColumnParity parity);

// The frame the panel receives: eye 0's pixels on the columns of `eye0_columns`, eye 1's on
// the others; outside `area` (when given) only its outside eye's. Both eyes have the same
// size.
RgbaFrame Interleave(const RgbaFrame& eye0, const RgbaFrame& eye1, ColumnParity eye0_columns,
                     const MaskArea* area = nullptr);

// The columns of one parity of `frame` (even width), side by side: (W / 2) x H. Of an
// interleaved frame that is one eye's image in its own pixels ("eye pixels").
RgbaFrame ColumnsOf(const RgbaFrame& frame, ColumnParity parity);

struct EyeImages {
    RgbaFrame m_eye0;
    RgbaFrame m_eye1;
};

// Both eyes' images of an interleaved frame `raw` (even width), each (W / 2) x H.
EyeImages Deinterleave(const RgbaFrame& raw, ColumnParity eye0_columns);

// The two eyes of an interleaved frame `raw` (even width) next to each other, eye 0 on the
// left, each at full width: an eye's column fills itself and its neighbour of the other
// eye. 2W x H, so the preview keeps the aspect.
RgbaFrame Preview(const RgbaFrame& raw, ColumnParity eye0_columns);

// Red-cyan anaglyph of an interleaved frame `raw` (even width), each eye at full width as
// in Preview: red from eye 0 (left), green and blue from eye 1 (right). Each eye is turned
// to grey (its luma) first: in colour, an object that is red or cyan reaches one eye only
// and the two eyes' images fight.
RgbaFrame Anaglyph(const RgbaFrame& raw, ColumnParity eye0_columns);

}  // namespace ovo_frames

#endif
