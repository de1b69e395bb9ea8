#ifndef OVO_STEREO_ES1_STEREO_LAYER_H
#define OVO_STEREO_ES1_STEREO_LAYER_H

#include "core/gl_layer.h"

namespace ovo {

struct DrawCall;

// Draws every OpenGL ES 1.x draw once per eye: perspective draws with a per-eye projection
// (the eye moved along the eye axis, its image moved back), flat draws shifted in clip
// space; flat 2D overlay draws go to the overlay target instead.
class Es1StereoLayer : public GlLayer {
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
