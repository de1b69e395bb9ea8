#ifndef OVO_STEREO_ES1_SCALED_LAYER_H
#define OVO_STEREO_ES1_SCALED_LAYER_H

#include "core/gl_layer.h"

namespace ovo {

struct DrawCall;

// The plain mode's OpenGL ES 1.x layer: every draw once, its viewport scaled from the
// game's size to the output size.
class Es1ScaledLayer : public GlLayer {
public:
    void glClear(StereoManager& manager, GLbitfield mask) override;
    void glDrawArrays(StereoManager& manager, GLenum mode, GLint first, GLsizei count) override;
    void glDrawElements(StereoManager& manager, GLenum mode, GLsizei count, GLenum type,
                        const void* indices) override;

private:
    static void Draw(StereoManager& manager, const DrawCall& draw);
};

}  // namespace ovo

#endif
