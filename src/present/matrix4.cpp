#include "present/matrix4.h"

#include <cmath>

namespace ovo {

namespace {
// Half the near plane's height, 2 * tan(35 degrees) at near 2: the single-precision value
// with bits 0x3FB340CE.
constexpr float PERSPECTIVE_HALF_HEIGHT = 1.4004152f;
constexpr float PERSPECTIVE_NEAR = 2.0f;
constexpr float PERSPECTIVE_FAR = 1000.0f;

bool IsUsableExtent(float extent) { return extent != 0.0f && std::isfinite(extent); }
}  // namespace

void Mat4Identity(float m[16]) {
    for (int32_t i = 0; i < 16; ++i) m[i] = (i % 5 == 0) ? 1.0f : 0.0f;
}

bool Mat4IsIdentity(const float m[16]) {
    for (int32_t i = 0; i < 16; ++i) {
        if (m[i] != ((i % 5 == 0) ? 1.0f : 0.0f)) return false;
    }
    return true;
}

void Mat4Copy(float dst[16], const float src[16]) {
    for (int32_t i = 0; i < 16; ++i) dst[i] = src[i];
}

void Mat4MulVec4(float out[4], const float m[16], const float v[4]) {
    for (int32_t r = 0; r < 4; ++r) {
        out[r] = m[r] * v[0] + m[4 + r] * v[1] + m[8 + r] * v[2] + m[12 + r] * v[3];
    }
}

bool Mat4Invert(float dst[16], const float src[16]) {
    // aRC is row R, column C.
    const float a00 = src[0], a10 = src[1], a20 = src[2], a30 = src[3];
    const float a01 = src[4], a11 = src[5], a21 = src[6], a31 = src[7];
    const float a02 = src[8], a12 = src[9], a22 = src[10], a32 = src[11];
    const float a03 = src[12], a13 = src[13], a23 = src[14], a33 = src[15];

    // 2x2 minors of the upper two rows (s) and of the lower two rows (c).
    const float s0 = a00 * a11 - a10 * a01;
    const float s1 = a00 * a12 - a10 * a02;
    const float s2 = a00 * a13 - a10 * a03;
    const float s3 = a01 * a12 - a11 * a02;
    const float s4 = a01 * a13 - a11 * a03;
    const float s5 = a02 * a13 - a12 * a03;
    const float c0 = a20 * a31 - a30 * a21;
    const float c1 = a20 * a32 - a30 * a22;
    const float c2 = a20 * a33 - a30 * a23;
    const float c3 = a21 * a32 - a31 * a22;
    const float c4 = a21 * a33 - a31 * a23;
    const float c5 = a22 * a33 - a32 * a23;

    const float determinant = s0 * c5 - s1 * c4 + s2 * c3 + s3 * c2 - s4 * c1 + s5 * c0;
    if (determinant == 0.0f) return false;
    const float scale = 1.0f / determinant;

    float inverse[16];
    inverse[0] = (a11 * c5 - a12 * c4 + a13 * c3) * scale;
    inverse[4] = (-a01 * c5 + a02 * c4 - a03 * c3) * scale;
    inverse[8] = (a31 * s5 - a32 * s4 + a33 * s3) * scale;
    inverse[12] = (-a21 * s5 + a22 * s4 - a23 * s3) * scale;
    inverse[1] = (-a10 * c5 + a12 * c2 - a13 * c1) * scale;
    inverse[5] = (a00 * c5 - a02 * c2 + a03 * c1) * scale;
    inverse[9] = (-a30 * s5 + a32 * s2 - a33 * s1) * scale;
    inverse[13] = (a20 * s5 - a22 * s2 + a23 * s1) * scale;
    inverse[2] = (a10 * c4 - a11 * c2 + a13 * c0) * scale;
    inverse[6] = (-a00 * c4 + a01 * c2 - a03 * c0) * scale;
    inverse[10] = (a30 * s4 - a31 * s2 + a33 * s0) * scale;
    inverse[14] = (-a20 * s4 + a21 * s2 - a23 * s0) * scale;
    inverse[3] = (-a10 * c3 + a11 * c1 - a12 * c0) * scale;
    inverse[7] = (a00 * c3 - a01 * c1 + a02 * c0) * scale;
    inverse[11] = (-a30 * s3 + a31 * s1 - a32 * s0) * scale;
    inverse[15] = (a20 * s3 - a21 * s1 + a22 * s0) * scale;
    Mat4Copy(dst, inverse);
    return true;
}

void Mat4Frustum(float m[16], float left, float right, float bottom, float top, float near_z,
                 float far_z) {
    const float width = right - left;
    const float height = top - bottom;
    const float depth = far_z - near_z;
    if (!IsUsableExtent(width) || !IsUsableExtent(height) || !IsUsableExtent(depth)) return;
    for (int32_t i = 0; i < 16; ++i) m[i] = 0.0f;
    m[0] = 2.0f * near_z / width;
    m[5] = 2.0f * near_z / height;
    m[8] = (right + left) / width;
    m[9] = (top + bottom) / height;
    m[10] = -(far_z + near_z) / depth;
    m[11] = -1.0f;
    m[14] = -2.0f * far_z * near_z / depth;
}

void Mat4Perspective(float m[16], int32_t w, int32_t h) {
    const float aspect = static_cast<float>(w) / static_cast<float>(h);
    const float half_width = PERSPECTIVE_HALF_HEIGHT * aspect;
    Mat4Frustum(m, -half_width, half_width, -PERSPECTIVE_HALF_HEIGHT, PERSPECTIVE_HALF_HEIGHT,
                PERSPECTIVE_NEAR, PERSPECTIVE_FAR);
}

void Mat4PixelProjection(float m[16], float w, float h) {
    Mat4Identity(m);
    m[0] = 2.0f / w;
    m[5] = 2.0f / h;
    m[10] = 2.0f / w;
    // The offsets of an orthographic volume that starts at 0: -1 for every usable size.
    m[12] = -w / w;
    m[13] = -h / h;
    m[14] = -w / w;
}

}  // namespace ovo
