#include <gtest/gtest.h>

#include <cmath>
#include <cstring>

#include "present/matrix4.h"
#include "present/matrix_snapshot.h"

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

}  // namespace
