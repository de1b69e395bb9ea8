#include "present/matrix_snapshot.h"

#include "core/gl_api.h"
#include "core/raw_gl.h"
#include "present/matrix4.h"

namespace ovo {

uint32_t ClassifyProjection(const float projection[16]) {
    if (projection[11] == 0.0f) return PROJECTION_FLAT;
    if (projection[15] == 1.0f) return PROJECTION_FLAT;
    return PROJECTION_PERSPECTIVE;
}

void MatrixSnapshot::Capture() {
    Mat4Identity(m_projection);
    Mat4Identity(m_modelview);
    // GL's initial mode, in case the query answers nothing (no context bound).
    m_matrix_mode = GL_MODELVIEW;
    raw::glGetFloatv(GL_PROJECTION_MATRIX, m_projection);
    raw::glGetFloatv(GL_MODELVIEW_MATRIX, m_modelview);
    raw::glGetIntegerv(GL_MATRIX_MODE, &m_matrix_mode);
}

bool IsOverlayCandidate(const float modelview[16]) {
    if (!Mat4IsIdentity(modelview)) return false;
    GLint source = GL_ONE;
    GLint destination = GL_ZERO;
    raw::glGetIntegerv(GL_BLEND_SRC, &source);
    raw::glGetIntegerv(GL_BLEND_DST, &destination);
    const bool blending = raw::glIsEnabled(GL_BLEND) != GL_FALSE;
    return !blending || (source == GL_SRC_ALPHA && destination == GL_ONE_MINUS_SRC_ALPHA);
}

void MatrixSnapshot::LoadShiftedProjection(const float t[3]) const {
    raw::glMatrixMode(GL_PROJECTION);
    raw::glLoadIdentity();
    raw::glTranslatef(t[0], t[1], t[2]);
    raw::glMultMatrixf(m_projection);
}

void MatrixSnapshot::LoadEyeProjection(const float t1[3], const float t2[3]) const {
    LoadShiftedProjection(t2);
    raw::glTranslatef(t1[0], t1[1], t1[2]);
}

void RestoreMatrices(const float projection[16], const float modelview[16], int32_t matrix_mode) {
    raw::glMatrixMode(GL_PROJECTION);
    raw::glLoadMatrixf(projection);
    raw::glMatrixMode(GL_MODELVIEW);
    raw::glLoadMatrixf(modelview);
    raw::glMatrixMode(static_cast<GLenum>(matrix_mode));
}

}  // namespace ovo
