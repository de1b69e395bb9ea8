#ifndef OVO_CONFIG_STEREO_PROFILE_H
#define OVO_CONFIG_STEREO_PROFILE_H

#include <cstdint>

#include "config/command_line_area.h"
#include "config/profile_file.h"
#include "config/stereo_profile_fields.h"

namespace ovo {

// The profile that the companion application writes for the game about to start.
constexpr const char PROFILE_PATH[] = "/sdcard/stereoconv/game/stereo_gm.ovo";

// The settings record of the whole library. The fields (StereoProfileFields, in the
// profile's order) are plain data: the control channel, the swap path and the per-frame
// logic read and write them directly.
class StereoProfile : public StereoProfileFields {
public:
    // Defaults, then the profile file (when accepted: enabled, output size, mode), then the
    // live-wallpaper preset when the process is one. Never fails.
    StereoProfile();
    ~StereoProfile();

    StereoProfile(const StereoProfile&) = delete;
    StereoProfile& operator=(const StereoProfile&) = delete;

    // Reads PROFILE_PATH below the device root into the item table and applies the items
    // when the validity word is non-zero. Returns m_valid after applying; false when the
    // file cannot be opened or its validity word is 0.
    bool LoadProfile();
    // The cached mode; resolved from the flags and the process name on first use.
    StereoMode ResolveMode();
    // Takes the output size from the screen or the eye target, then resolves the mode.
    StereoMode ApplyScreenSize();
    // The live-wallpaper kind (1..6) of this process, 0 when it is none. The name is read
    // anew at each call, so that a rename after start is seen: from the argument area in
    // memory (no system call; the stereo draws ask per eye), from the file only where the
    // area is not known or the name runs on past it.
    int DetectLiveWallpaper();

    // The item table of the last LoadProfile (header words and 32 slots).
    const ProfileTable& ItemTable() const { return m_item_table; }

    // Reads the first NUL-terminated string of "/proc/self/cmdline" into `name`
    // (PROFILE_PROCESS_NAME_CAPACITY bytes, always terminated inside). False, with an
    // empty name, when the file cannot be opened.
    static bool ReadProcessName(char* name);

private:
    ProfileTable m_item_table;
    // Where the process's arguments lie, found once at construction; a rename later writes
    // over them in place.
    CommandLineArea m_command_line;
};

}  // namespace ovo

#endif
