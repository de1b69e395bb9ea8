#ifndef OVO_STEREO_EYE_TEXTURE_H
#define OVO_STEREO_EYE_TEXTURE_H

#include "core/gl_api.h"

namespace ovo {

// One eye's copy of a double-width render texture: the texture, the framebuffer it is
// attached to, its size, and the program that copies a texture through a full-screen quad.
struct EyeTexture {
    GLuint m_texture;
    GLuint m_framebuffer;
    GLuint m_width;
    GLuint m_height;
    GLuint m_program;

    // Gives the texture storage of this size unless it has it already.
    void Resize(GLuint width, GLuint height);
    // Copies the left or right half of the bound 2D texture into this one, in the
    // caller's viewport.
    void CopyHalfLeft() const;
    void CopyHalfRight() const;

private:
    void CopyHalf(const GLfloat* coordinates) const;
};

// The two eyes' copies, eye 0 first. Owned by the manager; the GL objects are made by
// the first draw that needs them, in that draw's context, and again after the context
// changed (the old names went with their context).
struct EyeTexturePair {
    EyeTexture m_eyes[2];
    EGLContext m_context;

    // Both eye textures usable in the current context.
    void Prepare();
};

}  // namespace ovo

#endif
