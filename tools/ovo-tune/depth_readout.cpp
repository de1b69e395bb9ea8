#include "depth_readout.h"

#include <cstdio>

#include "screen_disparity.h"

namespace ovo_tune {

DepthReadout MeasureDepth(const ovo_frames::RgbaFrame& raw, ovo_frames::ColumnParity eye0_columns,
                          const ovo_frames::ComfortBudget& budget) {
    DepthReadout readout;
    const ovo_frames::DisparityField field =
        ovo_frames::MeasureScreenDisparity(raw, eye0_columns, ovo_frames::BlockMatchOptions());
    readout.m_range = ovo_frames::MeasureRange(field);
    readout.m_eye_width = field.m_image_width;
    readout.m_verdict = ovo_frames::CheckComfort(readout.m_range, readout.m_eye_width, budget);
    return readout;
}

std::string DescribeDepth(const DepthReadout& readout) {
    const ovo_frames::DisparityRange& range = readout.m_range;
    const int32_t blocks = range.m_known_blocks + range.m_unknown_blocks;
    char text[256];
    if (range.m_known_blocks == 0) {
        std::snprintf(text, sizeof(text), "unknown: none of %d blocks could be matched (flat or too alike)", blocks);
    } else {
        std::snprintf(text, sizeof(text), "nearest %+.2f px (%+.2f %%), farthest %+.2f px (%+.2f %%), %d of %d blocks",
                      range.m_nearest, ovo_frames::PercentOfWidth(range.m_nearest, readout.m_eye_width),
                      range.m_farthest, ovo_frames::PercentOfWidth(range.m_farthest, readout.m_eye_width),
                      range.m_known_blocks, blocks);
    }
    return text;
}

std::vector<std::string> ComfortWarnings(const DepthReadout& readout, const ovo_frames::ComfortBudget& budget) {
    std::vector<std::string> warnings;
    char text[256];
    if (readout.m_verdict.m_too_near) {
        std::snprintf(
            text, sizeof(text), "nearest is %.2f %% of the width in front of the screen, beyond the %.2f %% budget",
            ovo_frames::PercentOfWidth(-readout.m_range.m_nearest, readout.m_eye_width), budget.m_near_percent);
        warnings.push_back(text);
    }
    if (readout.m_verdict.m_too_far) {
        std::snprintf(
            text, sizeof(text), "farthest is %.2f %% of the width behind the screen, beyond the %.2f %% budget",
            ovo_frames::PercentOfWidth(readout.m_range.m_farthest, readout.m_eye_width), budget.m_far_percent);
        warnings.push_back(text);
    }
    return warnings;
}

}  // namespace ovo_tune
