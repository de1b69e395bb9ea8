#ifndef OVO_STEREO_OVERLAY_TARGET_H
#define OVO_STEREO_OVERLAY_TARGET_H

#include <cstdint>

#include "core/gl_api.h"

namespace ovo {

class StereoManager;
struct DrawCall;

// Create the overlay's texture and framebuffer (the manager always asks for them).
constexpr uint32_t OVERLAY_CREATE_OBJECTS = 0x1000;
// The overlay texture's name, used without glGenTextures.
constexpr GLuint OVERLAY_TEXTURE_NAME = 65535;

// An OpenGL ES 1.x game's flat 2D draws (HUD, menus) collected off-screen and later drawn
// into both eyes with one parallax shift, so that they keep their place in front of the 3D
// scene. One per process, owned by the manager; all GL calls go straight to the vendor.
class OverlayTarget {
public:
    OverlayTarget(int32_t width, int32_t height, uint32_t flags);

    // Makes the texture and framebuffer once per reset (eglMakeCurrent with a context).
    void Create();
    // Deletes them before the context goes away. The names are forgotten, so a second
    // release deletes nothing (by then the names may be the application's).
    void Release();
    // The next Create makes the objects again (a new context or window surface).
    void Reset() { m_created = false; }
    // The application bound `framebuffer` itself.
    void SetBoundFramebuffer(GLuint framebuffer) { m_bound_framebuffer = framebuffer; }

    void Bind();
    void Unbind();
    // One overlay draw, unshifted, with the application's viewport and scissor. Dropped
    // when there is no framebuffer.
    void DrawInto(const StereoManager& manager, const DrawCall& draw);
    bool HasContent() const { return m_has_content; }
    // Empties the overlay; the binding the application believes in is kept.
    void Clear();
    // The application's clear, always on the window surface.
    void ClearScreen(GLbitfield mask);
    // The collected overlay as one quad into the window (the scaled layer, plain mode).
    void ComposeSingle(float x, float y, float w, float h, float z, float t);
    // The collected overlay into both side-by-side halves, shifted per eye by the profile's
    // eye shift (in units of 400 pixels).
    void ComposeStereo(const StereoManager& manager, float x, float y, float w, float h, float z,
                       float t);
    // Before a draw that is not an overlay draw: pending overlay content goes into both eyes.
    void Flush(const StereoManager& manager);

    GLuint Texture() const { return m_texture; }
    GLuint Framebuffer() const { return m_framebuffer; }
    GLuint BoundFramebuffer() const { return m_bound_framebuffer; }

private:
    // One quad of a composition: its left and right edge and where its viewport starts.
    struct ComposeQuad {
        float m_left;
        float m_right;
        GLint m_viewport_x;
    };
    void Compose(const ComposeQuad* quads, int32_t quad_count, float y, float w, float h, float z,
                 float t);

    int32_t m_width;
    int32_t m_height;
    GLuint m_texture;
    GLuint m_framebuffer;
    GLuint m_bound_framebuffer;
    bool m_created;
    uint32_t m_flags;
    bool m_has_content;
};

}  // namespace ovo

#endif
