#include "stereo/es2_scaled_layer.h"

#include "core/raw_gl.h"
#include "core/saturating_math.h"
#include "core/stereo_manager.h"
#include "stereo/draw_call.h"
#include "stereo/gl_object_tracker.h"

namespace ovo {

namespace {

GLint Scaled(GLint value, float scale) {
    return SaturatingTrunc(static_cast<float>(value) * scale);
}

}  // namespace

void Es2ScaledLayer::glBindFramebuffer(StereoManager& manager, GLenum target,
                                       GLuint framebuffer) {
    raw::glBindFramebuffer(target, framebuffer);
    manager.m_objects->NoteBoundFramebuffer(framebuffer);
}

void Es2ScaledLayer::glBindTexture(StereoManager& manager, GLenum target, GLuint texture) {
    raw::glBindTexture(target, texture);
    manager.m_objects->NoteBoundTexture(texture);
}

void Es2ScaledLayer::glDeleteTextures(StereoManager& manager, GLsizei n,
                                      const GLuint* textures) {
    raw::glDeleteTextures(n, textures);
    manager.m_objects->NoteDeletedTextures(n, textures);
}

void Es2ScaledLayer::glFramebufferTexture2D(StereoManager& manager, GLenum target,
                                            GLenum attachment, GLenum textarget,
                                            GLuint texture, GLint level) {
    raw::glFramebufferTexture2D(target, attachment, textarget, texture, level);
    manager.m_objects->NoteAttachedTexture(texture);
}

void Es2ScaledLayer::glClear(StereoManager& manager, GLbitfield mask) {
    const GlRect& scissor = manager.m_scissor;
    const float sx = manager.ScaleX();
    const float sy = manager.ScaleY();
    raw::glScissor(Scaled(scissor.m_x, sx), Scaled(scissor.m_y, sy), Scaled(scissor.m_width, sx),
                   Scaled(scissor.m_height, sy));
    raw::glClear(mask);
}

void Es2ScaledLayer::Draw(StereoManager& manager, const DrawCall& draw) {
    const GlRect& viewport = manager.m_viewport;
    if (manager.m_objects->m_current_framebuffer != 0) {
        raw::glViewport(viewport.m_x, viewport.m_y, viewport.m_width, viewport.m_height);
    } else {
        const float sx = manager.ScaleX();
        const float sy = manager.ScaleY();
        raw::glViewport(Scaled(viewport.m_x, sx), Scaled(viewport.m_y, sy),
                        Scaled(viewport.m_width, sx), Scaled(viewport.m_height, sy));
    }
    draw.Issue();
}

}  // namespace ovo
