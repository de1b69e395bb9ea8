#include "profile_text_format.h"

#include <cinttypes>
#include <cmath>
#include <cstdlib>
#include <cstring>

#include "config/stereo_profile_fields.h"
#include "profile_fields.h"
#include "profile_mode.h"
#include "text_tokens.h"

namespace ovo_profile {

namespace {

using ovo::ProfileItem;
using ovo::ProfileTable;
using ovo::StereoProfileFields;

std::string FormatValue(const Field& field, const StereoProfileFields& fields) {
    switch (field.m_kind) {
        case Kind::FLOAT: return FormatFloat(fields.*field.m_float);
        case Kind::INT: return FormatText("%" PRId32, fields.*field.m_int);
        case Kind::BOOL: return fields.*field.m_bool ? "true" : "false";
        default: break;
    }
    const uint32_t value = fields.*field.m_enum;
    const char* name = EnumValueName(field.m_kind, value);
    return name != nullptr ? name : FormatText("0x%" PRIX32, value);
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
            text += FormatText("\\x%02X", byte);
        }
    }
    return text + "\"";
}

std::string FormatRawItem(const ProfileItem& item) {
    std::string line = FormatText("item = 0x%04" PRIX32 " 0x%04X", item.m_id, static_cast<uint16_t>(item.m_data_type));
    const int held = ovo::ProfileHeldElements(item);
    if (IsWordType(item.m_data_type)) {
        for (int index = 0; index < held; ++index) line += FormatText(" %" PRIu32, item.m_data[index]);
    } else if (item.m_data_type == ovo::PROFILE_TYPE_TEXT) {
        line += " " + QuoteBytes(ovo::ProfileItemBytes(item), held);
    } else {
        line += FormatText(" %d", item.m_data_count);
    }
    return line;
}

}  // namespace

// At most 9 digits, which always suffice for a 32-bit float; text keeps no NaN payload, so
// a NaN's bits are spelled out.
std::string FormatFloat(float value) {
    uint32_t bits;
    std::memcpy(&bits, &value, sizeof(bits));
    if (std::isnan(value)) {
        const char* sign = (bits & FLOAT_SIGN_BIT) != 0 ? "-" : "";
        const uint32_t mantissa = bits & FLOAT_MANTISSA_BITS;
        if (mantissa == FLOAT_QUIET_NAN_MANTISSA) return FormatText("%snan", sign);
        return FormatText("%snan(0x%" PRIX32 ")", sign, mantissa);
    }
    std::string text;
    for (int digits = 1; digits <= 9; ++digits) {
        text = FormatText("%.*g", digits, static_cast<double>(value));
        const float back = std::strtof(text.c_str(), nullptr);
        if (std::memcmp(&back, &value, sizeof(value)) == 0) break;
    }
    return text;
}

std::string FormatProfileText(const ProfileTable& table, const ovo::ProfileReadResult& read, const char* process_name,
                              size_t trailing_bytes) {
    std::string text;
    const bool applies = table.m_validity != 0;
    if (!applies) text += "# validity word is 0: nothing in this file applies (the lines below are not applied)\n";
    if (!read.m_header_complete) {
        text += "# the file is shorter than its 16-byte header\n";
    } else if (read.m_truncated) {
        text +=
            FormatText("# the file ends inside item %d of %d; what arrived of it is kept, later items are missing\n",
                       read.m_complete_items + 1, ovo::PROFILE_FILE_ITEMS);
    } else if (trailing_bytes > 0) {
        text += FormatText("# %zu bytes after the 24th item are not read\n", trailing_bytes);
    }
    for (int index = 0; index < ovo::PROFILE_FILE_ITEMS; ++index) {
        const ProfileItem& item = table.m_items[index];
        const bool words = IsWordType(item.m_data_type);
        if (!words && item.m_data_type != ovo::PROFILE_TYPE_TEXT) continue;
        const int capacity = words ? ovo::PROFILE_PAYLOAD_WORDS : ovo::PROFILE_PAYLOAD_BYTES;
        if (item.m_data_count < 0) {
            text += FormatText("# item %d (id 0x%04" PRIX32 "): negative count %d, no payload is read\n", index + 1,
                               item.m_id, item.m_data_count);
        } else if (item.m_data_count > capacity) {
            text += FormatText("# item %d (id 0x%04" PRIX32
                               "): count %d exceeds the slot; the first %d %s are read, the "
                               "rest is skipped\n",
                               index + 1, item.m_id, item.m_data_count, capacity, words ? "words" : "bytes");
        }
    }

    // What the items set, field by field (the last item with an id wins).
    StereoProfileFields fields;
    ovo::ApplyProfileItems(fields, table);
    const char* prefix = applies ? "" : "# ";
    for (int field_index = 0; field_index < FIELD_COUNT; ++field_index) {
        const Field& field = FIELDS[field_index];
        bool present = false;
        for (int index = 0; index < ovo::PROFILE_FILE_ITEMS; ++index) {
            present |= table.m_items[index].m_id == field.m_id;
        }
        if (present) text += FormatText("%s%s = %s\n", prefix, field.m_name, FormatValue(field, fields).c_str());
    }
    for (int index = 0; index < ovo::PROFILE_FILE_ITEMS; ++index) {
        const ProfileItem& item = table.m_items[index];
        if (item.m_id == 0) {
            if (item.m_data_type != 0 || item.m_data_count != 0) {
                text += FormatText("# item %d: padding id 0 with type 0x%04X and count %d, ignored\n", index + 1,
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
    text += FormatText("mode = %s\n", ModeName(ResolveStartUpMode(table, name)));
    return text;
}

}  // namespace ovo_profile
