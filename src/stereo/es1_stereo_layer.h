#ifndef OVO_STEREO_ES1_STEREO_LAYER_H
#define OVO_STEREO_ES1_STEREO_LAYER_H

#include "stereo/drawing_layer.h"

namespace ovo {

// Draws every OpenGL ES 1.x draw once per eye: perspective draws with a per-eye projection
// (the eye moved along the eye axis, its image moved back), flat draws shifted in clip
// space; flat 2D overlay draws go to the overlay target instead.
class Es1StereoLayer : public DrawingLayer {
public:
    void glClear(StereoManager& manager, GLbitfield mask) override;

protected:
    void Draw(StereoManager& manager, const DrawCall& draw) override;
};

}  // namespace ovo

#endif
