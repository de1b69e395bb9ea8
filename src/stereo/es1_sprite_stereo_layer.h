#ifndef OVO_STEREO_ES1_SPRITE_STEREO_LAYER_H
#define OVO_STEREO_ES1_SPRITE_STEREO_LAYER_H

#include "core/gl_layer.h"

namespace ovo {

struct DrawCall;

// For the listed 2D sprite games: every draw once per eye, flat draws shifted by the depth
// plane of their texture.
class Es1SpriteStereoLayer : public GlLayer {
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
