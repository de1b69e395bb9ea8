#ifndef OVO_TOOLS_PROFILE_TEXT_PROFILE_TEXT_PARSE_H
#define OVO_TOOLS_PROFILE_TEXT_PROFILE_TEXT_PARSE_H

// Reads the text form of a stereo profile (as `ovo-profile show` prints it) into the
// table that `ovo-profile write` writes.

#include <string>

#include "config/profile_file.h"

namespace ovo_profile {

// Parses the text form into a table ready for WriteProfileTable: a validity word of 1,
// the items of the fields in one fixed order, then the raw items in text order, then
// padding (id 0, type 0, count 0) up to 24 items. On failure returns false and sets
// `error` to "FILE:LINE: what is wrong" (FILE being `file_name`).
bool ParseProfileText(const std::string& text, const std::string& file_name, ovo::ProfileTable& table,
                      std::string& error);

}  // namespace ovo_profile

#endif
