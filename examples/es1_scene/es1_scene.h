#ifndef OVO_EXAMPLES_ES1_SCENE_ES1_SCENE_H
#define OVO_EXAMPLES_ES1_SCENE_ES1_SCENE_H

#include <GLES/gl.h>

#include <vector>

#include "common/overlay_reference.h"
#include "common/reference_options.h"
#include "common/sample_args.h"
#include "common/sample_scene.h"
#include "es1_scene/hud.h"

namespace ovo_sample {

// A fixed-function 3D yard: a vertex-coloured tiled floor in fog, lit crates, a textured
// crate and a stacked tower built with the matrix stack, then the HUD over it. The
// reference options render one eye of the stereo pair, or the one scaled image; `surface`
// is the size of the window (the HUD's texture when it is collected in one).
class Es1Scene : public SampleScene {
public:
    Es1Scene(const ReferenceOptions& reference, PixelSize surface)
        : m_reference(reference), m_surface(surface) {}

    bool Init(const char* program, int32_t width, int32_t height) override;
    void DrawFrame(int32_t frame) override;
    void Release() override;

    // Draws the textured crate with `texture` from now on (made elsewhere: a loading
    // thread's) and owns it: the crate's texture before it is deleted now, this one at
    // Release.
    void UseCrateTexture(uint32_t texture);

private:
    struct FloorVertex {
        GLfloat m_position[3];
        GLubyte m_color[4];
    };

    void BuildFloor();
    void SetUpPerspective() const;
    void DrawFloor() const;
    void DrawCrates(int32_t frame) const;
    void DrawTower(int32_t frame) const;
    void DrawHud(int32_t frame) const;

    std::vector<FloorVertex> m_floor;
    GLuint m_crate_texture = 0;
    Hud m_hud;
    ReferenceOptions m_reference;
    PixelSize m_surface;
    OverlayReference m_overlay;
    int32_t m_width = 0;
    int32_t m_height = 0;
};

}  // namespace ovo_sample

#endif
