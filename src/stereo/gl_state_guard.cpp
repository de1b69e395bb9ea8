#include "stereo/gl_state_guard.h"

#include "core/raw_gl.h"

namespace ovo {

namespace {

constexpr uint32_t ATTRIBUTE_FLAGS[2] = {GUARD_ATTRIBUTE_0, GUARD_ATTRIBUTE_1};

GLuint IntegerState(GLenum name) {
    GLint value = 0;
    raw::glGetIntegerv(name, &value);
    return static_cast<GLuint>(value);
}

}  // namespace

GlStateGuard::GlStateGuard()
    : m_flags(0), m_attributes{}, m_texture(0), m_program(0), m_framebuffer(0),
      m_depth_test(false) {}

void GlStateGuard::Save(uint32_t flags) {
    *this = GlStateGuard();
    if (flags & GUARD_TEXTURE) m_texture = IntegerState(GL_TEXTURE_BINDING_2D);
    if (flags & GUARD_PROGRAM) m_program = IntegerState(GL_CURRENT_PROGRAM);
    if (flags & GUARD_FRAMEBUFFER) m_framebuffer = IntegerState(GL_FRAMEBUFFER_BINDING);
    for (GLuint index = 0; index < 2; ++index) {
        if (flags & ATTRIBUTE_FLAGS[index]) SaveVertexAttribute(index, m_attributes[index]);
    }
    if (flags & GUARD_DEPTH_TEST) m_depth_test = raw::glIsEnabled(GL_DEPTH_TEST) != GL_FALSE;
    m_flags = flags & GUARD_ALL;
}

void GlStateGuard::Restore() {
    if (m_flags & GUARD_TEXTURE) raw::glBindTexture(GL_TEXTURE_2D, m_texture);
    if (m_flags & GUARD_PROGRAM) raw::glUseProgram(m_program);
    if (m_flags & GUARD_FRAMEBUFFER) raw::glBindFramebuffer(GL_FRAMEBUFFER, m_framebuffer);
    for (GLuint index = 0; index < 2; ++index) {
        if (m_flags & ATTRIBUTE_FLAGS[index]) RestoreVertexAttribute(index, m_attributes[index]);
    }
    if (m_flags & GUARD_DEPTH_TEST) {
        if (m_depth_test) {
            raw::glEnable(GL_DEPTH_TEST);
        } else {
            raw::glDisable(GL_DEPTH_TEST);
        }
    }
    m_flags = 0;
}

}  // namespace ovo
