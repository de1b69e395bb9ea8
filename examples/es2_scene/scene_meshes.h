#ifndef OVO_EXAMPLES_ES2_SCENE_SCENE_MESHES_H
#define OVO_EXAMPLES_ES2_SCENE_SCENE_MESHES_H

#include <GLES2/gl2.h>

namespace ovo_sample {

constexpr GLsizei QUAD_VERTEX_COUNT = 4;
constexpr GLsizei PYRAMID_FACE_VERTICES = 3;
constexpr GLsizei PYRAMID_SIDE_COUNT = 4;
constexpr GLsizei PYRAMID_VERTEX_COUNT = 18;

// The scene's vertex and index buffers.
struct SceneMeshes {
    // MeshVertex, drawn with CUBE_INDICES from m_cube_indices.
    GLuint m_cube_vertices = 0;
    GLuint m_cube_indices = 0;
    // MeshVertex: -1..1 in the XY plane facing +Z, a triangle strip. Ground, glass and HUD.
    GLuint m_quad_vertices = 0;
    // Positions only: four sides then the base, as triangles.
    GLuint m_pyramid_vertices = 0;
};

void CreateSceneMeshes(SceneMeshes* meshes);
void DeleteSceneMeshes(SceneMeshes* meshes);

}  // namespace ovo_sample

#endif
