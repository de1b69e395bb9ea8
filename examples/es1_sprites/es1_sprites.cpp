// An OpenGL ES 1.1 2D sprite game: background layers and sprites drawn as textured quads
// under an orthographic projection, with alpha blending and a texture change between draws.
#include <GLES/gl.h>

#include <cmath>
#include <vector>

#include "sample.h"

namespace {

constexpr int TEXTURE_SIZE = 32;

enum SpriteTexture { TEXTURE_SKY, TEXTURE_HILLS, TEXTURE_BALL, TEXTURE_CRATE, TEXTURE_COUNT };

struct Scene {
    GLuint m_textures[TEXTURE_COUNT];
    int m_width, m_height;
} scene;

// Procedural images, RGBA: every texel from its coordinates only.
uint32_t Texel(SpriteTexture texture, int x, int y) {
    auto rgba = [](int r, int g, int b, int a) {
        return static_cast<uint32_t>(r) | static_cast<uint32_t>(g) << 8 | static_cast<uint32_t>(b) << 16 |
               static_cast<uint32_t>(a) << 24;
    };
    switch (texture) {
        case TEXTURE_SKY: return rgba(60 + 4 * y, 110 + 3 * y, 230, 255);
        case TEXTURE_HILLS: {
            int top = 16 + static_cast<int>(8 * std::sin(x * 0.4));
            return y < top ? rgba(40, 140 + 2 * y, 50, 255) : rgba(0, 0, 0, 0);
        }
        case TEXTURE_BALL: {
            int dx = x - 16, dy = y - 16, d = dx * dx + dy * dy;
            return d < 196 ? rgba(240, 200 - d / 2, 40, 255) : rgba(0, 0, 0, 0);
        }
        default: {
            bool edge = x < 3 || y < 3 || x > 28 || y > 28 || x == y || x == 31 - y;
            return edge ? rgba(90, 55, 20, 255) : rgba(180, 120, 60, 220);
        }
    }
}

bool SetUp(int width, int height) {
    scene.m_width = width;
    scene.m_height = height;
    glGenTextures(TEXTURE_COUNT, scene.m_textures);
    std::vector<uint32_t> pixels(TEXTURE_SIZE * TEXTURE_SIZE);
    for (int texture = 0; texture < TEXTURE_COUNT; ++texture) {
        for (int y = 0; y < TEXTURE_SIZE; ++y) {
            for (int x = 0; x < TEXTURE_SIZE; ++x) {
                pixels[y * TEXTURE_SIZE + x] = Texel(static_cast<SpriteTexture>(texture), x, y);
            }
        }
        glBindTexture(GL_TEXTURE_2D, scene.m_textures[texture]);
        glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_NEAREST);
        glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_NEAREST);
        glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_REPEAT);
        glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, TEXTURE_SIZE, TEXTURE_SIZE, 0, GL_RGBA,
                     GL_UNSIGNED_BYTE, pixels.data());
    }
    return true;
}

void DrawSprite(SpriteTexture texture, float x, float y, float width, float height, float repeat = 1) {
    const GLfloat corners[] = {x, y, x + width, y, x, y + height, x + width, y + height};
    const GLfloat texcoords[] = {0, 0, repeat, 0, 0, 1, repeat, 1};
    glBindTexture(GL_TEXTURE_2D, scene.m_textures[texture]);
    glVertexPointer(2, GL_FLOAT, 0, corners);
    glTexCoordPointer(2, GL_FLOAT, 0, texcoords);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
}

void DrawFrame(int frame) {
    glViewport(0, 0, scene.m_width, scene.m_height);
    glClearColor(0, 0, 0, 1);
    glClear(GL_COLOR_BUFFER_BIT);
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glOrthof(0, static_cast<float>(scene.m_width), 0, static_cast<float>(scene.m_height), -1, 1);
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
    glEnable(GL_TEXTURE_2D);
    glEnable(GL_BLEND);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_TEXTURE_COORD_ARRAY);

    float width = static_cast<float>(scene.m_width);
    float height = static_cast<float>(scene.m_height);
    DrawSprite(TEXTURE_SKY, 0, 0, width, height);
    DrawSprite(TEXTURE_HILLS, -6.0f * frame, 0, width + 64, 120, 6);
    for (int crate = 0; crate < 4; ++crate) {
        DrawSprite(TEXTURE_CRATE, 40.0f + 56 * crate, 30, 48, 48);
        DrawSprite(TEXTURE_BALL, 52.0f + 56 * crate + 4 * frame, 90 + 10.0f * (crate % 2), 24, 24);
    }
    DrawSprite(TEXTURE_CRATE, 236, 78, 48, 48);

    glDisableClientState(GL_TEXTURE_COORD_ARRAY);
    glDisableClientState(GL_VERTEX_ARRAY);
    glDisable(GL_BLEND);
    glDisable(GL_TEXTURE_2D);
}

}  // namespace

const Sample SAMPLE = {"es1_sprites", 1, SetUp, DrawFrame};
