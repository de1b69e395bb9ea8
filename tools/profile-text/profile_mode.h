#ifndef OVO_TOOLS_PROFILE_TEXT_PROFILE_MODE_H
#define OVO_TOOLS_PROFILE_TEXT_PROFILE_MODE_H

// The mode that a profile gives a process, as the text form's `mode` line names it.

#include <cstdint>
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
bool IsModeName(const std::string& name);

// The process name as the library sees it: cut to what its 256-byte buffer holds.
std::string LibraryProcessName(const std::string& name);

}  // namespace ovo_profile

#endif
