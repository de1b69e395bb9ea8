#ifndef OVO_STEREO_FIXED_FUNCTION_SNAPSHOT_H
#define OVO_STEREO_FIXED_FUNCTION_SNAPSHOT_H

#include "core/gl_api.h"

namespace ovo {

// The OpenGL ES 1.x state that the sprite and scaled layers change around one draw: taken
// at its start, put back at its end.
class FixedFunctionSnapshot {
public:
    // The sprite layer also takes the texture matrix (which it never puts back).
    explicit FixedFunctionSnapshot(bool with_texture_matrix);

    bool IsFlat() const { return m_flat; }
    const GLfloat* Projection() const { return m_projection; }
    const GLfloat* Modelview() const { return m_modelview; }

    // Texture filters, then projection, modelview and matrix mode.
    void Restore() const;

private:
    GLfloat m_projection[16];
    GLfloat m_modelview[16];
    GLfloat m_texture_matrix[16];
    bool m_flat;
    GLint m_matrix_mode;
    GLint m_mag_filter;
    GLint m_min_filter;
};

}  // namespace ovo

#endif
