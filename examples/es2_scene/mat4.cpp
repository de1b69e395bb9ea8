#include "es2_scene/mat4.h"

#include <cmath>

namespace ovo_sample {

namespace {

constexpr float DEGREES_TO_RADIANS = 3.14159265358979f / 180.0f;

void Normalize(float v[3]) {
    const float length = std::sqrt(v[0] * v[0] + v[1] * v[1] + v[2] * v[2]);
    for (int i = 0; i < 3; ++i) v[i] /= length;
}

void Cross(const float a[3], const float b[3], float out[3]) {
    out[0] = a[1] * b[2] - a[2] * b[1];
    out[1] = a[2] * b[0] - a[0] * b[2];
    out[2] = a[0] * b[1] - a[1] * b[0];
}

float Dot(const float a[3], const float b[3]) { return a[0] * b[0] + a[1] * b[1] + a[2] * b[2]; }

}  // namespace

Mat4 Mat4Identity() {
    Mat4 r = {};
    r.m[0] = r.m[5] = r.m[10] = r.m[15] = 1.0f;
    return r;
}

Mat4 Mat4Multiply(const Mat4& a, const Mat4& b) {
    Mat4 r = {};
    for (int column = 0; column < 4; ++column) {
        for (int row = 0; row < 4; ++row) {
            float sum = 0.0f;
            for (int k = 0; k < 4; ++k) sum += a.m[4 * k + row] * b.m[4 * column + k];
            r.m[4 * column + row] = sum;
        }
    }
    return r;
}

Mat4 Mat4Translate(float x, float y, float z) {
    Mat4 r = Mat4Identity();
    r.m[12] = x;
    r.m[13] = y;
    r.m[14] = z;
    return r;
}

Mat4 Mat4Scale(float x, float y, float z) {
    Mat4 r = Mat4Identity();
    r.m[0] = x;
    r.m[5] = y;
    r.m[10] = z;
    return r;
}

Mat4 Mat4RotateX(float degrees) {
    const float c = std::cos(degrees * DEGREES_TO_RADIANS);
    const float s = std::sin(degrees * DEGREES_TO_RADIANS);
    Mat4 r = Mat4Identity();
    r.m[5] = c;
    r.m[6] = s;
    r.m[9] = -s;
    r.m[10] = c;
    return r;
}

Mat4 Mat4RotateY(float degrees) {
    const float c = std::cos(degrees * DEGREES_TO_RADIANS);
    const float s = std::sin(degrees * DEGREES_TO_RADIANS);
    Mat4 r = Mat4Identity();
    r.m[0] = c;
    r.m[2] = -s;
    r.m[8] = s;
    r.m[10] = c;
    return r;
}

Mat4 Mat4Perspective(float fovy_degrees, float aspect, float near_z, float far_z) {
    const float f = 1.0f / std::tan(fovy_degrees * 0.5f * DEGREES_TO_RADIANS);
    Mat4 r = {};
    r.m[0] = f / aspect;
    r.m[5] = f;
    r.m[10] = (far_z + near_z) / (near_z - far_z);
    r.m[11] = -1.0f;
    r.m[14] = 2.0f * far_z * near_z / (near_z - far_z);
    return r;
}

Mat4 Mat4Ortho(float left, float right, float bottom, float top, float near_z, float far_z) {
    Mat4 r = Mat4Identity();
    r.m[0] = 2.0f / (right - left);
    r.m[5] = 2.0f / (top - bottom);
    r.m[10] = -2.0f / (far_z - near_z);
    r.m[12] = -(right + left) / (right - left);
    r.m[13] = -(top + bottom) / (top - bottom);
    r.m[14] = -(far_z + near_z) / (far_z - near_z);
    return r;
}

Mat4 Mat4LookAt(const float eye[3], const float target[3], const float up[3]) {
    float forward[3] = {target[0] - eye[0], target[1] - eye[1], target[2] - eye[2]};
    Normalize(forward);
    float side[3];
    Cross(forward, up, side);
    Normalize(side);
    float true_up[3];
    Cross(side, forward, true_up);
    Mat4 r = Mat4Identity();
    for (int i = 0; i < 3; ++i) {
        r.m[4 * i + 0] = side[i];
        r.m[4 * i + 1] = true_up[i];
        r.m[4 * i + 2] = -forward[i];
    }
    r.m[12] = -Dot(side, eye);
    r.m[13] = -Dot(true_up, eye);
    r.m[14] = Dot(forward, eye);
    return r;
}

void Mat4NormalMatrix(const Mat4& model, float out[9]) {
    for (int column = 0; column < 3; ++column) {
        for (int row = 0; row < 3; ++row) out[3 * column + row] = model.m[4 * column + row];
    }
}

}  // namespace ovo_sample
