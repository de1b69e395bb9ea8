// The matrix library against matrices written out by rows, a product in double and the
// geometry that the projections must have.
#include <gtest/gtest.h>

#include <cmath>
#include <cstring>

#include "present/matrix4.h"

namespace {

using Rows = float[4][4];

void FromRows(float m[16], const Rows& rows) {
    for (int r = 0; r < 4; ++r)
        for (int c = 0; c < 4; ++c) m[c * 4 + r] = rows[r][c];
}

void Project(float ndc[3], const float m[16], float x, float y, float z) {
    const float point[4] = {x, y, z, 1.0f};
    float clip[4];
    ovo::Mat4MulVec4(clip, m, point);
    for (int i = 0; i < 3; ++i) ndc[i] = clip[i] / clip[3];
}

const Rows INVERTIBLE[] = {
    {{2, -1, 0.5f, 3}, {0.5f, 4, -2, 1}, {1, -3, 3, -1}, {-1.5f, 2, 1, 5}},  // no zero entry
    {{1e-3f, 0, 0, 0}, {0, 1e-3f, 0, 0}, {0, 0, 1e-3f, 0}, {0, 0, 0, 1}},     // tiny det
    {{0, 1, 0, 0}, {0, 0, 0, 1}, {1, 0, 0, 0}, {0, 0, 1, 0}},                 // permutation
};

TEST(Matrix4, IdentityIsExact) {
    const Rows rows = {{1, 0, 0, 0}, {0, 1, 0, 0}, {0, 0, 1, 0}, {0, 0, 0, 1}};
    float m[16], expected[16];
    FromRows(expected, rows);
    for (int i = 0; i < 16; ++i) {
        ovo::Mat4Identity(m);
        EXPECT_EQ(std::memcmp(m, expected, sizeof(m)), 0);
        EXPECT_TRUE(ovo::Mat4IsIdentity(m));
        m[i] += (i % 2) ? 1e-7f : -1e-7f;
        EXPECT_FALSE(ovo::Mat4IsIdentity(m)) << "element " << i;
    }
}

TEST(Matrix4, InverseTimesMatrixIsIdentity) {
    for (const Rows& rows : INVERTIBLE) {
        float m[16], inverse[16];
        FromRows(m, rows);
        ASSERT_TRUE(ovo::Mat4Invert(inverse, m));
        for (int r = 0; r < 4; ++r) {
            for (int c = 0; c < 4; ++c) {
                double product = 0;
                for (int k = 0; k < 4; ++k) product += double(rows[r][k]) * inverse[c * 4 + k];
                EXPECT_NEAR(product, r == c ? 1.0 : 0.0, 1e-5) << "row " << r << " column " << c;
            }
        }
        ASSERT_TRUE(ovo::Mat4Invert(m, m)) << "in place";
        EXPECT_EQ(std::memcmp(m, inverse, sizeof(m)), 0);
    }
}

TEST(Matrix4, DegenerateInputLeavesTheDestination) {
    const Rows singular[] = {
        {{1, 2, 1, 4}, {3, 5, 3, 6}, {7, 8, 7, 9}, {1, 1, 1, 1}},  // equal columns
        {{1, 0, 0, 0}, {0, 1, 0, 0}, {0, 0, 1, 0}, {0, 0, 0, 0}},  // w dropped
    };
    float dst[16], before[16];
    FromRows(dst, INVERTIBLE[0]);
    std::memcpy(before, dst, sizeof(dst));
    for (const Rows& rows : singular) {
        float m[16];
        FromRows(m, rows);
        EXPECT_FALSE(ovo::Mat4Invert(dst, m));
    }
    ovo::Mat4Frustum(dst, 1, 1, -1, 1, 1, 10);  // empty volumes
    ovo::Mat4Frustum(dst, -1, 1, 2, 2, 1, 10);
    ovo::Mat4Frustum(dst, -1, 1, -1, 1, 5, 5);
    ovo::Mat4Perspective(dst, 800, 0);
    EXPECT_EQ(std::memcmp(dst, before, sizeof(dst)), 0);
}

TEST(Matrix4, FrustumMapsItsCornersOntoTheCube) {
    // left, right, bottom, top, near, far
    const float cases[][6] = {{-0.5f, 2, -1.5f, 0.25f, 0.5f, 100}, {1, 3, 2, 5, 2, 4}};
    for (const auto& v : cases) {
        float m[16], ndc[3];
        ovo::Mat4Frustum(m, v[0], v[1], v[2], v[3], v[4], v[5]);
        Project(ndc, m, v[0], v[2], -v[4]);
        for (float value : ndc) EXPECT_NEAR(value, -1.0f, 1e-5f);
        Project(ndc, m, v[1] * v[5] / v[4], v[3] * v[5] / v[4], -v[5]);
        for (float value : ndc) EXPECT_NEAR(value, 1.0f, 1e-5f);
    }
}

TEST(Matrix4, PerspectiveHasSeventyDegreesVertically) {
    const uint32_t bits = 0x3FB340CE;
    float half_height;  // 2 tan 35 degrees
    std::memcpy(&half_height, &bits, sizeof(bits));
    float m[16];
    ovo::Mat4Perspective(m, 800, 480);
    EXPECT_NEAR(m[0], 2.0 / (half_height * 800.0 / 480.0), 1e-6);
    EXPECT_NEAR(m[5], 1.0 / std::tan(35.0 * M_PI / 180.0), 1e-5);
    EXPECT_NEAR(m[10], -1002.0 / 998.0, 1e-6);
    EXPECT_NEAR(m[14], -4000.0 / 998.0, 1e-5);
    EXPECT_EQ(m[11], -1.0f);
    EXPECT_EQ(m[15], 0.0f);
}

TEST(Matrix4, PixelProjectionSpansThePicture) {
    // pixel x, y, z, then where they land; depth scales with the width
    const float points[][6] = {
        {0, 0, 0, -1, -1, -1}, {800, 480, 0, 1, 1, -1}, {400, 120, 400, 0, -0.5f, 0}};
    float m[16], ndc[3];
    ovo::Mat4PixelProjection(m, 800, 480);
    for (const auto& point : points) {
        Project(ndc, m, point[0], point[1], point[2]);
        for (int i = 0; i < 3; ++i) EXPECT_NEAR(ndc[i], point[3 + i], 1e-6f);
    }
}

}  // namespace
