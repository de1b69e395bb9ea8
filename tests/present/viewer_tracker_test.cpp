// The eye estimate from the nearest object of a frame, against closed forms.
#include <gtest/gtest.h>

#include <cmath>

#include "present/matrix4.h"
#include "present/viewer_tracker.h"

namespace {

// x' = x + shear * z + offset * w: unprojecting depth d at the screen's centre gives
// X = -(shear * d + offset), Z = d.
void ShearedProjection(float m[16], float shear, float offset) {
    ovo::Mat4Identity(m);
    m[8] = shear;
    m[12] = offset;
}

// An object whose origin sits at (x, y, z, w) in eye space.
void ObserveAt(ovo::ViewerTracker& tracker, const float projection[16], float x, float y,
               float z, float w = 1.0f) {
    float modelview[16];
    ovo::Mat4Identity(modelview);
    ovo::Vec3Set(modelview + 12, x, y, z);
    modelview[15] = w;
    tracker.Observe(projection, modelview);
}

TEST(ViewerTracker, KeepsTheNearestDepthStrictlyInsideTheView) {
    struct Case {
        const char* name;
        float objects[5][3];  // the shear below moves each x by its z
        int count;
        float depth;
    } cases[] = {
        {"a nearer one lowers it", {{0, 0, 0.5f}, {0, 0, 0.3f}}, 2, 0.3f},
        {"a farther one does not raise it", {{0, 0, 0.3f}, {0, 0, 0.5f}}, 2, 0.3f},
        {"depth 0 does not lower it", {{0, 0, 0.5f}, {0, 0, 0}}, 2, 0.5f},
        {"depth 1, beyond and behind", {{0, 0, 1}, {-1, 0, 1.5f}, {0, 0, -0.2f}}, 3, 0.0f},
        {"edges count", {{0, 0, 0.5f}, {0.5f, 0, 0.5f}, {-1.25f, -1, 0.25f}}, 3, 0.25f},
        {"off screen", {{0, 0, 0.5f}, {0.75f, 0, 0.375f}, {-1.5f, 0, 0.25f},
                        {0, -1.0625f, 0.25f}, {0, 1.0625f, 0.25f}}, 5, 0.5f},
    };
    float projection[16];
    ShearedProjection(projection, 1.0f, 0.0f);
    for (const Case& each : cases) {
        ovo::ViewerTracker tracker(true);
        for (int i = 0; i < each.count; ++i) {
            const float* at = each.objects[i];
            ObserveAt(tracker, projection, at[0], at[1], at[2]);
        }
        tracker.EstimateEyes();
        EXPECT_FLOAT_EQ(tracker.EyeDistance(), -each.depth) << each.name;
        EXPECT_NEAR(tracker.EyeAngle(), each.depth > 0 ? -45.0f : 0.0f, 1e-5f) << each.name;
    }
}

TEST(ViewerTracker, OnlyAnOffCentreFrustumMovesTheEyes) {
    const float near_z = 1, far_z = 10, object_z = -3;
    const float sides[][2] = {{-1, 1}, {-1, 2}};
    for (const auto& side : sides) {
        float projection[16];
        ovo::Mat4Frustum(projection, side[0], side[1], -1, 1, near_z, far_z);
        ovo::ViewerTracker tracker(true);
        ObserveAt(tracker, projection, 0, 0, object_z);
        tracker.EstimateEyes();
        // The screen's centre at the object's depth lies on the frustum's centre line.
        const double x = -(side[0] + side[1]) / (2.0 * near_z) * object_z;
        EXPECT_NEAR(tracker.EyeDistance(), x, 1e-5);
        EXPECT_NEAR(tracker.EyeAngle(), std::atan2(x, -object_z) * 180.0 / M_PI, 1e-4);
    }
}

TEST(ViewerTracker, LastProjectionFollowsEveryProjectableObject) {
    float first[16], second[16];
    ShearedProjection(first, 0.0f, 0.25f);
    ShearedProjection(second, 0.0f, 0.75f);
    ovo::ViewerTracker tracker(true);
    ObserveAt(tracker, first, 0, 0, 0.5f);
    ObserveAt(tracker, second, 0, 0, 0.5f, 0.0f);  // w = 0: not projectable
    tracker.EstimateEyes();
    EXPECT_FLOAT_EQ(tracker.EyeDistance(), -0.25f);
    ObserveAt(tracker, second, 0, 0, 2.0f);  // projectable, though beyond the far plane
    tracker.EstimateEyes();
    EXPECT_FLOAT_EQ(tracker.EyeDistance(), -0.75f);

    ovo::ViewerTracker inactive(false);
    EXPECT_FALSE(inactive.IsEnabled());
    ObserveAt(inactive, first, 0, 0, 0.5f);
    inactive.EstimateEyes();
    EXPECT_EQ(inactive.EyeDistance(), 0.0f) << "an inactive tracker ignores draws";
}

// Also needs the reset after each frame: the first frame's depth, kept, would give
// swap_z_w a finite viewer.
TEST(ViewerTracker, KeepsTheEstimateWithoutAnInverseOrAFiniteViewer) {
    const float swap_z_w[16] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 0, 1, 0, 0, 1, 0};
    const float singular[16] = {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1};
    for (const float* unusable : {swap_z_w, singular}) {
        float projection[16];
        ShearedProjection(projection, 1.0f, 0.25f);
        ovo::ViewerTracker tracker(true);
        ObserveAt(tracker, projection, 0, 0, 0.5f);
        tracker.EstimateEyes();
        const float distance = tracker.EyeDistance(), angle = tracker.EyeAngle();
        ASSERT_FLOAT_EQ(distance, -0.75f);
        ObserveAt(tracker, unusable, 0, 0, 0.5f);
        tracker.EstimateEyes();
        EXPECT_EQ(tracker.EyeDistance(), distance);
        EXPECT_EQ(tracker.EyeAngle(), angle);
    }
}

}  // namespace
