#include "stereo/frame_parameters.h"

#include <cmath>

#include "config/debug_config.h"
#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "present/viewer_tracker.h"
#include "stereo/overlay_target.h"

namespace ovo {

namespace {

// Within this of zero a ramped value counts as having reached it.
constexpr double RAMP_ZERO = 0.000001;
// The plane a sprite frame wraps back to (fixed, unlike the frame's start).
constexpr float DEPTH_PLANE_WRAP = -5.0f;

GLuint BoundTexture() {
    GLint texture = 0;
    raw::glGetIntegerv(GL_TEXTURE_BINDING_2D, &texture);
    return static_cast<GLuint>(texture);
}

// One ramp step of `live` (configured value `configured`); false when the texture did not
// change and nothing moved.
bool StepRamp(StereoManager& manager, float& live, float configured) {
    const GLuint texture = BoundTexture();
    if (texture == manager.m_last_texture) return false;
    manager.m_last_texture = texture;
    StereoProfile& profile = *manager.m_profile;
    if (profile.m_ramp_steps == 0.0f) profile.m_ramp_steps = 1.0f;
    const double step = std::fabs(static_cast<double>(configured)) / profile.m_ramp_steps;
    double value = live;
    if (configured < 0.0f) {
        if (manager.m_frame_draws != 0) value += step;
        manager.m_frame_draws = 1;
        live = static_cast<float>(value);
        if (value < -RAMP_ZERO) return true;
    } else {
        if (manager.m_frame_draws != 0) value -= step;
        manager.m_frame_draws = 1;
        live = static_cast<float>(value);
        if (value > RAMP_ZERO) return true;
    }
    // Reached or crossed zero: a small value of the other sign for the rest of the frame.
    live = -configured / profile.m_ramp_restart;
    return true;
}

}  // namespace

void BeginFrame(StereoManager& manager) {
    StereoProfile& profile = *manager.m_profile;
    ViewerTracker& viewer = *manager.m_viewer;
    if (viewer.IsEnabled()) {
        viewer.EstimateEyes();
        const float distance = viewer.EyeDistance();
        const float angle = viewer.EyeAngle();
        profile.m_eye_distance = distance;
        profile.m_eye_angle = angle;
        manager.m_debug->Print("%04d : eye_distance(%f), eye_angle(%f)", manager.m_frame_number,
                               distance, angle);
    }
    manager.m_depth_plane = -manager.m_depth_start;
    manager.m_last_texture = 0;
    manager.m_frame_draws = 0;
    if (profile.m_eye_target) {
        OverlayTarget& overlay = *manager.m_overlay;
        if (!profile.m_shader_convert) {
            overlay.ComposeSingle(0.0f, 0.0f, 1280.0f, 720.0f, 0.0f, 1.0f);
        } else if (profile.m_use_screen_size) {
            overlay.ComposeStereo(manager, 0.0f, 0.0f, 640.0f, 720.0f, 0.0f, 1.0f);
        } else {
            overlay.ComposeStereo(manager, 0.0f, 0.0f, 400.0f, 480.0f, 0.0f, 1.0f);
        }
    }
    manager.m_frame_number += 1;
}

void StepRampEs1(StereoManager& manager) {
    StereoProfile& profile = *manager.m_profile;
    if (manager.m_frame_draws == 0) {
        profile.m_eye_distance = profile.m_eye_distance_set;
        profile.m_eye_angle = profile.m_eye_angle_set;
        profile.m_eye_shift = profile.m_eye_shift_set;
    }
    switch (profile.m_ramp_param) {
        case STEREO_AXIS_Y: StepRamp(manager, profile.m_eye_angle, profile.m_eye_angle_set); break;
        case STEREO_AXIS_Z: StepRamp(manager, profile.m_eye_shift, profile.m_eye_shift_set); break;
        default: StepRamp(manager, profile.m_eye_distance, profile.m_eye_distance_set); break;
    }
}

void StepRampEs2(StereoManager& manager) {
    StereoProfile& profile = *manager.m_profile;
    if (manager.m_frame_draws == 0) {
        profile.m_eye_distance = profile.m_eye_distance_set;
        profile.m_eye_angle = profile.m_eye_angle_set;
    }
    if (profile.m_ramp_param == STEREO_AXIS_Y) {
        StepRamp(manager, profile.m_eye_angle, profile.m_eye_angle_set);
    } else {
        StepRamp(manager, profile.m_eye_distance, profile.m_eye_distance_set);
    }
}

void StepDepthPlane(StereoManager& manager) {
    const GLuint texture = BoundTexture();
    if (texture != manager.m_last_texture) {
        manager.m_last_texture = texture;
        if (manager.m_frame_draws != 0) manager.m_depth_plane += manager.m_depth_step;
        if (manager.m_depth_plane > 0.0f) manager.m_depth_plane = DEPTH_PLANE_WRAP;
    }
    manager.m_frame_draws += 1;
}

}  // namespace ovo
