#include "preview_view.h"

namespace ovo_tune {

namespace {

struct ViewName {
    const char* m_word;
    const char* m_description;
};

const ViewName VIEW_NAMES[PREVIEW_VIEW_COUNT] = {
    {"anaglyph", "anaglyph (red-cyan)"},
    {"sbs", "side by side (left eye left)"},
    {"raw", "raw (as the panel receives it)"},
};

}  // namespace

ovo_frames::RgbaFrame ViewOf(const ovo_frames::RgbaFrame& raw, PreviewView view,
                             ovo_frames::ColumnParity eye0_columns) {
    switch (view) {
        case VIEW_ANAGLYPH: return ovo_frames::Anaglyph(raw, eye0_columns);
        case VIEW_SIDE_BY_SIDE: return ovo_frames::Preview(raw, eye0_columns);
        case VIEW_RAW: break;
    }
    return raw;
}

const char* ViewWord(PreviewView view) { return VIEW_NAMES[view].m_word; }

const char* ViewDescription(PreviewView view) { return VIEW_NAMES[view].m_description; }

}  // namespace ovo_tune
