#ifndef OVO_EXAMPLES_ES1_SCENE_ES1_SCENE_H
#define OVO_EXAMPLES_ES1_SCENE_ES1_SCENE_H

#include <GLES/gl.h>

#include <vector>

#include "common/sample_scene.h"
#include "es1_scene/hud.h"

namespace ovo_sample {

// A fixed-function 3D yard: a vertex-coloured tiled floor in fog, lit crates, a textured
// crate and a stacked tower built with the matrix stack, then the HUD over it.
class Es1Scene : public SampleScene {
public:
    bool Init(const char* program, int32_t width, int32_t height) override;
    void DrawFrame(int32_t frame) override;
    void Release() override;

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

    std::vector<FloorVertex> m_floor;
    GLuint m_crate_texture = 0;
    Hud m_hud;
    int32_t m_width = 0;
    int32_t m_height = 0;
};

}  // namespace ovo_sample

#endif
