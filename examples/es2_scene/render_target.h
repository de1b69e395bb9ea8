#ifndef OVO_EXAMPLES_ES2_SCENE_RENDER_TARGET_H
#define OVO_EXAMPLES_ES2_SCENE_RENDER_TARGET_H

#include <GLES2/gl2.h>

namespace ovo_sample {

// A framebuffer object drawing into a square RGBA texture with a 16-bit depth buffer, the
// way games render mirrors, monitors and portraits.
class RenderTarget {
public:
    // False after printing why the framebuffer is incomplete.
    bool Create(const char* program, GLsizei size);
    void Delete();

    // Directs drawing into the texture, over all of it.
    void Bind() const;

    GLuint Texture() const { return m_texture; }
    GLsizei Size() const { return m_size; }

private:
    GLuint m_framebuffer = 0;
    GLuint m_texture = 0;
    GLuint m_depth = 0;
    GLsizei m_size = 0;
};

}  // namespace ovo_sample

#endif
