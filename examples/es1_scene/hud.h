#ifndef OVO_EXAMPLES_ES1_SCENE_HUD_H
#define OVO_EXAMPLES_ES1_SCENE_HUD_H

#include <GLES/gl.h>

#include <cstdint>

#include "common/reference_options.h"

namespace ovo_sample {

// The 2D overlay: an orthographic pixel projection, identity modelview, no depth test,
// alpha blending. A see-through panel with bars, icons, a radar and a crosshair. Items are
// placed by their vertices, never by the modelview.
class Hud {
public:
    // `reference` gives the HUD its eye's shift, unless the HUD goes to an overlay target.
    void Init(int32_t width, int32_t height, const ReferenceOptions& reference);
    void Release();
    void Draw(int32_t frame) const;

private:
    void DrawPanel() const;
    void DrawRadar(int32_t frame) const;
    void DrawCrosshair() const;

    ReferenceOptions m_reference;
    GLuint m_icon_texture = 0;
    int32_t m_width = 0;
    int32_t m_height = 0;
};

}  // namespace ovo_sample

#endif
