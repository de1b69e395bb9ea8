#ifndef OVO_STEREO_GL_STATE_GUARD_H
#define OVO_STEREO_GL_STATE_GUARD_H

#include <cstdint>

#include "core/gl_api.h"
#include "core/vertex_attribute_state.h"

namespace ovo {

// What a GlStateGuard saves.
constexpr uint32_t GUARD_TEXTURE = 1;
constexpr uint32_t GUARD_PROGRAM = 2;
constexpr uint32_t GUARD_ATTRIBUTE_0 = 4;
constexpr uint32_t GUARD_ATTRIBUTE_1 = 8;
constexpr uint32_t GUARD_DEPTH_TEST = 16;
constexpr uint32_t GUARD_FRAMEBUFFER = 32;
constexpr uint32_t GUARD_ALL = 63;

// The OpenGL ES 2.0 bindings that the library's own drawing disturbs, saved before it and
// put back after it.
class GlStateGuard {
public:
    GlStateGuard();

    void Save(uint32_t flags);
    // Puts back what was saved, once: a second restore does nothing. The array buffer
    // binding is left at the last restored attribute's buffer.
    void Restore();

private:
    uint32_t m_flags;
    VertexAttributeState m_attributes[2];
    GLuint m_texture;
    GLuint m_program;
    GLuint m_framebuffer;
    bool m_depth_test;
};

}  // namespace ovo

#endif
