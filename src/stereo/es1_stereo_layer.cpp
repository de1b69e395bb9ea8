#include "stereo/es1_stereo_layer.h"

#include "core/stereo_manager.h"
#include "present/matrix4.h"
#include "present/matrix_snapshot.h"
#include "present/viewer_tracker.h"
#include "stereo/draw_call.h"
#include "stereo/es1_eye_clear.h"
#include "stereo/eye_bracket.h"
#include "stereo/eye_viewport.h"
#include "stereo/frame_parameters.h"
#include "stereo/overlay_target.h"

namespace ovo {

namespace {

// `value` on `axis`, 0 elsewhere; all zero for an unknown axis.
void AxisVector(float vector[3], uint32_t axis, float value) {
    Vec3Zero(vector);
    if (axis == STEREO_AXIS_X) vector[0] = value;
    if (axis == STEREO_AXIS_Y) vector[1] = value;
    if (axis == STEREO_AXIS_Z) vector[2] = value;
}

void SetUpFlatEye(StereoManager& manager, const MatrixSnapshot& snapshot, int eye) {
    const StereoProfile& profile = *manager.m_profile;
    float shift[3];
    AxisVector(shift, profile.m_shift_axis, EyeSign(eye) * profile.m_eye_shift);
    snapshot.LoadShiftedProjection(shift);
    ApplyEyeViewport(manager, eye, manager.ScaleX(), manager.ScaleY());
}

void SetUpPerspectiveEye(StereoManager& manager, const MatrixSnapshot& snapshot, int eye) {
    const StereoProfile& profile = *manager.m_profile;
    // A viewport of the full target width that does not start at 0 keeps its projection.
    const bool offset_full_width =
        manager.m_viewport.m_width == profile.m_target_width && manager.m_viewport.m_x != 0;
    if (!offset_full_width) {
        const float sign = EyeSign(eye);
        float eye_move[3];
        float image_move[3];
        AxisVector(eye_move, profile.m_eye_axis, sign * profile.m_eye_distance);
        AxisVector(image_move, profile.m_eye_axis, -(sign * profile.m_eye_angle));
        snapshot.LoadEyeProjection(eye_move, image_move);
    }
    ApplyEyeViewport(manager, eye, manager.ScaleX(), manager.ScaleY());
}

}  // namespace

void Es1StereoLayer::glClear(StereoManager& manager, GLbitfield mask) {
    ClearBothEyes(manager, mask);
}

void Es1StereoLayer::Draw(StereoManager& manager, const DrawCall& draw) {
    const MatrixSnapshot snapshot;
    const StereoProfile& profile = *manager.m_profile;
    if (profile.m_ramp == STEREO_RAMP_ON && manager.m_interleave) StepRampEs1(manager);
    OverlayTarget& overlay = *manager.m_overlay;
    if (snapshot.ProjectionKind() == PROJECTION_FLAT) {
        if (profile.m_eye_target && snapshot.IsOverlayCandidate()) {
            overlay.DrawInto(manager, draw);
        } else {
            BeginEyeMask(manager);
            overlay.Flush(manager);
            DrawEyePair(manager, draw,
                        [&](int eye) { SetUpFlatEye(manager, snapshot, eye); });
        }
    } else {
        BeginEyeMask(manager);
        overlay.Flush(manager);
        manager.m_viewer->Observe(snapshot.Projection(), snapshot.Modelview());
        DrawEyePair(manager, draw,
                    [&](int eye) { SetUpPerspectiveEye(manager, snapshot, eye); });
    }
    snapshot.Restore();
}

}  // namespace ovo
