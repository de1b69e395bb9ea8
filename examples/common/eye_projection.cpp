#include "common/eye_projection.h"

#include <GLES/gl.h>

namespace ovo_sample {

namespace {

constexpr int EYE_MATRIX_ELEMENTS = 16;

// T(clip_x, 0, 0) · P, then · T(*eye_x, 0, 0) when eye_x is given. Built with the same GL
// calls as a converter that captures P, so that the floats round alike.
void RebuildProjection(GLfloat clip_x, const GLfloat* eye_x) {
    GLint mode = GL_MODELVIEW;
    glGetIntegerv(GL_MATRIX_MODE, &mode);
    GLfloat projection[EYE_MATRIX_ELEMENTS];
    glGetFloatv(GL_PROJECTION_MATRIX, projection);
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glTranslatef(clip_x, 0.0f, 0.0f);
    glMultMatrixf(projection);
    if (eye_x != nullptr) glTranslatef(*eye_x, 0.0f, 0.0f);
    glMatrixMode(static_cast<GLenum>(mode));
}

}  // namespace

void LoadEyePerspective(const ReferenceOptions& reference) {
    if (!reference.HasEye()) return;
    const GLfloat sign = reference.EyeSign();
    const GLfloat eye_x = sign * reference.m_eye_distance;
    RebuildProjection(-(sign * reference.m_eye_angle), &eye_x);
}

void LoadEyeFlat(const ReferenceOptions& reference) {
    if (!reference.HasEye()) return;
    RebuildProjection(reference.EyeSign() * reference.m_eye_shift, nullptr);
}

}  // namespace ovo_sample
