#include "profile_fields.h"

#include "config/profile_file.h"

namespace ovo_profile {

namespace {

using ovo::StereoProfileFields;

constexpr Field FloatField(const char* name, uint32_t id, float StereoProfileFields::*member) {
    return {name, id, 0, Kind::FLOAT, member, nullptr, nullptr, nullptr};
}
constexpr Field IntField(const char* name, uint32_t id, int word, int32_t StereoProfileFields::*member) {
    return {name, id, word, Kind::INT, nullptr, member, nullptr, nullptr};
}
constexpr Field BoolField(const char* name, uint32_t id, bool StereoProfileFields::*member) {
    return {name, id, 0, Kind::BOOL, nullptr, nullptr, member, nullptr};
}
constexpr Field EnumField(const char* name, uint32_t id, Kind kind, uint32_t StereoProfileFields::*member) {
    return {name, id, 0, kind, nullptr, nullptr, nullptr, member};
}

struct EnumName {
    Kind m_kind;
    uint32_t m_value;
    const char* m_name;
};

const EnumName ENUM_NAMES[] = {
    {Kind::AXIS, ovo::STEREO_AXIS_X, "x"},
    {Kind::AXIS, ovo::STEREO_AXIS_Y, "y"},
    {Kind::AXIS, ovo::STEREO_AXIS_Z, "z"},
    {Kind::SPLIT, ovo::STEREO_SPLIT_SIDE_BY_SIDE, "side_by_side"},
    {Kind::SPLIT, ovo::STEREO_SPLIT_TOP_BOTTOM, "top_bottom"},
    {Kind::EYE_ORDER, ovo::STEREO_EYE_ORDER_NORMAL, "normal"},
    {Kind::EYE_ORDER, ovo::STEREO_EYE_ORDER_SWAPPED, "swapped"},
    {Kind::RAMP, ovo::STEREO_RAMP_OFF, "off"},
    {Kind::RAMP, ovo::STEREO_RAMP_ON, "on"},
};

}  // namespace

// Declared with FIELD_COUNT entries: a table of another length does not compile.
const Field FIELDS[] = {
    FloatField("eye_distance", ovo::PROFILE_ITEM_EYE_DISTANCE, &StereoProfileFields::m_eye_distance),
    FloatField("eye_shift", ovo::PROFILE_ITEM_EYE_SHIFT, &StereoProfileFields::m_eye_shift),
    FloatField("eye_angle", ovo::PROFILE_ITEM_EYE_ANGLE, &StereoProfileFields::m_eye_angle),
    FloatField("ramp_steps", ovo::PROFILE_ITEM_RAMP_STEPS, &StereoProfileFields::m_ramp_steps),
    EnumField("eye_axis", ovo::PROFILE_ITEM_EYE_AXIS, Kind::AXIS, &StereoProfileFields::m_eye_axis),
    EnumField("ramp_param", ovo::PROFILE_ITEM_RAMP_PARAM, Kind::AXIS, &StereoProfileFields::m_ramp_param),
    EnumField("split", ovo::PROFILE_ITEM_SPLIT, Kind::SPLIT, &StereoProfileFields::m_split),
    EnumField("eye_order", ovo::PROFILE_ITEM_EYE_ORDER, Kind::EYE_ORDER, &StereoProfileFields::m_eye_order),
    EnumField("ramp", ovo::PROFILE_ITEM_RAMP, Kind::RAMP, &StereoProfileFields::m_ramp),
    IntField("target_width", ovo::PROFILE_ITEM_TARGET_SIZE, 0, &StereoProfileFields::m_target_width),
    IntField("target_height", ovo::PROFILE_ITEM_TARGET_SIZE, 1, &StereoProfileFields::m_target_height),
    IntField("screen_width", ovo::PROFILE_ITEM_SCREEN_SIZE, 0, &StereoProfileFields::m_screen_width),
    IntField("screen_height", ovo::PROFILE_ITEM_SCREEN_SIZE, 1, &StereoProfileFields::m_screen_height),
    BoolField("shader_convert", ovo::PROFILE_ITEM_SHADER_CONVERT, &StereoProfileFields::m_shader_convert),
    BoolField("use_screen_size", ovo::PROFILE_ITEM_USE_SCREEN_SIZE, &StereoProfileFields::m_use_screen_size),
    BoolField("auto_eye", ovo::PROFILE_ITEM_AUTO_EYE, &StereoProfileFields::m_auto_eye),
    BoolField("eye_target", ovo::PROFILE_ITEM_EYE_TARGET, &StereoProfileFields::m_eye_target),
    BoolField("valid", ovo::PROFILE_ITEM_VALID, &StereoProfileFields::m_valid),
};

const Field* FindField(const std::string& name) {
    for (const Field& field : FIELDS) {
        if (name == field.m_name) return &field;
    }
    return nullptr;
}

const Field* FieldOfId(uint32_t id) {
    for (const Field& field : FIELDS) {
        if (field.m_id == id) return &field;
    }
    return nullptr;
}

const char* EnumValueName(Kind kind, uint32_t value) {
    for (const EnumName& name : ENUM_NAMES) {
        if (name.m_kind == kind && name.m_value == value) return name.m_name;
    }
    return nullptr;
}

bool EnumValueOf(Kind kind, const std::string& name, uint32_t& value) {
    for (const EnumName& each : ENUM_NAMES) {
        if (each.m_kind == kind && name == each.m_name) {
            value = each.m_value;
            return true;
        }
    }
    return false;
}

const char* KindDescription(Kind kind) {
    switch (kind) {
        case Kind::FLOAT: return "a 32-bit float";
        case Kind::INT: return "a 32-bit signed integer";
        case Kind::BOOL: return "true or false";
        case Kind::AXIS: return "x, y, z or a 32-bit number";
        case Kind::SPLIT: return "side_by_side, top_bottom or a 32-bit number";
        case Kind::EYE_ORDER: return "normal, swapped or a 32-bit number";
        case Kind::RAMP: return "on, off or a 32-bit number";
    }
    return "";
}

bool IsWordType(int16_t type) { return type == ovo::PROFILE_TYPE_WORDS || type == ovo::PROFILE_TYPE_WORDS_ALT; }

}  // namespace ovo_profile
