#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <vector>

#include "present/matrix4.h"
#include "present/matrix_snapshot.h"
#include "present/panel_refresh.h"
#include "present/viewer_tracker.h"

namespace {

// Exact: a game's identity that drifted by a rounding step must not count.
TEST(Matrix4, IdentityIsExact) {
    float m[16];
    for (int i = 0; i < 16; ++i) {
        ovo::Mat4Identity(m);
        ASSERT_TRUE(ovo::Mat4IsIdentity(m));
        m[i] += (i % 2) ? 1e-7f : -1e-7f;
        EXPECT_FALSE(ovo::Mat4IsIdentity(m)) << "element " << i;
    }
}

TEST(Matrix4, InvertsOrLeavesTheDestination) {
    float invertible[][16] = {
        {2, -1, 0.5f, 3, 0.5f, 4, -2, 1, 1, -3, 3, -1, -1.5f, 2, 1, 5},  // no zero entry
        {1e-3f, 0, 0, 0, 0, 1e-3f, 0, 0, 0, 0, 1e-3f, 0, 0, 0, 0, 1},     // tiny determinant
        {0, 1, 0, 0, 0, 0, 0, 1, 1, 0, 0, 0, 0, 0, 1, 0},                 // permutation
    };
    float inverse[16], before[16];
    for (float* m : invertible) {
        ASSERT_TRUE(ovo::Mat4Invert(inverse, m));
        for (int i = 0; i < 16; ++i) {
            double product = 0;  // row i % 4 of m times column i / 4 of the inverse
            for (int k = 0; k < 4; ++k) product += m[k * 4 + i % 4] * inverse[i / 4 * 4 + k];
            EXPECT_NEAR(product, i % 5 == 0 ? 1.0 : 0.0, 1e-5) << "element " << i;
        }
        ASSERT_TRUE(ovo::Mat4Invert(m, m)) << "in place";
        EXPECT_EQ(std::memcmp(m, inverse, sizeof(inverse)), 0);
    }
    std::memcpy(before, inverse, sizeof(inverse));
    const float equal_columns[16] = {1, 3, 7, 1, 2, 5, 8, 1, 1, 3, 7, 1, 4, 6, 9, 1};
    EXPECT_FALSE(ovo::Mat4Invert(inverse, equal_columns));
    ovo::Mat4Frustum(inverse, 1, 1, -1, 1, 1, 10);  // empty volumes
    ovo::Mat4Frustum(inverse, -1, 1, 2, 2, 1, 10);
    ovo::Mat4Frustum(inverse, -1, 1, -1, 1, 5, 5);
    ovo::Mat4Perspective(inverse, 800, 0);
    EXPECT_EQ(std::memcmp(inverse, before, sizeof(before)), 0);
}

TEST(Matrix4, ProjectionsMapTheirVolumeOntoTheCube) {
    const float h = 2 * std::tan(35 * M_PI / 180), w = h * 800 / 480;  // 70 degrees vertically
    float frustum1[16], frustum2[16], persp[16], pixel[16];
    ovo::Mat4Frustum(frustum1, -0.5f, 2, -1.5f, 0.25f, 0.5f, 100);
    ovo::Mat4Frustum(frustum2, 1, 3, 2, 5, 2, 4);
    ovo::Mat4Perspective(persp, 800, 480);
    ovo::Mat4PixelProjection(pixel, 800, 480);
    // A frustum's near left bottom corner lands on -1s, its far right top one on 1s.
    const struct {
        const float* m;
        float point[3], ndc[3];
    } cases[] = {
        {frustum1, {-0.5f, -1.5f, -0.5f}, {-1, -1, -1}}, {frustum1, {400, 50, -100}, {1, 1, 1}},
        {frustum2, {1, 2, -2}, {-1, -1, -1}}, {frustum2, {6, 10, -4}, {1, 1, 1}},
        {persp, {-w, -h, -2}, {-1, -1, -1}}, {persp, {500 * w, 500 * h, -1000}, {1, 1, 1}},
        {pixel, {0, 0, 0}, {-1, -1, -1}}, {pixel, {800, 480, 0}, {1, 1, -1}},
        {pixel, {400, 120, 400}, {0, -0.5f, 0}},  // depth scales with the width
    };
    for (const auto& c : cases) {
        const float point[4] = {c.point[0], c.point[1], c.point[2], 1.0f};
        float clip[4];
        ovo::Mat4MulVec4(clip, c.m, point);
        for (int i = 0; i < 3; ++i) EXPECT_NEAR(clip[i] / clip[3], c.ndc[i], 1e-5f) << &c - cases;
    }
}

// Games' orthographic and near-orthographic matrices must stay flat.
TEST(MatrixSnapshot, ClassifiesOnlyTrueFrustumsAsPerspective) {
    const float cases[][3] = {// m[11], m[15], perspective
                              {0.0f, 1.0f, 0}, {-0.0f, 0.0f, 0}, {-1.0f, 1.0f, 0},
                              {-1.0f, 0.0f, 1}, {-1e-30f, 0.0f, 1}, {-1.0f, 1.0000001f, 1}};
    for (const auto& c : cases) {
        const float m[16] = {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, c[0], 0, 0, 0, c[1]};
        EXPECT_EQ(ovo::ClassifyProjection(m) == ovo::PROJECTION_PERSPECTIVE, c[2] != 0) << &c - cases;
    }
}

// An object whose origin sits at (x, y, z, w) in eye space.
void ObserveAt(ovo::ViewerTracker& tracker, const float projection[16], float x, float y,
               float z, float w = 1.0f) {
    const float modelview[16] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, x, y, z, w};
    tracker.Observe(projection, modelview);
}

double Degrees(double x, double z) { return std::atan2(x, z) * 180.0 / M_PI; }

TEST(ViewerTracker, KeepsTheNearestDepthStrictlyInsideTheView) {
    // x' = x + z, so depth d at the screen's centre unprojects to x = -d, z = d.
    const float shear[16] = {1, 0, 0, 0, 0, 1, 0, 0, 1, 0, 1, 0, 0, 0, 0, 1};
    const struct {
        std::vector<std::array<float, 3>> objects;
        float depth;
    } cases[] = {
        {{{0, 0, 0.5f}, {0, 0, 0.3f}}, 0.3f},
        {{{0, 0, 0.3f}, {0, 0, 0.5f}}, 0.3f},
        {{{0, 0, 0.5f}, {0, 0, 0}}, 0.5f},
        {{{0, 0, 1}, {-1, 0, 1.5f}, {0, 0, -0.2f}}, 0.0f},              // depth 1, beyond, behind
        {{{0, 0, 0.5f}, {0.625f, 1, 0.375f}}, 0.375f},  // edges count
        {{{0, 0, 0.5f}, {-1.25f, -1, 0.25f}}, 0.25f},
        {{{0, 0, 0.5f}, {0.75f, 0, 0.375f}, {-1.5f, 0, 0.25f}, {0, -1.0625f, 0.25f},
          {0, 1.0625f, 0.25f}}, 0.5f},  // off screen
    };
    for (const auto& each : cases) {
        ovo::ViewerTracker tracker(true);
        for (const auto& [x, y, z] : each.objects) ObserveAt(tracker, shear, x, y, z);
        tracker.EstimateEyes();
        EXPECT_FLOAT_EQ(tracker.EyeDistance(), -each.depth);
        EXPECT_NEAR(tracker.EyeAngle(), Degrees(-each.depth, each.depth), 1e-5);
    }
}

// One object per frame at (0, 0, z, w), unprojected through the last projectable projection.
TEST(ViewerTracker, EstimatesThroughTheLastUsableProjection) {
    // x' = x + offset: any depth at the screen's centre unprojects to x = -offset.
    const float first[16] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0.25f, 0, 0, 1};
    const float second[16] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0.75f, 0, 0, 1};
    const float swap_z_w[16] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 0, 1, 0, 0, 1, 0};
    const float singular[16] = {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1};
    float off_centre[16];
    ovo::Mat4Frustum(off_centre, -1, 2, -1, 1, 1, 10);
    const struct {
        const float* projection;
        float z, w;
        double distance, angle;
    } frames[] = {
        {first, 0.5f, 1, -0.25, Degrees(-0.25, 0.5)},
        {second, 0.5f, 0, -0.25, -90},  // w = 0 cannot be projected
        {second, 0.5f, 1, -0.75, Degrees(-0.75, 0.5)},
        {swap_z_w, 0.5f, 1, -0.75, Degrees(-0.75, 0.5)},  // kept: the reset depth lies at infinity
        {singular, 0.5f, 1, -0.75, Degrees(-0.75, 0.5)},  // kept: no inverse
        {off_centre, -20, 1, 10.0 / 11, Degrees(1, 2)},   // beyond far: the centre line at depth 0
    };
    ovo::ViewerTracker tracker(true), inactive(false);
    for (const auto& frame : frames) {
        ObserveAt(tracker, frame.projection, 0, 0, frame.z, frame.w);
        ObserveAt(inactive, frame.projection, 0, 0, frame.z, frame.w);
        tracker.EstimateEyes();
        inactive.EstimateEyes();
        EXPECT_NEAR(tracker.EyeDistance(), frame.distance, 1e-5) << "frame " << &frame - frames;
        EXPECT_NEAR(tracker.EyeAngle(), frame.angle, 1e-4) << "frame " << &frame - frames;
        EXPECT_EQ(inactive.EyeDistance(), 0.0f);
    }
}

// The processor-time difference behind the panel refresh, across the wrap of a 32-bit
// clock_t (the device's: after 2^31 - 1 ticks it goes on at -2^31) and with a 64-bit one (the
// host's: it never wraps, and a difference beyond 32 bits keeps its low word, as the device's
// would).
struct TicksCase {
    int64_t m_start, m_now;
    int32_t m_ticks;
};

constexpr int64_t MAX32 = INT32_MAX;
constexpr int64_t MIN32 = INT32_MIN;

constexpr TicksCase READINGS_32[] = {
    {0, 100000, 100000},
    {MAX32 - 49999, MIN32 + 50000, 100000},  // over the signed limit
    {-50000, 50000, 100000},                 // over -1 to 0
    {MAX32, MIN32, 1},
    {100000, 0, -100000},                    // a reading behind the start
    {MIN32 + 50000, MAX32 - 49999, -100000},
};

constexpr TicksCase READINGS_64[] = {
    {MAX32 - 49999, MAX32 + 50001, 100000},
    {0xFFFFFFFFLL - 49999, 0x100000000LL + 50000, 100000},
    {int64_t{1} << 40, (int64_t{1} << 40) + 100000, 100000},
    {0, 0x80000000LL, INT32_MIN},
    {0, 0x100000005LL, 5},
};

// The row of the first wrong answer, or -1.
template <typename Reading, size_t COUNT>
constexpr int FirstWrongRow(const TicksCase (&cases)[COUNT]) {
    for (size_t row = 0; row < COUNT; ++row) {
        const Reading start = static_cast<Reading>(cases[row].m_start);
        const Reading now = static_cast<Reading>(cases[row].m_now);
        if (ovo::ProcessorTicksBetween(start, now) != cases[row].m_ticks) return static_cast<int>(row);
    }
    return -1;
}

// Evaluated while compiling, where an overflowing signed subtraction is an error rather than
// a silent wrap.
TEST(ProcessorTicks, AreTheSigned32BitDifferenceOfTwoReadings) {
    constexpr int wrong_32 = FirstWrongRow<int32_t>(READINGS_32);
    constexpr int wrong_64 = FirstWrongRow<int64_t>(READINGS_64);
    EXPECT_EQ(wrong_32, -1);
    EXPECT_EQ(wrong_64, -1);
}

}  // namespace
