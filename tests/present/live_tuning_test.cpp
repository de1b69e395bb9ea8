// The live-tuning file's numbers: read as fscanf with "%f %f %f %f %f" reads them from a
// file of the same bytes, and never more than the read limit of a long file.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "config/stereo_profile.h"
#include "present/live_tuning.h"
#include "support/device_files.h"

namespace {

using ovo::LIVE_TUNING_READ_LIMIT;

// What the profile takes from a short file is what fscanf reads from the same file: numbers
// that the C library takes only in part, hexadecimal, NaN and infinities, and bytes that end
// the numbers (a NUL among them) included.
TEST(LiveTuning, ReadsAShortFileAsFscanfReadsIt) {
    const std::string path = device_files::Path(ovo::LIVE_TUNING_PATH);
    const std::string cases[] = {
        "", "0.02 1.5", "1 2 3 4 5 6", "-1e3\n\t2.5   -0.25\n8", "1e 2", "1e+ 2", "0x1p-2 0x1P+ 3",
        "0x 1", "nan(1) 2", "inf -INF +Infinity 1", "1,5 2", std::string("1\0 2", 4),
        std::string("1 \0 2", 5), "16777217.000000000000000000000000000001 3.4028236e38 1e-46",
    };
    ovo::StereoProfile profile;
    for (const std::string& text : cases) {
        device_files::Write(ovo::LIVE_TUNING_PATH, text);
        float expected[5] = {};
        FILE* file = std::fopen(path.c_str(), "r");
        ASSERT_NE(file, nullptr);
        (void)std::fscanf(file, "%f %f %f %f %f", &expected[0], &expected[1], &expected[2], &expected[3],
                          &expected[4]);
        std::fclose(file);
        profile.m_eye_distance = profile.m_eye_angle = profile.m_eye_shift = profile.m_ramp_steps = 9.0f;

        ovo::ReadLiveTuning(profile);
        const float read[4] = {profile.m_eye_distance, profile.m_eye_angle, profile.m_eye_shift,
                               profile.m_ramp_steps};
        // As bits, so that NaNs compare too.
        EXPECT_EQ(std::memcmp(read, expected, sizeof(read)), 0)
            << '"' << text << "\": " << read[0] << ' ' << read[1] << ' ' << read[2] << ' ' << read[3];
    }
    device_files::Remove(ovo::LIVE_TUNING_PATH);
}

// The bytes that this process has read so far, as the kernel counts them (-1 when it does
// not), and how many bytes this reading itself took, which the next count includes.
struct ReadCount {
    long m_bytes;
    long m_own;
};

ReadCount BytesRead() {
    char text[1024] = {};
    const int file = open("/proc/self/io", O_RDONLY);
    const ssize_t got = file < 0 ? -1 : read(file, text, sizeof(text) - 1);
    if (file >= 0) close(file);
    const char* count = got > 0 ? std::strstr(text, "rchar: ") : nullptr;
    return {count != nullptr ? std::atol(count + 7) : -1, got};
}

// A file of 100 MiB whose bytes past the read limit would set the ramp steps: the read
// takes at most the limit and leaves the positions that lie past it at 0.
TEST(LiveTuning, ReadsNoMoreThanTheLimitOfALongFile) {
    const std::string path = device_files::Path(ovo::LIVE_TUNING_PATH);
    const struct {
        std::string m_start;  // LIVE_TUNING_READ_LIMIT bytes; "4 5" follows
        float m_eye_shift;
    } cases[] = {
        {"0.02 1.5 3 " + std::string(LIVE_TUNING_READ_LIMIT - 11, ' '), 3.0f},
        {"0.02 1.5 " + std::string(LIVE_TUNING_READ_LIMIT - 10, ' ') + "3", 0.0f},  // "34" past it
    };
    ovo::StereoProfile profile;
    for (const auto& test : cases) {
        ASSERT_EQ(test.m_start.size(), LIVE_TUNING_READ_LIMIT);
        device_files::Write(ovo::LIVE_TUNING_PATH, test.m_start + "4 5\n");
        ASSERT_EQ(truncate(path.c_str(), 100 << 20), 0);  // sparse: zero bytes after
        profile.m_ramp_steps = 9.0f;

        const ReadCount start = BytesRead();
        if (start.m_bytes < 0) GTEST_SKIP() << "no /proc/self/io";
        ovo::ReadLiveTuning(profile);
        const long read = BytesRead().m_bytes - start.m_bytes - start.m_own;

        EXPECT_EQ(read, long(LIVE_TUNING_READ_LIMIT));
        EXPECT_EQ(profile.m_eye_distance, 0.02f);
        EXPECT_EQ(profile.m_eye_angle, 1.5f);
        EXPECT_EQ(profile.m_eye_shift, test.m_eye_shift);
        EXPECT_EQ(profile.m_ramp_steps, 0.0f) << "the 4 past the limit was read";
        // The C library reads on to the "4" and "34".
        FILE* file = std::fopen(path.c_str(), "r");
        float values[5] = {};
        ASSERT_NE(file, nullptr);
        EXPECT_EQ(std::fscanf(file, "%f %f %f %f %f", &values[0], &values[1], &values[2], &values[3], &values[4]),
                  test.m_eye_shift == 0.0f ? 4 : 5);
        std::fclose(file);
    }
    device_files::Remove(ovo::LIVE_TUNING_PATH);
}

}  // namespace
