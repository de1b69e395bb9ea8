#include "es1_sprites/sprite_scene.h"

#include <cmath>

#include "common/game_viewport.h"
#include "common/gl_texture.h"
#include "es1_sprites/sprite_draw.h"
#include "es1_sprites/sprite_images.h"

namespace ovo_sample {

namespace {

constexpr GLfloat TILE = 32.0f;
constexpr GLfloat FLOOR_TOP = 200.0f;
constexpr GLfloat FAR_HILLS_TOP = 96.0f;
constexpr GLfloat NEAR_HILLS_TOP = 120.0f;
constexpr GLfloat HILLS_HEIGHT = 96.0f;
constexpr GLfloat HILLS_TEXTURE_WIDTH = 128.0f;
// Pixels per frame; the nearer layer moves faster.
constexpr GLfloat FAR_SCROLL = 1.5f;
constexpr GLfloat NEAR_SCROLL = 4.0f;
constexpr GLfloat CLOUD_DRIFT = 2.0f;
constexpr GLfloat SCORE_BAR_HEIGHT = 20.0f;

const TextureSampling SMOOTH = {GL_LINEAR, GL_LINEAR, GL_CLAMP_TO_EDGE, GL_CLAMP_TO_EDGE};
const TextureSampling PIXEL_ART = {GL_NEAREST, GL_NEAREST, GL_CLAMP_TO_EDGE, GL_CLAMP_TO_EDGE};
// Repeats sideways only: wrapping vertically would bleed the hills' foot into their top.
const TextureSampling SCROLLING = {GL_LINEAR, GL_LINEAR, GL_REPEAT, GL_CLAMP_TO_EDGE};

struct Cloud {
    GLfloat m_x;
    GLfloat m_y;
    GLfloat m_width;
    GLfloat m_alpha;
};

constexpr Cloud CLOUDS[] = {
    {40, 40, 70, 0.9f}, {70, 52, 50, 0.8f}, {170, 30, 90, 0.85f}, {210, 44, 60, 0.7f},
    {290, 62, 64, 0.8f}, {130, 78, 40, 0.6f},
};

// Coins and enemies in level order, so the bound texture changes from one draw to the next.
struct Actor {
    bool m_enemy;
    GLfloat m_x;
    GLfloat m_y;
    GLfloat m_tint[3];
};

constexpr Actor ACTORS[] = {
    {false, 200, 104, {1, 1, 1}},     {true, 150, 150, {1.0f, 0.3f, 0.3f}},
    {false, 224, 96, {1, 1, 1}},      {false, 248, 92, {1, 1, 1}},
    {true, 268, 176, {1.0f, 0.9f, 0.2f}}, {false, 272, 96, {1, 1, 1}},
    {false, 296, 104, {1, 1, 1}},     {true, 40, 120, {0.8f, 0.4f, 1.0f}},
    {false, 120, 176, {1, 1, 1}},
};

constexpr GLfloat PLAYER_X = 80.0f;
constexpr GLfloat PLAYER_Y = 176.0f;
constexpr int32_t SPARK_COUNT = 14;

}  // namespace

bool SpriteScene::Init(const char* /*program*/, int32_t width, int32_t height) {
    m_width = width;
    m_height = height;
    m_textures[TEXTURE_SKY] = CreateTexture(
        MakeVerticalGradient(4, 64, {250, 200, 150, 255}, {70, 120, 210, 255}), SMOOTH);
    m_textures[TEXTURE_FAR_HILLS] = CreateTexture(
        MakeHills(128, 64, 0.0f, 0.55f, {90, 110, 160, 255}, {140, 160, 200, 255}), SCROLLING);
    m_textures[TEXTURE_NEAR_HILLS] = CreateTexture(
        MakeHills(128, 64, 2.0f, 0.45f, {40, 110, 60, 255}, {90, 170, 80, 255}), SCROLLING);
    m_textures[TEXTURE_CLOUD] =
        CreateTexture(MakeDisc(64, {255, 255, 255, 230}, {225, 235, 250, 255}, 0.7f), SMOOTH);
    m_textures[TEXTURE_GRASS] = CreateTexture(MakeGrassTile(32), PIXEL_ART);
    m_textures[TEXTURE_BRICK] = CreateTexture(MakeBricks(32), PIXEL_ART);
    m_textures[TEXTURE_COIN] =
        CreateTexture(MakeDisc(32, {255, 235, 90, 255}, {200, 130, 0, 255}, 0.08f), SMOOTH);
    m_textures[TEXTURE_STAR] = CreateTexture(MakeStar(32), SMOOTH);
    m_textures[TEXTURE_PLAYER] = CreateTexture(MakeCharacter(32), SMOOTH);
    m_textures[TEXTURE_GLOW] =
        CreateTexture(MakeDisc(16, {255, 240, 180, 255}, {255, 120, 40, 255}, 1.0f), SMOOTH);
    return true;
}

void SpriteScene::Release() {
    for (GLuint& texture : m_textures) DeleteTexture(&texture);
}

void SpriteScene::DrawFrame(int32_t frame) {
    SetGameViewport(m_reference, 0, 0, m_width, m_height);
    glClearColor(0.0f, 0.0f, 0.0f, 1.0f);
    glClear(GL_COLOR_BUFFER_BIT);

    // Pixels, y down, as 2D games lay out their screens.
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glOrthof(0.0f, static_cast<GLfloat>(m_width), static_cast<GLfloat>(m_height), 0.0f, -1.0f,
             1.0f);
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
    glDisable(GL_DEPTH_TEST);
    glDisable(GL_CULL_FACE);
    glTexEnvf(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_MODULATE);

    m_draws.StartFrame();
    BeginSprites();
    DrawBackground(frame);
    DrawLevel();
    DrawActors(frame);
    DrawSparks(frame);
    EndSprites();
    DrawScoreBar();
}

void SpriteScene::DrawBackground(int32_t frame) {
    const GLfloat width = static_cast<GLfloat>(m_width);
    glDisable(GL_BLEND);
    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);
    DrawQuad(&m_draws, m_textures[TEXTURE_SKY], 0.0f, 0.0f, width, FLOOR_TOP, WHOLE_TEXTURE);

    glEnable(GL_BLEND);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    // Scrolling moves the texture coordinates; the quads stay put.
    const GLfloat repeats = width / HILLS_TEXTURE_WIDTH;
    const GLfloat far_s = FAR_SCROLL * frame / HILLS_TEXTURE_WIDTH;
    DrawQuad(&m_draws, m_textures[TEXTURE_FAR_HILLS], 0.0f, FAR_HILLS_TOP, width,
             HILLS_HEIGHT, {far_s, 0.0f, far_s + repeats, 1.0f});

    for (const Cloud& cloud : CLOUDS) {
        glColor4f(1.0f, 1.0f, 1.0f, cloud.m_alpha);
        const GLfloat x = std::fmod(cloud.m_x - CLOUD_DRIFT * frame + width, width);
        DrawQuad(&m_draws, m_textures[TEXTURE_CLOUD], x - cloud.m_width * 0.5f, cloud.m_y,
                 cloud.m_width, cloud.m_width * 0.45f, WHOLE_TEXTURE);
    }
    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);

    const GLfloat near_s = NEAR_SCROLL * frame / HILLS_TEXTURE_WIDTH;
    DrawQuad(&m_draws, m_textures[TEXTURE_NEAR_HILLS], 0.0f, NEAR_HILLS_TOP, width,
             HILLS_HEIGHT, {near_s, 0.0f, near_s + repeats, 1.0f});
}

void SpriteScene::DrawLevel() {
    // Tile by tile, column by column, as a tile map draws: grass, brick, grass, ...
    glDisable(GL_BLEND);
    for (GLfloat x = 0.0f; x < m_width; x += TILE) {
        DrawQuad(&m_draws, m_textures[TEXTURE_GRASS], x, FLOOR_TOP, TILE, TILE, WHOLE_TEXTURE);
        DrawQuad(&m_draws, m_textures[TEXTURE_BRICK], x, FLOOR_TOP + TILE, TILE, TILE,
                 WHOLE_TEXTURE);
    }
    glEnable(GL_BLEND);
    for (int32_t i = 0; i < 4; ++i) {
        DrawQuad(&m_draws, m_textures[TEXTURE_BRICK], 192.0f + TILE * i, 120.0f, TILE,
                 TILE * 0.5f, {0.0f, 0.5f, 1.0f, 1.0f});
    }
}

void SpriteScene::DrawActors(int32_t frame) {
    for (int32_t i = 0; i < static_cast<int32_t>(sizeof(ACTORS) / sizeof(ACTORS[0])); ++i) {
        const Actor& actor = ACTORS[i];
        glColor4f(actor.m_tint[0], actor.m_tint[1], actor.m_tint[2], 1.0f);
        if (actor.m_enemy) {
            DrawSprite(&m_draws, m_textures[TEXTURE_STAR], actor.m_x, actor.m_y, 28.0f,
                       28.0f, 12.0f * frame + 40.0f * i);
        } else {
            // A spinning coin narrows and widens.
            const GLfloat turn = std::fabs(std::cos(0.5f * frame + 0.7f * i));
            DrawSprite(&m_draws, m_textures[TEXTURE_COIN], actor.m_x, actor.m_y,
                       4.0f + 16.0f * turn, 20.0f, 0.0f);
        }
    }
    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);
    const GLfloat bob = 3.0f * std::sin(0.8f * frame);
    DrawSprite(&m_draws, m_textures[TEXTURE_PLAYER], PLAYER_X, PLAYER_Y + bob, 32.0f, 32.0f,
               -8.0f);
}

void SpriteScene::DrawSparks(int32_t frame) {
    // Light adds up: sparks brighten what is behind them.
    glBlendFunc(GL_SRC_ALPHA, GL_ONE);
    for (int32_t i = 0; i < SPARK_COUNT; ++i) {
        const GLfloat angle = 0.45f * i + 0.3f * frame;
        const GLfloat radius = 10.0f + 2.2f * i;
        const GLfloat fade = 1.0f - static_cast<GLfloat>(i) / SPARK_COUNT;
        glColor4f(1.0f, 0.8f, 0.5f, 0.9f * fade);
        DrawSprite(&m_draws, m_textures[TEXTURE_GLOW], PLAYER_X + radius * std::cos(angle),
                   PLAYER_Y - 6.0f + radius * std::sin(angle) * 0.6f, 10.0f, 10.0f, 0.0f);
    }
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);
}

void SpriteScene::DrawScoreBar() {
    // Untextured see-through bar, then the lives as small player icons on top.
    glEnable(GL_BLEND);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    const GLfloat width = static_cast<GLfloat>(m_width);
    const GLfloat bar[] = {0, 0, 0, SCORE_BAR_HEIGHT, width, 0, width, SCORE_BAR_HEIGHT};
    glEnableClientState(GL_VERTEX_ARRAY);
    glVertexPointer(2, GL_FLOAT, 0, bar);
    glColor4f(0.0f, 0.0f, 0.0f, 0.5f);
    // Untextured, yet on the plane of the texture still bound from the sprites.
    m_draws.DrawArrays(GL_TRIANGLE_STRIP, 0, 4);
    glDisableClientState(GL_VERTEX_ARRAY);

    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);
    BeginSprites();
    for (int32_t life = 0; life < 3; ++life) {
        DrawQuad(&m_draws, m_textures[TEXTURE_PLAYER], 4.0f + 18.0f * life, 2.0f, 16.0f, 16.0f,
                 WHOLE_TEXTURE);
    }
    for (int32_t coin = 0; coin < 5; ++coin) {
        DrawQuad(&m_draws, m_textures[TEXTURE_COIN], width - 20.0f - 14.0f * coin, 4.0f, 12.0f,
                 12.0f, WHOLE_TEXTURE);
    }
    EndSprites();
    glDisable(GL_BLEND);
}

}  // namespace ovo_sample
