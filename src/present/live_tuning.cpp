#include "present/live_tuning.h"

#include <cstdio>

#include "config/stereo_profile.h"
#include "platform/device_path.h"
#include "platform/regular_file.h"

namespace ovo {

void ReadLiveTuning(StereoProfile& profile) {
    float values[5] = {0.0f, 0.0f, 0.0f, 0.0f, 0.0f};
    char path[DEVICE_PATH_CAPACITY];
    if (!MakeDevicePath(LIVE_TUNING_PATH, path, sizeof(path))) return;
    FILE* file = OpenRegularStream(path, REGULAR_FILE_READ);
    if (file == nullptr) return;
    int scanned = std::fscanf(file, "%f %f %f %f %f", &values[0], &values[1], &values[2],
                              &values[3], &values[4]);
    (void)scanned;  // unfilled positions count as 0
    std::fclose(file);
    profile.m_eye_distance = values[0];
    profile.m_eye_angle = values[1];
    profile.m_eye_shift = values[2];
    profile.m_ramp_steps = values[3];
}

}  // namespace ovo
