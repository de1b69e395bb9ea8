#ifndef OVO_STEREO_EYE_TEXTURE_H
#define OVO_STEREO_EYE_TEXTURE_H

#include "core/gl_api.h"
#include "egl/context_objects.h"

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

// The two eyes' copies, eye 0 first, sharing one copy program: made in one context and
// used, and deleted, only there.
struct EyeTexturePair {
    EyeTexture m_eyes[2];

    // Makes the textures, their framebuffers and the program in the current context.
    void Create();
    void Delete() const;
};

// The eye textures of each context that drew a render texture to its window.
using EyeTextureTable = ContextObjectTable<EGLContext, EyeTexturePair>;

}  // namespace ovo

#endif
