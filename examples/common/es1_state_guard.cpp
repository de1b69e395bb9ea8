#include "common/es1_state_guard.h"

namespace ovo_sample {

namespace {

const GLenum GUARDED_ENABLES[] = {GL_BLEND,    GL_DEPTH_TEST,  GL_TEXTURE_2D,
                                  GL_LIGHTING, GL_ALPHA_TEST, GL_CULL_FACE};
const GLenum GUARDED_CLIENT_STATES[] = {GL_VERTEX_ARRAY, GL_TEXTURE_COORD_ARRAY,
                                        GL_COLOR_ARRAY};

void SetEnabled(GLenum capability, GLboolean enabled) {
    if (enabled) {
        glEnable(capability);
    } else {
        glDisable(capability);
    }
}

void SetClientEnabled(GLenum array, GLboolean enabled) {
    if (enabled) {
        glEnableClientState(array);
    } else {
        glDisableClientState(array);
    }
}

}  // namespace

void Es1StateGuard::Save() {
    static_assert(sizeof(GUARDED_ENABLES) / sizeof(GUARDED_ENABLES[0]) == ENABLE_COUNT, "");
    static_assert(sizeof(GUARDED_CLIENT_STATES) / sizeof(GUARDED_CLIENT_STATES[0]) ==
                      CLIENT_STATE_COUNT, "");
    glGetBooleanv(GL_COLOR_WRITEMASK, m_color_mask);
    glGetBooleanv(GL_DEPTH_WRITEMASK, &m_depth_mask);
    for (int i = 0; i < ENABLE_COUNT; ++i) m_enabled[i] = glIsEnabled(GUARDED_ENABLES[i]);
    for (int i = 0; i < CLIENT_STATE_COUNT; ++i) {
        m_client_enabled[i] = glIsEnabled(GUARDED_CLIENT_STATES[i]);
    }
    glGetIntegerv(GL_MATRIX_MODE, &m_matrix_mode);
    glGetIntegerv(GL_BLEND_SRC, &m_blend_source);
    glGetIntegerv(GL_BLEND_DST, &m_blend_destination);
    glGetIntegerv(GL_VIEWPORT, m_viewport);
    glGetIntegerv(GL_TEXTURE_BINDING_2D, &m_texture);
    glGetTexEnviv(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, &m_texture_env_mode);
    glGetIntegerv(GL_ARRAY_BUFFER_BINDING, &m_array_buffer);
    glGetIntegerv(GL_CULL_FACE_MODE, &m_cull_face_mode);
    glGetIntegerv(GL_FRONT_FACE, &m_front_face);
    glGetIntegerv(GL_ALPHA_TEST_FUNC, &m_alpha_function);
    glGetFloatv(GL_ALPHA_TEST_REF, &m_alpha_reference);
    glGetIntegerv(GL_VERTEX_ARRAY_SIZE, &m_vertex_array.m_size);
    glGetIntegerv(GL_VERTEX_ARRAY_TYPE, &m_vertex_array.m_type);
    glGetIntegerv(GL_VERTEX_ARRAY_STRIDE, &m_vertex_array.m_stride);
    glGetPointerv(GL_VERTEX_ARRAY_POINTER, &m_vertex_array.m_pointer);
    glGetIntegerv(GL_TEXTURE_COORD_ARRAY_SIZE, &m_coord_array.m_size);
    glGetIntegerv(GL_TEXTURE_COORD_ARRAY_TYPE, &m_coord_array.m_type);
    glGetIntegerv(GL_TEXTURE_COORD_ARRAY_STRIDE, &m_coord_array.m_stride);
    glGetPointerv(GL_TEXTURE_COORD_ARRAY_POINTER, &m_coord_array.m_pointer);
}

void Es1StateGuard::Restore() const {
    glAlphaFunc(static_cast<GLenum>(m_alpha_function), m_alpha_reference);
    for (int i = 0; i < ENABLE_COUNT; ++i) SetEnabled(GUARDED_ENABLES[i], m_enabled[i]);
    glMatrixMode(static_cast<GLenum>(m_matrix_mode));
    glViewport(m_viewport[0], m_viewport[1], m_viewport[2], m_viewport[3]);
    glBlendFunc(static_cast<GLenum>(m_blend_source), static_cast<GLenum>(m_blend_destination));
    glBindTexture(GL_TEXTURE_2D, static_cast<GLuint>(m_texture));
    glTexEnvi(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, m_texture_env_mode);
    glBindBuffer(GL_ARRAY_BUFFER, static_cast<GLuint>(m_array_buffer));
    for (int i = 0; i < CLIENT_STATE_COUNT; ++i) {
        SetClientEnabled(GUARDED_CLIENT_STATES[i], m_client_enabled[i]);
    }
    glCullFace(static_cast<GLenum>(m_cull_face_mode));
    glFrontFace(static_cast<GLenum>(m_front_face));
    glVertexPointer(m_vertex_array.m_size, static_cast<GLenum>(m_vertex_array.m_type),
                    m_vertex_array.m_stride, m_vertex_array.m_pointer);
    glTexCoordPointer(m_coord_array.m_size, static_cast<GLenum>(m_coord_array.m_type),
                      m_coord_array.m_stride, m_coord_array.m_pointer);
    glDepthMask(m_depth_mask);
    glColorMask(m_color_mask[0], m_color_mask[1], m_color_mask[2], m_color_mask[3]);
}

}  // namespace ovo_sample
