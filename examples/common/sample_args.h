#ifndef OVO_EXAMPLES_COMMON_SAMPLE_ARGS_H
#define OVO_EXAMPLES_COMMON_SAMPLE_ARGS_H

#include <cstdint>

namespace ovo_sample {

constexpr int32_t SAMPLE_DEFAULT_FRAMES = 3;

struct SampleArgs {
    const char* m_output = nullptr;
    int32_t m_frames = SAMPLE_DEFAULT_FRAMES;
};

// `PROGRAM OUTPUT.png [--frames N]`. On a bad command line prints the usage under the name
// `program` and answers false.
bool ParseSampleArgs(const char* program, int argc, char** argv, SampleArgs* args);

}  // namespace ovo_sample

#endif
