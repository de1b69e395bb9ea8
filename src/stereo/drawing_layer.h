#ifndef OVO_STEREO_DRAWING_LAYER_H
#define OVO_STEREO_DRAWING_LAYER_H

#include "core/gl_layer.h"

namespace ovo {

struct DrawCall;

// A layer whose glDrawArrays and glDrawElements differ only in the draw they pass on.
class DrawingLayer : public GlLayer {
public:
    void glDrawArrays(StereoManager& manager, GLenum mode, GLint first, GLsizei count) final;
    void glDrawElements(StereoManager& manager, GLenum mode, GLsizei count, GLenum type,
                        const void* indices) final;

protected:
    virtual void Draw(StereoManager& manager, const DrawCall& draw) = 0;
};

}  // namespace ovo

#endif
