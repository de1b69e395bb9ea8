#include "es2_scene/scene_meshes.h"

#include "common/cube_mesh.h"

namespace ovo_sample {

namespace {

const MeshVertex QUAD_VERTICES[QUAD_VERTEX_COUNT] = {
    {{-1, -1, 0}, {0, 0, 1}, {0, 0}},
    {{1, -1, 0}, {0, 0, 1}, {1, 0}},
    {{-1, 1, 0}, {0, 0, 1}, {0, 1}},
    {{1, 1, 0}, {0, 0, 1}, {1, 1}},
};

constexpr float PYRAMID_HALF_BASE = 0.8f;
constexpr float PYRAMID_HEIGHT = 1.4f;
constexpr float B = PYRAMID_HALF_BASE;
constexpr float H = PYRAMID_HEIGHT;

const float PYRAMID_POSITIONS[PYRAMID_VERTEX_COUNT * 3] = {
    -B, 0, B,  B,  0, B,  0,  H, 0,  // +Z
    B,  0, B,  B,  0, -B, 0,  H, 0,  // +X
    B,  0, -B, -B, 0, -B, 0,  H, 0,  // -Z
    -B, 0, -B, -B, 0, B,  0,  H, 0,  // -X
    -B, 0, -B, B,  0, -B, B,  0, B,  // base, facing down
    -B, 0, -B, B,  0, B,  -B, 0, B,
};

GLuint CreateBuffer(GLenum target, GLsizeiptr size, const void* data) {
    GLuint buffer = 0;
    glGenBuffers(1, &buffer);
    glBindBuffer(target, buffer);
    glBufferData(target, size, data, GL_STATIC_DRAW);
    return buffer;
}

void DeleteBuffer(GLuint* buffer) {
    if (*buffer != 0) glDeleteBuffers(1, buffer);
    *buffer = 0;
}

}  // namespace

void CreateSceneMeshes(SceneMeshes* meshes) {
    meshes->m_cube_vertices =
        CreateBuffer(GL_ARRAY_BUFFER, sizeof(CUBE_VERTICES), CUBE_VERTICES);
    meshes->m_cube_indices =
        CreateBuffer(GL_ELEMENT_ARRAY_BUFFER, sizeof(CUBE_INDICES), CUBE_INDICES);
    meshes->m_quad_vertices = CreateBuffer(GL_ARRAY_BUFFER, sizeof(QUAD_VERTICES), QUAD_VERTICES);
    meshes->m_pyramid_vertices =
        CreateBuffer(GL_ARRAY_BUFFER, sizeof(PYRAMID_POSITIONS), PYRAMID_POSITIONS);
    glBindBuffer(GL_ARRAY_BUFFER, 0);
    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, 0);
}

void DeleteSceneMeshes(SceneMeshes* meshes) {
    DeleteBuffer(&meshes->m_cube_vertices);
    DeleteBuffer(&meshes->m_cube_indices);
    DeleteBuffer(&meshes->m_quad_vertices);
    DeleteBuffer(&meshes->m_pyramid_vertices);
}

}  // namespace ovo_sample
