#ifndef OVO_EXAMPLES_LIFECYCLE_LOADING_SCENARIO_H
#define OVO_EXAMPLES_LIFECYCLE_LOADING_SCENARIO_H

#include <cstdint>

#include "lifecycle/scenarios.h"

namespace ovo_sample {

// Puts a texture made by another context into `scene`, which then owns it.
using TextureUser = void (*)(SampleScene* scene, uint32_t texture);

// A loading thread with a context shared with the game's uploads textures (TextureLoader)
// while the game's thread draws; `use` puts each into the scene as soon as it is complete.
// The last frames show the last texture.
bool LoadWhileDrawing(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                      SampleArgs* args, TextureUser use);

}  // namespace ovo_sample

#endif
