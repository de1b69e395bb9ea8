#ifndef OVO_TOOLS_OVO_FRAMES_DISPARITY_SUMMARY_H
#define OVO_TOOLS_OVO_FRAMES_DISPARITY_SUMMARY_H

#include <vector>

#include "block_match.h"

// What a disparity field says about the whole frame: its nearest and farthest depth, how
// the blocks spread over the depths, and whether the range is comfortable to look at.
// Disparities are x_eye1 - x_eye0 on the screen in eye pixels (see screen_disparity.h):
// negative in front of the screen (crossed), positive behind it (uncrossed).
namespace ovo_frames {

// A few blocks on a depth edge or a repeating pattern can match wrongly; the range leaves
// out this share of the known blocks at each end.
constexpr float DISPARITY_OUTLIER_PERCENT = 2.0f;

// The nearest-rank percentile: the value at index round(percent / 100 * (n - 1)) of the
// sorted values; 0 for no values.
float PercentileOf(std::vector<float> values, float percent);

struct DisparityRange {
    int32_t m_known_blocks = 0;
    int32_t m_unknown_blocks = 0;
    // The outlier_percent-th and (100 - outlier_percent)-th percentile of the known blocks'
    // disparities; both 0 when no block is known.
    float m_nearest = 0.0f;
    float m_farthest = 0.0f;
};

DisparityRange MeasureRange(const DisparityField& field, float outlier_percent = DISPARITY_OUTLIER_PERCENT);

// Each eye's image spans the whole screen, so an eye's width in eye pixels is the screen's
// width; as is the frame's width in screen pixels.
float PercentOfWidth(float pixels, int32_t width);

struct DisparityHistogram {
    // The disparity of m_counts[0]; each count is of the known blocks whose disparity
    // rounds to its whole eye pixel. No counts when no block is known.
    int32_t m_lowest = 0;
    std::vector<int32_t> m_counts;
};

DisparityHistogram HistogramOf(const DisparityField& field);

// Limits in percent of the screen width, both positive. The default is the BSkyB
// "Technical Guidelines for Plano Stereoscopic (3D) Programme Content" (2010), widely
// adopted for 3D television: at most 1 % in front of the screen (crossed) and 2 % behind it
// (uncrossed). They were written for 46 to 70 inch televisions, about a third as wide as
// they are far from the viewer; so is a phone's panel held at 30 cm, so the same
// percentages come to about the same angles at the eye (1 % is about 0.2 degrees).
struct ComfortBudget {
    float m_near_percent = 1.0f;
    float m_far_percent = 2.0f;
};

struct ComfortVerdict {
    bool m_too_near = false;
    bool m_too_far = false;
};

ComfortVerdict CheckComfort(const DisparityRange& range, int32_t eye_width, const ComfortBudget& budget);

}  // namespace ovo_frames

#endif
