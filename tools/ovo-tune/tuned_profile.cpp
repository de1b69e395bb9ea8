#include "tuned_profile.h"

#include <cerrno>
#include <cstdio>
#include <cstring>

#include "atomic_file.h"
#include "config/stereo_profile_fields.h"
#include "profile_text_edit.h"
#include "profile_text_format.h"
#include "profile_text_parse.h"

namespace ovo_tune {

namespace {

bool ReadWholeFile(const std::string& path, std::string* text, std::string* problem) {
    FILE* file = std::fopen(path.c_str(), "rb");
    if (file == nullptr) {
        *problem = "cannot read " + path + ": " + std::strerror(errno);
        return false;
    }
    char buffer[4096];
    size_t count;
    while ((count = std::fread(buffer, 1, sizeof(buffer), file)) > 0) text->append(buffer, count);
    const bool failed = std::ferror(file) != 0;
    std::fclose(file);
    if (failed) *problem = "cannot read " + path;
    return !failed;
}

}  // namespace

bool TunedProfile::Load(const std::string& path, std::string* problem) {
    if (!ReadWholeFile(path, &m_text, problem)) return false;
    ovo::ProfileTable table;
    if (!ovo_profile::ParseProfileText(m_text, path, table, *problem)) return false;
    ovo::StereoProfileFields fields;
    ovo::ApplyProfileItems(fields, table);
    if (!fields.m_valid || !fields.m_shader_convert) {
        *problem = path + ": the library reads the live-tuning file only when the profile is valid and converts " +
                   "shaders (valid = true, shader_convert = true); with this profile no key would reach the program";
        return false;
    }
    m_start_values.m_parameters[EYE_DISTANCE] = fields.m_eye_distance;
    m_start_values.m_parameters[EYE_ANGLE] = fields.m_eye_angle;
    m_start_values.m_parameters[EYE_SHIFT] = fields.m_eye_shift;
    m_start_values.m_ramp_steps = fields.m_ramp_steps;
    m_ramp_on = fields.m_ramp == ovo::STEREO_RAMP_ON;
    m_binary.assign(ovo::PROFILE_FILE_CAPACITY, 0);
    m_binary.resize(ovo::WriteProfileTable(table, m_binary.data(), m_binary.size()));
    if (m_binary.empty()) {
        *problem = path + ": the items do not fit a profile file";
        return false;
    }
    return true;
}

bool TunedProfile::Save(const EyeValues& values, const std::string& path, std::string* problem) {
    std::vector<ovo_profile::FieldValue> changes;
    for (int index = 0; index < EYE_PARAMETER_COUNT; ++index) {
        const auto parameter = static_cast<EyeParameter>(index);
        changes.push_back(
            {ParameterName(parameter), ovo_profile::FormatFloat(static_cast<float>(values.m_parameters[index]))});
    }
    const std::string text = ovo_profile::SetFieldValues(m_text, changes);
    // What is saved must read back as a profile: `ovo-profile write` takes it.
    ovo::ProfileTable table;
    if (!ovo_profile::ParseProfileText(text, path, table, *problem)) return false;
    if (!ovo_profile::WriteFileAtomically(path, text, *problem)) return false;
    m_text = text;
    return true;
}

}  // namespace ovo_tune
