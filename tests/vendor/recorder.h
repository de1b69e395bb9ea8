#ifndef OVO_TESTS_VENDOR_RECORDER_H
#define OVO_TESTS_VENDOR_RECORDER_H

// The recording vendor driver: EGL, OpenGL ES 1.x and 2.0 libraries built from the
// library's own entry tables. Every call is recorded with the index of the function that
// received it and its arguments as bits, and answers a result derived from that index,
// so a test can tell exactly which vendor function a call reached.

#include <EGL/egl.h>

#include <cstdint>
#include <cstring>
#include <type_traits>

enum RecorderApi : int32_t {
    RECORDER_API_EGL = 0,
    RECORDER_API_GLES1 = 1,
    RECORDER_API_GLES2 = 2,
    RECORDER_API_RESOLVER = 3,  // GL functions handed out by the EGL library's resolver
};

constexpr uint32_t RECORDER_MAX_ARGUMENTS = 16;
constexpr uint32_t RECORDER_CAPACITY = 256;
constexpr uint32_t RECORDER_ATTRIBUTE_CAPACITY = 64;
constexpr uint32_t RECORDER_GL_NAMES = 376;

struct RecordedCall {
    int32_t m_api;
    uint32_t m_index;
    uint32_t m_argument_count;
    uint64_t m_arguments[RECORDER_MAX_ARGUMENTS];
};

struct RecorderState {
    bool m_recording;        // false: every function does nothing but answer its result
    uint32_t m_call_count;   // calls recorded since the last reset; the log keeps the last ones
    RecordedCall m_calls[RECORDER_CAPACITY];
    // Knobs of the EGL library.
    bool m_make_current_fails;
    bool m_swap_fails;
    EGLint m_surface_width;
    EGLint m_surface_height;
    EGLint m_chosen_attributes[RECORDER_ATTRIBUTE_CAPACITY];  // last eglChooseConfig list
    bool m_resolver_knows[RECORDER_GL_NAMES];                  // GL names the resolver answers
};

extern "C" RecorderState* RecorderGetState();

// The value a vendor function answers: distinct per function and library.
template <typename Result>
Result RecorderResult(int32_t api, uint32_t index) {
    uint64_t value = 0x100000u + static_cast<uint64_t>(api) * 0x1000u + index;
    if constexpr (std::is_void_v<Result>) {
        return;
    } else if constexpr (std::is_pointer_v<Result>) {
        return reinterpret_cast<Result>(static_cast<uintptr_t>(value));
    } else if constexpr (std::is_same_v<Result, unsigned char>) {
        return static_cast<Result>(1 + (index + api) % 250);  // GLboolean: never 0
    } else {
        return static_cast<Result>(value);
    }
}

// An argument as it is recorded: integers by value, floats and pointers by their bits.
template <typename Value>
uint64_t ArgumentBits(Value value) {
    if constexpr (std::is_pointer_v<Value>) {
        return reinterpret_cast<uintptr_t>(value);
    } else if constexpr (std::is_floating_point_v<Value>) {
        uint32_t bits;
        static_assert(sizeof(bits) == sizeof(value), "GL floats are 32-bit");
        std::memcpy(&bits, &value, sizeof(bits));
        return bits;
    } else {
        return static_cast<uint64_t>(static_cast<int64_t>(value));
    }
}

template <int32_t API, uint32_t INDEX, typename Result, typename... Arguments>
Result RecordCall(Arguments... arguments) {
    RecorderState& state = *RecorderGetState();
    if (state.m_recording) {
        RecordedCall& call = state.m_calls[state.m_call_count++ % RECORDER_CAPACITY];
        call.m_api = API;
        call.m_index = INDEX;
        call.m_argument_count = sizeof...(Arguments);
        uint32_t position = 0;
        ((call.m_arguments[position++] = ArgumentBits(arguments)), ...);
    }
    return RecorderResult<Result>(API, INDEX);
}

// The recording function of one table entry, addressable by its exact pointer type.
template <int32_t API, uint32_t INDEX, typename Pointer>
struct Recorder;

template <int32_t API, uint32_t INDEX, typename Result, typename... Arguments>
struct Recorder<API, INDEX, Result (*)(Arguments...)> {
    static Result Call(Arguments... arguments) {
        return RecordCall<API, INDEX, Result>(arguments...);
    }
};

#endif
