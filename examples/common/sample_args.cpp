#include "common/sample_args.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace ovo_sample {

namespace {

// Enough to watch an animation go by; the frame index is all that moves the scene.
constexpr long SAMPLE_MAX_FRAMES = 10000;

bool ParseFrames(const char* text, int32_t* frames) {
    char* end = nullptr;
    const long value = std::strtol(text, &end, 10);
    if (end == text || *end != '\0' || value < 1 || value > SAMPLE_MAX_FRAMES) return false;
    *frames = static_cast<int32_t>(value);
    return true;
}

}  // namespace

bool ParseSampleArgs(const char* program, int argc, char** argv, SampleArgs* args) {
    bool valid = true;
    for (int i = 1; i < argc && valid; ++i) {
        if (std::strcmp(argv[i], "--frames") == 0) {
            valid = i + 1 < argc && ParseFrames(argv[i + 1], &args->m_frames);
            ++i;
        } else if (argv[i][0] != '-' && args->m_output == nullptr) {
            args->m_output = argv[i];
        } else {
            valid = false;
        }
    }
    if (valid && args->m_output != nullptr) return true;
    std::fprintf(stderr, "usage: %s OUTPUT.png [--frames N]   (N: 1 to %ld, default %d)\n",
                 program, SAMPLE_MAX_FRAMES, SAMPLE_DEFAULT_FRAMES);
    return false;
}

}  // namespace ovo_sample
