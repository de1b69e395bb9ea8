#include "common/game_viewport.h"

#include <GLES2/gl2.h>

// Only calls that OpenGL ES 1.1 and 2.0 share, so both kinds of sample link this.
namespace ovo_sample {

void SetGameViewport(const ReferenceOptions& reference, int32_t x, int32_t y, int32_t width,
                     int32_t height) {
    if (!reference.m_viewport_scaled) {
        glViewport(x, y, width, height);
        return;
    }
    const float sx = reference.m_scale_x;
    const float sy = reference.m_scale_y;
    // Only the width is rounded; the rest truncates toward zero.
    glViewport(static_cast<GLint>(x * sx), static_cast<GLint>(y * sy),
               static_cast<GLsizei>(0.5f + width * sx), static_cast<GLsizei>(height * sy));
}

}  // namespace ovo_sample
