#include "present/live_tuning.h"

#include <unistd.h>

#include "config/stereo_profile.h"
#include "platform/device_path.h"
#include "platform/regular_file.h"
#include "present/live_tuning_text.h"

namespace ovo {

void ReadLiveTuning(StereoProfile& profile) {
    char path[DEVICE_PATH_CAPACITY];
    if (!MakeDevicePath(LIVE_TUNING_PATH, path, sizeof(path))) return;
    const int file = OpenRegularFile(path, REGULAR_FILE_READ);
    if (file < 0) return;
    // The start of the file only, however long it is; one byte more for the scan.
    char text[LIVE_TUNING_READ_LIMIT + 1];
    size_t size = 0;
    while (size < LIVE_TUNING_READ_LIMIT) {
        const ssize_t got = read(file, text + size, LIVE_TUNING_READ_LIMIT - size);
        if (got <= 0) break;
        size += static_cast<size_t>(got);
    }
    close(file);

    float values[LIVE_TUNING_VALUES] = {0.0f, 0.0f, 0.0f, 0.0f, 0.0f};
    // Positions without a number count as 0; the fifth is not used.
    ScanLiveTuningText(text, size, size < LIVE_TUNING_READ_LIMIT, values);
    profile.m_eye_distance = values[0];
    profile.m_eye_angle = values[1];
    profile.m_eye_shift = values[2];
    profile.m_ramp_steps = values[3];
}

}  // namespace ovo
