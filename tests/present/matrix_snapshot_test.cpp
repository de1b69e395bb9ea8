// The projection classification. Capture, the per-eye loads and the restore talk to the
// vendor and are not covered here.
#include <gtest/gtest.h>

#include "present/matrix4.h"
#include "present/matrix_snapshot.h"

namespace {

TEST(MatrixSnapshot, ClassifiesOnlyTrueFrustumsAsPerspective) {
    const float cases[][3] = {// m[11], m[15], perspective
                              {0.0f, 1.0f, 0}, {-0.0f, 0.0f, 0}, {-1.0f, 1.0f, 0},
                              {-1.0f, 0.0f, 1}, {-1e-30f, 0.0f, 1}, {-1.0f, 1.0000001f, 1}};
    for (const auto& each : cases) {
        float m[16];
        ovo::Mat4Identity(m);
        m[11] = each[0];
        m[15] = each[1];
        EXPECT_EQ(ovo::ClassifyProjection(m),
                  each[2] != 0 ? ovo::PROJECTION_PERSPECTIVE : ovo::PROJECTION_FLAT)
            << each[0] << " " << each[1];
    }
    float m[16];
    ovo::Mat4Perspective(m, 800, 480);
    EXPECT_EQ(ovo::ClassifyProjection(m), ovo::PROJECTION_PERSPECTIVE);
    ovo::Mat4PixelProjection(m, 800, 480);
    EXPECT_EQ(ovo::ClassifyProjection(m), ovo::PROJECTION_FLAT);
}

}  // namespace
