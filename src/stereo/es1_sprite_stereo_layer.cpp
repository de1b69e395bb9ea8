#include "stereo/es1_sprite_stereo_layer.h"

#include "core/raw_gl.h"
#include "core/saturating_math.h"
#include "core/stereo_manager.h"
#include "stereo/draw_call.h"
#include "stereo/es1_eye_clear.h"
#include "stereo/eye_bracket.h"
#include "stereo/eye_viewport.h"
#include "stereo/fixed_function_snapshot.h"
#include "stereo/frame_parameters.h"

namespace ovo {

void Es1SpriteStereoLayer::glClear(StereoManager& manager, GLbitfield mask) {
    ClearBothEyes(manager, mask);
}

void Es1SpriteStereoLayer::Draw(StereoManager& manager, const DrawCall& draw) {
    const FixedFunctionSnapshot snapshot(true);
    raw::glMatrixMode(GL_PROJECTION);
    StepDepthPlane(manager);
    DrawEyeBracket(manager, draw, [&](int eye) {
        raw::glLoadMatrixf(snapshot.Projection());
        ApplyEyeViewport(manager, eye, manager.ScaleX(), manager.ScaleY());
        if (snapshot.IsFlat()) {
            // Whole units of the plane only: the product is truncated before it is scaled.
            const float distance = EyeSign(eye) * manager.m_profile->m_eye_distance;
            const int32_t units = SaturatingTrunc(distance * manager.m_depth_plane);
            raw::glTranslatef(static_cast<float>(units) * manager.m_depth_unit, 0.0f, 0.0f);
        }
    });
    snapshot.Restore();
}

}  // namespace ovo
