#ifndef OVO_EXAMPLES_COMMON_SAMPLE_RUNNER_H
#define OVO_EXAMPLES_COMMON_SAMPLE_RUNNER_H

#include <cstdint>
#include <vector>

#include "common/pbuffer_context.h"
#include "common/sample_args.h"
#include "common/sample_scene.h"

namespace ovo_sample {

// What a game lives through between its first frames and its last ones: leaving and
// returning, turning, losing its context. It may change the surface, the context and the
// sizes in `args`; the last frames are drawn and written as it leaves them. False after
// printing what failed.
using SampleLife = bool (*)(const SampleInfo& info, PbufferContext* context,
                            SampleScene* scene, SampleArgs* args);

// The whole program: parses the command line, then runs as below. Answers main's exit
// status.
int RunSample(const SampleInfo& info, SampleScene* scene, int argc, char** argv);

// Sets up EGL at the pbuffer size, draws and swaps the frames (the scene at the game size),
// writes the last one as a PNG and tears everything down. With `life` the frames are drawn
// once before it and once after it. Answers main's exit status.
int RunSample(const SampleInfo& info, const SampleArgs& args, SampleScene* scene,
              SampleLife life = nullptr);

// Draws frames 0, 1, ... of `scene` with a swap after each, at least `args.m_frames` and
// until the processor time asked for is used. With `last_frame` the last one is read
// (args.m_size) before its swap, as a game's screenshot is: after a swap a window's back
// buffer holds nothing defined. False after printing a failed swap or a GL error.
bool DrawFrames(const char* program, const SampleArgs& args, SampleScene* scene,
                PbufferContext* context, std::vector<uint8_t>* last_frame);

// Writes the frame of `args.m_size` to `args.m_output`; false after printing why not.
bool WriteFrame(const char* program, const SampleArgs& args, const std::vector<uint8_t>& pixels);

}  // namespace ovo_sample

#endif
