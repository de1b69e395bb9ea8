#ifndef OVO_EXAMPLES_COMMON_SAMPLE_RUNNER_H
#define OVO_EXAMPLES_COMMON_SAMPLE_RUNNER_H

#include "common/sample_args.h"
#include "common/sample_scene.h"

namespace ovo_sample {

// The whole program: parses the command line, then runs as below. Answers main's exit
// status.
int RunSample(const SampleInfo& info, SampleScene* scene, int argc, char** argv);

// Sets up EGL at the pbuffer size, draws and swaps the frames (the scene at the game size),
// writes the last one as a PNG and tears everything down. Answers main's exit status.
int RunSample(const SampleInfo& info, const SampleArgs& args, SampleScene* scene);

}  // namespace ovo_sample

#endif
