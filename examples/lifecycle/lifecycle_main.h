#ifndef OVO_EXAMPLES_LIFECYCLE_LIFECYCLE_MAIN_H
#define OVO_EXAMPLES_LIFECYCLE_LIFECYCLE_MAIN_H

#include <cstdint>

#include "common/sample_runner.h"
#include "lifecycle/loading_scenario.h"
#include "lifecycle/scenarios.h"

namespace ovo_sample {

// The loading scenario for a scene of type Scene: each loaded texture goes to
// (scene->*USE_TEXTURE)(texture).
template <typename Scene, void (Scene::*USE_TEXTURE)(uint32_t)>
bool LoadIntoScene(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                   SampleArgs* args) {
    return LoadWhileDrawing(info, context, scene, args, [](SampleScene* own, uint32_t texture) {
        (static_cast<Scene*>(own)->*USE_TEXTURE)(texture);
    });
}

// A lifecycle program's whole main: `--scenario NAME` and the sample options, then the
// scene that `make_scene(args)` answers through that scenario. Answers main's exit status.
template <typename Scene, void (Scene::*USE_TEXTURE)(uint32_t), typename MakeScene>
int RunLifecycleSample(const SampleInfo& info, int argc, char** argv, MakeScene make_scene) {
    static constexpr Scenario LOADING = {
        "load-while-drawing", LoadIntoScene<Scene, USE_TEXTURE>,
        "a loading thread with a shared context uploads textures while the game draws"};
    SampleLife life = nullptr;
    SampleArgs args;
    if (!TakeScenario(info, &LOADING, &argc, argv, &life) ||
        !ParseSampleArgs(info, argc, argv, &args)) {
        return SAMPLE_EXIT_USAGE;
    }
    Scene scene = make_scene(args);
    return RunSample(info, args, &scene, life);
}

}  // namespace ovo_sample

#endif
