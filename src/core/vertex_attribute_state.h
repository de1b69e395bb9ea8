#ifndef OVO_CORE_VERTEX_ATTRIBUTE_STATE_H
#define OVO_CORE_VERTEX_ATTRIBUTE_STATE_H

#include "core/gl_api.h"

namespace ovo {

// One vertex attribute array as glGetVertexAttribiv and glGetVertexAttribPointerv give it.
struct VertexAttributeState {
    GLint m_enabled;
    GLint m_buffer;
    GLint m_size;
    GLint m_type;
    GLint m_normalized;
    GLint m_stride;
    void* m_pointer;
};

void SaveVertexAttribute(GLuint index, VertexAttributeState& attribute);
// Leaves the array buffer binding at the attribute's buffer: glVertexAttribPointer takes its
// pointer from the buffer bound there.
void RestoreVertexAttribute(GLuint index, const VertexAttributeState& attribute);

}  // namespace ovo

#endif
