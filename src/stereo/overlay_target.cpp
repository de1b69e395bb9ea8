#include "stereo/overlay_target.h"

#include "core/raw_gl.h"
#include "core/saturating_math.h"
#include "core/stereo_manager.h"
#include "stereo/draw_call.h"

namespace ovo {

namespace {
// The overlay is cleared as an 800 x 480 target, whatever its size.
constexpr GLsizei OVERLAY_CLEAR_WIDTH = 800;
constexpr GLsizei OVERLAY_CLEAR_HEIGHT = 480;
}  // namespace

OverlayTarget::OverlayTarget(int32_t width, int32_t height, uint32_t flags)
    : m_width(width),
      m_height(height),
      m_texture(0),
      m_framebuffer(0),
      m_bound_framebuffer(0),
      m_created(false),
      m_flags(flags),
      m_has_content(false) {}

void OverlayTarget::Create() {
    if (m_created) return;
    m_created = true;
    if ((m_flags & OVERLAY_CREATE_OBJECTS) == 0) return;

    m_texture = OVERLAY_TEXTURE_NAME;
    raw::glBindTexture(GL_TEXTURE_2D, m_texture);
    raw::glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, m_width, m_height, 0, GL_RGBA, GL_UNSIGNED_BYTE,
                      nullptr);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
    raw::glBindTexture(GL_TEXTURE_2D, 0);

    GLint previous = 0;
    raw::glGetIntegerv(GL_FRAMEBUFFER_BINDING_OES, &previous);
    raw::glGenFramebuffersOES(1, &m_framebuffer);
    raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, m_framebuffer);
    if (m_texture != 0) {
        raw::glFramebufferTexture2DOES(GL_FRAMEBUFFER_OES, GL_COLOR_ATTACHMENT0_OES, GL_TEXTURE_2D,
                                       m_texture, 0);
    }
    raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, static_cast<GLuint>(previous));
    m_bound_framebuffer = 0;
}

void OverlayTarget::Release() {
    if (!m_created) return;
    if (m_texture != 0) raw::glDeleteTextures(1, &m_texture);
    if (m_framebuffer != 0) raw::glDeleteFramebuffersOES(1, &m_framebuffer);
    m_texture = 0;
    m_framebuffer = 0;
}

void OverlayTarget::Bind() {
    if (m_bound_framebuffer != 0) return;
    m_bound_framebuffer = m_framebuffer;
    raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, m_framebuffer);
}

void OverlayTarget::Unbind() {
    if (m_bound_framebuffer != m_framebuffer) return;
    m_bound_framebuffer = 0;
    raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, 0);
}

void OverlayTarget::DrawInto(const StereoManager& manager, const DrawCall& draw) {
    if (m_framebuffer == 0) return;
    Bind();
    m_has_content = true;
    const GlRect& viewport = manager.m_viewport;
    const GlRect& scissor = manager.m_scissor;
    raw::glViewport(viewport.m_x, viewport.m_y, viewport.m_width, viewport.m_height);
    raw::glScissor(scissor.m_x, scissor.m_y, scissor.m_width, scissor.m_height);
    draw.Issue();
}

void OverlayTarget::Clear() {
    if (m_framebuffer == 0) return;
    const bool elsewhere = m_bound_framebuffer != m_framebuffer;
    if (elsewhere) raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, m_framebuffer);
    raw::glViewport(0, 0, OVERLAY_CLEAR_WIDTH, OVERLAY_CLEAR_HEIGHT);
    raw::glScissor(0, 0, OVERLAY_CLEAR_WIDTH, OVERLAY_CLEAR_HEIGHT);
    GLfloat color[4] = {0.0f, 0.0f, 0.0f, 0.0f};
    GLfloat depth = 1.0f;
    raw::glGetFloatv(GL_COLOR_CLEAR_VALUE, color);
    raw::glGetFloatv(GL_DEPTH_CLEAR_VALUE, &depth);
    raw::glClearColor(0.0f, 0.0f, 0.0f, 0.0f);
    raw::glClearDepthf(1.0f);
    raw::glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    raw::glClearColor(color[0], color[1], color[2], color[3]);
    raw::glClearDepthf(depth);
    m_has_content = false;
    if (elsewhere) raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, m_bound_framebuffer);
}

void OverlayTarget::ClearScreen(GLbitfield mask) {
    if (m_framebuffer != 0 && m_bound_framebuffer == m_framebuffer) {
        raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, 0);
        raw::glClear(mask);
        raw::glBindFramebufferOES(GL_FRAMEBUFFER_OES, m_framebuffer);
    } else {
        raw::glClear(mask);
    }
}

void OverlayTarget::ComposeSingle(float x, float y, float w, float h, float z, float t) {
    const ComposeQuad quad = {x, x + w, 0};
    Compose(&quad, 1, y, w, h, z, t);
}

void OverlayTarget::ComposeStereo(const StereoManager& manager, float x, float y, float w,
                                  float h, float z, float t) {
    // Every point lies `shift` pixels further right in eye 0 than in eye 1: one depth for
    // the whole overlay, whatever the split and eye order.
    const float shift = manager.m_profile->m_eye_shift * 400.0f;
    const ComposeQuad quads[2] = {{x, x + w + shift, 0},
                                  {x - shift, x + w, SaturatingTrunc(w)}};
    Compose(quads, 2, y, w, h, z, t);
}

void OverlayTarget::Flush(const StereoManager& manager) {
    if (!manager.m_profile->m_eye_target) return;
    if (m_has_content) {
        ComposeStereo(manager, 0.0f, 0.0f, 640.0f, 720.0f, 0.0f, 1.0f);
        Clear();
    }
    Unbind();
}

}  // namespace ovo
