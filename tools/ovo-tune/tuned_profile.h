#ifndef OVO_TOOLS_OVO_TUNE_TUNED_PROFILE_H
#define OVO_TOOLS_OVO_TUNE_TUNED_PROFILE_H

#include <cstdint>
#include <string>
#include <vector>

#include "config/profile_file.h"
#include "eye_values.h"

// The profile being tuned: its text, as `ovo-profile write` reads it, the binary file made
// from it, and the text saved back with the tuned values.
namespace ovo_tune {

class TunedProfile {
public:
    // Reads and parses `path`. False with "FILE:LINE: what is wrong" (or why the file cannot
    // be read) in `problem`; also when the profile leaves the live-tuning file unread: the
    // library reads it only with shader conversion on in an accepted profile.
    bool Load(const std::string& path, std::string* problem);

    // The values that the profile starts the program with.
    const EyeValues& StartValues() const { return m_start_values; }
    // The binary profile file, as `ovo-profile write` makes it.
    const std::vector<uint8_t>& Binary() const { return m_binary; }
    // The profile's ramp runs, and moves the eye parameters on its own.
    bool RampOn() const { return m_ramp_on; }

    // Writes the text with the eye parameters of `values` to `path` as a whole (a file of
    // that name is replaced only when the new one is complete); every other line is kept.
    // Later saves start from this text.
    bool Save(const EyeValues& values, const std::string& path, std::string* problem);

private:
    std::string m_text;
    EyeValues m_start_values;
    std::vector<uint8_t> m_binary;
    bool m_ramp_on = false;
};

}  // namespace ovo_tune

#endif
