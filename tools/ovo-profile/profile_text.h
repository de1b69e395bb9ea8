#ifndef OVO_TOOLS_OVO_PROFILE_PROFILE_TEXT_H
#define OVO_TOOLS_OVO_PROFILE_PROFILE_TEXT_H

// The text form of a stereo profile file: one `name = value` line per profile field that
// the file sets, raw `item = ...` lines for items that set no field, and the mode that the
// profile resolves to. `show` prints it, `write` reads it back.

#include <string>

#include "config/profile_file.h"
#include "config/stereo_profile_fields.h"

namespace ovo_profile {

// The mode that a process with the name `process_name` (possibly empty) runs in when this
// table is the profile file, following the library's start-up (StereoProfile's
// constructor): the items apply when the validity word is non-zero, the file is accepted
// when they leave `valid` set, and a live-wallpaper preset overrides everything.
ovo::StereoMode ResolveStartUpMode(const ovo::ProfileTable& table, const std::string& process_name);

// The mode's name in the text form ("off", "plain", "shader", "shader_listed").
const char* ModeName(uint32_t mode);

// The text form of a file as the reader found it. `process_name` null: no --process was
// given (the mode is resolved for an empty name and no `process` line is printed).
// `trailing_bytes`: bytes after the 24th item (not read by the library).
std::string FormatProfileText(const ovo::ProfileTable& table, const ovo::ProfileReadResult& read,
                              const char* process_name, size_t trailing_bytes);

// Parses the text form into a table ready for WriteProfileTable: a validity word of 1,
// the items of the fields in one fixed order, then the raw items in text order, then
// padding (id 0, type 0, count 0) up to 24 items. On failure returns false and sets
// `error` to "FILE:LINE: what is wrong" (FILE being `file_name`).
bool ParseProfileText(const std::string& text, const std::string& file_name, ovo::ProfileTable& table,
                      std::string& error);

}  // namespace ovo_profile

#endif
