#include "common/sprite_eye_reference.h"

#include <cstdint>

namespace ovo_sample {

namespace {

constexpr GLfloat SPRITE_PLANE_FIRST = -5.0f;
constexpr GLfloat SPRITE_PLANE_STEP = 2.0f;
// Eye-space x per whole unit of eye distance times plane.
constexpr GLfloat SPRITE_SHIFT_UNIT = 0.0025f;
constexpr int SPRITE_MATRIX_ELEMENTS = 16;

// An orthographic projection: no perspective divide row.
bool IsFlat(const GLfloat* projection) {
    return projection[11] == 0.0f || projection[15] == 1.0f;
}

}  // namespace

void SpriteEyeReference::StartFrame() {
    m_plane = SPRITE_PLANE_FIRST;
    m_last_texture = 0;
    m_first_draw = true;
}

GLfloat SpriteEyeReference::StepPlane() {
    GLint bound = 0;
    glGetIntegerv(GL_TEXTURE_BINDING_2D, &bound);
    const GLuint texture = static_cast<GLuint>(bound);
    if (texture != m_last_texture) {
        m_last_texture = texture;
        if (!m_first_draw) m_plane += SPRITE_PLANE_STEP;
        if (m_plane > 0.0f) m_plane = SPRITE_PLANE_FIRST;
    }
    m_first_draw = false;
    return m_plane;
}

void SpriteEyeReference::DrawArrays(GLenum mode, GLint first, GLsizei count) {
    if (!m_reference.HasEye()) {
        glDrawArrays(mode, first, count);
        return;
    }
    const GLfloat plane = StepPlane();
    GLfloat projection[SPRITE_MATRIX_ELEMENTS];
    glGetFloatv(GL_PROJECTION_MATRIX, projection);
    if (!IsFlat(projection)) {
        glDrawArrays(mode, first, count);
        return;
    }
    // Truncated to whole units before scaling, so small products do not move at all.
    const int32_t units =
        static_cast<int32_t>(m_reference.EyeSign() * m_reference.m_eye_distance * plane);
    GLint matrix_mode = GL_MODELVIEW;
    glGetIntegerv(GL_MATRIX_MODE, &matrix_mode);
    glMatrixMode(GL_PROJECTION);
    glLoadMatrixf(projection);
    glTranslatef(static_cast<GLfloat>(units) * SPRITE_SHIFT_UNIT, 0.0f, 0.0f);
    glDrawArrays(mode, first, count);
    glLoadMatrixf(projection);
    glMatrixMode(static_cast<GLenum>(matrix_mode));
}

}  // namespace ovo_sample
