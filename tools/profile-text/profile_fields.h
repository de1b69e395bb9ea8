#ifndef OVO_TOOLS_PROFILE_TEXT_PROFILE_FIELDS_H
#define OVO_TOOLS_PROFILE_TEXT_PROFILE_FIELDS_H

// The profile fields that the text form names: which file item carries each, in which
// word, and the names of their enumerated values.

#include <cstdint>
#include <string>

#include "config/stereo_profile_fields.h"

namespace ovo_profile {

enum class Kind { FLOAT, INT, BOOL, AXIS, SPLIT, EYE_ORDER, RAMP };

// One profile field that a file item sets. The item's word `m_word` carries it.
struct Field {
    const char* m_name;
    uint32_t m_id;
    int m_word;
    Kind m_kind;
    float ovo::StereoProfileFields::*m_float;
    int32_t ovo::StereoProfileFields::*m_int;
    bool ovo::StereoProfileFields::*m_bool;
    uint32_t ovo::StereoProfileFields::*m_enum;
};

// The fields in the order in which `show` prints them and `write` writes their items.
// (Items 0x2001 to 0x2003 also set the configured copies eye_distance_set, eye_shift_set
// and eye_angle_set to the same value; the text form names only the live field.)
constexpr int FIELD_COUNT = 18;
extern const Field FIELDS[FIELD_COUNT];

const Field* FindField(const std::string& name);
const Field* FieldOfId(uint32_t id);

// The name of an enumerated field's value, null when it has none.
const char* EnumValueName(Kind kind, uint32_t value);
// The value of an enumerated field's value name; false when `name` is none of them.
bool EnumValueOf(Kind kind, const std::string& name, uint32_t& value);

// What a field of the kind takes, for messages ("a 32-bit float").
const char* KindDescription(Kind kind);

// Whether items of this payload type carry words (0x1003, 0x1004).
bool IsWordType(int16_t type);

}  // namespace ovo_profile

#endif
