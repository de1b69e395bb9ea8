#ifndef OVO_EXAMPLES_COMMON_SAMPLE_RUNNER_H
#define OVO_EXAMPLES_COMMON_SAMPLE_RUNNER_H

#include <cstdint>

#include "common/sample_scene.h"

namespace ovo_sample {

// Landscape, as a phone game runs.
constexpr int32_t SAMPLE_WIDTH = 320;
constexpr int32_t SAMPLE_HEIGHT = 240;

struct SampleInfo {
    const char* m_program;
    int32_t m_client_version;
};

// The whole program: parses the command line, sets up EGL, draws and swaps the frames,
// writes the last one as a PNG and tears everything down. Answers main's exit status.
int RunSample(const SampleInfo& info, SampleScene* scene, int argc, char** argv);

}  // namespace ovo_sample

#endif
