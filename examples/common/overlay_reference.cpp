#include "common/overlay_reference.h"

#include <EGL/egl.h>

#include <cstdio>

#include "common/es1_state_guard.h"

namespace ovo_sample {

namespace {

// Screen pixels of parallax per unit of eye shift.
constexpr GLfloat OVERLAY_SHIFT_PIXELS = 400.0f;

template <typename Function>
bool LoadFunction(const char* name, Function* function) {
    *function = reinterpret_cast<Function>(eglGetProcAddress(name));
    return *function != nullptr;
}

}  // namespace

bool OverlayReference::LoadFunctions() {
    return LoadFunction("glGenFramebuffersOES", &m_gen_framebuffers) &&
           LoadFunction("glBindFramebufferOES", &m_bind_framebuffer) &&
           LoadFunction("glFramebufferTexture2DOES", &m_framebuffer_texture) &&
           LoadFunction("glCheckFramebufferStatusOES", &m_check_framebuffer) &&
           LoadFunction("glDeleteFramebuffersOES", &m_delete_framebuffers);
}

bool OverlayReference::Create(const char* program, PixelSize size) {
    if (!LoadFunctions()) {
        std::fprintf(stderr, "%s: no GL_OES_framebuffer_object functions\n", program);
        return false;
    }
    glGenTextures(1, &m_texture);
    glBindTexture(GL_TEXTURE_2D, m_texture);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, size.m_width, size.m_height, 0, GL_RGBA,
                 GL_UNSIGNED_BYTE, nullptr);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
    glBindTexture(GL_TEXTURE_2D, 0);

    m_gen_framebuffers(1, &m_framebuffer);
    m_bind_framebuffer(GL_FRAMEBUFFER_OES, m_framebuffer);
    m_framebuffer_texture(GL_FRAMEBUFFER_OES, GL_COLOR_ATTACHMENT0_OES, GL_TEXTURE_2D,
                          m_texture, 0);
    const GLenum status = m_check_framebuffer(GL_FRAMEBUFFER_OES);
    m_bind_framebuffer(GL_FRAMEBUFFER_OES, 0);
    if (status != GL_FRAMEBUFFER_COMPLETE_OES) {
        std::fprintf(stderr, "%s: the overlay framebuffer is incomplete (0x%04X)\n", program,
                     status);
        return false;
    }
    return true;
}

void OverlayReference::Release() {
    if (m_framebuffer != 0) m_delete_framebuffers(1, &m_framebuffer);
    if (m_texture != 0) glDeleteTextures(1, &m_texture);
    m_framebuffer = 0;
    m_texture = 0;
}

void OverlayReference::Begin() const {
    m_bind_framebuffer(GL_FRAMEBUFFER_OES, m_framebuffer);
    GLfloat clear_color[4];
    GLfloat clear_depth = 1.0f;
    glGetFloatv(GL_COLOR_CLEAR_VALUE, clear_color);
    glGetFloatv(GL_DEPTH_CLEAR_VALUE, &clear_depth);
    glClearColor(0.0f, 0.0f, 0.0f, 0.0f);
    glClearDepthf(1.0f);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    glClearColor(clear_color[0], clear_color[1], clear_color[2], clear_color[3]);
    glClearDepthf(clear_depth);
}

void OverlayReference::End() const { m_bind_framebuffer(GL_FRAMEBUFFER_OES, 0); }

void OverlayReference::DrawHalf(GLfloat left, GLfloat right, GLfloat height, GLint viewport_x,
                                GLsizei viewport_width) const {
    const GLfloat corners[] = {left, 0.0f, 0.0f,  left, height, 0.0f,
                               right, 0.0f, 0.0f, right, height, 0.0f};
    glVertexPointer(3, GL_FLOAT, 0, corners);
    const GLsizei viewport_height = static_cast<GLsizei>(height);
    glViewport(viewport_x, 0, viewport_width, viewport_height);
    glScissor(viewport_x, 0, viewport_width, viewport_height);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
}

void OverlayReference::ComposeStereo(const ReferenceOptions& reference) const {
    const GLfloat width = reference.m_overlay_width;
    const GLfloat height = reference.m_overlay_height;
    const GLfloat shift = reference.m_eye_shift * OVERLAY_SHIFT_PIXELS;
    Es1StateGuard saved;
    saved.Save();

    glColorMask(GL_TRUE, GL_TRUE, GL_TRUE, GL_TRUE);
    glDepthMask(GL_FALSE);
    glEnable(GL_CULL_FACE);
    glCullFace(GL_BACK);
    glFrontFace(GL_CCW);
    glMatrixMode(GL_PROJECTION);
    glPushMatrix();
    glLoadIdentity();
    glOrthof(0.0f, width, height, 0.0f, -1.0f, 1.0f);
    glMatrixMode(GL_TEXTURE);
    glPushMatrix();
    glLoadIdentity();
    glMatrixMode(GL_MODELVIEW);
    glPushMatrix();
    glLoadIdentity();

    glBindTexture(GL_TEXTURE_2D, m_texture);
    glBindBuffer(GL_ARRAY_BUFFER, 0);
    glTexEnvf(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_REPLACE);
    glDisable(GL_DEPTH_TEST);
    glEnable(GL_TEXTURE_2D);
    glEnable(GL_BLEND);
    glBlendFunc(GL_ONE, GL_ONE_MINUS_SRC_ALPHA);
    glDisable(GL_ALPHA_TEST);
    glDisable(GL_LIGHTING);

    // Upright: the quad's top edge (y = 0) takes the texture's top row (t = 1).
    static const GLfloat COORDS[] = {0.0f, 1.0f, 0.0f, 0.0f, 1.0f, 1.0f, 1.0f, 0.0f};
    glTexCoordPointer(2, GL_FLOAT, 0, COORDS);
    glEnableClientState(GL_TEXTURE_COORD_ARRAY);
    glEnableClientState(GL_VERTEX_ARRAY);
    glDisableClientState(GL_COLOR_ARRAY);
    const GLsizei half_width = static_cast<GLsizei>(width);
    DrawHalf(0.0f, width + shift, height, 0, half_width);
    DrawHalf(-shift, width, height, half_width, half_width);

    glMatrixMode(GL_PROJECTION);
    glPopMatrix();
    glMatrixMode(GL_TEXTURE);
    glPopMatrix();
    glMatrixMode(GL_MODELVIEW);
    glPopMatrix();
    saved.Restore();
}

}  // namespace ovo_sample
