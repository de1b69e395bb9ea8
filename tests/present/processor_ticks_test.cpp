// The processor-time difference behind the panel refresh, across the wrap of a 32-bit
// clock_t (the device's) and with a 64-bit one (the host's).
#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>

#include "present/panel_refresh.h"

namespace {

struct TicksCase {
    int64_t m_start;
    int64_t m_now;
    int32_t m_ticks;
};

constexpr int64_t MAX32 = INT32_MAX;
constexpr int64_t MIN32 = INT32_MIN;

// Readings that a 32-bit clock_t can hold: after 2^31 - 1 ticks it goes on at -2^31.
constexpr TicksCase READINGS_32[] = {
    {0, 100000, 100000},
    {MAX32 - 49999, MIN32 + 50000, 100000},  // over the signed limit
    {-50000, 50000, 100000},                 // over -1 to 0
    {MAX32, MIN32, 1},
    {100000, 0, -100000},                    // a reading behind the start
    {MIN32 + 50000, MAX32 - 49999, -100000},
};

// A 64-bit clock_t never wraps; a difference beyond 32 bits keeps its low word, as the
// device's would.
constexpr TicksCase READINGS_64[] = {
    {MAX32 - 49999, MAX32 + 50001, 100000},
    {0xFFFFFFFFLL - 49999, 0x100000000LL + 50000, 100000},
    {int64_t{1} << 40, (int64_t{1} << 40) + 100000, 100000},
    {0, 0x80000000LL, INT32_MIN},
    {0, 0x100000005LL, 5},
};

// The row of the first wrong answer, or -1.
template <typename Reading, size_t COUNT>
constexpr int FirstWrongRow(const TicksCase (&cases)[COUNT]) {
    for (size_t row = 0; row < COUNT; ++row) {
        const TicksCase& each = cases[row];
        const int32_t ticks = ovo::ProcessorTicksBetween(static_cast<Reading>(each.m_start),
                                                         static_cast<Reading>(each.m_now));
        if (ticks != each.m_ticks) return static_cast<int>(row);
    }
    return -1;
}

// Evaluated while compiling, where an overflowing signed subtraction is an error rather than
// a silent wrap.
TEST(ProcessorTicks, AreTheSigned32BitDifferenceOfTwoReadings) {
    constexpr int wrong_32 = FirstWrongRow<int32_t>(READINGS_32);
    constexpr int wrong_64 = FirstWrongRow<int64_t>(READINGS_64);
    EXPECT_EQ(wrong_32, -1);
    EXPECT_EQ(wrong_64, -1);
}

}  // namespace
