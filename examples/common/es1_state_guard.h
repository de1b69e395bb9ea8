#ifndef OVO_EXAMPLES_COMMON_ES1_STATE_GUARD_H
#define OVO_EXAMPLES_COMMON_ES1_STATE_GUARD_H

#include <GLES/gl.h>

namespace ovo_sample {

// The OpenGL ES 1.1 state that drawing a textured quad over the frame changes, saved and put
// back so that the game's next frame starts from its own state. The matrices are left to
// the matrix stacks.
class Es1StateGuard {
public:
    void Save();
    void Restore() const;

private:
    struct ClientArray {
        GLint m_size;
        GLint m_type;
        GLint m_stride;
        GLvoid* m_pointer;
    };

    static constexpr int ENABLE_COUNT = 6;
    static constexpr int CLIENT_STATE_COUNT = 3;

    GLboolean m_color_mask[4] = {};
    GLboolean m_depth_mask = GL_TRUE;
    GLboolean m_enabled[ENABLE_COUNT] = {};
    GLboolean m_client_enabled[CLIENT_STATE_COUNT] = {};
    GLint m_matrix_mode = 0;
    GLint m_blend_source = 0;
    GLint m_blend_destination = 0;
    GLint m_viewport[4] = {};
    GLint m_texture = 0;
    GLint m_texture_env_mode = 0;
    GLint m_array_buffer = 0;
    GLint m_cull_face_mode = 0;
    GLint m_front_face = 0;
    GLint m_alpha_function = 0;
    GLfloat m_alpha_reference = 0.0f;
    ClientArray m_vertex_array = {};
    ClientArray m_coord_array = {};
};

}  // namespace ovo_sample

#endif
