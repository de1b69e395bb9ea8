#ifndef OVO_CONFIG_STEREO_PROFILE_H
#define OVO_CONFIG_STEREO_PROFILE_H

#include <cstdint>

namespace ovo {

// How the process is converted to stereo; resolved once per process.
enum StereoMode : uint32_t {
    STEREO_MODE_OFF = 0x1000,
    STEREO_MODE_PLAIN = 0x1001,
    STEREO_MODE_SHADER = 0x1002,
    STEREO_MODE_SHADER_LISTED = 0x1003,
};

enum StereoAxis : uint32_t {
    STEREO_AXIS_X = 0x3001,
    STEREO_AXIS_Y = 0x3002,
    STEREO_AXIS_Z = 0x3003,
};

enum StereoSplit : uint32_t {
    STEREO_SPLIT_SIDE_BY_SIDE = 0x3101,
    STEREO_SPLIT_TOP_BOTTOM = 0x3102,
};

enum StereoEyeOrder : uint32_t {
    STEREO_EYE_ORDER_NORMAL = 0x3106,
    STEREO_EYE_ORDER_SWAPPED = 0x3107,
};

enum StereoRamp : uint32_t {
    STEREO_RAMP_OFF = 0x3201,
    STEREO_RAMP_ON = 0x3202,
};

// The profile that the companion application writes for the game about to start.
constexpr const char PROFILE_PATH[] = "/sdcard/stereoconv/game/stereo_gm.ovo";

// The settings record of the whole library. Fields are plain data: the control channel,
// the swap path and the per-frame logic read and write them directly.
class StereoProfile {
public:
    StereoProfile();
    ~StereoProfile();

    StereoProfile(const StereoProfile&) = delete;
    StereoProfile& operator=(const StereoProfile&) = delete;

    // The cached mode; resolved from the flags and the process name on first use.
    StereoMode ResolveMode();
    // Takes the output size from the screen or the eye target, then resolves the mode.
    StereoMode ApplyScreenSize();

    int32_t m_width;
    int32_t m_height;
    bool m_enabled;
    uint32_t m_mode;
    float m_eye_distance;
    float m_eye_shift;
    float m_eye_angle;
    float m_ramp_steps;
    uint32_t m_eye_axis;
    uint32_t m_shift_axis;
    uint32_t m_ramp_param;
    uint32_t m_split;
    uint32_t m_eye_order;
    uint32_t m_ramp;
    int32_t m_target_width;
    int32_t m_target_height;
    int32_t m_screen_width;
    int32_t m_screen_height;
    bool m_shader_convert;
    bool m_use_screen_size;
    bool m_auto_eye;
    bool m_eye_target;
    bool m_valid;
    bool m_swap_eye_mask;
    float m_eye_shift_set;
    float m_eye_distance_set;
    float m_eye_angle_set;
    float m_ramp_restart;
    bool m_force_portrait;
};

}  // namespace ovo

#endif
