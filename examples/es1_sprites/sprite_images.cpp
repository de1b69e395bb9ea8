#include "es1_sprites/sprite_images.h"

#include <cmath>

namespace ovo_sample {

namespace {

constexpr float TWO_PI = 6.28318530717959f;

// 0 outside, 1 inside, a one-pixel ramp in between: edges without stair steps.
float Coverage(float signed_distance) {
    const float inside = 0.5f - signed_distance;
    return inside < 0.0f ? 0.0f : (inside > 1.0f ? 1.0f : inside);
}

Rgba WithAlpha(Rgba color, float coverage) {
    color.m_a = static_cast<uint8_t>(std::lround(color.m_a * coverage));
    return color;
}

}  // namespace

RgbaImage MakeHills(int32_t width, int32_t height, float phase, float base, Rgba foot,
                    Rgba crest) {
    RgbaImage image(width, height);
    for (int32_t x = 0; x < width; ++x) {
        // Whole periods across the width keep the seam invisible.
        const float t = TWO_PI * x / width;
        const float ridge = base + 0.18f * std::sin(2.0f * t + phase) +
                            0.08f * std::sin(5.0f * t + 2.0f * phase);
        const float top = ridge * height;
        for (int32_t y = 0; y < height; ++y) {
            const float coverage = Coverage(y + 0.5f - top);
            if (coverage <= 0.0f) continue;
            image.Set(x, y, WithAlpha(MixRgba(foot, crest, (y + 0.5f) / top), coverage));
        }
    }
    return image;
}

RgbaImage MakeBricks(int32_t size) {
    const Rgba mortar = {90, 80, 75, 255};
    const Rgba brick = {170, 75, 50, 255};
    const Rgba brick_dark = {140, 60, 40, 255};
    const int32_t course = size / 4;
    RgbaImage image(size, size);
    for (int32_t y = 0; y < size; ++y) {
        const int32_t row = y / course;
        // Every other course is offset by half a brick.
        const int32_t shift = (row & 1) ? size / 4 : 0;
        for (int32_t x = 0; x < size; ++x) {
            const int32_t bx = (x + shift) % size;
            const bool joint = y % course == 0 || bx % (size / 2) == 0;
            const bool dark = ((bx / (size / 2)) + row) % 3 == 0;
            image.Set(x, y, joint ? mortar : (dark ? brick_dark : brick));
        }
    }
    return image;
}

RgbaImage MakeGrassTile(int32_t size) {
    const Rgba dirt = {120, 80, 45, 255};
    const Rgba dirt_dark = {95, 62, 35, 255};
    const Rgba grass = {70, 170, 60, 255};
    const Rgba grass_light = {120, 210, 90, 255};
    RgbaImage image(size, size);
    for (int32_t y = 0; y < size; ++y) {
        for (int32_t x = 0; x < size; ++x) {
            // Row 0 is the bottom: the grass is the top quarter, with a ragged edge.
            const int32_t grass_edge = size - size / 4 - ((x * 7) % 5 == 0 ? 2 : 0);
            Rgba color;
            if (y >= grass_edge) {
                color = y >= size - 2 ? grass_light : grass;
            } else {
                color = ((x * 13 + y * 7) % 11 == 0) ? dirt_dark : dirt;
            }
            image.Set(x, y, color);
        }
    }
    return image;
}

RgbaImage MakeStar(int32_t size) {
    RgbaImage image(size, size);
    const float centre = size * 0.5f;
    for (int32_t y = 0; y < size; ++y) {
        for (int32_t x = 0; x < size; ++x) {
            const float dx = x + 0.5f - centre;
            const float dy = y + 0.5f - centre;
            const float distance = std::sqrt(dx * dx + dy * dy);
            const float angle = std::atan2(dx, dy);
            // The outline's radius swings between the inner and outer points five times.
            const float swing = 0.5f + 0.5f * std::cos(5.0f * angle);
            const float outline = centre * (0.42f + 0.53f * swing * swing);
            const float coverage = Coverage(distance - outline);
            if (coverage <= 0.0f) continue;
            const uint8_t shade = static_cast<uint8_t>(255 - 90 * distance / centre);
            image.Set(x, y, WithAlpha({255, shade, shade, 255}, coverage));
        }
    }
    return image;
}

RgbaImage MakeCharacter(int32_t size) {
    RgbaImage image = MakeDisc(size, {90, 160, 255, 255}, {20, 50, 150, 255}, 0.05f);
    const float eye_radius = size * 0.11f;
    const float eye_y = size * 0.62f;
    const float eye_x[2] = {size * 0.36f, size * 0.64f};
    for (int32_t y = 0; y < size; ++y) {
        for (int32_t x = 0; x < size; ++x) {
            for (float ex : eye_x) {
                const float dx = x + 0.5f - ex;
                const float dy = y + 0.5f - eye_y;
                const float distance = std::sqrt(dx * dx + dy * dy);
                if (distance < eye_radius * 0.45f) {
                    image.Set(x, y, {10, 10, 30, 255});
                } else if (distance < eye_radius) {
                    image.Set(x, y, {255, 255, 255, 255});
                }
            }
        }
    }
    return image;
}

}  // namespace ovo_sample
