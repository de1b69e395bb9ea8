#ifndef OVO_CORE_GL_STATE_TABLE_H
#define OVO_CORE_GL_STATE_TABLE_H

// GL state that the library changes around its own drawing, saved and put back from
// tables: a drawing operation lists what it saves (and what it sets right after saving),
// and the order in which it puts things back, as data.

#include <cstddef>
#include <cstdint>

#include "core/gl_api.h"
#include "core/vertex_attribute_state.h"

namespace ovo {

// What one saved item is, how it is queried and how it is put back.
enum GlStateKind : uint8_t {
    GL_STATE_ENABLE,           // glIsEnabled(name); glEnable / glDisable(name)
    GL_STATE_CLIENT_ARRAY,     // glIsEnabled(name); glEnableClientState / glDisableClientState
    GL_STATE_COLOR_MASK,       // glGetBooleanv(GL_COLOR_WRITEMASK); glColorMask
    GL_STATE_DEPTH_MASK,       // glGetBooleanv(GL_DEPTH_WRITEMASK); glDepthMask
    GL_STATE_VIEWPORT,         // glGetIntegerv(GL_VIEWPORT); glViewport
    GL_STATE_SCISSOR_BOX,      // glGetIntegerv(GL_SCISSOR_BOX); glScissor
    GL_STATE_MATRIX_MODE,      // glGetIntegerv(GL_MATRIX_MODE); glMatrixMode
    GL_STATE_BLEND_FUNC,       // glGetIntegerv(GL_BLEND_SRC), then GL_BLEND_DST; glBlendFunc
    GL_STATE_ALPHA_FUNC,       // glGetIntegerv(GL_ALPHA_TEST_FUNC),
                               // glGetFloatv(GL_ALPHA_TEST_REF); glAlphaFunc
    GL_STATE_TEXTURE_BINDING,  // glGetIntegerv(GL_TEXTURE_BINDING_2D); glBindTexture(GL_TEXTURE_2D)
    GL_STATE_TEX_ENV_MODE,     // glGetTexEnviv(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE); glTexEnvi
    GL_STATE_ARRAY_BUFFER,     // glGetIntegerv(GL_ARRAY_BUFFER_BINDING);
                               // glBindBuffer(GL_ARRAY_BUFFER)
    GL_STATE_CULL_FACE_MODE,   // glGetIntegerv(GL_CULL_FACE_MODE); glCullFace
    GL_STATE_FRONT_FACE,       // glGetIntegerv(GL_FRONT_FACE); glFrontFace
    GL_STATE_VERTEX_POINTER,   // glGetIntegerv GL_VERTEX_ARRAY_SIZE, _TYPE, _STRIDE, then
                               // glGetPointerv(GL_VERTEX_ARRAY_POINTER); glVertexPointer
    GL_STATE_TEXCOORD_POINTER, // the same for GL_TEXTURE_COORD_ARRAY_*; glTexCoordPointer
    GL_STATE_PROGRAM,          // glGetIntegerv(GL_CURRENT_PROGRAM); glUseProgram
    GL_STATE_VERTEX_ATTRIB,    // attribute array m_name: SaveVertexAttribute; put back with
                               // its buffer bound to GL_ARRAY_BUFFER, so before ARRAY_BUFFER
    GL_STATE_CURRENT_COLOR,    // glGetFloatv(GL_CURRENT_COLOR); glColor4f
};

struct GlStateItem {
    GlStateKind m_kind;
    GLenum m_name;  // the capability or client state of ENABLE / CLIENT_ARRAY, the index
                    // of VERTEX_ATTRIB
    bool m_set;     // set to m_set_value right after saving it
    // In the put-back call's argument order: {GL_FALSE x4} for a colour mask, {GL_BACK} for
    // the cull face, {1} to enable, {GL_NOTEQUAL, 0} for the alpha function (the reference
    // as a whole number), {size, type, stride} for a pointer (set to null), {enabled, size,
    // type, stride} for an attribute array (from no buffer, not normalised, at null), the
    // colour in whole numbers.
    GLint m_set_value[4];
};

// More items than any drawing operation saves; further items are ignored.
constexpr size_t GL_STATE_CAPACITY = 40;

// The values of a list of items; lives on the stack of one drawing operation.
class GlStateSnapshot {
public:
    // Queries each item in order, appending it (so a later Save can add more), and sets the
    // items that say so right after each is saved. Items past the capacity are neither
    // saved nor set.
    void Save(const GlStateItem* items, size_t count);
    // Puts items back in the order given: each entry is the position of an item among all
    // items saved so far (0-based, in Save order). Positions past the saved count are ignored.
    void Restore(const uint8_t* order, size_t count) const;
    // Sets each item to its m_set_value without saving anything: the constant part of what
    // a drawing operation sets once everything is saved.
    static void Set(const GlStateItem* items, size_t count);

    size_t Count() const { return m_count; }

private:
    struct SavedState {
        GlStateKind m_kind;
        GLenum m_name;
        GLint m_values[4];
        GLfloat m_floats[4];    // the alpha reference (second) or the colour, as put back
        const void* m_pointer;  // an array pointer
        VertexAttributeState m_attribute;
    };

    static void Apply(const SavedState& state);
    static void SetItem(const GlStateItem& item);

    SavedState m_saved[GL_STATE_CAPACITY];
    size_t m_count = 0;
};

}  // namespace ovo

#endif
