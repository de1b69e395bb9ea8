#include "profile_text.h"

#include <cctype>
#include <cerrno>
#include <cinttypes>
#include <cmath>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <map>
#include <vector>

namespace ovo_profile {

namespace {

using ovo::ProfileItem;
using ovo::ProfileTable;
using ovo::StereoProfileFields;

enum class Kind { FLOAT, INT, BOOL, AXIS, SPLIT, EYE_ORDER, RAMP };

// One profile field that a file item sets. The item's word `m_word` carries it.
struct Field {
    const char* m_name;
    uint32_t m_id;
    int m_word;
    Kind m_kind;
    float StereoProfileFields::*m_float;
    int32_t StereoProfileFields::*m_int;
    bool StereoProfileFields::*m_bool;
    uint32_t StereoProfileFields::*m_enum;
};

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

// The fields in the order in which `show` prints them and `write` writes their items.
// (Items 0x2001 to 0x2003 also set the configured copies eye_distance_set, eye_shift_set
// and eye_angle_set to the same value; the text form names only the live field.)
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
constexpr int FIELD_COUNT = sizeof(FIELDS) / sizeof(FIELDS[0]);

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

const uint32_t MODES[] = {ovo::STEREO_MODE_OFF, ovo::STEREO_MODE_PLAIN, ovo::STEREO_MODE_SHADER,
                          ovo::STEREO_MODE_SHADER_LISTED};

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

std::string Format(const char* format, ...) __attribute__((format(printf, 1, 2)));
std::string Format(const char* format, ...) {
    char text[512];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof(text), format, arguments);
    va_end(arguments);
    return text;
}

// The process name as the library sees it: cut to what its 256-byte buffer holds.
std::string LibraryProcessName(const std::string& name) {
    return name.substr(0, ovo::PROFILE_PROCESS_NAME_CAPACITY - 1);
}

bool IsWordType(int16_t type) { return type == ovo::PROFILE_TYPE_WORDS || type == ovo::PROFILE_TYPE_WORDS_ALT; }

// ---- show -----------------------------------------------------------------------------

constexpr uint32_t FLOAT_SIGN_BIT = 0x80000000u;
constexpr uint32_t FLOAT_EXPONENT_BITS = 0x7F800000u;
constexpr uint32_t FLOAT_MANTISSA_BITS = 0x007FFFFFu;
constexpr uint32_t FLOAT_QUIET_NAN_MANTISSA = 0x00400000u;  // what "nan" reads as

// The shortest "%.Ng" text that reads back as the same float (at most 9 digits, which
// always suffice for a 32-bit float): -0.035 rather than -0.0350000001. A NaN other than
// the plain one is named by its mantissa bits, "nan(0x1)", since text keeps no payload.
std::string FormatFloat(float value) {
    uint32_t bits;
    std::memcpy(&bits, &value, sizeof(bits));
    if (std::isnan(value)) {
        const char* sign = (bits & FLOAT_SIGN_BIT) != 0 ? "-" : "";
        const uint32_t mantissa = bits & FLOAT_MANTISSA_BITS;
        if (mantissa == FLOAT_QUIET_NAN_MANTISSA) return Format("%snan", sign);
        return Format("%snan(0x%" PRIX32 ")", sign, mantissa);
    }
    std::string text;
    for (int digits = 1; digits <= 9; ++digits) {
        text = Format("%.*g", digits, static_cast<double>(value));
        const float back = std::strtof(text.c_str(), nullptr);
        if (std::memcmp(&back, &value, sizeof(value)) == 0) break;
    }
    return text;
}

std::string FormatValue(const Field& field, const StereoProfileFields& fields) {
    switch (field.m_kind) {
        case Kind::FLOAT: return FormatFloat(fields.*field.m_float);
        case Kind::INT: return Format("%" PRId32, fields.*field.m_int);
        case Kind::BOOL: return fields.*field.m_bool ? "true" : "false";
        default: break;
    }
    const uint32_t value = fields.*field.m_enum;
    for (const EnumName& name : ENUM_NAMES) {
        if (name.m_kind == field.m_kind && name.m_value == value) return name.m_name;
    }
    return Format("0x%" PRIX32, value);
}

std::string QuoteBytes(const uint8_t* bytes, int count) {
    std::string text = "\"";
    for (int index = 0; index < count; ++index) {
        const uint8_t byte = bytes[index];
        if (byte == '"' || byte == '\\') {
            text += '\\';
            text += static_cast<char>(byte);
        } else if (byte == 0) {
            text += "\\0";
        } else if (byte >= 0x20 && byte < 0x7F) {
            text += static_cast<char>(byte);
        } else {
            text += Format("\\x%02X", byte);
        }
    }
    return text + "\"";
}

std::string FormatRawItem(const ProfileItem& item) {
    std::string line = Format("item = 0x%04" PRIX32 " 0x%04X", item.m_id, static_cast<uint16_t>(item.m_data_type));
    const int held = ovo::ProfileHeldElements(item);
    if (IsWordType(item.m_data_type)) {
        for (int index = 0; index < held; ++index) line += Format(" %" PRIu32, item.m_data[index]);
    } else if (item.m_data_type == ovo::PROFILE_TYPE_TEXT) {
        line += " " + QuoteBytes(ovo::ProfileItemBytes(item), held);
    } else {
        line += Format(" %d", item.m_data_count);
    }
    return line;
}

// ---- write ----------------------------------------------------------------------------

std::string Trim(const std::string& text) {
    size_t begin = text.find_first_not_of(" \t\r");
    if (begin == std::string::npos) return "";
    size_t end = text.find_last_not_of(" \t\r");
    return text.substr(begin, end - begin + 1);
}

// The line without its comment: '#' outside a double-quoted string starts one.
std::string StripComment(const std::string& line) {
    bool quoted = false;
    for (size_t index = 0; index < line.size(); ++index) {
        const char byte = line[index];
        if (quoted && byte == '\\') {
            ++index;
        } else if (byte == '"') {
            quoted = !quoted;
        } else if (byte == '#' && !quoted) {
            return line.substr(0, index);
        }
    }
    return line;
}

// Whitespace-separated words; a double-quoted string (with its escapes) is one word.
std::vector<std::string> SplitWords(const std::string& text) {
    std::vector<std::string> words;
    size_t index = 0;
    while (index < text.size()) {
        if (text[index] == ' ' || text[index] == '\t') {
            ++index;
            continue;
        }
        size_t start = index;
        bool quoted = false;
        while (index < text.size() && (quoted || (text[index] != ' ' && text[index] != '\t'))) {
            if (quoted && text[index] == '\\') {
                ++index;
            } else if (text[index] == '"') {
                quoted = !quoted;
            }
            ++index;
        }
        words.push_back(text.substr(start, index - start));
    }
    return words;
}

enum class NumberStatus { OK, MALFORMED, OUT_OF_RANGE };

// A whole integer: decimal with an optional sign, or hexadecimal with a 0x prefix.
NumberStatus ParseInteger(const std::string& text, int64_t minimum, int64_t maximum, int64_t& value) {
    if (text.empty()) return NumberStatus::MALFORMED;
    size_t start = (text[0] == '-' || text[0] == '+') ? 1 : 0;
    const bool hex = text.size() > start + 2 && text[start] == '0' && (text[start + 1] == 'x' || text[start + 1] == 'X');
    const size_t digits = start + (hex ? 2 : 0);
    if (digits >= text.size()) return NumberStatus::MALFORMED;
    for (size_t index = digits; index < text.size(); ++index) {
        if (!(hex ? std::isxdigit(static_cast<unsigned char>(text[index])) : std::isdigit(static_cast<unsigned char>(text[index])))) {
            return NumberStatus::MALFORMED;
        }
    }
    errno = 0;
    const long long parsed = std::strtoll(text.c_str(), nullptr, hex ? 16 : 10);
    if (errno == ERANGE || parsed < minimum || parsed > maximum) return NumberStatus::OUT_OF_RANGE;
    value = parsed;
    return NumberStatus::OK;
}

// "nan(0xM)" with an optional sign: the NaN whose mantissa bits are M (1 to 0x7FFFFF).
NumberStatus ParseNanBits(const std::string& text, float& value) {
    const bool negative = text[0] == '-';
    const size_t start = (negative || text[0] == '+') ? 5 : 4;  // after "nan("
    int64_t mantissa = 0;
    const NumberStatus status =
        ParseInteger(text.substr(start, text.size() - start - 1), 1, FLOAT_MANTISSA_BITS, mantissa);
    if (status != NumberStatus::OK) return status;
    const uint32_t bits = (negative ? FLOAT_SIGN_BIT : 0) | FLOAT_EXPONENT_BITS | static_cast<uint32_t>(mantissa);
    std::memcpy(&value, &bits, sizeof(value));
    return NumberStatus::OK;
}

bool IsNanWithBits(const std::string& text) {
    const size_t start = (!text.empty() && (text[0] == '-' || text[0] == '+')) ? 1 : 0;
    return text.compare(start, 4, "nan(") == 0 && text.back() == ')';
}

// A whole 32-bit float as strtof reads it (so "%.9g" output reads back exactly), or a NaN
// by its bits.
NumberStatus ParseFloat(const std::string& text, float& value) {
    if (text.empty() || std::isspace(static_cast<unsigned char>(text[0]))) return NumberStatus::MALFORMED;
    if (IsNanWithBits(text)) return ParseNanBits(text, value);
    char* end = nullptr;
    errno = 0;
    const float parsed = std::strtof(text.c_str(), &end);
    if (end == text.c_str() || *end != '\0') return NumberStatus::MALFORMED;
    // Overflow gives an infinity, underflow below the smallest single gives 0 (both with
    // ERANGE); a subnormal result is kept.
    if (errno == ERANGE && (std::isinf(parsed) || parsed == 0.0f)) return NumberStatus::OUT_OF_RANGE;
    value = parsed;
    return NumberStatus::OK;
}

// Bytes of a double-quoted string with the escapes \\ \" \0 \n \t \xNN.
bool ParseQuoted(const std::string& text, std::string& bytes, std::string& problem) {
    if (text.size() < 2 || text.front() != '"' || text.back() != '"') {
        problem = "expected a double-quoted string";
        return false;
    }
    bytes.clear();
    for (size_t index = 1; index + 1 < text.size(); ++index) {
        char byte = text[index];
        if (byte != '\\') {
            bytes += byte;
            continue;
        }
        if (index + 2 >= text.size()) {
            problem = "a '\\' ends the string";
            return false;
        }
        const char escape = text[++index];
        switch (escape) {
            case '\\': bytes += '\\'; break;
            case '"': bytes += '"'; break;
            case '0': bytes += '\0'; break;
            case 'n': bytes += '\n'; break;
            case 't': bytes += '\t'; break;
            case 'x': {
                if (index + 3 >= text.size() || !std::isxdigit(static_cast<unsigned char>(text[index + 1])) ||
                    !std::isxdigit(static_cast<unsigned char>(text[index + 2]))) {
                    problem = "'\\x' needs two hexadecimal digits";
                    return false;
                }
                bytes += static_cast<char>(std::strtol(text.substr(index + 1, 2).c_str(), nullptr, 16));
                index += 2;
                break;
            }
            default:
                problem = Format("unknown escape '\\%c'", escape);
                return false;
        }
    }
    return true;
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

// Parses a field's value into the word that its item carries.
bool ParseFieldValue(const Field& field, const std::string& text, uint32_t& word, std::string& problem) {
    NumberStatus status = NumberStatus::OK;
    switch (field.m_kind) {
        case Kind::FLOAT: {
            float value = 0.0f;
            status = ParseFloat(text, value);
            std::memcpy(&word, &value, sizeof(word));
            break;
        }
        case Kind::INT: {
            int64_t value = 0;
            status = ParseInteger(text, INT32_MIN, INT32_MAX, value);
            word = static_cast<uint32_t>(static_cast<int32_t>(value));
            break;
        }
        case Kind::BOOL:
            if (text == "true" || text == "false") {
                word = text == "true" ? 1 : 0;
                return true;
            }
            problem = Format("%s must be true or false, not '%s'", field.m_name, text.c_str());
            return false;
        default: {
            for (const EnumName& name : ENUM_NAMES) {
                if (name.m_kind == field.m_kind && text == name.m_name) {
                    word = name.m_value;
                    return true;
                }
            }
            const bool numeric = !text.empty() && (std::isdigit(static_cast<unsigned char>(text[0])) || text[0] == '-' || text[0] == '+');
            if (!numeric) {
                problem = Format("unknown value '%s' for %s (expected %s)", text.c_str(), field.m_name,
                                 KindDescription(field.m_kind));
                return false;
            }
            int64_t value = 0;
            status = ParseInteger(text, 0, UINT32_MAX, value);
            word = static_cast<uint32_t>(value);
            break;
        }
    }
    if (status == NumberStatus::MALFORMED) {
        problem = Format("malformed number '%s' for %s (expected %s)", text.c_str(), field.m_name,
                         KindDescription(field.m_kind));
        return false;
    }
    if (status == NumberStatus::OUT_OF_RANGE) {
        problem = Format("value %s out of range for %s (%s)", text.c_str(), field.m_name, KindDescription(field.m_kind));
        return false;
    }
    return true;
}

// `item = ID TYPE ARGS`: words for the word types, one quoted string for text, the count
// for any other type.
bool ParseRawItem(const std::string& value, ProfileItem& item, std::string& problem) {
    std::vector<std::string> words = SplitWords(value);
    if (words.size() < 2) {
        problem = "an item needs an id and a type: item = ID TYPE ...";
        return false;
    }
    int64_t number = 0;
    NumberStatus status = ParseInteger(words[0], 0, UINT32_MAX, number);
    if (status != NumberStatus::OK) {
        problem = Format(status == NumberStatus::MALFORMED ? "malformed number '%s' for the item id"
                                                           : "value %s out of range for the item id (32 bits)",
                         words[0].c_str());
        return false;
    }
    item.m_id = static_cast<uint32_t>(number);
    if (item.m_id == 0) {
        problem = "item id 0 is the padding id; write pads by itself";
        return false;
    }
    if (const Field* field = FieldOfId(item.m_id)) {
        problem = Format("item 0x%04" PRIX32 " sets %s; write '%s = ...' instead", item.m_id, field->m_name,
                         field->m_name);
        return false;
    }
    status = ParseInteger(words[1], INT16_MIN, UINT16_MAX, number);
    if (status != NumberStatus::OK) {
        problem = Format(status == NumberStatus::MALFORMED ? "malformed number '%s' for the item type"
                                                           : "value %s out of range for the item type (16 bits)",
                         words[1].c_str());
        return false;
    }
    item.m_data_type = static_cast<int16_t>(static_cast<uint16_t>(number));
    const size_t arguments = words.size() - 2;
    if (IsWordType(item.m_data_type)) {
        if (arguments > static_cast<size_t>(ovo::PROFILE_PAYLOAD_WORDS)) {
            problem = Format("value out of range: %zu words, an item holds at most %d", arguments,
                             ovo::PROFILE_PAYLOAD_WORDS);
            return false;
        }
        for (size_t index = 0; index < arguments; ++index) {
            status = ParseInteger(words[2 + index], INT32_MIN, UINT32_MAX, number);
            if (status != NumberStatus::OK) {
                problem = Format(status == NumberStatus::MALFORMED ? "malformed number '%s' for an item word"
                                                                   : "value %s out of range for an item word (32 bits)",
                                 words[2 + index].c_str());
                return false;
            }
            item.m_data[index] = static_cast<uint32_t>(number);
        }
        item.m_data_count = static_cast<int16_t>(arguments);
    } else if (item.m_data_type == ovo::PROFILE_TYPE_TEXT) {
        std::string bytes;
        if (arguments != 1 || !ParseQuoted(words[2], bytes, problem)) {
            if (arguments != 1) problem = "a text item (type 0x1005) takes one double-quoted string";
            return false;
        }
        if (bytes.size() > static_cast<size_t>(ovo::PROFILE_PAYLOAD_BYTES)) {
            problem = Format("value out of range: %zu text bytes, an item holds at most %d", bytes.size(),
                             ovo::PROFILE_PAYLOAD_BYTES);
            return false;
        }
        std::memcpy(item.m_data, bytes.data(), bytes.size());
        item.m_data_count = static_cast<int16_t>(bytes.size());
    } else {
        if (arguments != 1) {
            problem = "an item of a type without payload takes its count: item = ID TYPE COUNT";
            return false;
        }
        status = ParseInteger(words[2], INT16_MIN, INT16_MAX, number);
        if (status != NumberStatus::OK) {
            problem = Format(status == NumberStatus::MALFORMED ? "malformed number '%s' for the item count"
                                                               : "value %s out of range for the item count (16 bits)",
                             words[2].c_str());
            return false;
        }
        item.m_data_count = static_cast<int16_t>(number);
    }
    return true;
}

bool IsModeName(const std::string& name) {
    for (uint32_t mode : MODES) {
        if (name == ModeName(mode)) return true;
    }
    return false;
}

}  // namespace

const char* ModeName(uint32_t mode) {
    switch (mode) {
        case ovo::STEREO_MODE_OFF: return "off";
        case ovo::STEREO_MODE_PLAIN: return "plain";
        case ovo::STEREO_MODE_SHADER: return "shader";
        case ovo::STEREO_MODE_SHADER_LISTED: return "shader_listed";
        default: return "unresolved";
    }
}

ovo::StereoMode ResolveStartUpMode(const ProfileTable& table, const std::string& process_name) {
    // The same steps as StereoProfile's constructor, on the given table and name.
    const std::string name = LibraryProcessName(process_name);
    StereoProfileFields fields;
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

std::string FormatProfileText(const ProfileTable& table, const ovo::ProfileReadResult& read,
                              const char* process_name, size_t trailing_bytes) {
    std::string text;
    const bool applies = table.m_validity != 0;
    if (!applies) text += "# validity word is 0: nothing in this file applies (the lines below are not applied)\n";
    if (!read.m_header_complete) {
        text += "# the file is shorter than its 16-byte header\n";
    } else if (read.m_truncated) {
        text += Format("# the file ends inside item %d of %d; what arrived of it is kept, later items are missing\n",
                       read.m_complete_items + 1, ovo::PROFILE_FILE_ITEMS);
    } else if (trailing_bytes > 0) {
        text += Format("# %zu bytes after the 24th item are not read\n", trailing_bytes);
    }
    for (int index = 0; index < ovo::PROFILE_FILE_ITEMS; ++index) {
        const ProfileItem& item = table.m_items[index];
        const bool words = IsWordType(item.m_data_type);
        if (!words && item.m_data_type != ovo::PROFILE_TYPE_TEXT) continue;
        const int capacity = words ? ovo::PROFILE_PAYLOAD_WORDS : ovo::PROFILE_PAYLOAD_BYTES;
        if (item.m_data_count < 0) {
            text += Format("# item %d (id 0x%04" PRIX32 "): negative count %d, no payload is read\n", index + 1,
                           item.m_id, item.m_data_count);
        } else if (item.m_data_count > capacity) {
            text += Format("# item %d (id 0x%04" PRIX32 "): count %d exceeds the slot; the first %d %s are read, the "
                           "rest is skipped\n",
                           index + 1, item.m_id, item.m_data_count, capacity, words ? "words" : "bytes");
        }
    }

    // What the items set, field by field (the last item with an id wins).
    StereoProfileFields fields;
    ovo::ApplyProfileItems(fields, table);
    const char* prefix = applies ? "" : "# ";
    for (const Field& field : FIELDS) {
        bool present = false;
        for (int index = 0; index < ovo::PROFILE_FILE_ITEMS; ++index) present |= table.m_items[index].m_id == field.m_id;
        if (present) text += Format("%s%s = %s\n", prefix, field.m_name, FormatValue(field, fields).c_str());
    }
    for (int index = 0; index < ovo::PROFILE_FILE_ITEMS; ++index) {
        const ProfileItem& item = table.m_items[index];
        if (item.m_id == 0) {
            if (item.m_data_type != 0 || item.m_data_count != 0) {
                text += Format("# item %d: padding id 0 with type 0x%04X and count %d, ignored\n", index + 1,
                               static_cast<uint16_t>(item.m_data_type), item.m_data_count);
            }
        } else if (FieldOfId(item.m_id) == nullptr) {
            text += prefix + FormatRawItem(item) + "\n";
        }
    }

    const std::string name = process_name != nullptr ? process_name : "";
    if (process_name != nullptr) text += "process = " + name + "\n";
    if (ovo::LiveWallpaperKindOf(LibraryProcessName(name).c_str()) != ovo::LIVE_WALLPAPER_NONE) {
        text += "# " + name + " is a live wallpaper: its built-in preset overrides the file\n";
    }
    text += Format("mode = %s\n", ModeName(ResolveStartUpMode(table, name)));
    return text;
}

bool ParseProfileText(const std::string& text, const std::string& file_name, ProfileTable& table,
                      std::string& error) {
    std::memset(&table, 0, sizeof(table));
    uint32_t field_words[FIELD_COUNT] = {};
    int field_lines[FIELD_COUNT] = {};
    std::vector<ProfileItem> raw_items;
    std::map<uint32_t, bool> field_items;  // ids of the fields' items met so far
    int item_count = 0;
    std::string mode;
    int mode_line = 0;
    std::string process;
    int process_line = 0;

    auto fail = [&](int line, const std::string& what) {
        error = file_name + ":" + std::to_string(line) + ": " + what;
        return false;
    };

    int line_number = 0;
    size_t position = 0;
    while (position <= text.size()) {
        size_t end = text.find('\n', position);
        if (end == std::string::npos) end = text.size();
        const std::string line = Trim(StripComment(text.substr(position, end - position)));
        ++line_number;
        position = end + 1;
        if (line.empty()) continue;

        const size_t equals = line.find('=');
        if (equals == std::string::npos) return fail(line_number, "expected 'name = value', got '" + line + "'");
        const std::string name = Trim(line.substr(0, equals));
        const std::string value = Trim(line.substr(equals + 1));

        if (name == "mode" || name == "process") {
            int& seen = name == "mode" ? mode_line : process_line;
            if (seen != 0) {
                return fail(line_number, Format("duplicate field '%s' (first set on line %d)", name.c_str(), seen));
            }
            seen = line_number;
            if (name == "process") {
                process = value;
            } else if (!IsModeName(value)) {
                return fail(line_number, "unknown mode '" + value + "' (expected off, plain, shader or shader_listed)");
            } else {
                mode = value;
            }
            continue;
        }

        std::string problem;
        if (name == "item") {
            ProfileItem item{};
            if (!ParseRawItem(value, item, problem)) return fail(line_number, problem);
            if (++item_count > ovo::PROFILE_FILE_ITEMS) {
                return fail(line_number, Format("too many items: a profile holds %d", ovo::PROFILE_FILE_ITEMS));
            }
            raw_items.push_back(item);
            continue;
        }

        const Field* field = FindField(name);
        if (field == nullptr) return fail(line_number, "unknown field '" + name + "'");
        const int index = static_cast<int>(field - FIELDS);
        if (field_lines[index] != 0) {
            return fail(line_number, Format("duplicate field '%s' (first set on line %d)", name.c_str(), field_lines[index]));
        }
        if (!ParseFieldValue(*field, value, field_words[index], problem)) return fail(line_number, problem);
        field_lines[index] = line_number;
        if (!field_items[field->m_id]) {
            field_items[field->m_id] = true;
            if (++item_count > ovo::PROFILE_FILE_ITEMS) {
                return fail(line_number, Format("too many items: a profile holds %d", ovo::PROFILE_FILE_ITEMS));
            }
        }
    }

    // A size item carries both words: width and height come together.
    for (int index = 0; index < FIELD_COUNT; ++index) {
        const Field& field = FIELDS[index];
        for (int other = 0; other < FIELD_COUNT; ++other) {
            if (other != index && FIELDS[other].m_id == field.m_id && field_lines[index] != 0 &&
                field_lines[other] == 0) {
                return fail(field_lines[index], Format("%s is set but %s is not; one item carries both",
                                                       field.m_name, FIELDS[other].m_name));
            }
        }
    }

    table.m_validity = 1;
    int slot = 0;
    for (int index = 0; index < FIELD_COUNT; ++index) {
        if (field_lines[index] == 0) continue;
        const Field& field = FIELDS[index];
        ProfileItem* item = nullptr;
        for (int existing = 0; existing < slot; ++existing) {
            if (table.m_items[existing].m_id == field.m_id) item = &table.m_items[existing];
        }
        if (item == nullptr) {
            item = &table.m_items[slot++];
            item->m_id = field.m_id;
            item->m_data_type = ovo::PROFILE_TYPE_WORDS;
        }
        item->m_data[field.m_word] = field_words[index];
        if (item->m_data_count < field.m_word + 1) item->m_data_count = static_cast<int16_t>(field.m_word + 1);
    }
    for (const ProfileItem& item : raw_items) table.m_items[slot++] = item;

    if (mode_line != 0) {
        const char* resolved = ModeName(ResolveStartUpMode(table, process));
        if (mode != resolved) {
            return fail(mode_line, Format("mode = %s, but this profile resolves to %s for the process '%s'",
                                          mode.c_str(), resolved, LibraryProcessName(process).c_str()));
        }
    }
    return true;
}

}  // namespace ovo_profile
