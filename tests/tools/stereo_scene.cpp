#include "stereo_scene.h"

#include <cmath>
#include <cstring>

namespace ovo_test {

namespace {

using ovo_frames::RgbaFrame;

constexpr float NOISE_STEP = 2.0f;
constexpr uint8_t FLAT_LEVEL = 90;
constexpr int32_t BAR_PERIOD = 6;

float LatticeLevel(int64_t index, int32_t y, int32_t channel) {
    uint64_t hash = static_cast<uint64_t>(index) * 0x9E3779B97F4A7C15ull ^ static_cast<uint64_t>(y) * 0xC2B2AE3D27D4EB4Full ^
                    static_cast<uint64_t>(channel) * 0x165667B19E3779F9ull;
    hash ^= hash >> 29;
    hash *= 0xBF58476D1CE4E5B9ull;
    hash ^= hash >> 32;
    return static_cast<float>(hash & 0xFF);
}

float Level(StripeContent content, float x, int32_t y, int32_t channel) {
    if (content == STRIPE_FLAT) return FLAT_LEVEL;
    if (content == STRIPE_BARS) return std::fmod(std::floor(x) + 1000.0f * BAR_PERIOD, BAR_PERIOD) < BAR_PERIOD / 2 ? 220.0f : 30.0f;
    return NoiseAt(x, y, channel);
}

void Fill(RgbaFrame* eye, int32_t y, float offset, StripeContent content) {
    for (int32_t x = 0; x < eye->m_width; ++x) {
        uint8_t* pixel = eye->At(x, y);
        for (int32_t channel = 0; channel < 3; ++channel) {
            pixel[channel] = static_cast<uint8_t>(std::lround(Level(content, static_cast<float>(x) + offset, y, channel)));
        }
        pixel[3] = 255;
    }
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

ovo_frames::EyeImages MakeEyes(int32_t eye_width, const std::vector<Stripe>& stripes) {
    int32_t height = 0;
    for (const Stripe& stripe : stripes) height += stripe.m_rows;
    ovo_frames::EyeImages eyes = {RgbaFrame(eye_width, height), RgbaFrame(eye_width, height)};
    int32_t y = 0;
    for (const Stripe& stripe : stripes) {
        for (int32_t row = 0; row < stripe.m_rows; ++row, ++y) {
            Fill(&eyes.m_eye0, y, stripe.m_disparity / 2.0f, stripe.m_content);
            Fill(&eyes.m_eye1, y, -stripe.m_disparity / 2.0f, stripe.m_content);
        }
    }
    return eyes;
}

RgbaFrame InterleaveEyes(const ovo_frames::EyeImages& eyes, ovo_frames::ColumnParity eye0_columns) {
    RgbaFrame raw(eyes.m_eye0.m_width * 2, eyes.m_eye0.m_height);
    for (int32_t y = 0; y < raw.m_height; ++y) {
        for (int32_t x = 0; x < eyes.m_eye0.m_width; ++x) {
            std::memcpy(raw.At(2 * x + eye0_columns, y), eyes.m_eye0.At(x, y), ovo_frames::FRAME_PIXEL_BYTES);
            std::memcpy(raw.At(2 * x + 1 - eye0_columns, y), eyes.m_eye1.At(x, y), ovo_frames::FRAME_PIXEL_BYTES);
        }
    }
    return raw;
}

}  // namespace ovo_test
