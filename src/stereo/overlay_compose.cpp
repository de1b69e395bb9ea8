// Drawing the collected overlay into the window with the fixed-function pipeline, with
// the application's state saved before and put back after.
#include <iterator>

#include "core/gl_state_table.h"
#include "core/raw_gl.h"
#include "core/saturating_math.h"
#include "stereo/overlay_target.h"

namespace ovo {

namespace {

// Positions in COMPOSE_SAVED, then COMPOSE_ALPHA_SAVED, which is saved after it.
enum ComposeSaved : uint8_t {
    COMPOSE_SAVED_COLOR_MASK,
    COMPOSE_SAVED_DEPTH_MASK,
    COMPOSE_SAVED_MATRIX_MODE,
    COMPOSE_SAVED_BLEND_FUNC,
    COMPOSE_SAVED_VIEWPORT,
    COMPOSE_SAVED_BLEND,
    COMPOSE_SAVED_DEPTH_TEST,
    COMPOSE_SAVED_TEXTURE_2D,
    COMPOSE_SAVED_LIGHTING,
    COMPOSE_SAVED_TEXTURE_BINDING,
    COMPOSE_SAVED_TEX_ENV_MODE,
    COMPOSE_SAVED_ARRAY_BUFFER,
    COMPOSE_SAVED_TEXTURE_COORD_ARRAY,
    COMPOSE_SAVED_VERTEX_ARRAY,
    COMPOSE_SAVED_COLOR_ARRAY,
    COMPOSE_SAVED_CULL_FACE,
    COMPOSE_SAVED_CULL_FACE_MODE,
    COMPOSE_SAVED_FRONT_FACE,
    COMPOSE_SAVED_VERTEX_POINTER,
    COMPOSE_SAVED_TEXCOORD_POINTER,
    COMPOSE_SAVED_FIRST_COUNT,
    COMPOSE_SAVED_ALPHA_TEST = COMPOSE_SAVED_FIRST_COUNT,
    COMPOSE_SAVED_ALPHA_FUNC,
    COMPOSE_SAVED_COUNT
};

// What is saved before the quads, in query order; some items are set right after saving.
constexpr GlStateItem COMPOSE_SAVED[] = {
    {GL_STATE_COLOR_MASK, 0, true, {GL_TRUE, GL_TRUE, GL_TRUE, GL_TRUE}},
    {GL_STATE_DEPTH_MASK, 0, true, {GL_FALSE}},
    {GL_STATE_MATRIX_MODE, 0, false, {}},
    {GL_STATE_BLEND_FUNC, 0, false, {}},
    {GL_STATE_VIEWPORT, 0, false, {}},
    {GL_STATE_ENABLE, GL_BLEND, false, {}},
    {GL_STATE_ENABLE, GL_DEPTH_TEST, false, {}},
    {GL_STATE_ENABLE, GL_TEXTURE_2D, false, {}},
    {GL_STATE_ENABLE, GL_LIGHTING, false, {}},
    {GL_STATE_TEXTURE_BINDING, 0, false, {}},
    {GL_STATE_TEX_ENV_MODE, 0, false, {}},
    {GL_STATE_ARRAY_BUFFER, 0, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_TEXTURE_COORD_ARRAY, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_VERTEX_ARRAY, false, {}},
    {GL_STATE_CLIENT_ARRAY, GL_COLOR_ARRAY, false, {}},
    {GL_STATE_ENABLE, GL_CULL_FACE, true, {GL_TRUE}},
    {GL_STATE_CULL_FACE_MODE, 0, true, {GL_BACK}},
    {GL_STATE_FRONT_FACE, 0, true, {GL_CCW}},
    {GL_STATE_VERTEX_POINTER, 0, false, {}},
    {GL_STATE_TEXCOORD_POINTER, 0, false, {}},
};
static_assert(std::size(COMPOSE_SAVED) == COMPOSE_SAVED_FIRST_COUNT, "one position per item");

// Saved once the texture is set up, just before the alpha test is switched off.
constexpr GlStateItem COMPOSE_ALPHA_SAVED[] = {
    {GL_STATE_ENABLE, GL_ALPHA_TEST, false, {}},
    {GL_STATE_ALPHA_FUNC, 0, false, {}},
};
static_assert(std::size(COMPOSE_SAVED) + std::size(COMPOSE_ALPHA_SAVED) == COMPOSE_SAVED_COUNT,
              "one position per item");

// The order things are put back in; the scissor box and the framebuffer stay as drawn.
constexpr uint8_t COMPOSE_RESTORE_ORDER[] = {
    COMPOSE_SAVED_ALPHA_TEST,          COMPOSE_SAVED_ALPHA_FUNC,      COMPOSE_SAVED_BLEND,
    COMPOSE_SAVED_DEPTH_TEST,          COMPOSE_SAVED_TEXTURE_2D,      COMPOSE_SAVED_LIGHTING,
    COMPOSE_SAVED_MATRIX_MODE,         COMPOSE_SAVED_VIEWPORT,        COMPOSE_SAVED_BLEND_FUNC,
    COMPOSE_SAVED_TEXTURE_BINDING,     COMPOSE_SAVED_TEX_ENV_MODE,    COMPOSE_SAVED_ARRAY_BUFFER,
    COMPOSE_SAVED_TEXTURE_COORD_ARRAY, COMPOSE_SAVED_VERTEX_ARRAY,    COMPOSE_SAVED_COLOR_ARRAY,
    COMPOSE_SAVED_CULL_FACE,           COMPOSE_SAVED_CULL_FACE_MODE,  COMPOSE_SAVED_FRONT_FACE,
    COMPOSE_SAVED_VERTEX_POINTER,      COMPOSE_SAVED_TEXCOORD_POINTER, COMPOSE_SAVED_DEPTH_MASK,
    COMPOSE_SAVED_COLOR_MASK,
};
static_assert(std::size(COMPOSE_RESTORE_ORDER) == COMPOSE_SAVED_COUNT, "everything saved is put back");

void PushIdentity(GLenum mode) {
    raw::glMatrixMode(mode);
    raw::glPushMatrix();
    raw::glLoadIdentity();
}

void PopMatrix(GLenum mode) {
    raw::glMatrixMode(mode);
    raw::glPopMatrix();
}

}  // namespace

void OverlayTarget::Compose(const ComposeQuad* quads, int32_t quad_count, float y, float w,
                            float h, float z, float t) {
    if (!m_has_content || m_texture == 0) return;
    Unbind();

    GlStateSnapshot saved;
    saved.Save(COMPOSE_SAVED, std::size(COMPOSE_SAVED));

    // y grows downward, so the overlay comes out upright.
    PushIdentity(GL_PROJECTION);
    raw::glOrthof(0.0f, w, h, 0.0f, -1.0f, 1.0f);
    PushIdentity(GL_TEXTURE);
    PushIdentity(GL_MODELVIEW);

    raw::glBindTexture(GL_TEXTURE_2D, m_texture);
    raw::glBindBuffer(GL_ARRAY_BUFFER, 0);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    raw::glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
    raw::glTexEnvf(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_REPLACE);
    raw::glDisable(GL_DEPTH_TEST);
    raw::glEnable(GL_TEXTURE_2D);
    raw::glEnable(GL_BLEND);
    // The overlay holds premultiplied colour: it was drawn with alpha blending onto (0,0,0,0).
    raw::glBlendFunc(GL_ONE, GL_ONE_MINUS_SRC_ALPHA);

    saved.Save(COMPOSE_ALPHA_SAVED, std::size(COMPOSE_ALPHA_SAVED));
    raw::glDisable(GL_ALPHA_TEST);
    raw::glAlphaFunc(GL_NOTEQUAL, 0.0f);
    raw::glDisable(GL_LIGHTING);

    const GLfloat coordinates[8] = {0.0f, t, 0.0f, 0.0f, 1.0f, t, 1.0f, 0.0f};
    GLfloat vertices[12];
    raw::glTexCoordPointer(2, GL_FLOAT, 0, coordinates);
    raw::glEnableClientState(GL_TEXTURE_COORD_ARRAY);
    raw::glVertexPointer(3, GL_FLOAT, 0, vertices);
    raw::glEnableClientState(GL_VERTEX_ARRAY);
    raw::glDisableClientState(GL_COLOR_ARRAY);

    const GLsizei width = SaturatingTrunc(w);
    const GLsizei height = SaturatingTrunc(h);
    for (int32_t i = 0; i < quad_count; ++i) {
        const ComposeQuad& quad = quads[i];
        const GLfloat strip[12] = {quad.m_left,  y, z, quad.m_left,  y + h, z,
                                   quad.m_right, y, z, quad.m_right, y + h, z};
        for (int32_t k = 0; k < 12; ++k) vertices[k] = strip[k];
        raw::glViewport(quad.m_viewport_x, 0, width, height);
        raw::glScissor(quad.m_viewport_x, 0, width, height);
        raw::glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
    }

    PopMatrix(GL_PROJECTION);
    PopMatrix(GL_TEXTURE);
    PopMatrix(GL_MODELVIEW);
    saved.Restore(COMPOSE_RESTORE_ORDER, std::size(COMPOSE_RESTORE_ORDER));
}

}  // namespace ovo
