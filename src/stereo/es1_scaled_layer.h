#ifndef OVO_STEREO_ES1_SCALED_LAYER_H
#define OVO_STEREO_ES1_SCALED_LAYER_H

#include "stereo/drawing_layer.h"

namespace ovo {

// The plain mode's OpenGL ES 1.x layer: every draw once, its viewport scaled from the
// game's size to the output size.
class Es1ScaledLayer : public DrawingLayer {
public:
    void glClear(StereoManager& manager, GLbitfield mask) override;

protected:
    void Draw(StereoManager& manager, const DrawCall& draw) override;
};

}  // namespace ovo

#endif
