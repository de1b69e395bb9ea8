#ifndef OVO_EXAMPLES_ES2_SCENE_ES2_SCENE_H
#define OVO_EXAMPLES_ES2_SCENE_ES2_SCENE_H

#include <GLES2/gl2.h>

#include "common/reference_options.h"
#include "common/sample_scene.h"
#include "es2_scene/eye_shift.h"
#include "es2_scene/mat4.h"
#include "es2_scene/render_target.h"
#include "es2_scene/scene_meshes.h"
#include "es2_scene/scene_programs.h"

namespace ovo_sample {

// A small 3D level: a checkered floor, lit crates at several depths, a pyramid, a glass
// pane, a crate showing a picture rendered to a texture this frame, and a HUD on top.
// The reference options render one eye of the stereo pair, or the one scaled image.
class Es2Scene : public SampleScene {
public:
    explicit Es2Scene(const ReferenceOptions& reference)
        : m_reference(reference), m_eye_shift(reference) {}

    bool Init(const char* program, int32_t width, int32_t height) override;
    void DrawFrame(int32_t frame) override;
    void Release() override;

    // Draws the floor with `texture` from now on (made elsewhere: a loading thread's) and
    // owns it: the floor's texture before it is deleted now, this one at Release.
    void UseFloorTexture(uint32_t texture);

private:
    void DrawMonitorPicture(int32_t frame);
    void DrawWorld(int32_t frame);
    void DrawHud();
    void SetWindowViewport() const;
    // glUseProgram, then the eye's depth shift for the draws that follow.
    void UseProgram(GLuint program);

    void DrawLitCube(const Mat4& view_projection, const Mat4& model, const float color[4]);
    void DrawTexturedCube(const Mat4& mvp, GLuint texture);
    void DrawGround(const Mat4& view_projection);
    void DrawPyramid(const Mat4& view_projection, const Mat4& model);
    void DrawFlatQuad(const Mat4& mvp, const float color[4]);

    ReferenceOptions m_reference;
    EyeShift m_eye_shift;
    ScenePrograms m_programs;
    SceneMeshes m_meshes;
    RenderTarget m_monitor;
    uint32_t m_floor_texture = 0;
    int32_t m_width = 0;
    int32_t m_height = 0;
};

}  // namespace ovo_sample

#endif
