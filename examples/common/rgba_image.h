#ifndef OVO_EXAMPLES_COMMON_RGBA_IMAGE_H
#define OVO_EXAMPLES_COMMON_RGBA_IMAGE_H

#include <cstdint>
#include <vector>

namespace ovo_sample {

struct Rgba {
    uint8_t m_r;
    uint8_t m_g;
    uint8_t m_b;
    uint8_t m_a;
};

// Texture pixels made in code, so the samples need no asset files. Rows go bottom first,
// as glTexImage2D takes them; straight (not premultiplied) alpha.
struct RgbaImage {
    int32_t m_width = 0;
    int32_t m_height = 0;
    std::vector<uint8_t> m_pixels;

    RgbaImage(int32_t width, int32_t height);
    void Set(int32_t x, int32_t y, Rgba color);
};

// `size` x `size` squares of `cell` pixels alternating between `a` and `b`.
RgbaImage MakeCheckerboard(int32_t size, int32_t cell, Rgba a, Rgba b);

// A filled disc touching the edges of a `size` square: `color` shading towards `rim`
// at the edge, with the alpha falling to 0 over the outer `soft_edge` fraction of the
// radius. Transparent outside.
RgbaImage MakeDisc(int32_t size, Rgba color, Rgba rim, float soft_edge);

// `bottom` at row 0 blending to `top` at the last row.
RgbaImage MakeVerticalGradient(int32_t width, int32_t height, Rgba bottom, Rgba top);

// `a` + (`b` - `a`) * t per channel, t in [0, 1].
Rgba MixRgba(Rgba a, Rgba b, float t);

}  // namespace ovo_sample

#endif
