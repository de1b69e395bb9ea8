#ifndef OVO_TOOLS_PROFILE_TEXT_PROFILE_TEXT_EDIT_H
#define OVO_TOOLS_PROFILE_TEXT_PROFILE_TEXT_EDIT_H

// Changes field values in a profile's text form the way a person would in an editor, so
// that every other line, comments and blank lines included, stays as it was.

#include <string>
#include <vector>

namespace ovo_profile {

struct FieldValue {
    std::string m_name;
    std::string m_value;
};

// `text` with the value of every `name = value` line of each named field replaced (what
// stands before the value and the comment after it kept), and a `name = value` line added
// at the end for each field that no line sets. Line ends stay as the text has them.
std::string SetFieldValues(const std::string& text, const std::vector<FieldValue>& values);

}  // namespace ovo_profile

#endif
