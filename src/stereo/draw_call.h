#ifndef OVO_STEREO_DRAW_CALL_H
#define OVO_STEREO_DRAW_CALL_H

#include "core/gl_api.h"
#include "core/raw_gl.h"

namespace ovo {

// The application's draw, kept so that a layer can issue it once per eye (or into the
// overlay) with its arguments unchanged. glDrawArrays and glDrawElements differ only here.
struct DrawCall {
    GLenum m_mode;
    GLint m_first;          // glDrawArrays
    GLsizei m_count;
    GLenum m_type;          // glDrawElements
    const void* m_indices;  // glDrawElements
    bool m_elements;

    static DrawCall Arrays(GLenum mode, GLint first, GLsizei count) {
        return DrawCall{mode, first, count, 0, nullptr, false};
    }
    static DrawCall Elements(GLenum mode, GLsizei count, GLenum type, const void* indices) {
        return DrawCall{mode, 0, count, type, indices, true};
    }

    void Issue() const {
        if (m_elements) {
            raw::glDrawElements(m_mode, m_count, m_type, m_indices);
        } else {
            raw::glDrawArrays(m_mode, m_first, m_count);
        }
    }
};

}  // namespace ovo

#endif
