#include "common/sample_args.h"

#include <cctype>
#include <cerrno>
#include <cmath>
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
// Keeps eye distance times depth plane within an int when the sprite shift truncates it.
constexpr float SAMPLE_MAX_EYE_PARAMETER = 10000.0f;

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

// A float with |value| <= limit at *cursor; moves the cursor past it.
bool ParseFloat(const char** cursor, float limit, float* value) {
    char* end = nullptr;
    const float parsed = std::strtof(*cursor, &end);
    if (end == *cursor || std::isspace(static_cast<unsigned char>(**cursor)) ||
        !(std::fabs(parsed) <= limit)) {
        return false;
    }
    *cursor = end;
    *value = parsed;
    return true;
}

bool ParseWholeFloat(const char* text, float* value) {
    return ParseFloat(&text, SAMPLE_MAX_EYE_PARAMETER, value) && *text == '\0';
}

// "A,B", both above zero.
bool ParsePositivePair(const char* text, float* first, float* second) {
    float a = 0.0f;
    float b = 0.0f;
    if (!ParseFloat(&text, SAMPLE_MAX_SIDE, &a) || *text++ != ',') return false;
    if (!ParseFloat(&text, SAMPLE_MAX_SIDE, &b) || *text != '\0') return false;
    if (!(a > 0.0f && b > 0.0f)) return false;
    *first = a;
    *second = b;
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

bool ParseFrames(const char* text, SampleArgs* args) {
    long frames = 0;
    if (!ParseDecimal(&text, 1, SAMPLE_MAX_FRAMES, &frames) || *text != '\0') return false;
    args->m_frames = static_cast<int32_t>(frames);
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

bool ParseEye(const char* text, SampleArgs* args) {
    if (std::strcmp(text, "0") != 0 && std::strcmp(text, "1") != 0) return false;
    args->m_reference.m_eye = text[0] - '0';
    return true;
}

bool ParseEyeDistance(const char* text, SampleArgs* args) {
    return ParseWholeFloat(text, &args->m_reference.m_eye_distance);
}

bool ParseEyeAngle(const char* text, SampleArgs* args) {
    return ParseWholeFloat(text, &args->m_reference.m_eye_angle);
}

bool ParseEyeShift(const char* text, SampleArgs* args) {
    return ParseWholeFloat(text, &args->m_reference.m_eye_shift);
}

bool ParseTexturePass(const char* text, SampleArgs* args) {
    const bool per_eye = std::strcmp(text, "per-eye") == 0;
    if (!per_eye && std::strcmp(text, "once") != 0) return false;
    args->m_reference.m_texture_pass_per_eye = per_eye;
    return true;
}

bool ParseHud(const char* text, SampleArgs* args) {
    const bool left_out = std::strcmp(text, "left-out") == 0;
    if (!left_out && std::strcmp(text, "drawn") != 0) return false;
    args->m_reference.m_hud_left_out = left_out;
    return true;
}

bool ParseOverlay(const char* text, SampleArgs* args) {
    ReferenceOptions& reference = args->m_reference;
    reference.m_overlay =
        ParsePositivePair(text, &reference.m_overlay_width, &reference.m_overlay_height);
    return reference.m_overlay;
}

bool ParseViewportScale(const char* text, SampleArgs* args) {
    ReferenceOptions& reference = args->m_reference;
    reference.m_viewport_scaled =
        ParsePositivePair(text, &reference.m_scale_x, &reference.m_scale_y);
    return reference.m_viewport_scaled;
}

// How an option goes with --eye.
enum class EyeRule { ANY, NEEDS_EYE, WITHOUT_EYE };

struct SampleOption {
    const char* m_name;
    const char* m_value;
    const char* m_help;
    bool (*m_parse)(const char* text, SampleArgs* args);
    uint32_t m_offered_by;  // REFERENCE_OPTION_... flag; 0: every sample
    EyeRule m_eye_rule;
};

const SampleOption SAMPLE_OPTIONS[] = {
    {"--frames", "N", "frames to draw, 1 to 10000 (default 3)", ParseFrames, 0, EyeRule::ANY},
    {"--size", "WxH", "pbuffer size, sides 1 to 8192 (default 320x240)", ParseSize, 0,
     EyeRule::ANY},
    {"--game-size", "WxH", "size the game renders at (default: --size)", ParseGameSize, 0,
     EyeRule::ANY},
    {"--cpu-seconds", "S", "draw until S seconds of processor time are used, then at least "
     "--frames frames", ParseCpuSeconds, 0, EyeRule::ANY},
    {"--eye", "0|1", "render this eye of the stereo pair", ParseEye, REFERENCE_OPTION_EYE,
     EyeRule::ANY},
    {"--eye-distance", "D", "eye offset of perspective draws (default 0)", ParseEyeDistance,
     REFERENCE_OPTION_EYE, EyeRule::NEEDS_EYE},
    {"--eye-angle", "A", "image offset of perspective draws (default 0)", ParseEyeAngle,
     REFERENCE_OPTION_EYE, EyeRule::NEEDS_EYE},
    {"--eye-shift", "S", "shift of flat draws (default 0)", ParseEyeShift, REFERENCE_OPTION_EYE,
     EyeRule::NEEDS_EYE},
    {"--texture-pass", "once|per-eye", "draws into the game's framebuffers: once (default) "
     "or per eye", ParseTexturePass, REFERENCE_OPTION_TEXTURE_PASS, EyeRule::NEEDS_EYE},
    {"--overlay-reference", "W,H", "HUD through a texture, composed into two W x H halves",
     ParseOverlay, REFERENCE_OPTION_OVERLAY, EyeRule::NEEDS_EYE},
    {"--hud", "drawn|left-out", "the HUD's draws: drawn (default) or left out", ParseHud,
     REFERENCE_OPTION_HUD, EyeRule::ANY},
    {"--viewport-scale", "SX,SY", "scale the viewports the game sets for its window",
     ParseViewportScale, REFERENCE_OPTION_VIEWPORT_SCALE, EyeRule::WITHOUT_EYE},
};

const SampleOption* FindOption(const SampleInfo& info, const char* name) {
    for (const SampleOption& option : SAMPLE_OPTIONS) {
        const bool offered = (option.m_offered_by & ~info.m_reference_options) == 0;
        if (offered && std::strcmp(name, option.m_name) == 0) return &option;
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
        if ((option.m_offered_by & ~info.m_reference_options) != 0) continue;
        char syntax[64];
        std::snprintf(syntax, sizeof(syntax), "%s %s", option.m_name, option.m_value);
        std::fprintf(stderr, "  %-28s %s\n", syntax, option.m_help);
    }
    return false;
}

}  // namespace

bool ParseSampleArgs(const SampleInfo& info, int argc, char** argv, SampleArgs* args) {
    bool game_size_given = false;
    const SampleOption* needs_eye = nullptr;
    const SampleOption* without_eye = nullptr;
    for (int i = 1; i < argc; ++i) {
        const char* word = argv[i];
        if (word[0] != '-') {
            if (args->m_output != nullptr) return Fail(info, "a second output file '%s'", word);
            args->m_output = word;
            continue;
        }
        const SampleOption* option = FindOption(info, word);
        if (option == nullptr) return Fail(info, "unknown option '%s'", word);
        if (i + 1 == argc) return Fail(info, "no value after %s", word);
        const char* value = argv[++i];
        if (!option->m_parse(value, args)) return Fail(info, "bad value '%s' for %s", value, word);
        game_size_given = game_size_given || option->m_parse == ParseGameSize;
        if (option->m_eye_rule == EyeRule::NEEDS_EYE) needs_eye = option;
        if (option->m_eye_rule == EyeRule::WITHOUT_EYE) without_eye = option;
    }
    if (args->m_output == nullptr) return Fail(info, "no output file");
    const bool eye = args->m_reference.HasEye();
    if (needs_eye != nullptr && !eye) return Fail(info, "%s needs --eye", needs_eye->m_name);
    if (without_eye != nullptr && eye) {
        return Fail(info, "%s draws the one scaled image; it does not go with --eye",
                    without_eye->m_name);
    }
    if (!game_size_given) args->m_game_size = args->m_size;
    return true;
}

}  // namespace ovo_sample
