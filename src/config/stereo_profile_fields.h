#ifndef OVO_CONFIG_STEREO_PROFILE_FIELDS_H
#define OVO_CONFIG_STEREO_PROFILE_FIELDS_H

// The stereo profile's settings record and the rules that fill it: what each file item
// sets, the mode that a process resolves to, the live-wallpaper presets. Pure functions of
// their arguments (no files, no log), shared by the library's StereoProfile and the
// ovo-profile tool.

#include <cstddef>
#include <cstdint>

#include "config/profile_file.h"

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

// Live-wallpaper kinds (DetectLiveWallpaper); 0 is none.
enum LiveWallpaperKind : int {
    LIVE_WALLPAPER_NONE = 0,
    LIVE_WALLPAPER_SNOWFALL = 1,
    LIVE_WALLPAPER_ANDROID = 2,
    LIVE_WALLPAPER_KOI_POND = 3,
    LIVE_WALLPAPER_AQUARIUM = 4,
    LIVE_WALLPAPER_CLOUDS = 5,
    LIVE_WALLPAPER_PACK_EARTH = 6,
};

// The process name is the first NUL-terminated string of the process's command line, read
// into a buffer of this size and always terminated inside it.
constexpr size_t PROFILE_PROCESS_NAME_CAPACITY = 256;

// The settings, in the profile's field order, with their defaults. StereoProfile derives
// from this record, so the fields are reached as profile.m_eye_distance and so on.
struct StereoProfileFields {
    int32_t m_width = 0;
    int32_t m_height = 0;
    bool m_enabled = false;
    uint32_t m_mode = 0;  // a StereoMode; 0 while not resolved
    float m_eye_distance = 0.0f;
    float m_eye_shift = 0.0f;
    float m_eye_angle = 0.0f;
    float m_ramp_steps = 0.0f;
    uint32_t m_eye_axis = STEREO_AXIS_X;
    uint32_t m_shift_axis = STEREO_AXIS_X;
    uint32_t m_ramp_param = STEREO_AXIS_X;
    uint32_t m_split = STEREO_SPLIT_SIDE_BY_SIDE;
    uint32_t m_eye_order = STEREO_EYE_ORDER_NORMAL;
    uint32_t m_ramp = STEREO_RAMP_OFF;
    int32_t m_target_width = 0;
    int32_t m_target_height = 0;
    int32_t m_screen_width = 0;
    int32_t m_screen_height = 0;
    bool m_shader_convert = false;
    bool m_use_screen_size = false;
    bool m_auto_eye = false;
    bool m_eye_target = false;
    bool m_valid = false;
    bool m_swap_eye_mask = true;
    float m_eye_shift_set = 0.0f;
    float m_eye_distance_set = 0.0f;
    float m_eye_angle_set = 0.0f;
    float m_ramp_restart = 10.0f;
    bool m_force_portrait = false;
};

// Applies one item by its id (the type only decided how the payload was read): a float is
// word 0's bits as an IEEE-754 single, a flag is word 0 != 0. Ids that set nothing (0, the
// unused ones, unknown ones) change nothing. Returns whether the id sets a field.
bool ApplyProfileItem(StereoProfileFields& fields, const ProfileItem& item);

// Applies the file's 24 slots in order (a later item with the same id wins). Does not look
// at the validity word; the caller decides whether the items apply at all.
void ApplyProfileItems(StereoProfileFields& fields, const ProfileTable& table);

// m_width/m_height from the screen size when m_use_screen_size is set, else from the eye
// target size.
void SelectOutputSize(StereoProfileFields& fields);

// The name is one of the built-in applications with their own shader handling (exact,
// case-sensitive comparison).
bool IsListedProcess(const char* process_name);

// The mode that the flags give for `process_name` (null: the name could not be read):
// OFF when not enabled, PLAIN without shader conversion, otherwise SHADER_LISTED for the
// built-in applications and SHADER for every other process. Ignores m_mode.
StereoMode ModeForProcess(const StereoProfileFields& fields, const char* process_name);

// The live-wallpaper kind of `process_name` (null or unknown: LIVE_WALLPAPER_NONE).
int LiveWallpaperKindOf(const char* process_name);

// Some live wallpaper's name begins with `prefix` (or is it).
bool IsLiveWallpaperNamePrefix(const char* prefix);

// Overwrites the fields with the preset of `kind` (1..6); any other kind changes nothing.
// m_eye_shift_set and m_ramp_param keep their values.
void ApplyLiveWallpaperPreset(StereoProfileFields& fields, int kind);

}  // namespace ovo

#endif
