#ifndef OVO_TESTS_SUPPORT_FORWARDING_CHECK_H
#define OVO_TESTS_SUPPORT_FORWARDING_CHECK_H

#include <gtest/gtest.h>

#include <cstdint>
#include <tuple>
#include <type_traits>
#include <utility>

#include "core/entry_tables.h"
#include "vendor/recorder.h"

// Arguments that tell every parameter of every entry point apart. Pointers are never
// dereferenced on a GL forwarding path, so they need not point anywhere.
struct DistinctArguments {
    template <typename Value>
    static Value Make(uint32_t index, uint32_t position) {
        uint64_t seed = static_cast<uint64_t>(index) * 16 + position + 1;
        if constexpr (std::is_pointer_v<Value>) {
            return reinterpret_cast<Value>(static_cast<uintptr_t>(0x7000000 + seed * 8));
        } else if constexpr (std::is_floating_point_v<Value>) {
            return static_cast<Value>(seed) + 0.25f;
        } else {
            return static_cast<Value>(seed);
        }
    }

    template <typename Result>
    static Result Expected(int32_t api, uint32_t index) {
        return RecorderResult<Result>(api, index);
    }
};

// As DistinctArguments, but attribute lists are real (empty) lists, since the EGL
// paths read them.
struct DistinctEglArguments {
    template <typename Value>
    static Value Make(uint32_t index, uint32_t position) {
        if constexpr (std::is_same_v<Value, const EGLint*>) {
            static const EGLint EMPTY_LISTS[RECORDER_MAX_ARGUMENTS] = {
                EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE,
                EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE, EGL_NONE};
            return &EMPTY_LISTS[position];
        } else {
            return DistinctArguments::Make<Value>(index, position);
        }
    }

    // The recording vendor succeeds at make-current, so that the library acts on it.
    template <typename Result>
    static Result Expected(int32_t api, uint32_t index) {
        if constexpr (std::is_same_v<Result, EGLBoolean>) {
            if (index == ovo::EGL_ENTRY_eglMakeCurrent) return EGL_TRUE;
        }
        return RecorderResult<Result>(api, index);
    }
};

inline void ResetRecorder() {
    RecorderState& state = *RecorderGetState();
    state.m_call_count = 0;
    state.m_recording = true;
}

// The most recent recorded call of `index` in `api`, or null.
inline const RecordedCall* FindRecordedCall(int32_t api, uint32_t index) {
    const RecorderState& state = *RecorderGetState();
    uint32_t kept = state.m_call_count < RECORDER_CAPACITY ? state.m_call_count : RECORDER_CAPACITY;
    for (uint32_t back = 1; back <= kept; ++back) {
        const RecordedCall& call = state.m_calls[(state.m_call_count - back) % RECORDER_CAPACITY];
        if (call.m_api == api && call.m_index == index) return &call;
    }
    return nullptr;
}

// Calls `function` with distinct arguments and expects that the vendor function
// `vendor_index` of `api` received them unchanged and that its result came back.
template <typename Maker, typename Result, typename... Arguments, size_t... POSITIONS>
void ExpectForwarded(const char* name, uint32_t index, int32_t api, uint32_t vendor_index,
                     Result (*function)(Arguments...), std::index_sequence<POSITIONS...>) {
    std::tuple<Arguments...> arguments{
        Maker::template Make<Arguments>(index, static_cast<uint32_t>(POSITIONS))...};
    static_cast<void>(index);  // unused by entry points without parameters
    ResetRecorder();
    if constexpr (std::is_void_v<Result>) {
        std::apply(function, arguments);
    } else {
        Result result = std::apply(function, arguments);
        EXPECT_EQ(result, Maker::template Expected<Result>(api, vendor_index)) << name;
    }
    const RecordedCall* call = FindRecordedCall(api, vendor_index);
    ASSERT_NE(call, nullptr) << name << " did not reach vendor function " << vendor_index;
    uint64_t expected[] = {ArgumentBits(std::get<POSITIONS>(arguments))..., 0};
    ASSERT_EQ(call->m_argument_count, sizeof...(Arguments)) << name;
    for (size_t position = 0; position < sizeof...(Arguments); ++position) {
        EXPECT_EQ(call->m_arguments[position], expected[position])
            << name << " argument " << position;
    }
}

template <typename Maker, typename Result, typename... Arguments>
void ExpectForwarded(const char* name, uint32_t index, int32_t api, uint32_t vendor_index,
                     Result (*function)(Arguments...)) {
    ExpectForwarded<Maker>(name, index, api, vendor_index, function,
                    std::index_sequence_for<Arguments...>{});
}

#endif
