#include "es1_sprites/sprite_draw.h"

namespace ovo_sample {

namespace {
constexpr GLsizei QUAD_VERTICES = 4;
}  // namespace

void BeginSprites() {
    glEnable(GL_TEXTURE_2D);
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_TEXTURE_COORD_ARRAY);
}

void EndSprites() {
    glDisableClientState(GL_TEXTURE_COORD_ARRAY);
    glDisableClientState(GL_VERTEX_ARRAY);
    glDisable(GL_TEXTURE_2D);
}

void DrawQuad(SpriteEyeReference* draws, GLuint texture, GLfloat x, GLfloat y, GLfloat width,
              GLfloat height, const TexRect& uv) {
    const GLfloat positions[] = {x, y, x, y + height, x + width, y, x + width, y + height};
    const GLfloat coords[] = {uv.m_s0, uv.m_t1, uv.m_s0, uv.m_t0,
                              uv.m_s1, uv.m_t1, uv.m_s1, uv.m_t0};
    glBindTexture(GL_TEXTURE_2D, texture);
    glVertexPointer(2, GL_FLOAT, 0, positions);
    glTexCoordPointer(2, GL_FLOAT, 0, coords);
    draws->DrawArrays(GL_TRIANGLE_STRIP, 0, QUAD_VERTICES);
}

void DrawSprite(SpriteEyeReference* draws, GLuint texture, GLfloat x, GLfloat y,
                GLfloat width, GLfloat height, GLfloat degrees) {
    glPushMatrix();
    glTranslatef(x, y, 0.0f);
    // y points down, so a positive turn about +z is clockwise on screen.
    glRotatef(degrees, 0.0f, 0.0f, 1.0f);
    glScalef(width, height, 1.0f);
    DrawQuad(draws, texture, -0.5f, -0.5f, 1.0f, 1.0f, WHOLE_TEXTURE);
    glPopMatrix();
}

}  // namespace ovo_sample
