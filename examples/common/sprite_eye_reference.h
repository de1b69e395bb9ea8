#ifndef OVO_EXAMPLES_COMMON_SPRITE_EYE_REFERENCE_H
#define OVO_EXAMPLES_COMMON_SPRITE_EYE_REFERENCE_H

#include <GLES/gl.h>

#include "common/reference_options.h"

namespace ovo_sample {

// OpenGL ES 1.1 draws of a 2D sprite game, rendered for one eye with a depth plane per
// texture: within a frame the plane starts at -5 and moves 2 nearer at every change of the
// bound 2D texture, wrapping from above 0 back to -5. A flat draw is moved sideways by
// trunc(s * D * plane) * 0.0025 in eye space (eye sign s, eye distance D). Without an eye
// the draws are the game's own.
class SpriteEyeReference {
public:
    explicit SpriteEyeReference(const ReferenceOptions& reference) : m_reference(reference) {}

    void StartFrame();

    // glDrawArrays on the plane of the texture bound now.
    void DrawArrays(GLenum mode, GLint first, GLsizei count);

private:
    GLfloat StepPlane();

    ReferenceOptions m_reference;
    GLfloat m_plane = 0.0f;
    GLuint m_last_texture = 0;
    bool m_first_draw = true;
};

}  // namespace ovo_sample

#endif
