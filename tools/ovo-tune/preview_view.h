#ifndef OVO_TOOLS_OVO_TUNE_PREVIEW_VIEW_H
#define OVO_TOOLS_OVO_TUNE_PREVIEW_VIEW_H

#include "column_ops.h"
#include "rgba_frame.h"

// How the preview shows a column-interleaved frame on a flat screen.
namespace ovo_tune {

enum PreviewView {
    VIEW_ANAGLYPH = 0,      // red-cyan, each eye at full width
    VIEW_SIDE_BY_SIDE = 1,  // eye 0 left, eye 1 right
    VIEW_RAW = 2,           // the frame as the panel receives it
};
constexpr int PREVIEW_VIEW_COUNT = 3;

ovo_frames::RgbaFrame ViewOf(const ovo_frames::RgbaFrame& raw, PreviewView view, ovo_frames::ColumnParity eye0_columns);

// "anaglyph", "sbs", "raw": the view's word in key scripts.
const char* ViewWord(PreviewView view);
// For the window: "anaglyph (red-cyan)", ...
const char* ViewDescription(PreviewView view);

}  // namespace ovo_tune

#endif
