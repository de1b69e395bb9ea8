// The live-tuning file's numbers: read as fscanf with "%f %f %f %f %f" reads them from a
// file of the same bytes, and never more than the read limit of a long file.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <random>
#include <string>

#include "config/stereo_profile.h"
#include "present/live_tuning.h"
#include "present/live_tuning_text.h"
#include "support/device_files.h"

namespace {

using ovo::LIVE_TUNING_READ_LIMIT;
using ovo::LIVE_TUNING_VALUES;

// Five values and how many were converted, as bits, so that NaNs compare too.
struct Scan {
    int m_converted;
    uint32_t m_bits[LIVE_TUNING_VALUES];
    bool operator==(const Scan& other) const {
        return m_converted == other.m_converted && std::memcmp(m_bits, other.m_bits, sizeof(m_bits)) == 0;
    }
};

std::ostream& operator<<(std::ostream& out, const Scan& scan) {
    out << scan.m_converted << " converted:";
    for (uint32_t bits : scan.m_bits) out << " 0x" << std::hex << bits << std::dec;
    return out;
}

constexpr float UNSET = 42.0f;

Scan Bits(int converted, const float (&values)[LIVE_TUNING_VALUES]) {
    Scan scan{converted, {}};
    std::memcpy(scan.m_bits, values, sizeof(values));
    return scan;
}

// The C library's own reading of the same bytes as a whole file.
Scan Fscanf(const std::string& text) {
    float values[LIVE_TUNING_VALUES] = {UNSET, UNSET, UNSET, UNSET, UNSET};
    std::string bytes = text;
    FILE* file = fmemopen(bytes.empty() ? nullptr : &bytes[0], bytes.size(), "r");
    int converted = file == nullptr ? 0 : std::fscanf(file, "%f %f %f %f %f", &values[0], &values[1], &values[2], &values[3], &values[4]);
    if (file != nullptr) std::fclose(file);
    return Bits(converted < 0 ? 0 : converted, values);
}

Scan Scanned(const std::string& text, bool whole = true) {
    float values[LIVE_TUNING_VALUES] = {UNSET, UNSET, UNSET, UNSET, UNSET};
    std::string bytes = text + '#';  // the byte that the scan borrows
    const int converted = ovo::ScanLiveTuningText(&bytes[0], text.size(), whole, values);
    EXPECT_EQ(bytes, text + '#') << "the text is left as it was";
    return Bits(converted, values);
}

// Hand-picked texts, then random ones of the characters that numbers are made of, so that
// every path through the scan meets the C library's.
TEST(LiveTuningText, ReadsAsFscanfReads) {
    const std::string digits_200 = "1" + std::string(199, '0');
    const std::string cases[] = {
        "", " ", "\n\t\v\f\r", "0.02 1.5", "1 2 3 4 5", "1 2 3 4 5 6", "  1\n2\t3\v4\f5\r",
        "-1e3\n\t2.5   -0.25\n8", "+.5 -.5 5. .", "-", "+", "- 1", "1 - 2", "--1", "+-1",
        // What the C library's "%f" takes and then converts only in part.
        "1e 2", "1e+ 2", "1e+x", "1E5 1e-5 1e+5 1E+-5", "1e5.5", "1.5.5", "1..2", ".e5", "e5", "5.e", "1e5e6",
        "0x", "0x 1", "0X1.8P1 0x1p", "0x.", "0x.p1", "0xg", "0xp1", "0x1p-2 0x1P+ 0x1pp", "0xe.8", "-0x10",
        "00000000001.5", "0", "0 0", "-0", "0e", "0.", "0..",
        "inf", "-INF", "+Infinity", "infinit", "infinity5", "infx 2", "info", "in", "i",
        "nan", "-NaN 1", "nan(1) 2", "na", "nax", "n",
        "1,5 2", "1;2", "1x2", "\xff" "1", "\xc2\xa0" "1", "5\xff",
        std::string("1\0 2", 4), std::string("1 \0 2", 5),
        // Rounding: ties go to even, one digit past a tie decides it.
        "16777217", "16777217.000000000000000000000000000001", "0.1 0.2 0.3",
        "3.4028235e38 3.4028236e38 1e39 1e-45 1e-46 7e-46 -1e-50",
        digits_200, "0." + std::string(150, '0') + "1", digits_200 + "e-190",
    };
    for (const std::string& text : cases) EXPECT_EQ(Scanned(text), Fscanf(text)) << '"' << text << '"';
    const char alphabet[] = "0123456789+-.eExXpPaAfFiInNtTyY \t\n()";
    std::mt19937 random(12345);
    std::uniform_int_distribution<size_t> length(0, 24), pick(0, sizeof(alphabet) - 2);
    int agreed = 0;
    for (int i = 0; i < 100000; ++i) {
        std::string text;
        for (size_t n = length(random); n > 0; --n) text += alphabet[pick(random)];
        const Scan scanned = Scanned(text), expected = Fscanf(text);
        if (scanned == expected) {
            ++agreed;
        } else {
            ADD_FAILURE() << '"' << text << "\": " << scanned << " where fscanf gives " << expected;
            if (i - agreed > 10) break;
        }
    }
    EXPECT_EQ(agreed, 100000);
}

// Only the start of a longer file: a number, or white space before one, that reaches the
// end of the bytes could go on past them, so it and what follows count as missing.
TEST(LiveTuningText, ANumberThatMayGoOnPastTheBytesIsMissing) {
    const struct {
        const char* m_start;
        int m_converted;
    } cases[] = {
        {"1 2 3 4 5", 4},  // "5" may be "55"
        {"1 2 3 4 5 ", 5}, {"1 2 ", 2}, {"1 2", 1}, {"1 2 3 4 5 6", 5},
        {"1e", 0},          // "1e" may be "1e5"
        {"inf", 0},         // "inf" may be "infinity"
        {"1 nan", 2},       // nothing can follow "nan"
        {"-", 0}, {"", 0},
    };
    for (const auto& test : cases) {
        const Scan scanned = Scanned(test.m_start, false);
        EXPECT_EQ(scanned.m_converted, test.m_converted) << '"' << test.m_start << '"';
        // What was converted is what fscanf converts from the whole text.
        Scan expected = Fscanf(test.m_start);
        for (int i = test.m_converted; i < LIVE_TUNING_VALUES; ++i) std::memcpy(&expected.m_bits[i], &UNSET, 4);
        expected.m_converted = test.m_converted;
        EXPECT_EQ(scanned, expected) << '"' << test.m_start << '"';
    }
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
