#include "present/live_tuning.h"

#include <unistd.h>

#include <cstdio>

#include "config/stereo_profile.h"
#include "platform/device_path.h"
#include "platform/regular_file.h"

namespace ovo {

namespace {
bool IsSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }
}  // namespace

void ReadLiveTuning(StereoProfile& profile) {
    char path[DEVICE_PATH_CAPACITY];
    if (!MakeDevicePath(LIVE_TUNING_PATH, path, sizeof(path))) return;
    const int file = OpenRegularFile(path, REGULAR_FILE_READ);
    if (file < 0) return;
    // fscanf on the file itself would read on to the end of any run of blanks or digits.
    char text[LIVE_TUNING_READ_LIMIT + 1];
    size_t size = 0;
    while (size < LIVE_TUNING_READ_LIMIT) {
        const ssize_t got = read(file, text + size, LIVE_TUNING_READ_LIMIT - size);
        if (got <= 0) break;
        size += static_cast<size_t>(got);
    }
    close(file);
    // The file may go on: a number that reaches the limit could go on past it, so it counts
    // as missing, as if the file ended before it.
    if (size == LIVE_TUNING_READ_LIMIT) {
        while (size > 0 && !IsSpace(text[size - 1])) --size;
    }
    text[size] = '\0';

    // A NUL byte ends the string where it would end the numbers in the file; positions
    // without a number count as 0; the fifth is not used.
    float values[5] = {0.0f, 0.0f, 0.0f, 0.0f, 0.0f};
    std::sscanf(text, "%f %f %f %f %f", &values[0], &values[1], &values[2], &values[3], &values[4]);
    profile.m_eye_distance = values[0];
    profile.m_eye_angle = values[1];
    profile.m_eye_shift = values[2];
    profile.m_ramp_steps = values[3];
}

}  // namespace ovo
