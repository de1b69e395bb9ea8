#ifndef OVO_PRESENT_MATRIX4_H
#define OVO_PRESENT_MATRIX4_H

#include <cstdint>

// Column-major 4x4 single-precision matrices as OpenGL ES keeps them: m[4c + r] is row r,
// column c, the translation is m[12], m[13], m[14]. Vectors are plain arrays of 3 or 4.
namespace ovo {

void Mat4Identity(float m[16]);

// Exact comparison: a game's "identity" that drifted by a rounding step is not one.
bool Mat4IsIdentity(const float m[16]);

void Mat4Copy(float dst[16], const float src[16]);

inline float Mat4Element(const float m[16], int32_t i) { return m[i]; }

// out = m x v; out may not alias v.
void Mat4MulVec4(float out[4], const float m[16], const float v[4]);

// dst = src^-1. A determinant of exactly 0 leaves dst as it was and answers false; dst
// may be src.
bool Mat4Invert(float dst[16], const float src[16]);

// The matrix glFrustumf loads. Left as it was when a width, height or depth of the volume
// is zero or not finite, where glFrustumf would refuse too.
void Mat4Frustum(float m[16], float left, float right, float bottom, float top, float near_z,
                 float far_z);

// 70 degrees of vertical field of view for a w x h picture, near 2, far 1000.
void Mat4Perspective(float m[16], int32_t w, int32_t h);

// Maps pixel x in [0, w] and y in [0, h] onto [-1, 1]; z = 0 lands at depth -1.
void Mat4PixelProjection(float m[16], float w, float h);

inline void Vec3Set(float v[3], float x, float y, float z) {
    v[0] = x;
    v[1] = y;
    v[2] = z;
}

inline void Vec3Zero(float v[3]) { Vec3Set(v, 0.0f, 0.0f, 0.0f); }

}  // namespace ovo

#endif
