#include "stereo/es1_scaled_layer.h"

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "present/matrix_snapshot.h"
#include "stereo/draw_call.h"
#include "stereo/eye_viewport.h"
#include "stereo/fixed_function_snapshot.h"
#include "stereo/overlay_target.h"

namespace ovo {

void Es1ScaledLayer::glClear(StereoManager& manager, GLbitfield mask) {
    const StereoProfile& profile = *manager.m_profile;
    raw::glScissor(0, 0, profile.m_width, profile.m_height);
    raw::glClear(mask);
}

void Es1ScaledLayer::Draw(StereoManager& manager, const DrawCall& draw) {
    const FixedFunctionSnapshot snapshot(false);
    const bool eye_target = manager.m_profile->m_eye_target;
    OverlayTarget& overlay = *manager.m_overlay;
    if (snapshot.IsFlat() && eye_target && IsOverlayCandidate(snapshot.Modelview())) {
        overlay.DrawInto(manager, draw);
        return;
    }
    if (eye_target) {
        if (overlay.HasContent()) {
            overlay.ComposeSingle(0.0f, 0.0f, 1280.0f, 720.0f, 0.0f, 1.0f);
            overlay.Clear();
        }
        overlay.Unbind();
    }
    ApplyScaledViewport(manager, manager.ScaleX(), manager.ScaleY());
    draw.Issue();
    snapshot.Restore();
}

}  // namespace ovo
