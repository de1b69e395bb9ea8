#ifndef OVO_TESTS_TOOLS_STEREO_SCENE_H
#define OVO_TESTS_TOOLS_STEREO_SCENE_H

#include <vector>

#include "column_ops.h"

// Stereo frames with a made disparity: bands of rows, each textured content at its own
// depth or a flat colour.
namespace ovo_test {

// Random levels two pixels apart along each row, joined smoothly (smoothstep), so the
// texture can be read between pixels: a made sub-pixel shift is exact.
float NoiseAt(float x, int32_t y, int32_t channel);

enum StripeContent {
    STRIPE_NOISE,
    STRIPE_FLAT,
    // Vertical bars, three columns light and three dark: every sixth shift fits as well.
    STRIPE_BARS,
};

struct Stripe {
    int32_t m_rows;
    // x_eye1 - x_eye0 in eye pixels.
    float m_disparity;
    StripeContent m_content = STRIPE_NOISE;
};

// A stripe's content lies at x + d/2 in eye 0 and x - d/2 in eye 1 (so that a point lies d
// further right in eye 1), where d is the stripe's disparity.
ovo_frames::EyeImages MakeEyes(int32_t eye_width, const std::vector<Stripe>& stripes);

// The panel's frame: eye 0's pixel x on column 2x + eye0_columns, eye 1's beside it.
ovo_frames::RgbaFrame InterleaveEyes(const ovo_frames::EyeImages& eyes, ovo_frames::ColumnParity eye0_columns);

}  // namespace ovo_test

#endif
