#include "config/stereo_profile.h"

namespace ovo {

StereoProfile::StereoProfile()
    : m_width(0),
      m_height(0),
      m_enabled(false),
      m_mode(0),
      m_eye_distance(0.0f),
      m_eye_shift(0.0f),
      m_eye_angle(0.0f),
      m_ramp_steps(0.0f),
      m_eye_axis(STEREO_AXIS_X),
      m_shift_axis(STEREO_AXIS_X),
      m_ramp_param(STEREO_AXIS_X),
      m_split(STEREO_SPLIT_SIDE_BY_SIDE),
      m_eye_order(STEREO_EYE_ORDER_NORMAL),
      m_ramp(STEREO_RAMP_OFF),
      m_target_width(0),
      m_target_height(0),
      m_screen_width(0),
      m_screen_height(0),
      m_shader_convert(false),
      m_use_screen_size(false),
      m_auto_eye(false),
      m_eye_target(false),
      m_valid(false),
      m_swap_eye_mask(true),
      m_eye_shift_set(0.0f),
      m_eye_distance_set(0.0f),
      m_eye_angle_set(0.0f),
      m_ramp_restart(10.0f),
      m_force_portrait(false) {}

StereoProfile::~StereoProfile() { m_enabled = false; }

StereoMode StereoProfile::ResolveMode() {
    if (m_mode == 0) {
        if (!m_enabled) {
            m_mode = STEREO_MODE_OFF;
        } else if (!m_shader_convert) {
            m_mode = STEREO_MODE_PLAIN;
        } else {
            m_mode = STEREO_MODE_SHADER;
        }
    }
    return static_cast<StereoMode>(m_mode);
}

StereoMode StereoProfile::ApplyScreenSize() {
    if (m_use_screen_size) {
        m_width = m_screen_width;
        m_height = m_screen_height;
    } else {
        m_width = m_target_width;
        m_height = m_target_height;
    }
    m_mode = ResolveMode();
    return static_cast<StereoMode>(m_mode);
}

}  // namespace ovo
