#ifndef OVO_PRESENT_COMPOSITION_RENDERER_H
#define OVO_PRESENT_COMPOSITION_RENDERER_H

#include <cstdint>

#include "config/stereo_profile_fields.h"
#include "core/gl_api.h"
#include "egl/context_objects.h"

namespace ovo {

class StereoManager;

// The OpenGL ES 2.0 mask's program in one share group, with its uniforms' locations.
struct MaskProgram {
    GLuint m_program;
    GLint m_matrix_location;
    GLint m_color_location;

    void Delete() const;
};

// Column interleaving through the stencil buffer: after each swap the stencil becomes 1
// everywhere and 0 on every second pixel column, and each eye's pass draws where the
// stencil holds that eye's reference.
class CompositionRenderer {
public:
    // swap_eyes: non-zero exchanges the two eyes' stencil references.
    explicit CompositionRenderer(uint32_t swap_eyes);
    ~CompositionRenderer();
    CompositionRenderer(const CompositionRenderer&) = delete;
    CompositionRenderer& operator=(const CompositionRenderer&) = delete;

    // After the vendor swap: clears the new back buffer and draws the column mask. The
    // first call in the process also starts the panel's composition and builds the lines,
    // for the drawing path and target size of that moment.
    void Present(StereoManager& manager);
    // Before the first stereo draw into a window surface that was made current since its
    // last swap: its stencil gets the mask, its colour and depth stay. Nothing before the
    // first swap of the process, which builds the lines.
    void MaskNewSurface(const StereoManager& manager);
    // on == 1 switches the stencil test on, anything else off.
    void SetMaskTest(int on) const;
    // Restricts drawing to the columns of `eye`.
    void SelectEye(int eye) const;
    // The application's clears keep the mask.
    static GLbitfield FilterClearMask(GLbitfield mask);
    // Whether the mask is drawn at the profile's target size; otherwise at 800 x 480.
    static bool IsKnownTargetSize(const StereoProfileFields& profile);

    // The ES 2.0 mask's program is built once per share group, where the mask is first
    // drawn, and goes with the group's last context.
    bool HoldsProgram(uint32_t share_group) const { return m_programs.Holds(share_group); }
    void ReleaseProgram(uint32_t share_group, bool deletable) {
        m_programs.Release(share_group, deletable);
    }

    int32_t LineCount() const { return m_line_count; }
    // Line i is entries 4i..4i+3: x0, y0, x1, y1.
    const float* Vertices() const { return m_vertices; }

private:
    // Lines for the OpenGL ES 2.0 path, origin at the lower-left corner.
    void BuildLinesGl2(const StereoProfileFields& profile);
    // Lines for the OpenGL ES 1.x path, origin at the centre.
    void BuildLinesGl1(const StereoProfileFields& profile);
    // Allocates room for the lines; false (and no lines) when memory is short.
    bool AllocateLines(const StereoProfileFields& profile);
    // Clears `clear_bits` (the stencil to 1 among them) and draws the lines.
    void DrawMask(const StereoManager& manager, GLbitfield clear_bits);
    void DrawLinesGl2(GLsizei width, GLsizei height, uint32_t share_group);
    void DrawLinesGl1(GLsizei width, GLsizei height) const;

    int32_t m_line_count;
    float* m_vertices;
    float m_projection[16];
    uint32_t m_swap_eyes;
    ContextObjectTable<uint32_t, MaskProgram> m_programs;
};

}  // namespace ovo

#endif
