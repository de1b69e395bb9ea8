#include "column_ops.h"

#include <cstring>

namespace ovo_frames {

namespace {

// Rec. 601 luma weights in thousandths; they add up to 1000, so white stays 255.
uint8_t Luma(const uint8_t* pixel) {
    return static_cast<uint8_t>((299u * pixel[0] + 587u * pixel[1] + 114u * pixel[2] + 500u) / 1000u);
}

// The pixel of `eye_columns`'s eye that (x, y) shows when that eye is at full width.
const uint8_t* EyePixel(const RgbaFrame& raw, ColumnParity eye_columns, int32_t x, int32_t y) {
    return raw.At(x - x % 2 + eye_columns, y);
}

}  // namespace

ColumnParity OtherParity(ColumnParity parity) {
    return parity == COLUMN_PARITY_EVEN ? COLUMN_PARITY_ODD : COLUMN_PARITY_EVEN;
}

RgbaFrame Interleave(const RgbaFrame& eye0, const RgbaFrame& eye1, ColumnParity eye0_columns,
                     const MaskArea* area) {
    RgbaFrame out(eye0.m_width, eye0.m_height);
    const MaskArea whole = {out.m_width, out.m_height, 0};
    if (area == nullptr) area = &whole;
    const RgbaFrame& outside = area->m_outside_eye == 0 ? eye0 : eye1;
    for (int32_t y = 0; y < out.m_height; ++y) {
        // Frame rows go top first, window rows bottom first.
        const bool row_masked = out.m_height - 1 - y < area->m_height;
        for (int32_t x = 0; x < out.m_width; ++x) {
            const bool masked = row_masked && x < area->m_width;
            const RgbaFrame& eye = !masked ? outside : x % 2 == eye0_columns ? eye0 : eye1;
            std::memcpy(out.At(x, y), eye.At(x, y), FRAME_PIXEL_BYTES);
        }
    }
    return out;
}

RgbaFrame ColumnsOf(const RgbaFrame& frame, ColumnParity parity) {
    RgbaFrame out(frame.m_width / 2, frame.m_height);
    for (int32_t y = 0; y < out.m_height; ++y) {
        for (int32_t x = 0; x < out.m_width; ++x) std::memcpy(out.At(x, y), frame.At(2 * x + parity, y), FRAME_PIXEL_BYTES);
    }
    return out;
}

EyeImages Deinterleave(const RgbaFrame& raw, ColumnParity eye0_columns) {
    return {ColumnsOf(raw, eye0_columns), ColumnsOf(raw, OtherParity(eye0_columns))};
}

RgbaFrame Preview(const RgbaFrame& raw, ColumnParity eye0_columns) {
    RgbaFrame out(raw.m_width * 2, raw.m_height);
    for (int32_t y = 0; y < raw.m_height; ++y) {
        for (int32_t x = 0; x < raw.m_width; ++x) {
            std::memcpy(out.At(x, y), EyePixel(raw, eye0_columns, x, y), FRAME_PIXEL_BYTES);
            std::memcpy(out.At(raw.m_width + x, y), EyePixel(raw, OtherParity(eye0_columns), x, y),
                        FRAME_PIXEL_BYTES);
        }
    }
    return out;
}

RgbaFrame Anaglyph(const RgbaFrame& raw, ColumnParity eye0_columns) {
    RgbaFrame out(raw.m_width, raw.m_height);
    for (int32_t y = 0; y < out.m_height; ++y) {
        for (int32_t x = 0; x < out.m_width; ++x) {
            uint8_t* pixel = out.At(x, y);
            pixel[0] = Luma(EyePixel(raw, eye0_columns, x, y));
            pixel[1] = pixel[2] = Luma(EyePixel(raw, OtherParity(eye0_columns), x, y));
            pixel[3] = 255;
        }
    }
    return out;
}

}  // namespace ovo_frames
