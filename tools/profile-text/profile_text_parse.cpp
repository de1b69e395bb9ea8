#include "profile_text_parse.h"

#include <cctype>
#include <cinttypes>
#include <cstring>
#include <map>
#include <vector>

#include "profile_fields.h"
#include "profile_mode.h"
#include "text_tokens.h"

namespace ovo_profile {

namespace {

using ovo::ProfileItem;
using ovo::ProfileTable;

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
            problem = FormatText("%s must be true or false, not '%s'", field.m_name, text.c_str());
            return false;
        default: {
            if (EnumValueOf(field.m_kind, text, word)) return true;
            const bool numeric = !text.empty() && (std::isdigit(static_cast<unsigned char>(text[0])) ||
                                                   text[0] == '-' || text[0] == '+');
            if (!numeric) {
                problem = FormatText("unknown value '%s' for %s (expected %s)", text.c_str(), field.m_name,
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
        problem = FormatText("malformed number '%s' for %s (expected %s)", text.c_str(), field.m_name,
                             KindDescription(field.m_kind));
        return false;
    }
    if (status == NumberStatus::OUT_OF_RANGE) {
        problem =
            FormatText("value %s out of range for %s (%s)", text.c_str(), field.m_name, KindDescription(field.m_kind));
        return false;
    }
    return true;
}

// A whole number of an item's line; `what` names it in the message ("the item id"),
// `bits` its size.
bool ParseItemNumber(const std::string& text, int64_t minimum, int64_t maximum, const char* what, int bits,
                     int64_t& number, std::string& problem) {
    const NumberStatus status = ParseInteger(text, minimum, maximum, number);
    if (status == NumberStatus::OK) return true;
    problem = status == NumberStatus::MALFORMED
                  ? FormatText("malformed number '%s' for %s", text.c_str(), what)
                  : FormatText("value %s out of range for %s (%d bits)", text.c_str(), what, bits);
    return false;
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
    if (!ParseItemNumber(words[0], 0, UINT32_MAX, "the item id", 32, number, problem)) return false;
    item.m_id = static_cast<uint32_t>(number);
    if (item.m_id == 0) {
        problem = "item id 0 is the padding id; write pads by itself";
        return false;
    }
    if (const Field* field = FieldOfId(item.m_id)) {
        problem = FormatText("item 0x%04" PRIX32 " sets %s; write '%s = ...' instead", item.m_id, field->m_name,
                             field->m_name);
        return false;
    }
    if (!ParseItemNumber(words[1], INT16_MIN, UINT16_MAX, "the item type", 16, number, problem)) return false;
    item.m_data_type = static_cast<int16_t>(static_cast<uint16_t>(number));
    const size_t arguments = words.size() - 2;
    if (IsWordType(item.m_data_type)) {
        if (arguments > static_cast<size_t>(ovo::PROFILE_PAYLOAD_WORDS)) {
            problem = FormatText("value out of range: %zu words, an item holds at most %d", arguments,
                                 ovo::PROFILE_PAYLOAD_WORDS);
            return false;
        }
        for (size_t index = 0; index < arguments; ++index) {
            if (!ParseItemNumber(words[2 + index], INT32_MIN, UINT32_MAX, "an item word", 32, number, problem)) {
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
            problem = FormatText("value out of range: %zu text bytes, an item holds at most %d", bytes.size(),
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
        if (!ParseItemNumber(words[2], INT16_MIN, INT16_MAX, "the item count", 16, number, problem)) return false;
        item.m_data_count = static_cast<int16_t>(number);
    }
    return true;
}

}  // namespace

bool ParseProfileText(const std::string& text, const std::string& file_name, ProfileTable& table, std::string& error) {
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
    for (const std::string& text_line : SplitLines(text)) {
        const TextLine line = ReadTextLine(text_line);
        ++line_number;
        if (line.m_blank) continue;
        if (!line.m_has_equals) return fail(line_number, "expected 'name = value', got '" + line.m_text + "'");
        const std::string& name = line.m_name;
        const std::string& value = line.m_value;

        if (name == "mode" || name == "process") {
            int& seen = name == "mode" ? mode_line : process_line;
            if (seen != 0) {
                return fail(line_number, FormatText("duplicate field '%s' (first set on line %d)", name.c_str(), seen));
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
                return fail(line_number, FormatText("too many items: a profile holds %d", ovo::PROFILE_FILE_ITEMS));
            }
            raw_items.push_back(item);
            continue;
        }

        const Field* field = FindField(name);
        if (field == nullptr) return fail(line_number, "unknown field '" + name + "'");
        const int index = static_cast<int>(field - FIELDS);
        if (field_lines[index] != 0) {
            return fail(line_number,
                        FormatText("duplicate field '%s' (first set on line %d)", name.c_str(), field_lines[index]));
        }
        if (!ParseFieldValue(*field, value, field_words[index], problem)) return fail(line_number, problem);
        field_lines[index] = line_number;
        if (!field_items[field->m_id]) {
            field_items[field->m_id] = true;
            if (++item_count > ovo::PROFILE_FILE_ITEMS) {
                return fail(line_number, FormatText("too many items: a profile holds %d", ovo::PROFILE_FILE_ITEMS));
            }
        }
    }

    // A size item carries both words: width and height come together.
    for (int index = 0; index < FIELD_COUNT; ++index) {
        const Field& field = FIELDS[index];
        for (int other = 0; other < FIELD_COUNT; ++other) {
            if (other != index && FIELDS[other].m_id == field.m_id && field_lines[index] != 0 &&
                field_lines[other] == 0) {
                return fail(field_lines[index], FormatText("%s is set but %s is not; one item carries both",
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
            return fail(mode_line, FormatText("mode = %s, but this profile resolves to %s for the process '%s'",
                                              mode.c_str(), resolved, LibraryProcessName(process).c_str()));
        }
    }
    return true;
}

}  // namespace ovo_profile
