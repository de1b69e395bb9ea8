#include "stereo_scene.h"

#include <cmath>

#include "screen_disparity.h"

namespace ovo_test {

namespace {

using ovo_frames::RgbaFrame;

constexpr float NOISE_STEP = 2.0f;
constexpr uint8_t FLAT_LEVEL = 90;
constexpr int32_t BAR_PERIOD = 6;
constexpr float LINE_GROUND_LEVEL = 190.0f;
constexpr float LINE_LEVEL = 40.0f;
// Of the lattice's 256 levels, those that make a screen column a line: about one in six.
constexpr float LINE_SHARE = 256.0f / 6.0f;

float LatticeLevel(int64_t index, int32_t y, int32_t channel) {
    uint64_t hash = static_cast<uint64_t>(index) * 0x9E3779B97F4A7C15ull ^ static_cast<uint64_t>(y) * 0xC2B2AE3D27D4EB4Full ^
                    static_cast<uint64_t>(channel) * 0x165667B19E3779F9ull;
    hash ^= hash >> 29;
    hash *= 0xBF58476D1CE4E5B9ull;
    hash ^= hash >> 32;
    return static_cast<float>(hash & 0xFF);
}

// `x` in eye pixels.
float Level(StripeContent content, float x, int32_t y, int32_t channel) {
    switch (content) {
        case STRIPE_FLAT:
            return FLAT_LEVEL;
        case STRIPE_BARS:
            return std::fmod(std::floor(x) + 1000.0f * BAR_PERIOD, BAR_PERIOD) < BAR_PERIOD / 2 ? 220.0f : 30.0f;
        case STRIPE_LINES: {
            // The same columns on every row: vertical lines.
            const auto screen_column = static_cast<int64_t>(std::floor(x * ovo_frames::EYE_PIXEL_SCREEN_COLUMNS));
            return LatticeLevel(screen_column, 0, 0) < LINE_SHARE ? LINE_LEVEL : LINE_GROUND_LEVEL;
        }
        case STRIPE_NOISE:
            break;
    }
    return NoiseAt(x, y, channel);
}

}  // namespace

float NoiseAt(float x, int32_t y, int32_t channel) {
    const float position = x / NOISE_STEP;
    const float index = std::floor(position);
    const float t = position - index;
    const float smooth = t * t * (3.0f - 2.0f * t);
    const auto left = static_cast<int64_t>(index);
    return LatticeLevel(left, y, channel) * (1.0f - smooth) + LatticeLevel(left + 1, y, channel) * smooth;
}

RgbaFrame MakeStereoFrame(int32_t eye_width, const std::vector<Stripe>& stripes, ovo_frames::ColumnParity eye0_columns) {
    int32_t height = 0;
    for (const Stripe& stripe : stripes) height += stripe.m_rows;
    RgbaFrame frame(eye_width * ovo_frames::EYE_PIXEL_SCREEN_COLUMNS, height);
    int32_t y = 0;
    for (const Stripe& stripe : stripes) {
        for (int32_t row = 0; row < stripe.m_rows; ++row, ++y) {
            for (int32_t x = 0; x < frame.m_width; ++x) {
                const float half = (x % 2 == eye0_columns ? 0.5f : -0.5f) * stripe.m_disparity;
                const float at = static_cast<float>(x) / ovo_frames::EYE_PIXEL_SCREEN_COLUMNS + half;
                uint8_t* pixel = frame.At(x, y);
                for (int32_t channel = 0; channel < 3; ++channel) {
                    pixel[channel] = static_cast<uint8_t>(std::lround(Level(stripe.m_content, at, y, channel)));
                }
                pixel[3] = 255;
            }
        }
    }
    return frame;
}

RgbaFrame MakeFlatFrame(int32_t eye_width, std::vector<Stripe> stripes) {
    for (Stripe& stripe : stripes) stripe.m_disparity = 0.0f;
    return MakeStereoFrame(eye_width, stripes, ovo_frames::COLUMN_PARITY_EVEN);
}

}  // namespace ovo_test
