#ifndef OVO_EXAMPLES_LIFECYCLE_SCENARIOS_H
#define OVO_EXAMPLES_LIFECYCLE_SCENARIOS_H

#include "common/sample_runner.h"

// What Android does to a game's EGL objects, each between the game's first frames and its
// last ones (see RunSample). The game keeps its GL objects unless a scenario says it
// rebuilds them; every step is checked, and every drawing stage ends with a GL error check.
namespace ovo_sample {

struct Scenario {
    const char* m_name;
    SampleLife m_run;
    const char* m_help;
};

// The player leaves and returns, three times: nothing current, the window surface (a
// pbuffer here) destroyed; a new one of the same size made current with the same context,
// and frames drawn on it. The frames after the third return are the last frames, so that
// with one frame the last frame is the first on the new surface.
bool LeaveAndReturn(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                    SampleArgs* args);

// The device turns: the player leaves, the new surface has width and height exchanged, and
// the game lays itself out again for it (its objects rebuilt at the new size, same context).
bool Turn(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
          SampleArgs* args);

// The context is lost fifty times: the game deletes its objects, destroys the context,
// makes a new one current on the same surface, rebuilds its objects and draws a frame.
bool RenewContexts(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                   SampleArgs* args);

// EGL is shut down and started again, twice: the game deletes its objects, makes nothing
// current and calls eglTerminate (its surface and context go with the display), then
// initialises the display again, makes a new surface and context and draws.
bool Reinitialize(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                  SampleArgs* args);

// `args` drawing one frame at a time, whatever the command line asked for.
SampleArgs OneFrame(const SampleArgs& args);

// Takes `--scenario NAME` out of the command line (argv keeps the rest, in order): NAME
// is one of the four above or `extra` (a scenario of this sample's own; may be null).
// False after printing what is wrong and the names.
bool TakeScenario(const SampleInfo& info, const Scenario* extra, int* argc, char** argv,
                  SampleLife* life);

}  // namespace ovo_sample

#endif
