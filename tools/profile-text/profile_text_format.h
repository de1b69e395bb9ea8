#ifndef OVO_TOOLS_PROFILE_TEXT_PROFILE_TEXT_FORMAT_H
#define OVO_TOOLS_PROFILE_TEXT_PROFILE_TEXT_FORMAT_H

// The text form of a stereo profile file, as `ovo-profile show` prints it: one
// `name = value` line per profile field that the file sets, raw `item = ...` lines for
// items that set no field, and the mode that the profile resolves to.

#include <cstddef>
#include <string>

#include "config/profile_file.h"

namespace ovo_profile {

// The text form of a file as the reader found it. `process_name` null: no --process was
// given (the mode is resolved for an empty name and no `process` line is printed).
// `trailing_bytes`: bytes after the 24th item (not read by the library).
std::string FormatProfileText(const ovo::ProfileTable& table, const ovo::ProfileReadResult& read,
                              const char* process_name, size_t trailing_bytes);

// The shortest "%.Ng" text that reads back as the same float: -0.035 rather than
// -0.0350000001; a NaN other than the plain one by its mantissa bits, "nan(0x1)".
std::string FormatFloat(float value);

}  // namespace ovo_profile

#endif
