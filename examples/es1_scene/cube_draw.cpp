#include "es1_scene/cube_draw.h"

#include <GLES/gl.h>

#include "common/cube_mesh.h"

namespace ovo_sample {

void DrawCube(bool textured) {
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_NORMAL_ARRAY);
    glVertexPointer(3, GL_FLOAT, sizeof(MeshVertex), CUBE_VERTICES[0].m_position);
    glNormalPointer(GL_FLOAT, sizeof(MeshVertex), CUBE_VERTICES[0].m_normal);
    if (textured) {
        glEnableClientState(GL_TEXTURE_COORD_ARRAY);
        glTexCoordPointer(2, GL_FLOAT, sizeof(MeshVertex), CUBE_VERTICES[0].m_uv);
    }
    glDrawElements(GL_TRIANGLES, CUBE_INDEX_COUNT, GL_UNSIGNED_SHORT, CUBE_INDICES);
    if (textured) glDisableClientState(GL_TEXTURE_COORD_ARRAY);
    glDisableClientState(GL_NORMAL_ARRAY);
    glDisableClientState(GL_VERTEX_ARRAY);
}

}  // namespace ovo_sample
