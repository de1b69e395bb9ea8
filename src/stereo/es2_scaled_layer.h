#ifndef OVO_STEREO_ES2_SCALED_LAYER_H
#define OVO_STEREO_ES2_SCALED_LAYER_H

#include "stereo/drawing_layer.h"

namespace ovo {

// The plain mode's OpenGL ES 2.0 layer: every draw once, its viewport scaled from the
// game's size to the output size when it goes to the window.
class Es2ScaledLayer : public DrawingLayer {
public:
    void glBindFramebuffer(StereoManager& manager, GLenum target, GLuint framebuffer) override;
    void glBindTexture(StereoManager& manager, GLenum target, GLuint texture) override;
    void glClear(StereoManager& manager, GLbitfield mask) override;
    void glDeleteTextures(StereoManager& manager, GLsizei n, const GLuint* textures) override;
    void glFramebufferTexture2D(StereoManager& manager, GLenum target, GLenum attachment,
                                GLenum textarget, GLuint texture, GLint level) override;

protected:
    void Draw(StereoManager& manager, const DrawCall& draw) override;
};

}  // namespace ovo

#endif
