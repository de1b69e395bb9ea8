#include "common/rgba_image.h"

#include <cmath>

namespace ovo_sample {

namespace {

uint8_t MixChannel(uint8_t a, uint8_t b, float t) {
    return static_cast<uint8_t>(std::lround(a + (static_cast<float>(b) - a) * t));
}

float Clamp01(float value) { return value < 0.0f ? 0.0f : (value > 1.0f ? 1.0f : value); }

}  // namespace

RgbaImage::RgbaImage(int32_t width, int32_t height)
    : m_width(width), m_height(height), m_pixels(static_cast<size_t>(width) * height * 4, 0) {}

void RgbaImage::Set(int32_t x, int32_t y, Rgba color) {
    uint8_t* pixel = &m_pixels[(static_cast<size_t>(y) * m_width + x) * 4];
    pixel[0] = color.m_r;
    pixel[1] = color.m_g;
    pixel[2] = color.m_b;
    pixel[3] = color.m_a;
}

Rgba MixRgba(Rgba a, Rgba b, float t) {
    t = Clamp01(t);
    return {MixChannel(a.m_r, b.m_r, t), MixChannel(a.m_g, b.m_g, t),
            MixChannel(a.m_b, b.m_b, t), MixChannel(a.m_a, b.m_a, t)};
}

RgbaImage MakeCheckerboard(int32_t size, int32_t cell, Rgba a, Rgba b) {
    RgbaImage image(size, size);
    for (int32_t y = 0; y < size; ++y) {
        for (int32_t x = 0; x < size; ++x) image.Set(x, y, ((x / cell + y / cell) & 1) ? b : a);
    }
    return image;
}

RgbaImage MakeDisc(int32_t size, Rgba color, Rgba rim, float soft_edge) {
    RgbaImage image(size, size);
    const float radius = size * 0.5f;
    for (int32_t y = 0; y < size; ++y) {
        for (int32_t x = 0; x < size; ++x) {
            // Distances from pixel centres, so the disc is symmetric.
            const float dx = (x + 0.5f - radius) / radius;
            const float dy = (y + 0.5f - radius) / radius;
            const float distance = std::sqrt(dx * dx + dy * dy);
            if (distance >= 1.0f) continue;
            Rgba pixel = MixRgba(color, rim, distance * distance);
            const float fade = soft_edge > 0.0f ? (1.0f - distance) / soft_edge : 1.0f;
            pixel.m_a = static_cast<uint8_t>(std::lround(pixel.m_a * Clamp01(fade)));
            image.Set(x, y, pixel);
        }
    }
    return image;
}

RgbaImage MakeVerticalGradient(int32_t width, int32_t height, Rgba bottom, Rgba top) {
    RgbaImage image(width, height);
    for (int32_t y = 0; y < height; ++y) {
        const Rgba row = MixRgba(bottom, top, height > 1 ? static_cast<float>(y) / (height - 1)
                                                         : 0.0f);
        for (int32_t x = 0; x < width; ++x) image.Set(x, y, row);
    }
    return image;
}

}  // namespace ovo_sample
