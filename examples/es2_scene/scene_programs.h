#ifndef OVO_EXAMPLES_ES2_SCENE_SCENE_PROGRAMS_H
#define OVO_EXAMPLES_ES2_SCENE_SCENE_PROGRAMS_H

#include <GLES2/gl2.h>

#include "es2_scene/eye_shift.h"

namespace ovo_sample {

// Per-vertex diffuse lighting of one colour.
struct LitProgram {
    GLuint m_program = 0;
    GLint m_position = -1;
    GLint m_normal = -1;
    GLint m_mvp = -1;
    GLint m_normal_matrix = -1;
    GLint m_light_direction = -1;
    GLint m_color = -1;
};

// A texture, tiled `uv_scale` times, times a tint.
struct TexturedProgram {
    GLuint m_program = 0;
    GLint m_position = -1;
    GLint m_uv = -1;
    GLint m_mvp = -1;
    GLint m_uv_scale = -1;
    GLint m_texture = -1;
    GLint m_tint = -1;
};

// One colour with alpha: shapes, glass, the HUD.
struct FlatProgram {
    GLuint m_program = 0;
    GLint m_position = -1;
    GLint m_mvp = -1;
    GLint m_color = -1;
};

struct ScenePrograms {
    LitProgram m_lit;
    TexturedProgram m_textured;
    FlatProgram m_flat;
};

// The vertex shaders go through `eye_shift`. False after printing which program failed.
bool CreateScenePrograms(const char* program, const EyeShift& eye_shift,
                         ScenePrograms* programs);
void DeleteScenePrograms(ScenePrograms* programs);

}  // namespace ovo_sample

#endif
