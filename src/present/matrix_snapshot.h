#ifndef OVO_PRESENT_MATRIX_SNAPSHOT_H
#define OVO_PRESENT_MATRIX_SNAPSHOT_H

#include <cstdint>

namespace ovo {

constexpr uint32_t PROJECTION_FLAT = 0x1000;
constexpr uint32_t PROJECTION_PERSPECTIVE = 0x1001;

// A projection is perspective only when it carries -z into w (m[11] != 0) and does not
// keep w = 1 (m[15] != 1); games' orthographic and near-orthographic matrices are flat.
uint32_t ClassifyProjection(const float projection[16]);

// A 2D overlay draw: drawn unmoved (identity modelview) with no or ordinary alpha blending.
// Queries the blend state only when the modelview qualifies.
bool IsOverlayCandidate(const float modelview[16]);

// Loads both matrices and then the matrix mode, as a snapshot puts them back.
void RestoreMatrices(const float projection[16], const float modelview[16], int32_t matrix_mode);

// The fixed-function matrices around one ES 1.x draw: taken at its start, varied per eye,
// put back at its end. Lives on the stack of the draw; talks to the vendor directly.
class MatrixSnapshot {
public:
    MatrixSnapshot() { Capture(); }

    void Capture();
    uint32_t ProjectionKind() const { return ClassifyProjection(m_projection); }

    bool IsOverlayCandidate() const { return ovo::IsOverlayCandidate(m_modelview); }

    // The GL projection becomes translate(t) x captured projection: a shift in clip space.
    void LoadShiftedProjection(const float t[3]) const;

    // The GL projection becomes translate(t2) x captured projection x translate(t1): the
    // eye moves by t1, its image moves back by t2.
    void LoadEyeProjection(const float t1[3], const float t2[3]) const;

    // Both matrices and the matrix mode as they were captured.
    void Restore() const { RestoreMatrices(m_projection, m_modelview, m_matrix_mode); }

    const float* Projection() const { return m_projection; }
    const float* Modelview() const { return m_modelview; }

private:
    float m_projection[16];
    float m_modelview[16];
    int32_t m_matrix_mode;
};

}  // namespace ovo

#endif
