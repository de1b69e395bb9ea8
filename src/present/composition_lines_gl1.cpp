// The OpenGL ES 1.x drawing path of the column mask: the fixed-function pipeline with an
// orthographic projection centred on the target.
#include <iterator>

#include "core/gl_state_table.h"
#include "core/raw_gl.h"
#include "present/composition_renderer.h"

namespace ovo {

namespace {

// Positions in COMPOSITION_GL1_SAVED.
enum CompositionGl1Saved : uint8_t {
    GL1_SAVED_COLOR_MASK,
    GL1_SAVED_DEPTH_MASK,
    GL1_SAVED_MATRIX_MODE,
    GL1_SAVED_BLEND_FUNC,
    GL1_SAVED_VIEWPORT,
    GL1_SAVED_SCISSOR_BOX,
    GL1_SAVED_BLEND,
    GL1_SAVED_DEPTH_TEST,
    GL1_SAVED_TEXTURE_2D,
    GL1_SAVED_LIGHTING,
    GL1_SAVED_ALPHA_TEST,
    GL1_SAVED_SCISSOR_TEST,
    GL1_SAVED_ALPHA_FUNC,
    GL1_SAVED_TEXTURE_BINDING,
    GL1_SAVED_TEX_ENV_MODE,
    GL1_SAVED_ARRAY_BUFFER,
    GL1_SAVED_TEXTURE_COORD_ARRAY,
    GL1_SAVED_VERTEX_ARRAY,
    GL1_SAVED_COLOR_ARRAY,
    GL1_SAVED_NORMAL_ARRAY,
    GL1_SAVED_POINT_SIZE_ARRAY,
    GL1_SAVED_CURRENT_COLOR,
    GL1_SAVED_CULL_FACE,
    GL1_SAVED_CULL_FACE_MODE,
    GL1_SAVED_FRONT_FACE,
    GL1_SAVED_VERTEX_POINTER,
    GL1_SAVED_TEXCOORD_POINTER,
    GL1_SAVED_COUNT
};

// The write masks are switched off as soon as they are saved.
constexpr GlStateItem COMPOSITION_GL1_SAVED[] = {
    {GL_STATE_COLOR_MASK, 0, true, {GL_FALSE, GL_FALSE, GL_FALSE, GL_FALSE}},
    {GL_STATE_DEPTH_MASK, 0, true, {GL_FALSE}},
    {GL_STATE_MATRIX_MODE, 0, false, {}},
    {GL_STATE_BLEND_FUNC, 0, false, {}},
    {GL_STATE_VIEWPORT, 0, false, {}},
    {GL_STATE_SCISSOR_BOX, 0, false, {}},
    {GL_STATE_ENABLE, GL_BLEND, false, {}},
    {GL_STATE_ENABLE, GL_DEPTH_TEST, false, {}},
    {GL_STATE_ENABLE, GL_TEXTURE_2D, false, {}},
    {GL_STATE_ENABLE, GL_LIGHTING, false, {}},
    {GL_STATE_ENABLE, GL_ALPHA_TEST, false, {}},
    {GL_STATE_ENABLE, GL_SCISSOR_TEST, false, {}},
    {GL_STATE_ALPHA_FUNC, 0, false, {}},
    {GL_STATE_TEXTURE_BINDING, 0, false, {}},
    {GL_STATE_TEX_ENV_MODE, 0, false, {}},
    {GL_STATE_ARRAY_BUFFER, 0, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_TEXTURE_COORD_ARRAY, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_VERTEX_ARRAY, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_COLOR_ARRAY, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_NORMAL_ARRAY, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_POINT_SIZE_ARRAY_OES, false, {}},
    {GL_STATE_CURRENT_COLOR, 0, false, {}},
    {GL_STATE_ENABLE, GL_CULL_FACE, false, {}},
    {GL_STATE_CULL_FACE_MODE, 0, false, {}},
    {GL_STATE_FRONT_FACE, 0, false, {}},
    {GL_STATE_VERTEX_POINTER, 0, false, {}},
    {GL_STATE_TEXCOORD_POINTER, 0, false, {}},
};
static_assert(std::size(COMPOSITION_GL1_SAVED) == GL1_SAVED_COUNT, "one position per item");

constexpr uint8_t COMPOSITION_GL1_RESTORE_ORDER[] = {
    GL1_SAVED_ALPHA_TEST,       GL1_SAVED_ALPHA_FUNC,    GL1_SAVED_SCISSOR_TEST,
    GL1_SAVED_BLEND,            GL1_SAVED_DEPTH_TEST,    GL1_SAVED_TEXTURE_2D,
    GL1_SAVED_LIGHTING,         GL1_SAVED_MATRIX_MODE,   GL1_SAVED_VIEWPORT,
    GL1_SAVED_SCISSOR_BOX,      GL1_SAVED_BLEND_FUNC,    GL1_SAVED_TEXTURE_BINDING,
    GL1_SAVED_TEX_ENV_MODE,     GL1_SAVED_ARRAY_BUFFER,  GL1_SAVED_TEXTURE_COORD_ARRAY,
    GL1_SAVED_VERTEX_ARRAY,     GL1_SAVED_COLOR_ARRAY,   GL1_SAVED_NORMAL_ARRAY,
    GL1_SAVED_POINT_SIZE_ARRAY, GL1_SAVED_CURRENT_COLOR, GL1_SAVED_CULL_FACE,
    GL1_SAVED_CULL_FACE_MODE,   GL1_SAVED_FRONT_FACE,    GL1_SAVED_VERTEX_POINTER,
    GL1_SAVED_TEXCOORD_POINTER, GL1_SAVED_DEPTH_MASK,    GL1_SAVED_COLOR_MASK,
};

constexpr GlStateItem COMPOSITION_GL1_SET_FIRST[] = {
    {GL_STATE_CULL_FACE_MODE, 0, true, {GL_BACK}},
    {GL_STATE_FRONT_FACE, 0, true, {GL_CCW}},
    {GL_STATE_ARRAY_BUFFER, 0, true, {0}},
    {GL_STATE_TEXTURE_BINDING, 0, true, {0}},
};

// Only the line positions feed the pipeline: plain white, untextured, unlit, every fragment
// reaching the stencil stage.
constexpr GlStateItem COMPOSITION_GL1_SET_PIPELINE[] = {
    {GL_STATE_CLIENT_ARRAY, GL_VERTEX_ARRAY, true, {1}},
    {GL_STATE_CLIENT_ARRAY, GL_TEXTURE_COORD_ARRAY, true, {0}},
    {GL_STATE_CLIENT_ARRAY, GL_COLOR_ARRAY, true, {0}},
    {GL_STATE_CLIENT_ARRAY, GL_NORMAL_ARRAY, true, {0}},
    {GL_STATE_CLIENT_ARRAY, GL_POINT_SIZE_ARRAY_OES, true, {0}},
    {GL_STATE_ENABLE, GL_TEXTURE_2D, true, {0}},
    {GL_STATE_ENABLE, GL_ALPHA_TEST, true, {0}},
    {GL_STATE_ENABLE, GL_SCISSOR_TEST, true, {0}},
    {GL_STATE_ENABLE, GL_LIGHTING, true, {0}},
    {GL_STATE_ENABLE, GL_CULL_FACE, true, {0}},
    {GL_STATE_ENABLE, GL_DEPTH_TEST, true, {0}},
    {GL_STATE_CURRENT_COLOR, 0, true, {1, 1, 1, 1}},
};

void PushIdentity(GLenum matrix) {
    raw::glMatrixMode(matrix);
    raw::glPushMatrix();
    raw::glLoadIdentity();
}

}  // namespace

void CompositionRenderer::DrawLinesGl1(GLsizei width, GLsizei height) const {
    GlStateSnapshot saved;
    saved.Save(COMPOSITION_GL1_SAVED, std::size(COMPOSITION_GL1_SAVED));
    GlStateSnapshot::Set(COMPOSITION_GL1_SET_FIRST, std::size(COMPOSITION_GL1_SET_FIRST));
    PushIdentity(GL_PROJECTION);
    const float half_width = static_cast<float>(width) * 0.5f;
    const float half_height = static_cast<float>(height) * 0.5f;
    raw::glOrthof(-half_width, half_width, -half_height, half_height, -1.0f, 1.0f);
    raw::glViewport(0, 0, width, height);
    raw::glScissor(0, 0, width, height);
    PushIdentity(GL_MODELVIEW);
    GlStateSnapshot::Set(COMPOSITION_GL1_SET_PIPELINE, std::size(COMPOSITION_GL1_SET_PIPELINE));

    raw::glVertexPointer(2, GL_FLOAT, 0, m_vertices);
    raw::glDrawArrays(GL_LINES, 0, 2 * m_line_count);

    raw::glMatrixMode(GL_PROJECTION);
    raw::glPopMatrix();
    raw::glMatrixMode(GL_MODELVIEW);
    raw::glPopMatrix();
    saved.Restore(COMPOSITION_GL1_RESTORE_ORDER, std::size(COMPOSITION_GL1_RESTORE_ORDER));
}

}  // namespace ovo
