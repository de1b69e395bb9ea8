// Any bytes as the start of the live-tuning file: the scan must convert exactly what the
// C library's fscanf with "%f %f %f %f %f" converts from a file of those bytes, value for
// value and bit for bit, and as the start of a longer file it may only drop numbers from
// the end.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "present/live_tuning_text.h"

namespace {

using ovo::LIVE_TUNING_VALUES;

// Stops the run where the fault is, so the fuzzer keeps the input.
void Check(bool condition) {
    if (!condition) std::abort();
}

constexpr uint32_t UNSET_BITS = 0x7FC0DEAD;

struct Values {
    float m_values[LIVE_TUNING_VALUES];
    Values() {
        for (float& value : m_values) std::memcpy(&value, &UNSET_BITS, sizeof(value));
    }
    bool SameFirst(const Values& other, int count) const {
        return std::memcmp(m_values, other.m_values, sizeof(float) * static_cast<size_t>(count)) == 0;
    }
    bool UnsetFrom(int first) const {
        for (int i = first; i < LIVE_TUNING_VALUES; ++i) {
            if (std::memcmp(&m_values[i], &UNSET_BITS, sizeof(float)) != 0) return false;
        }
        return true;
    }
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    if (size > ovo::LIVE_TUNING_READ_LIMIT) return 0;
    char text[ovo::LIVE_TUNING_READ_LIMIT + 1];
    if (size > 0) std::memcpy(text, data, size);

    Values expected;
    int expected_count = 0;
    if (FILE* file = size > 0 ? fmemopen(text, size, "r") : nullptr) {
        float* v = expected.m_values;
        expected_count = std::fscanf(file, "%f %f %f %f %f", &v[0], &v[1], &v[2], &v[3], &v[4]);
        std::fclose(file);
        if (expected_count < 0) expected_count = 0;
    }

    Values whole;
    Check(ovo::ScanLiveTuningText(text, size, true, whole.m_values) == expected_count);
    Check(whole.SameFirst(expected, LIVE_TUNING_VALUES));
    Check(size == 0 || std::memcmp(text, data, size) == 0);

    Values start;
    const int start_count = ovo::ScanLiveTuningText(text, size, false, start.m_values);
    Check(start_count <= expected_count && start_count >= expected_count - 1);
    Check(start.SameFirst(expected, start_count));
    Check(start.UnsetFrom(start_count));
    return 0;
}
