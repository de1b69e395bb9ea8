#ifndef OVO_EXAMPLES_COMMON_SAMPLE_ARGS_H
#define OVO_EXAMPLES_COMMON_SAMPLE_ARGS_H

#include <cstdint>

#include "common/reference_options.h"

namespace ovo_sample {

constexpr int32_t SAMPLE_DEFAULT_FRAMES = 3;
// Landscape, as a phone game runs.
constexpr int32_t SAMPLE_DEFAULT_WIDTH = 320;
constexpr int32_t SAMPLE_DEFAULT_HEIGHT = 240;

constexpr int SAMPLE_EXIT_FAILED = 1;
constexpr int SAMPLE_EXIT_USAGE = 2;

struct PixelSize {
    int32_t m_width;
    int32_t m_height;
};

struct SampleInfo {
    const char* m_program;
    int32_t m_client_version;
    // REFERENCE_OPTION_... flags: the reference renderings the sample can make.
    uint32_t m_reference_options = 0;
};

struct SampleArgs {
    const char* m_output = nullptr;
    int32_t m_frames = SAMPLE_DEFAULT_FRAMES;
    // Keep drawing until the process has used this much processor time (clock()).
    double m_cpu_seconds = 0.0;
    // The pbuffer's size.
    PixelSize m_size = {SAMPLE_DEFAULT_WIDTH, SAMPLE_DEFAULT_HEIGHT};
    // The size the game believes it renders at: its viewport, aspect and HUD layout.
    PixelSize m_game_size = {SAMPLE_DEFAULT_WIDTH, SAMPLE_DEFAULT_HEIGHT};
    ReferenceOptions m_reference;
};

// `PROGRAM OUTPUT.png [--frames N] [--size WxH] [--game-size WxH] [--cpu-seconds S]` and
// the reference options that `info` offers; the game size follows --size unless given. On a
// bad command line prints what is wrong and the usage, and answers false.
bool ParseSampleArgs(const SampleInfo& info, int argc, char** argv, SampleArgs* args);

}  // namespace ovo_sample

#endif
