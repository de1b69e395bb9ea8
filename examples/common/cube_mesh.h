#ifndef OVO_EXAMPLES_COMMON_CUBE_MESH_H
#define OVO_EXAMPLES_COMMON_CUBE_MESH_H

#include <cstdint>

namespace ovo_sample {

// One interleaved vertex as games pack them: position, normal, texture coordinate.
struct MeshVertex {
    float m_position[3];
    float m_normal[3];
    float m_uv[2];
};

constexpr int32_t CUBE_VERTEX_COUNT = 24;
constexpr int32_t CUBE_INDEX_COUNT = 36;

// A cube from -1 to 1 with four vertices per face (flat normals, a whole texture per face)
// and counter-clockwise front faces.
extern const MeshVertex CUBE_VERTICES[CUBE_VERTEX_COUNT];
extern const uint16_t CUBE_INDICES[CUBE_INDEX_COUNT];

}  // namespace ovo_sample

#endif
