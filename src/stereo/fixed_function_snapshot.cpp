#include "stereo/fixed_function_snapshot.h"

#include "core/raw_gl.h"
#include "present/matrix4.h"
#include "present/matrix_snapshot.h"

namespace ovo {

FixedFunctionSnapshot::FixedFunctionSnapshot(bool with_texture_matrix)
    : m_matrix_mode(GL_MODELVIEW), m_mag_filter(GL_LINEAR), m_min_filter(GL_NEAREST_MIPMAP_LINEAR) {
    // GL's initial values stand in where a query answers nothing.
    Mat4Identity(m_projection);
    Mat4Identity(m_modelview);
    Mat4Identity(m_texture_matrix);
    raw::glGetFloatv(GL_PROJECTION_MATRIX, m_projection);
    raw::glGetFloatv(GL_MODELVIEW_MATRIX, m_modelview);
    if (with_texture_matrix) raw::glGetFloatv(GL_TEXTURE_MATRIX, m_texture_matrix);
    m_flat = ClassifyProjection(m_projection) == PROJECTION_FLAT;
    raw::glGetIntegerv(GL_MATRIX_MODE, &m_matrix_mode);
    raw::glGetTexParameteriv(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, &m_mag_filter);
    raw::glGetTexParameteriv(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, &m_min_filter);
}

void FixedFunctionSnapshot::Restore() const {
    raw::glTexParameterx(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, m_mag_filter);
    raw::glTexParameterx(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, m_min_filter);
    RestoreMatrices(m_projection, m_modelview, m_matrix_mode);
}

}  // namespace ovo
