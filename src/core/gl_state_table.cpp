#include "core/gl_state_table.h"

#include "core/raw_gl.h"

namespace ovo {

namespace {

struct ArrayQueries {
    GLenum m_size;
    GLenum m_type;
    GLenum m_stride;
    GLenum m_pointer;
};

constexpr ArrayQueries VERTEX_ARRAY_QUERIES = {GL_VERTEX_ARRAY_SIZE, GL_VERTEX_ARRAY_TYPE,
                                               GL_VERTEX_ARRAY_STRIDE, GL_VERTEX_ARRAY_POINTER};
constexpr ArrayQueries TEXCOORD_ARRAY_QUERIES = {
    GL_TEXTURE_COORD_ARRAY_SIZE, GL_TEXTURE_COORD_ARRAY_TYPE, GL_TEXTURE_COORD_ARRAY_STRIDE,
    GL_TEXTURE_COORD_ARRAY_POINTER};

void QueryBooleans(GLenum name, GLint* values, int count) {
    GLboolean answer[4] = {GL_FALSE, GL_FALSE, GL_FALSE, GL_FALSE};
    raw::glGetBooleanv(name, answer);
    for (int i = 0; i < count; ++i) values[i] = answer[i];
}

void QueryArray(const ArrayQueries& queries, GLint* values, const void** pointer) {
    raw::glGetIntegerv(queries.m_size, &values[0]);
    raw::glGetIntegerv(queries.m_type, &values[1]);
    raw::glGetIntegerv(queries.m_stride, &values[2]);
    void* answer = nullptr;
    raw::glGetPointerv(queries.m_pointer, &answer);
    *pointer = answer;
}

GLboolean Boolean(GLint value) {
    return value != 0 ? GL_TRUE : GL_FALSE;
}

}  // namespace

void GlStateSnapshot::Save(const GlStateItem* items, size_t count) {
    for (size_t i = 0; i < count && m_count < GL_STATE_CAPACITY; ++i) {
        const GlStateItem& item = items[i];
        // Zeros stand for whatever a query leaves unanswered.
        SavedState& saved = m_saved[m_count++];
        saved = SavedState{item.m_kind, item.m_name, {0, 0, 0, 0}, {0, 0, 0, 0}, nullptr, {}};
        GLint* values = saved.m_values;
        switch (item.m_kind) {
            case GL_STATE_ENABLE:
            case GL_STATE_CLIENT_ARRAY:
                values[0] = raw::glIsEnabled(item.m_name);
                break;
            case GL_STATE_COLOR_MASK:
                QueryBooleans(GL_COLOR_WRITEMASK, values, 4);
                break;
            case GL_STATE_DEPTH_MASK:
                QueryBooleans(GL_DEPTH_WRITEMASK, values, 1);
                break;
            case GL_STATE_VIEWPORT:
                raw::glGetIntegerv(GL_VIEWPORT, values);
                break;
            case GL_STATE_SCISSOR_BOX:
                raw::glGetIntegerv(GL_SCISSOR_BOX, values);
                break;
            case GL_STATE_MATRIX_MODE:
                raw::glGetIntegerv(GL_MATRIX_MODE, values);
                break;
            case GL_STATE_BLEND_FUNC:
                raw::glGetIntegerv(GL_BLEND_SRC, &values[0]);
                raw::glGetIntegerv(GL_BLEND_DST, &values[1]);
                break;
            case GL_STATE_ALPHA_FUNC:
                raw::glGetIntegerv(GL_ALPHA_TEST_FUNC, values);
                raw::glGetFloatv(GL_ALPHA_TEST_REF, &saved.m_floats[1]);
                break;
            case GL_STATE_TEXTURE_BINDING:
                raw::glGetIntegerv(GL_TEXTURE_BINDING_2D, values);
                break;
            case GL_STATE_TEX_ENV_MODE:
                raw::glGetTexEnviv(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, values);
                break;
            case GL_STATE_ARRAY_BUFFER:
                raw::glGetIntegerv(GL_ARRAY_BUFFER_BINDING, values);
                break;
            case GL_STATE_CULL_FACE_MODE:
                raw::glGetIntegerv(GL_CULL_FACE_MODE, values);
                break;
            case GL_STATE_FRONT_FACE:
                raw::glGetIntegerv(GL_FRONT_FACE, values);
                break;
            case GL_STATE_VERTEX_POINTER:
                QueryArray(VERTEX_ARRAY_QUERIES, values, &saved.m_pointer);
                break;
            case GL_STATE_TEXCOORD_POINTER:
                QueryArray(TEXCOORD_ARRAY_QUERIES, values, &saved.m_pointer);
                break;
            case GL_STATE_PROGRAM:
                raw::glGetIntegerv(GL_CURRENT_PROGRAM, values);
                break;
            case GL_STATE_VERTEX_ATTRIB:
                SaveVertexAttribute(item.m_name, saved.m_attribute);
                break;
            case GL_STATE_CURRENT_COLOR:
                raw::glGetFloatv(GL_CURRENT_COLOR, saved.m_floats);
                break;
        }
        if (item.m_set) SetItem(item);
    }
}

void GlStateSnapshot::Set(const GlStateItem* items, size_t count) {
    for (size_t i = 0; i < count; ++i) SetItem(items[i]);
}

void GlStateSnapshot::SetItem(const GlStateItem& item) {
    const GLint* set = item.m_set_value;
    SavedState state{item.m_kind, item.m_name, {set[0], set[1], set[2], set[3]}, {}, nullptr,
                     {set[0], 0, set[1], set[2], GL_FALSE, set[3], nullptr}};
    for (int i = 0; i < 4; ++i) state.m_floats[i] = static_cast<GLfloat>(set[i]);
    Apply(state);
}

void GlStateSnapshot::Restore(const uint8_t* order, size_t count) const {
    for (size_t i = 0; i < count; ++i) {
        if (order[i] < m_count) Apply(m_saved[order[i]]);
    }
}

void GlStateSnapshot::Apply(const SavedState& state) {
    const GLint* values = state.m_values;
    switch (state.m_kind) {
        case GL_STATE_ENABLE:
            values[0] != 0 ? raw::glEnable(state.m_name) : raw::glDisable(state.m_name);
            break;
        case GL_STATE_CLIENT_ARRAY:
            values[0] != 0 ? raw::glEnableClientState(state.m_name)
                           : raw::glDisableClientState(state.m_name);
            break;
        case GL_STATE_COLOR_MASK:
            raw::glColorMask(Boolean(values[0]), Boolean(values[1]), Boolean(values[2]),
                             Boolean(values[3]));
            break;
        case GL_STATE_DEPTH_MASK:
            raw::glDepthMask(Boolean(values[0]));
            break;
        case GL_STATE_VIEWPORT:
            raw::glViewport(values[0], values[1], values[2], values[3]);
            break;
        case GL_STATE_SCISSOR_BOX:
            raw::glScissor(values[0], values[1], values[2], values[3]);
            break;
        case GL_STATE_MATRIX_MODE:
            raw::glMatrixMode(static_cast<GLenum>(values[0]));
            break;
        case GL_STATE_BLEND_FUNC:
            raw::glBlendFunc(static_cast<GLenum>(values[0]), static_cast<GLenum>(values[1]));
            break;
        case GL_STATE_ALPHA_FUNC:
            raw::glAlphaFunc(static_cast<GLenum>(values[0]), state.m_floats[1]);
            break;
        case GL_STATE_TEXTURE_BINDING:
            raw::glBindTexture(GL_TEXTURE_2D, static_cast<GLuint>(values[0]));
            break;
        case GL_STATE_TEX_ENV_MODE:
            raw::glTexEnvi(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, values[0]);
            break;
        case GL_STATE_ARRAY_BUFFER:
            raw::glBindBuffer(GL_ARRAY_BUFFER, static_cast<GLuint>(values[0]));
            break;
        case GL_STATE_CULL_FACE_MODE:
            raw::glCullFace(static_cast<GLenum>(values[0]));
            break;
        case GL_STATE_FRONT_FACE:
            raw::glFrontFace(static_cast<GLenum>(values[0]));
            break;
        case GL_STATE_VERTEX_POINTER:
            raw::glVertexPointer(values[0], static_cast<GLenum>(values[1]), values[2],
                                 state.m_pointer);
            break;
        case GL_STATE_TEXCOORD_POINTER:
            raw::glTexCoordPointer(values[0], static_cast<GLenum>(values[1]), values[2],
                                   state.m_pointer);
            break;
        case GL_STATE_PROGRAM:
            raw::glUseProgram(static_cast<GLuint>(values[0]));
            break;
        case GL_STATE_VERTEX_ATTRIB:
            RestoreVertexAttribute(state.m_name, state.m_attribute);
            break;
        case GL_STATE_CURRENT_COLOR:
            raw::glColor4f(state.m_floats[0], state.m_floats[1], state.m_floats[2],
                           state.m_floats[3]);
            break;
    }
}

}  // namespace ovo
