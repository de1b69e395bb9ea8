#include "config/stereo_profile.h"

#include <fcntl.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>

#include "platform/device_path.h"
#include "platform/log.h"
#include "platform/regular_file.h"

namespace ovo {

namespace {
constexpr const char SELF_COMMAND_LINE[] = "/proc/self/cmdline";
}  // namespace

StereoProfile::StereoProfile()
    : StereoProfileFields(), m_item_table{}, m_command_line(LocateCommandLineArea()) {
    // The fields hold their defaults (StereoProfileFields).
    if (LoadProfile()) {
        m_enabled = true;
        ApplyScreenSize();
    }
    ApplyLiveWallpaperPreset(*this, DetectLiveWallpaper());
}

StereoProfile::~StereoProfile() { m_enabled = false; }

bool StereoProfile::LoadProfile() {
    LogPrint(LOG_PRIORITY_DEBUG, "[Duoscope] LoadPorfile");
    std::memset(&m_item_table, 0, sizeof(m_item_table));

    char path[DEVICE_PATH_CAPACITY];
    if (!MakeDevicePath(PROFILE_PATH, path, sizeof(path))) return false;
    FILE* file = OpenRegularStream(path, REGULAR_FILE_READ);
    if (file == nullptr) return false;
    ReadProfileTable(file, m_item_table);
    std::fclose(file);

    // One line per item read, with the count as the file gives it.
    for (int index = 0; index < PROFILE_FILE_ITEMS; ++index) {
        LogPrint(LOG_PRIORITY_ERROR, "item.m_data_count = %d", m_item_table.m_items[index].m_data_count);
    }
    if (m_item_table.m_validity == 0) return false;
    ApplyProfileItems(*this, m_item_table);
    return m_valid;
}

StereoMode StereoProfile::ResolveMode() {
    if (m_mode == 0) {
        // The process name matters (and is read) only for an enabled shader profile.
        char name[PROFILE_PROCESS_NAME_CAPACITY];
        const bool named = m_enabled && m_shader_convert && ReadProcessName(name);
        m_mode = ModeForProcess(*this, named ? name : nullptr);
    }
    return static_cast<StereoMode>(m_mode);
}

StereoMode StereoProfile::ApplyScreenSize() {
    SelectOutputSize(*this);
    m_mode = ResolveMode();
    return static_cast<StereoMode>(m_mode);
}

int StereoProfile::DetectLiveWallpaper() {
    char name[PROFILE_PROCESS_NAME_CAPACITY];
    switch (ReadNameInArea(m_command_line, name)) {
    case COMMAND_LINE_NAME_READ:
        return LiveWallpaperKindOf(name);
    case COMMAND_LINE_NAME_RUNS_ON:
        // The name only grows past the area; unless that could still make a wallpaper's
        // name, it is none.
        if (!IsLiveWallpaperNamePrefix(name)) return LIVE_WALLPAPER_NONE;
        break;
    case COMMAND_LINE_AREA_UNKNOWN:
        break;
    }
    if (!ReadProcessName(name)) return LIVE_WALLPAPER_NONE;
    return LiveWallpaperKindOf(name);
}

bool StereoProfile::ReadProcessName(char* name) {
    name[0] = '\0';
    // Plain system calls: a draw may still come here (DetectLiveWallpaper), and must not
    // allocate.
    const int file = open(SELF_COMMAND_LINE, O_RDONLY | O_CLOEXEC);
    if (file < 0) return false;
    // The last byte is kept for the terminator, so a long name is cut inside the buffer.
    size_t length = 0;
    while (length < PROFILE_PROCESS_NAME_CAPACITY - 1) {
        const size_t wanted = PROFILE_PROCESS_NAME_CAPACITY - 1 - length;
        const ssize_t got = read(file, name + length, wanted);
        if (got <= 0) break;
        length += static_cast<size_t>(got);
        // The kernel gives the whole command line at once; a short read is its end, and
        // asking again would only cost the draws another system call.
        if (static_cast<size_t>(got) < wanted) break;
    }
    name[length] = '\0';
    close(file);
    return true;
}

}  // namespace ovo
