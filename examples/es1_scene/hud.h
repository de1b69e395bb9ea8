#ifndef OVO_EXAMPLES_ES1_SCENE_HUD_H
#define OVO_EXAMPLES_ES1_SCENE_HUD_H

#include <GLES/gl.h>

#include <cstdint>

namespace ovo_sample {

// The 2D overlay: an orthographic pixel projection, identity modelview, no depth test,
// alpha blending. A see-through panel with bars, icons, a radar and a crosshair.
class Hud {
public:
    void Init(int32_t width, int32_t height);
    void Release();
    void Draw(int32_t frame) const;

private:
    void DrawPanel() const;
    void DrawRadar(int32_t frame) const;
    void DrawCrosshair() const;

    GLuint m_icon_texture = 0;
    int32_t m_width = 0;
    int32_t m_height = 0;
};

}  // namespace ovo_sample

#endif
