#ifndef OVO_EXAMPLES_ES2_SCENE_MAT4_H
#define OVO_EXAMPLES_ES2_SCENE_MAT4_H

namespace ovo_sample {

// A column-major 4x4 matrix as glUniformMatrix4fv takes it: m[4 * column + row].
struct Mat4 {
    float m[16];
};

Mat4 Mat4Identity();
Mat4 Mat4Multiply(const Mat4& a, const Mat4& b);  // a x b: b applies first
Mat4 Mat4Translate(float x, float y, float z);
Mat4 Mat4Scale(float x, float y, float z);
Mat4 Mat4RotateX(float degrees);
Mat4 Mat4RotateY(float degrees);
Mat4 Mat4Perspective(float fovy_degrees, float aspect, float near_z, float far_z);
Mat4 Mat4Ortho(float left, float right, float bottom, float top, float near_z, float far_z);
Mat4 Mat4LookAt(const float eye[3], const float target[3], const float up[3]);

// The upper 3x3 of `model`, column-major, for normals. Exact for rotations and uniform
// scales, which is all the scene uses; the shader renormalises.
void Mat4NormalMatrix(const Mat4& model, float out[9]);

}  // namespace ovo_sample

#endif
