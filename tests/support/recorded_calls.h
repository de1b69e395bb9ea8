#ifndef OVO_TESTS_SUPPORT_RECORDED_CALLS_H
#define OVO_TESTS_SUPPORT_RECORDED_CALLS_H

// The recording vendor's GL calls as text, and the answers a test gives its queries.

#include <GLES2/gl2.h>

#include <cinttypes>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <initializer_list>
#include <string>
#include <vector>

#include "core/entry_tables.h"
#include "vendor/recorder.h"

namespace recorded_calls {

// gl_index answers `bytes` through its output pointer (and `result`, when given) whenever its
// last non-pointer argument is `key`. A later answer for the same function and key wins.
inline void AnswerBytes(uint32_t gl_index, uint64_t key, const void* bytes, size_t byte_count,
                        bool has_result = false, uint64_t result = 0) {
    RecorderState& state = *RecorderGetState();
    RecorderAnswer* answer = const_cast<RecorderAnswer*>(FindAnswer(state, gl_index, key));
    if (answer == nullptr) {
        if (state.m_answer_count == RECORDER_ANSWER_CAPACITY) {
            std::fprintf(stderr, "recorded_calls: more than %u answers\n",
                         RECORDER_ANSWER_CAPACITY);
            std::abort();
        }
        answer = &state.m_answers[state.m_answer_count++];
    }
    if (byte_count > RECORDER_ANSWER_BYTES) byte_count = RECORDER_ANSWER_BYTES;
    *answer =
        RecorderAnswer{gl_index, key, static_cast<uint32_t>(byte_count), {}, has_result, result};
    if (byte_count > 0) std::memcpy(answer->m_bytes, bytes, byte_count);
}

inline void AnswerIntegers(uint32_t gl_index, uint64_t key, std::initializer_list<GLint> values) {
    AnswerBytes(gl_index, key, values.begin(), values.size() * sizeof(GLint));
}

inline void AnswerFloats(uint32_t gl_index, uint64_t key, std::initializer_list<GLfloat> values) {
    AnswerBytes(gl_index, key, values.begin(), values.size() * sizeof(GLfloat));
}

inline void AnswerBooleans(uint32_t gl_index, uint64_t key,
                           std::initializer_list<GLboolean> values) {
    AnswerBytes(gl_index, key, values.begin(), values.size() * sizeof(GLboolean));
}

inline void AnswerResult(uint32_t gl_index, uint64_t key, uint64_t value) {
    AnswerBytes(gl_index, key, nullptr, 0, true, value);
}

inline void ClearAnswers() {
    RecorderGetState()->m_answer_count = 0;
}

inline std::string FormatArgument(uint64_t bits, uint8_t kind) {
    char text[32];
    switch (kind) {
        case RECORDER_ARGUMENT_POINTER:
            return bits != 0 ? "ptr" : "null";
        case RECORDER_ARGUMENT_FLOAT: {
            uint32_t float_bits = static_cast<uint32_t>(bits);
            float value;
            std::memcpy(&value, &float_bits, sizeof(value));
            std::snprintf(text, sizeof(text), "%g", static_cast<double>(value));
            break;
        }
        case RECORDER_ARGUMENT_SIGNED:
            std::snprintf(text, sizeof(text), "%" PRId64, static_cast<int64_t>(bits));
            break;
        default:
            std::snprintf(text, sizeof(text), bits < 0x100 ? "%" PRIu64 : "0x%04" PRIX64, bits);
            break;
    }
    return text;
}

// EGL handles in hex, so that contexts and surfaces can be told apart.
inline std::string FormatHandle(const void* handle) {
    if (handle == nullptr) return "null";
    char text[32];
    std::snprintf(text, sizeof(text), "0x%" PRIxPTR, reinterpret_cast<uintptr_t>(handle));
    return text;
}

// Every call recorded since the last reset, oldest first, as "glName(arguments)", with EGL
// calls too when `with_egl`. When the log has overflowed, a first line says how many calls
// it no longer holds.
inline std::vector<std::string> RecordedCalls(bool with_egl) {
    const RecorderState& state = *RecorderGetState();
    std::vector<std::string> calls;
    uint32_t first = 0;
    if (state.m_call_count > RECORDER_CAPACITY) {
        first = state.m_call_count - RECORDER_CAPACITY;
        calls.push_back("(" + std::to_string(first) + " earlier calls not kept)");
    }
    for (uint32_t number = first; number < state.m_call_count; ++number) {
        const RecordedCall& call = state.m_calls[number % RECORDER_CAPACITY];
        const bool egl = call.m_api == RECORDER_API_EGL;
        if (egl && !with_egl) continue;
        std::string text = std::string(egl ? ovo::EglEntryTable[call.m_index]
                                           : ovo::GlEntryTable[call.m_index]) + "(";
        for (uint32_t position = 0; position < call.m_argument_count; ++position) {
            if (position > 0) text += ", ";
            const uint64_t bits = call.m_arguments[position];
            text += egl && call.m_kinds[position] == RECORDER_ARGUMENT_POINTER
                        ? FormatHandle(reinterpret_cast<const void*>(static_cast<uintptr_t>(bits)))
                        : FormatArgument(bits, call.m_kinds[position]);
        }
        calls.push_back(text + ")");
    }
    return calls;
}

inline std::vector<std::string> RecordedGlCalls() { return RecordedCalls(false); }

}  // namespace recorded_calls

#endif
