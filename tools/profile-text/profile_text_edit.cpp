#include "profile_text_edit.h"

#include "text_tokens.h"

namespace ovo_profile {

std::string SetFieldValues(const std::string& text, const std::vector<FieldValue>& values) {
    std::vector<std::string> lines = SplitLines(text);
    std::vector<bool> set(values.size(), false);
    for (std::string& line : lines) {
        const TextLine read = ReadTextLine(line);
        if (!read.m_has_equals) continue;
        for (size_t index = 0; index < values.size(); ++index) {
            if (read.m_name != values[index].m_name) continue;
            line.replace(read.m_value_begin, read.m_value_end - read.m_value_begin, values[index].m_value);
            set[index] = true;
        }
    }
    // The text's own line end for the lines added: "\r\n" when its first line has one.
    const std::string line_end = !lines.empty() && !lines[0].empty() && lines[0].back() == '\r' ? "\r\n" : "\n";
    std::string edited;
    for (size_t index = 0; index < lines.size(); ++index) {
        if (index > 0) edited += '\n';
        edited += lines[index];
    }
    for (size_t index = 0; index < values.size(); ++index) {
        if (set[index]) continue;
        if (!edited.empty() && edited.back() != '\n') edited += line_end;
        edited += values[index].m_name + " = " + values[index].m_value + line_end;
    }
    return edited;
}

}  // namespace ovo_profile
