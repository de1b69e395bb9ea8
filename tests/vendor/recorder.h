#ifndef OVO_TESTS_VENDOR_RECORDER_H
#define OVO_TESTS_VENDOR_RECORDER_H

// The recording vendor driver: EGL, OpenGL ES 1.x and 2.0 libraries built from the
// library's own entry tables. Every call is recorded with the index of the function that
// received it and its arguments as bits, and answers a result derived from that index,
// so a test can tell exactly which vendor function a call reached. A test can also give
// a GL function answers: values written through its output pointer, or its result.

#include <EGL/egl.h>

#include <cstdint>
#include <cstring>
#include <tuple>
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
constexpr uint32_t RECORDER_ANSWER_CAPACITY = 64;
constexpr uint32_t RECORDER_ANSWER_BYTES = 64;  // a 4x4 float matrix

// How an argument's bits read back.
enum RecorderArgumentKind : uint8_t {
    RECORDER_ARGUMENT_SIGNED = 0,
    RECORDER_ARGUMENT_UNSIGNED = 1,
    RECORDER_ARGUMENT_FLOAT = 2,
    RECORDER_ARGUMENT_POINTER = 3,
};

struct RecordedCall {
    int32_t m_api;
    uint32_t m_index;
    uint32_t m_argument_count;
    uint64_t m_arguments[RECORDER_MAX_ARGUMENTS];
    uint8_t m_kinds[RECORDER_MAX_ARGUMENTS];  // RecorderArgumentKind
};

// What a GL function answers when its last non-pointer argument (the pname, the capability,
// the program) equals m_key.
struct RecorderAnswer {
    uint32_t m_index;
    uint64_t m_key;
    uint32_t m_byte_count;                 // copied through a last pointer-to-non-const argument
    uint8_t m_bytes[RECORDER_ANSWER_BYTES];
    bool m_has_result;
    uint64_t m_result;                     // returned by a function with an integer result
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
    uint32_t m_answer_count;
    RecorderAnswer m_answers[RECORDER_ANSWER_CAPACITY];
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

template <typename Value>
constexpr uint8_t ArgumentKind() {
    if constexpr (std::is_pointer_v<Value>) {
        return RECORDER_ARGUMENT_POINTER;
    } else if constexpr (std::is_floating_point_v<Value>) {
        return RECORDER_ARGUMENT_FLOAT;
    } else if constexpr (std::is_signed_v<Value>) {
        return RECORDER_ARGUMENT_SIGNED;
    } else {
        return RECORDER_ARGUMENT_UNSIGNED;
    }
}

inline const RecorderAnswer* FindAnswer(const RecorderState& state, uint32_t index, uint64_t key) {
    for (uint32_t i = 0; i < state.m_answer_count; ++i) {
        const RecorderAnswer& answer = state.m_answers[i];
        if (answer.m_index == index && answer.m_key == key) return &answer;
    }
    return nullptr;
}

// The answer for a GL call, written through its last argument when that is a pointer to
// something writable; null when the test gave none.
template <typename... Arguments>
const RecorderAnswer* GiveAnswer(uint32_t index, Arguments... arguments) {
    const RecorderState& state = *RecorderGetState();
    if (state.m_answer_count == 0) return nullptr;
    uint64_t key = 0;
    ((key = std::is_pointer_v<Arguments> ? key : ArgumentBits(arguments)), ...);
    const RecorderAnswer* answer = FindAnswer(state, index, key);
    if constexpr (sizeof...(Arguments) > 0) {
        using Last = std::tuple_element_t<sizeof...(Arguments) - 1, std::tuple<Arguments...>>;
        if constexpr (std::is_pointer_v<Last> && !std::is_const_v<std::remove_pointer_t<Last>>) {
            Last destination = std::get<sizeof...(Arguments) - 1>(std::make_tuple(arguments...));
            if (answer != nullptr && destination != nullptr) {
                std::memcpy(destination, answer->m_bytes, answer->m_byte_count);
            }
        }
    }
    return answer;
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
        ((call.m_kinds[position] = ArgumentKind<Arguments>(),
          call.m_arguments[position++] = ArgumentBits(arguments)),
         ...);
    }
    if constexpr (API != RECORDER_API_EGL) {
        const RecorderAnswer* answer = GiveAnswer(INDEX, arguments...);
        static_cast<void>(answer);  // unused by functions without a result
        if constexpr (!std::is_void_v<Result> && !std::is_pointer_v<Result>) {
            if (answer != nullptr && answer->m_has_result)
                return static_cast<Result>(answer->m_result);
        }
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
