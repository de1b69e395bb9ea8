// A clock that moves by one frame at each swap and stands still in between, preloaded into
// the third-party programs: what a program draws then depends on its frame number alone,
// so a frame drawn on Mesa directly and the same frame drawn through the library show the
// same moment, however long each took. The swap-capture stand-in calls
// ovo_frame_clock_advance after every eglSwapBuffers. OVO_FRAME_CLOCK_STEP_MS sets how far
// one frame moves it (default 1000 / 60), so that a few frames can reach well into an
// animation.
#include <dlfcn.h>
#include <sys/time.h>
#include <time.h>

#include <atomic>
#include <cstdint>
#include <cstdlib>

namespace {

// 2024-01-01 00:00:00 UTC, and 60 frames a second.
constexpr int64_t FRAME_CLOCK_START_SECONDS = 1704067200;
constexpr int64_t FRAME_CLOCK_DEFAULT_STEP_NANOSECONDS = 1000000000 / 60;

std::atomic<int64_t> g_frames{0};

int64_t StepNanoseconds() {
    static const int64_t step = [] {
        const char* milliseconds = std::getenv("OVO_FRAME_CLOCK_STEP_MS");
        const long long value = milliseconds != nullptr ? std::atoll(milliseconds) : 0;
        return value > 0 ? static_cast<int64_t>(value) * 1000000 : FRAME_CLOCK_DEFAULT_STEP_NANOSECONDS;
    }();
    return step;
}

timespec Now() {
    const int64_t nanoseconds = g_frames.load(std::memory_order_relaxed) * StepNanoseconds();
    return {static_cast<time_t>(FRAME_CLOCK_START_SECONDS + nanoseconds / 1000000000),
            static_cast<long>(nanoseconds % 1000000000)};
}

// Processor-time clocks stay real: the library's own rhythm runs on them.
bool IsWallClock(clockid_t clock) {
    return clock == CLOCK_REALTIME || clock == CLOCK_MONOTONIC || clock == CLOCK_MONOTONIC_RAW ||
           clock == CLOCK_REALTIME_COARSE || clock == CLOCK_MONOTONIC_COARSE || clock == CLOCK_BOOTTIME;
}

}  // namespace

extern "C" {

__attribute__((visibility("default"))) void ovo_frame_clock_advance() {
    g_frames.fetch_add(1, std::memory_order_relaxed);
}

__attribute__((visibility("default"))) int clock_gettime(clockid_t clock, timespec* now) {
    if (IsWallClock(clock)) {
        *now = Now();
        return 0;
    }
    using Real = int (*)(clockid_t, timespec*);
    static const Real real = reinterpret_cast<Real>(dlsym(RTLD_NEXT, "clock_gettime"));
    return real(clock, now);
}

__attribute__((visibility("default"))) int gettimeofday(timeval* now, void*) {
    const timespec clock = Now();
    now->tv_sec = clock.tv_sec;
    now->tv_usec = static_cast<suseconds_t>(clock.tv_nsec / 1000);
    return 0;
}

__attribute__((visibility("default"))) time_t time(time_t* now) {
    const time_t seconds = Now().tv_sec;
    if (now != nullptr) *now = seconds;
    return seconds;
}

}  // extern "C"
