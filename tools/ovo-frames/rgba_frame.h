#ifndef OVO_TOOLS_OVO_FRAMES_RGBA_FRAME_H
#define OVO_TOOLS_OVO_FRAMES_RGBA_FRAME_H

#include <cstddef>
#include <cstdint>
#include <vector>

namespace ovo_frames {

constexpr size_t FRAME_PIXEL_BYTES = 4;

// 8-bit RGBA pixels, rows top first, no padding between rows.
struct RgbaFrame {
    int32_t m_width = 0;
    int32_t m_height = 0;
    std::vector<uint8_t> m_pixels;

    RgbaFrame() = default;
    RgbaFrame(int32_t width, int32_t height)
        : m_width(width),
          m_height(height),
          m_pixels(static_cast<size_t>(width) * static_cast<size_t>(height) * FRAME_PIXEL_BYTES) {}

    uint8_t* At(int32_t x, int32_t y) { return &m_pixels[Offset(x, y)]; }
    const uint8_t* At(int32_t x, int32_t y) const { return &m_pixels[Offset(x, y)]; }

private:
    size_t Offset(int32_t x, int32_t y) const {
        return (static_cast<size_t>(y) * static_cast<size_t>(m_width) + static_cast<size_t>(x)) *
               FRAME_PIXEL_BYTES;
    }
};

}  // namespace ovo_frames

#endif
