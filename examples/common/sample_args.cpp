#include "common/sample_args.h"

#include <cctype>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace ovo_sample {

namespace {

// Enough to watch an animation go by; the frame index is all that moves the scene.
constexpr long SAMPLE_MAX_FRAMES = 10000;
// Far beyond any phone screen, well within what Mesa's pbuffers take.
constexpr long SAMPLE_MAX_SIDE = 8192;
constexpr double SAMPLE_MAX_CPU_SECONDS = 3600.0;

// A decimal number without sign or spaces at *cursor, within [low, high]; moves the cursor
// past it.
bool ParseDecimal(const char** cursor, long low, long high, long* value) {
    if (!std::isdigit(static_cast<unsigned char>(**cursor))) return false;
    char* end = nullptr;
    errno = 0;
    const long parsed = std::strtol(*cursor, &end, 10);
    if (errno != 0 || parsed < low || parsed > high) return false;
    *cursor = end;
    *value = parsed;
    return true;
}

bool ParseFrames(const char* text, SampleArgs* args) {
    long frames = 0;
    if (!ParseDecimal(&text, 1, SAMPLE_MAX_FRAMES, &frames) || *text != '\0') return false;
    args->m_frames = static_cast<int32_t>(frames);
    return true;
}

// "WxH".
bool ParsePixelSize(const char* text, PixelSize* size) {
    long width = 0;
    long height = 0;
    if (!ParseDecimal(&text, 1, SAMPLE_MAX_SIDE, &width) || *text++ != 'x') return false;
    if (!ParseDecimal(&text, 1, SAMPLE_MAX_SIDE, &height) || *text != '\0') return false;
    *size = {static_cast<int32_t>(width), static_cast<int32_t>(height)};
    return true;
}

bool ParseSize(const char* text, SampleArgs* args) { return ParsePixelSize(text, &args->m_size); }

bool ParseGameSize(const char* text, SampleArgs* args) {
    return ParsePixelSize(text, &args->m_game_size);
}

bool ParseCpuSeconds(const char* text, SampleArgs* args) {
    char* end = nullptr;
    const double seconds = std::strtod(text, &end);
    if (end == text || *end != '\0' || !(seconds > 0.0 && seconds <= SAMPLE_MAX_CPU_SECONDS)) {
        return false;
    }
    args->m_cpu_seconds = seconds;
    return true;
}

struct SampleOption {
    const char* m_name;
    const char* m_value;
    const char* m_help;
    bool (*m_parse)(const char* text, SampleArgs* args);
};

const SampleOption SAMPLE_OPTIONS[] = {
    {"--frames", "N", "frames to draw, 1 to 10000 (default 3)", ParseFrames},
    {"--size", "WxH", "pbuffer size, sides 1 to 8192 (default 320x240)", ParseSize},
    {"--game-size", "WxH", "size the game renders at (default: --size)", ParseGameSize},
    {"--cpu-seconds", "S", "draw until S seconds of processor time are used, then at least "
                           "--frames frames", ParseCpuSeconds},
};

const SampleOption* FindOption(const char* name) {
    for (const SampleOption& option : SAMPLE_OPTIONS) {
        if (std::strcmp(name, option.m_name) == 0) return &option;
    }
    return nullptr;
}

bool Fail(const SampleInfo& info, const char* format, ...) __attribute__((format(printf, 2, 3)));
bool Fail(const SampleInfo& info, const char* format, ...) {
    std::fprintf(stderr, "%s: ", info.m_program);
    va_list arguments;
    va_start(arguments, format);
    std::vfprintf(stderr, format, arguments);
    va_end(arguments);
    std::fprintf(stderr, "\nusage: %s OUTPUT.png [OPTION VALUE]...\n", info.m_program);
    for (const SampleOption& option : SAMPLE_OPTIONS) {
        char syntax[64];
        std::snprintf(syntax, sizeof(syntax), "%s %s", option.m_name, option.m_value);
        std::fprintf(stderr, "  %-28s %s\n", syntax, option.m_help);
    }
    return false;
}

}  // namespace

bool ParseSampleArgs(const SampleInfo& info, int argc, char** argv, SampleArgs* args) {
    bool game_size_given = false;
    for (int i = 1; i < argc; ++i) {
        const char* word = argv[i];
        if (word[0] != '-') {
            if (args->m_output != nullptr) return Fail(info, "a second output file '%s'", word);
            args->m_output = word;
            continue;
        }
        const SampleOption* option = FindOption(word);
        if (option == nullptr) return Fail(info, "unknown option '%s'", word);
        if (i + 1 == argc) return Fail(info, "no value after %s", word);
        const char* value = argv[++i];
        if (!option->m_parse(value, args)) return Fail(info, "bad value '%s' for %s", value, word);
        game_size_given = game_size_given || option->m_parse == ParseGameSize;
    }
    if (args->m_output == nullptr) return Fail(info, "no output file");
    if (!game_size_given) args->m_game_size = args->m_size;
    return true;
}

}  // namespace ovo_sample
