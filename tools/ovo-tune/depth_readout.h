#ifndef OVO_TOOLS_OVO_TUNE_DEPTH_READOUT_H
#define OVO_TOOLS_OVO_TUNE_DEPTH_READOUT_H

#include <string>
#include <vector>

#include "column_ops.h"
#include "disparity_summary.h"
#include "rgba_frame.h"

// The depth of a previewed frame, measured as `ovo-frames disparity` measures it: the
// nearest and farthest disparity between the eyes on the screen in eye pixels (negative in
// front of the screen) and in percent of the width, checked against a comfort budget.
namespace ovo_tune {

struct DepthReadout {
    ovo_frames::DisparityRange m_range;
    int32_t m_eye_width = 0;
    ovo_frames::ComfortVerdict m_verdict;
};

DepthReadout MeasureDepth(const ovo_frames::RgbaFrame& raw, ovo_frames::ColumnParity eye0_columns,
                          const ovo_frames::ComfortBudget& budget);

// "nearest -1.50 px (-0.38 %), farthest +4.00 px (+1.00 %), 412 of 750 blocks", or what
// kept it from being measured.
std::string DescribeDepth(const DepthReadout& readout);

// One line for each end of the range beyond the budget; none when it is comfortable.
std::vector<std::string> ComfortWarnings(const DepthReadout& readout, const ovo_frames::ComfortBudget& budget);

}  // namespace ovo_tune

#endif
