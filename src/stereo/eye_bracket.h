#ifndef OVO_STEREO_EYE_BRACKET_H
#define OVO_STEREO_EYE_BRACKET_H

#include "core/stereo_manager.h"
#include "egl/current_context.h"
#include "present/composition_renderer.h"
#include "stereo/draw_call.h"

namespace ovo {

// The first half of the eye bracket: the mask test goes on before anything of the pair.
// Layers that flush the overlay do so between this and DrawEyePair. A surface that was
// made current since its last swap (the player returned, the device turned) gets its mask
// first, so that its first frame is stereo too.
inline void BeginEyeMask(StereoManager& manager) {
    if (!manager.m_interleave) return;
    if (!CurrentBinding().m_surface_masked) manager.m_composer->MaskNewSurface(manager);
    manager.m_composer->SetMaskTest(1);
}

// The rest of the bracket: per eye, `setup(eye)`, the eye's stencil reference, the
// application's draw; eye 0 first. Viewport, scissor and stencil function keep eye 1's.
template <typename Setup>
void DrawEyePair(StereoManager& manager, const DrawCall& draw, Setup setup) {
    for (int eye = 0; eye < 2; ++eye) {
        setup(eye);
        if (manager.m_interleave) manager.m_composer->SelectEye(eye);
        draw.Issue();
    }
    if (manager.m_interleave) manager.m_composer->SetMaskTest(0);
}

// The whole bracket around one draw.
template <typename Setup>
void DrawEyeBracket(StereoManager& manager, const DrawCall& draw, Setup setup) {
    BeginEyeMask(manager);
    DrawEyePair(manager, draw, setup);
}

}  // namespace ovo

#endif
