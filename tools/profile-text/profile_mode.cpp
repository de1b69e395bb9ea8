#include "profile_mode.h"

namespace ovo_profile {

namespace {

const uint32_t MODES[] = {ovo::STEREO_MODE_OFF, ovo::STEREO_MODE_PLAIN, ovo::STEREO_MODE_SHADER,
                          ovo::STEREO_MODE_SHADER_LISTED};

}  // namespace

std::string LibraryProcessName(const std::string& name) {
    return name.substr(0, ovo::PROFILE_PROCESS_NAME_CAPACITY - 1);
}

const char* ModeName(uint32_t mode) {
    switch (mode) {
        case ovo::STEREO_MODE_OFF: return "off";
        case ovo::STEREO_MODE_PLAIN: return "plain";
        case ovo::STEREO_MODE_SHADER: return "shader";
        case ovo::STEREO_MODE_SHADER_LISTED: return "shader_listed";
        default: return "unresolved";
    }
}

bool IsModeName(const std::string& name) {
    for (uint32_t mode : MODES) {
        if (name == ModeName(mode)) return true;
    }
    return false;
}

ovo::StereoMode ResolveStartUpMode(const ovo::ProfileTable& table, const std::string& process_name) {
    // The same steps as StereoProfile's constructor, on the given table and name.
    const std::string name = LibraryProcessName(process_name);
    ovo::StereoProfileFields fields;
    bool accepted = false;
    if (table.m_validity != 0) {
        ovo::ApplyProfileItems(fields, table);
        accepted = fields.m_valid;
    }
    if (accepted) {
        fields.m_enabled = true;
        ovo::SelectOutputSize(fields);
        fields.m_mode = ovo::ModeForProcess(fields, name.c_str());
    }
    ovo::ApplyLiveWallpaperPreset(fields, ovo::LiveWallpaperKindOf(name.c_str()));
    if (fields.m_mode == 0) fields.m_mode = ovo::ModeForProcess(fields, name.c_str());
    return static_cast<ovo::StereoMode>(fields.m_mode);
}

}  // namespace ovo_profile
