#ifndef OVO_EXAMPLES_CUBE_MESH_H
#define OVO_EXAMPLES_CUBE_MESH_H

#include <cstdint>

// A unit cube around the origin: 24 vertices (4 per face) of position, normal and texture
// coordinate, interleaved, and 36 indices of its 12 triangles.
constexpr int CUBE_VERTEX_FLOATS = 8;
constexpr int CUBE_VERTEX_COUNT = 24;
constexpr int CUBE_INDEX_COUNT = 36;

// Face by face: normal, then corners counter-clockwise seen from outside.
inline void BuildCube(float vertices[CUBE_VERTEX_COUNT * CUBE_VERTEX_FLOATS],
                      uint16_t indices[CUBE_INDEX_COUNT]) {
    const float normals[6][3] = {{0, 0, 1}, {0, 0, -1}, {1, 0, 0}, {-1, 0, 0}, {0, 1, 0}, {0, -1, 0}};
    // Any axis across each face; with v = n x u, u x v = n keeps the winding outward.
    const float across[6][3] = {{1, 0, 0}, {-1, 0, 0}, {0, 0, -1}, {0, 0, 1}, {1, 0, 0}, {1, 0, 0}};
    const float corners[4][2] = {{-1, -1}, {1, -1}, {1, 1}, {-1, 1}};
    for (int face = 0; face < 6; ++face) {
        const float* n = normals[face];
        const float* u = across[face];
        const float v[3] = {n[1] * u[2] - n[2] * u[1], n[2] * u[0] - n[0] * u[2], n[0] * u[1] - n[1] * u[0]};
        for (int corner = 0; corner < 4; ++corner) {
            float* vertex = vertices + (face * 4 + corner) * CUBE_VERTEX_FLOATS;
            for (int axis = 0; axis < 3; ++axis) {
                vertex[axis] = 0.5f * (n[axis] + corners[corner][0] * u[axis] + corners[corner][1] * v[axis]);
                vertex[3 + axis] = n[axis];
            }
            vertex[6] = 0.5f * (corners[corner][0] + 1);
            vertex[7] = 0.5f * (corners[corner][1] + 1);
        }
        const uint16_t base = static_cast<uint16_t>(face * 4);
        const uint16_t face_indices[6] = {base, static_cast<uint16_t>(base + 1), static_cast<uint16_t>(base + 2),
                                          base, static_cast<uint16_t>(base + 2), static_cast<uint16_t>(base + 3)};
        for (int i = 0; i < 6; ++i) indices[face * 6 + i] = face_indices[i];
    }
}

#endif
