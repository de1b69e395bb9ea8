#include "config/stereo_profile_fields.h"

#include <cstring>

namespace ovo {

namespace {

// Applications with their own shader handling, in the order in which they are compared.
constexpr const char* LISTED_PROCESSES[] = {
    "com.rovio.angrybirdsrio.korean",
    "com.rovio.angrybirds",
    "com.rovio.angrybirds_lite",
    "com.rovio.angrybirdsseasons",
    "com.Paladog.Lite",
    "com.rovio.angrybirdsrio",
    "com.rovio.angrybirdsstarwars.ads.iap",
};

struct LiveWallpaperName {
    const char* m_name;
    int m_kind;
};

// Known live wallpapers, in the order in which they are compared.
constexpr LiveWallpaperName LIVE_WALLPAPERS[] = {
    {"fishnoodle.snowfall_free", LIVE_WALLPAPER_SNOWFALL},
    {"fishnoodle.snowfall", LIVE_WALLPAPER_SNOWFALL},
    {"com.android.wallpaper", LIVE_WALLPAPER_ANDROID},
    {"fishnoodle.koipond_free", LIVE_WALLPAPER_KOI_POND},
    {"fishnoodle.koipond", LIVE_WALLPAPER_KOI_POND},
    {"fishnoodle.aquarium_free", LIVE_WALLPAPER_AQUARIUM},
    {"fishnoodle.aquarium", LIVE_WALLPAPER_AQUARIUM},
    {"fishnoodle.clouds_free", LIVE_WALLPAPER_CLOUDS},
    {"fishnoodle.clouds", LIVE_WALLPAPER_CLOUDS},
    {"au.com.dealsmap.lwp.cube.PackEarth", LIVE_WALLPAPER_PACK_EARTH},
};

// The values that differ between the presets.
struct LiveWallpaperPreset {
    float m_eye_distance;
    float m_eye_angle;
    float m_ramp_steps;
    float m_ramp_restart;
};

// Indexed by kind - 1.
constexpr LiveWallpaperPreset PRESETS[] = {
    {-0.035f, -0.05f, 2.0f, 5.0f},   // snowfall
    {-0.005f, -3.0f, 1.0f, -1.0f},   // Android wallpapers
    {-0.001f, -20.0f, 1.0f, -1.0f},  // koi pond
    {-0.03f, -0.01f, 5.0f, 1.0f},    // aquarium
    {-0.04f, -0.01f, 30.0f, 1.0f},   // clouds
    {-0.001f, -20.0f, 1.0f, -1.0f},  // Pack Earth cube
};

constexpr int32_t PRESET_WIDTH = 480;
constexpr int32_t PRESET_HEIGHT = 800;

float FloatOf(uint32_t bits) {
    float value;
    std::memcpy(&value, &bits, sizeof(value));
    return value;
}

}  // namespace

bool ApplyProfileItem(StereoProfileFields& fields, const ProfileItem& item) {
    const uint32_t word0 = item.m_data[0];
    const uint32_t word1 = item.m_data[1];
    const bool flag = word0 != 0;
    switch (item.m_id) {
        case PROFILE_ITEM_EYE_DISTANCE:
            fields.m_eye_distance = FloatOf(word0);
            fields.m_eye_distance_set = fields.m_eye_distance;
            return true;
        case PROFILE_ITEM_EYE_SHIFT:
            fields.m_eye_shift = FloatOf(word0);
            fields.m_eye_shift_set = fields.m_eye_shift;
            return true;
        case PROFILE_ITEM_EYE_ANGLE:
            fields.m_eye_angle = FloatOf(word0);
            fields.m_eye_angle_set = fields.m_eye_angle;
            return true;
        case PROFILE_ITEM_RAMP_STEPS: fields.m_ramp_steps = FloatOf(word0); return true;
        case PROFILE_ITEM_EYE_AXIS: fields.m_eye_axis = word0; return true;
        case PROFILE_ITEM_RAMP_PARAM: fields.m_ramp_param = word0; return true;
        case PROFILE_ITEM_SPLIT: fields.m_split = word0; return true;
        case PROFILE_ITEM_EYE_ORDER: fields.m_eye_order = word0; return true;
        case PROFILE_ITEM_RAMP: fields.m_ramp = word0; return true;
        case PROFILE_ITEM_TARGET_SIZE:
            fields.m_target_width = static_cast<int32_t>(word0);
            fields.m_target_height = static_cast<int32_t>(word1);
            return true;
        case PROFILE_ITEM_SCREEN_SIZE:
            fields.m_screen_width = static_cast<int32_t>(word0);
            fields.m_screen_height = static_cast<int32_t>(word1);
            return true;
        case PROFILE_ITEM_SHADER_CONVERT: fields.m_shader_convert = flag; return true;
        case PROFILE_ITEM_USE_SCREEN_SIZE: fields.m_use_screen_size = flag; return true;
        case PROFILE_ITEM_AUTO_EYE: fields.m_auto_eye = flag; return true;
        case PROFILE_ITEM_EYE_TARGET: fields.m_eye_target = flag; return true;
        case PROFILE_ITEM_VALID: fields.m_valid = flag; return true;
        default: return false;  // 0, the unused flags and text, unknown ids
    }
}

void ApplyProfileItems(StereoProfileFields& fields, const ProfileTable& table) {
    for (int index = 0; index < PROFILE_FILE_ITEMS; ++index) ApplyProfileItem(fields, table.m_items[index]);
}

void SelectOutputSize(StereoProfileFields& fields) {
    if (fields.m_use_screen_size) {
        fields.m_width = fields.m_screen_width;
        fields.m_height = fields.m_screen_height;
    } else {
        fields.m_width = fields.m_target_width;
        fields.m_height = fields.m_target_height;
    }
}

bool IsListedProcess(const char* process_name) {
    if (process_name == nullptr) return false;
    for (const char* listed : LISTED_PROCESSES) {
        if (std::strcmp(process_name, listed) == 0) return true;
    }
    return false;
}

StereoMode ModeForProcess(const StereoProfileFields& fields, const char* process_name) {
    if (!fields.m_enabled) return STEREO_MODE_OFF;
    if (!fields.m_shader_convert) return STEREO_MODE_PLAIN;
    return IsListedProcess(process_name) ? STEREO_MODE_SHADER_LISTED : STEREO_MODE_SHADER;
}

int LiveWallpaperKindOf(const char* process_name) {
    if (process_name == nullptr) return LIVE_WALLPAPER_NONE;
    for (const LiveWallpaperName& wallpaper : LIVE_WALLPAPERS) {
        if (std::strcmp(process_name, wallpaper.m_name) == 0) return wallpaper.m_kind;
    }
    return LIVE_WALLPAPER_NONE;
}

bool IsLiveWallpaperNamePrefix(const char* prefix) {
    const size_t length = std::strlen(prefix);
    for (const LiveWallpaperName& wallpaper : LIVE_WALLPAPERS) {
        if (std::strncmp(wallpaper.m_name, prefix, length) == 0) return true;
    }
    return false;
}

void ApplyLiveWallpaperPreset(StereoProfileFields& fields, int kind) {
    if (kind < LIVE_WALLPAPER_SNOWFALL || kind > LIVE_WALLPAPER_PACK_EARTH) return;
    const LiveWallpaperPreset& preset = PRESETS[kind - 1];
    fields.m_enabled = true;
    fields.m_mode = STEREO_MODE_SHADER;
    fields.m_width = PRESET_WIDTH;
    fields.m_height = PRESET_HEIGHT;
    fields.m_eye_distance = preset.m_eye_distance;
    fields.m_ramp_steps = preset.m_ramp_steps;
    fields.m_ramp_restart = preset.m_ramp_restart;
    fields.m_eye_shift = 0.0f;
    fields.m_eye_angle = preset.m_eye_angle;
    fields.m_eye_axis = STEREO_AXIS_X;
    fields.m_shift_axis = STEREO_AXIS_X;
    fields.m_split = STEREO_SPLIT_SIDE_BY_SIDE;
    fields.m_eye_order = STEREO_EYE_ORDER_NORMAL;
    fields.m_ramp = STEREO_RAMP_ON;
    fields.m_eye_distance_set = fields.m_eye_distance;
    fields.m_eye_angle_set = fields.m_eye_angle;
    fields.m_target_width = PRESET_WIDTH;
    fields.m_target_height = PRESET_HEIGHT;
    fields.m_screen_width = PRESET_WIDTH;
    fields.m_screen_height = PRESET_HEIGHT;
    fields.m_shader_convert = true;
    fields.m_use_screen_size = false;
    fields.m_auto_eye = false;
    fields.m_eye_target = false;
    fields.m_valid = true;
    fields.m_swap_eye_mask = false;
    fields.m_force_portrait = true;
}

}  // namespace ovo
