#include "core/vertex_attribute_state.h"

#include "core/raw_gl.h"

namespace ovo {

void SaveVertexAttribute(GLuint index, VertexAttributeState& attribute) {
    const struct {
        GLenum m_name;
        GLint* m_value;
    } fields[] = {
        {GL_VERTEX_ATTRIB_ARRAY_ENABLED, &attribute.m_enabled},
        {GL_VERTEX_ATTRIB_ARRAY_BUFFER_BINDING, &attribute.m_buffer},
        {GL_VERTEX_ATTRIB_ARRAY_SIZE, &attribute.m_size},
        {GL_VERTEX_ATTRIB_ARRAY_TYPE, &attribute.m_type},
        {GL_VERTEX_ATTRIB_ARRAY_NORMALIZED, &attribute.m_normalized},
        {GL_VERTEX_ATTRIB_ARRAY_STRIDE, &attribute.m_stride},
    };
    for (const auto& field : fields) raw::glGetVertexAttribiv(index, field.m_name, field.m_value);
    raw::glGetVertexAttribPointerv(index, GL_VERTEX_ATTRIB_ARRAY_POINTER, &attribute.m_pointer);
}

void RestoreVertexAttribute(GLuint index, const VertexAttributeState& attribute) {
    if (attribute.m_enabled != 0) {
        raw::glEnableVertexAttribArray(index);
    } else {
        raw::glDisableVertexAttribArray(index);
    }
    raw::glBindBuffer(GL_ARRAY_BUFFER, static_cast<GLuint>(attribute.m_buffer));
    raw::glVertexAttribPointer(index, attribute.m_size, static_cast<GLenum>(attribute.m_type),
                               attribute.m_normalized != 0 ? GL_TRUE : GL_FALSE,
                               attribute.m_stride, attribute.m_pointer);
}

}  // namespace ovo
