#ifndef OVO_TESTS_TOOLS_STEREO_SCENE_H
#define OVO_TESTS_TOOLS_STEREO_SCENE_H

#include <vector>

#include "column_ops.h"

// Stereo frames with a made disparity on the screen: bands of rows, each textured content
// at its own depth or a flat colour, drawn as a panel shows them (each eye on its own
// screen columns).
namespace ovo_test {

// Random levels two eye pixels apart along each row, joined smoothly (smoothstep), so the
// texture can be read between pixels: a made sub-pixel shift is exact.
float NoiseAt(float x, int32_t y, int32_t channel);

enum StripeContent {
    STRIPE_NOISE,
    STRIPE_FLAT,
    // Vertical bars, three eye pixels light and three dark: every sixth shift fits as well.
    STRIPE_BARS,
    // Dark vertical lines one screen pixel wide on a light ground, at irregular screen
    // columns of either parity, as a grid or text has them.
    STRIPE_LINES,
};

struct Stripe {
    int32_t m_rows;
    // x_eye1 - x_eye0 on the screen, in eye pixels (two screen pixels each).
    float m_disparity;
    StripeContent m_content = STRIPE_NOISE;
};

// The panel's frame, 2 x eye_width wide: screen column c shows the stripe's content at
// c / 2 + d / 2 eye pixels when it is one of eye 0's columns, at c / 2 - d / 2 when it is
// one of eye 1's, d the stripe's disparity. So each eye's content lies d screen pixels from
// where the flat frame has it, eye 0's to the left.
ovo_frames::RgbaFrame MakeStereoFrame(int32_t eye_width, const std::vector<Stripe>& stripes,
                                      ovo_frames::ColumnParity eye0_columns);

// The game's flat frame of the same stripes: every disparity 0.
ovo_frames::RgbaFrame MakeFlatFrame(int32_t eye_width, std::vector<Stripe> stripes);

}  // namespace ovo_test

#endif
