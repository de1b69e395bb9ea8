#ifndef OVO_EXAMPLES_ES1_SPRITES_SPRITE_DRAW_H
#define OVO_EXAMPLES_ES1_SPRITES_SPRITE_DRAW_H

#include <GLES/gl.h>

#include "common/sprite_eye_reference.h"

namespace ovo_sample {

// Screen rectangles in pixels, y down. Texture row 0 is the image's bottom, so t = 1 is a
// quad's top edge.
struct TexRect {
    GLfloat m_s0;
    GLfloat m_t0;
    GLfloat m_s1;
    GLfloat m_t1;
};

constexpr TexRect WHOLE_TEXTURE = {0.0f, 0.0f, 1.0f, 1.0f};

// Vertex and texture coordinate arrays on for the sprite calls below.
void BeginSprites();
void EndSprites();

// `texture` over the rectangle at (x, y) of `width` x `height`, one draw through `draws`.
void DrawQuad(SpriteEyeReference* draws, GLuint texture, GLfloat x, GLfloat y, GLfloat width,
              GLfloat height, const TexRect& uv);

// `texture` as a `width` x `height` sprite centred on (x, y), turned `degrees` clockwise
// on screen, placed with the modelview matrix as many 2D engines do.
void DrawSprite(SpriteEyeReference* draws, GLuint texture, GLfloat x, GLfloat y,
                GLfloat width, GLfloat height, GLfloat degrees);

}  // namespace ovo_sample

#endif
