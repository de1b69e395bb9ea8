#ifndef OVO_EXAMPLES_MAT4_H
#define OVO_EXAMPLES_MAT4_H

#include <cmath>

// Just enough column-major matrix math for the OpenGL ES 2.0 sample.
struct Mat4 {
    float m[16];

    static Mat4 Identity() {
        return {{1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1}};
    }

    static Mat4 Perspective(float fovy_degrees, float aspect, float near, float far) {
        float f = 1.0f / std::tan(fovy_degrees * 3.14159265f / 360.0f);
        Mat4 r{};
        r.m[0] = f / aspect;
        r.m[5] = f;
        r.m[10] = (far + near) / (near - far);
        r.m[11] = -1.0f;
        r.m[14] = 2.0f * far * near / (near - far);
        return r;
    }

    static Mat4 Translation(float x, float y, float z) {
        Mat4 r = Identity();
        r.m[12] = x;
        r.m[13] = y;
        r.m[14] = z;
        return r;
    }

    // Rotation by `degrees` about the unit axis (x, y, z).
    static Mat4 Rotation(float degrees, float x, float y, float z) {
        float a = degrees * 3.14159265f / 180.0f, c = std::cos(a), s = std::sin(a), t = 1 - c;
        return {{t * x * x + c, t * x * y + s * z, t * x * z - s * y, 0,
                 t * x * y - s * z, t * y * y + c, t * y * z + s * x, 0,
                 t * x * z + s * y, t * y * z - s * x, t * z * z + c, 0,
                 0, 0, 0, 1}};
    }

    Mat4 operator*(const Mat4& b) const {
        Mat4 r{};
        for (int column = 0; column < 4; ++column) {
            for (int row = 0; row < 4; ++row) {
                for (int k = 0; k < 4; ++k) r.m[column * 4 + row] += m[k * 4 + row] * b.m[column * 4 + k];
            }
        }
        return r;
    }
};

#endif
