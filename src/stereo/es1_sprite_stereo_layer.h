#ifndef OVO_STEREO_ES1_SPRITE_STEREO_LAYER_H
#define OVO_STEREO_ES1_SPRITE_STEREO_LAYER_H

#include "stereo/drawing_layer.h"

namespace ovo {

// For the listed 2D sprite games: every draw once per eye, flat draws shifted by the depth
// plane of their texture.
class Es1SpriteStereoLayer : public DrawingLayer {
public:
    void glClear(StereoManager& manager, GLbitfield mask) override;

protected:
    void Draw(StereoManager& manager, const DrawCall& draw) override;
};

}  // namespace ovo

#endif
