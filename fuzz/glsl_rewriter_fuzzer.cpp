// Any bytes as a vertex shader's source: the leading directives that the injection keeps
// must end within it, and the rewrite must write nothing past the room it asks for, leave the
// buffer alone when it inserts nothing, and otherwise give back the source up to its first
// NUL with the two strings at exactly the places its trace names, in front of a `return` or
// a closing brace. The input's last byte picks the strings and the number of places, so that
// plain shader files remain plain shader files.
#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>

#include "stereo/glsl_directives.h"
#include "stereo/glsl_rewriter.h"

namespace {

// Stops the run where the fault is, so the fuzzer keeps the input.
void Check(bool condition) {
    if (!condition) std::abort();
}

struct StringPair {
    const char* m_pre;
    const char* m_post;
};

// The shader injection's own pair first: ASCII last bytes pick it.
constexpr StringPair STRING_PAIRS[] = {
    {"uniform vec2 uZpDepthShift;\n",
     "gl_Position.x = gl_Position.x + (uZpDepthShift.y * min((uZpDepthShift.x * gl_Position.w) - "
     "gl_Position.z, 0.0));\n"},
    {"", "}"},
    {nullptr, "return;"},
    {"#", nullptr},
};
// One place as the shader injection asks for, and more than a short source can fill.
constexpr int32_t POINT_COUNTS[] = {1, 2, 5, 64};
constexpr uint8_t GUARD = 0xA5;
constexpr size_t GUARD_BYTES = 64;

size_t Length(const char* text) { return text != nullptr ? std::strlen(text) : 0; }

// The rewriter's trace goes to an in-memory file during each rewrite and is read back; the
// process's own standard output is put back in between.
class TraceCapture {
public:
    TraceCapture() : m_file(memfd_create("glsl-trace", 0)), m_saved(dup(STDOUT_FILENO)) {
        Check(m_file >= 0 && m_saved >= 0);
    }

    void Begin() {
        std::fflush(stdout);
        Check(ftruncate(m_file, 0) == 0 && lseek(m_file, 0, SEEK_SET) == 0);
        Check(dup2(m_file, STDOUT_FILENO) == STDOUT_FILENO);
    }

    void End(std::vector<char>* trace) {
        std::fflush(stdout);
        Check(dup2(m_saved, STDOUT_FILENO) == STDOUT_FILENO);
        const off_t size = lseek(m_file, 0, SEEK_CUR);
        trace->resize(static_cast<size_t>(size));
        Check(pread(m_file, trace->data(), trace->size(), 0) == size);
    }

private:
    int m_file;
    int m_saved;
};

// Reads "LABEL'c': N\n" at *at, where c is any byte; checks that c is source[N].
bool ReadPlace(const std::vector<char>& trace, size_t* at, const char* label, const uint8_t* source,
               size_t size, int32_t* place) {
    const size_t label_length = std::strlen(label);
    if (trace.size() - *at < label_length || std::memcmp(&trace[*at], label, label_length) != 0) {
        return false;
    }
    size_t i = *at + label_length;
    Check(i + 4 < trace.size() && trace[i + 1] == '\'' && trace[i + 2] == ':' &&
          trace[i + 3] == ' ');
    const char shown = trace[i];
    int64_t value = 0;
    for (i += 4; i < trace.size() && trace[i] >= '0' && trace[i] <= '9'; ++i) {
        value = value * 10 + (trace[i] - '0');
        Check(value < static_cast<int64_t>(size));
    }
    Check(i < trace.size() && trace[i] == '\n' && i > *at + label_length + 4);
    Check(static_cast<uint8_t>(shown) == source[value]);
    *place = static_cast<int32_t>(value);
    *at = i + 1;
    return true;
}

bool StartsWordOrDirective(uint8_t c) {
    return c == '#' || c == '_' || (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') ||
           (c >= 'a' && c <= 'z') || c >= 0xC0;
}

// The token at `place` is a `return` or a closing brace, or the one just before it when that
// token's first character had been given back.
void CheckPostPlace(const uint8_t* source, size_t size, int32_t place) {
    auto holds = [&](int32_t at, const char* text) {
        return at >= 0 && static_cast<size_t>(at) + std::strlen(text) <= size &&
               std::memcmp(source + at, text, std::strlen(text)) == 0;
    };
    Check(holds(place, "return") || holds(place, "}") || holds(place - 1, "return") ||
          holds(place - 1, "}"));
}

// Removes the strings at the traced places from out and compares what is left with the
// source up to its first NUL.
void CheckSplice(const uint8_t* source, size_t size, const StringPair& strings, int32_t first,
                 const std::vector<int32_t>& places, const std::vector<uint8_t>& out) {
    size_t o = 0;
    size_t j = 0;
    auto skip = [&](const char* text) {
        const size_t length = Length(text);
        Check(o + length <= out.size() && (length == 0 || std::memcmp(&out[o], text, length) == 0));
        o += length;
    };
    for (size_t i = 0; i < size; ++i) {
        if (static_cast<int32_t>(i) == first && strings.m_pre != nullptr) {
            skip(strings.m_pre);
        } else if (j < places.size() && static_cast<int32_t>(i) == places[j]) {
            skip(strings.m_post);
            j += 1;
        }
        if (source[i] == 0) break;
        Check(o < out.size() && out[o] == source[i]);
        o += 1;
    }
    Check(o < out.size() && out[o] == 0);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    static TraceCapture capture;
    if (size > INT32_MAX) return 0;
    // They end at a line's end, or where the source does.
    const int32_t kept =
        ovo::LeadingDirectivesLength(reinterpret_cast<const char*>(data), static_cast<int32_t>(size));
    Check(kept >= 0 && static_cast<size_t>(kept) <= size);
    Check(kept == 0 || static_cast<size_t>(kept) == size || data[kept] == 0 ||
          data[kept - 1] == '\n' || data[kept - 1] == '\r');
    const uint8_t last = size > 0 ? data[size - 1] : 0;
    const int32_t max_points = POINT_COUNTS[(last >> 4) & 3];
    const StringPair& strings = STRING_PAIRS[last >> 6];
    const size_t room = size + Length(strings.m_pre) + max_points * Length(strings.m_post) + 1;
    std::vector<uint8_t> out(room + GUARD_BYTES, GUARD);
    std::vector<char> trace;

    capture.Begin();
    int result;
    {
        ovo::GlslRewriter rewriter;
        rewriter.SetPreString(strings.m_pre);
        rewriter.SetPostString(strings.m_post);
        result = rewriter.Rewrite(reinterpret_cast<char*>(out.data()),
                                  reinterpret_cast<const char*>(data), static_cast<int32_t>(size),
                                  max_points);
    }
    capture.End(&trace);

    for (size_t i = room; i < out.size(); ++i) Check(out[i] == GUARD);
    const char* first_label = "First Character '";
    auto found = std::search(trace.begin(), trace.end(), first_label,
                             first_label + std::strlen(first_label));
    if (result == 0) {
        Check(found == trace.end());
        for (uint8_t byte : out) Check(byte == GUARD);
        return 0;
    }
    Check(result == 1);
    size_t at = static_cast<size_t>(found - trace.begin());
    int32_t first = -1;
    Check(ReadPlace(trace, &at, first_label, data, size, &first));
    Check(StartsWordOrDirective(data[first]) ||
          (first > 0 && StartsWordOrDirective(data[first - 1])));
    std::vector<int32_t> places;
    int32_t place = -1;
    while (ReadPlace(trace, &at, "Last Character '", data, size, &place)) {
        Check(places.empty() || place > places.back());
        CheckPostPlace(data, size, place);
        places.push_back(place);
    }
    Check(at == trace.size() && !places.empty() &&
          places.size() <= static_cast<size_t>(max_points));
    CheckSplice(data, size, strings, first, places, out);
    return 0;
}
