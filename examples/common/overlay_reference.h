#ifndef OVO_EXAMPLES_COMMON_OVERLAY_REFERENCE_H
#define OVO_EXAMPLES_COMMON_OVERLAY_REFERENCE_H

#include <GLES/gl.h>
#include <GLES/glext.h>

#include "common/reference_options.h"
#include "common/sample_args.h"

namespace ovo_sample {

// OpenGL ES 1.1 with GL_OES_framebuffer_object: a game's 2D overlay collected in a texture
// and then drawn over the frame once per eye half, side by side, each half with its own
// parallax; the image that a converter with an overlay target shows for both eyes.
class OverlayReference {
public:
    // An RGBA texture of `size` (linear, clamped) as the only attachment of a framebuffer.
    // False after printing why (under the name `program`).
    bool Create(const char* program, PixelSize size);
    void Release();

    // The following draws go into the texture, cleared to transparent black first.
    void Begin() const;
    // The following draws go to the window again.
    void End() const;

    // Draws the texture over the window as two quads in a y-down pixel projection of the
    // reference's overlay width W and height H: into (0, 0, W, H) stretched from 0 to W + p,
    // then into (W, 0, W, H) stretched from -p to W, p = eye shift * 400 pixels; the colour
    // is taken as premultiplied. The GL state is put back afterwards.
    void ComposeStereo(const ReferenceOptions& reference) const;

private:
    bool LoadFunctions();
    void DrawHalf(GLfloat left, GLfloat right, GLfloat height, GLint viewport_x,
                  GLsizei viewport_width) const;

    PFNGLGENFRAMEBUFFERSOESPROC m_gen_framebuffers = nullptr;
    PFNGLBINDFRAMEBUFFEROESPROC m_bind_framebuffer = nullptr;
    PFNGLFRAMEBUFFERTEXTURE2DOESPROC m_framebuffer_texture = nullptr;
    PFNGLCHECKFRAMEBUFFERSTATUSOESPROC m_check_framebuffer = nullptr;
    PFNGLDELETEFRAMEBUFFERSOESPROC m_delete_framebuffers = nullptr;
    GLuint m_texture = 0;
    GLuint m_framebuffer = 0;
};

}  // namespace ovo_sample

#endif
