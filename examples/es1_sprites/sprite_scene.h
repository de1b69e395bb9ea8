#ifndef OVO_EXAMPLES_ES1_SPRITES_SPRITE_SCENE_H
#define OVO_EXAMPLES_ES1_SPRITES_SPRITE_SCENE_H

#include <GLES/gl.h>

#include "common/reference_options.h"
#include "common/sample_scene.h"
#include "common/sprite_eye_reference.h"

namespace ovo_sample {

// A side-scrolling platformer's screen: a sky, two parallax hill layers and clouds, a tile
// floor and a floating platform, coins, enemies, the player with glowing sparks, and a
// score bar. Every quad is its own draw with its own texture bound, as simple 2D engines
// draw. The reference options render one eye of the stereo pair, or the one scaled image.
class SpriteScene : public SampleScene {
public:
    explicit SpriteScene(const ReferenceOptions& reference)
        : m_reference(reference), m_draws(reference) {}

    bool Init(const char* program, int32_t width, int32_t height) override;
    void DrawFrame(int32_t frame) override;
    void Release() override;

private:
    enum TextureId {
        TEXTURE_SKY,
        TEXTURE_FAR_HILLS,
        TEXTURE_NEAR_HILLS,
        TEXTURE_CLOUD,
        TEXTURE_GRASS,
        TEXTURE_BRICK,
        TEXTURE_COIN,
        TEXTURE_STAR,
        TEXTURE_PLAYER,
        TEXTURE_GLOW,
        TEXTURE_COUNT
    };

    void DrawBackground(int32_t frame);
    void DrawLevel();
    void DrawActors(int32_t frame);
    void DrawSparks(int32_t frame);
    void DrawScoreBar();

    ReferenceOptions m_reference;
    SpriteEyeReference m_draws;
    GLuint m_textures[TEXTURE_COUNT] = {};
    int32_t m_width = 0;
    int32_t m_height = 0;
};

}  // namespace ovo_sample

#endif
