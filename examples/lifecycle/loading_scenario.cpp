#include "lifecycle/loading_scenario.h"

#include "lifecycle/texture_loader.h"

namespace ovo_sample {

namespace {

void TakeLoaded(TextureLoader* loader, SampleScene* scene, TextureUser use) {
    uint32_t texture = 0;
    while (loader->Take(&texture)) use(scene, texture);
}

}  // namespace

bool LoadWhileDrawing(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                      SampleArgs* args, TextureUser use) {
    const SampleArgs one = OneFrame(*args);
    TextureLoader loader;
    loader.Start(*context);
    bool ok = true;
    while (ok && !loader.Done()) {
        TakeLoaded(&loader, scene, use);
        ok = DrawFrames(info.m_program, one, scene, context, nullptr);
        loader.FrameDrawn();
    }
    ok = loader.Finish() && ok;
    TakeLoaded(&loader, scene, use);
    return ok;
}

}  // namespace ovo_sample
