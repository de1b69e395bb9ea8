#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <vector>

#include "present/matrix4.h"
#include "present/viewer_tracker.h"

namespace {

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

}  // namespace
