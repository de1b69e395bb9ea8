#ifndef OVO_EXAMPLES_COMMON_SAMPLE_SCENE_H
#define OVO_EXAMPLES_COMMON_SAMPLE_SCENE_H

#include <cstdint>

namespace ovo_sample {

// What a sample renders. The context is current for every call.
class SampleScene {
public:
    virtual ~SampleScene() = default;

    // Creates the GL objects; false after printing why (under the name `program`).
    virtual bool Init(const char* program, int32_t width, int32_t height) = 0;

    // Draws the whole frame number `frame` (from 0). The scene depends on nothing else, so
    // a render is the same on every run.
    virtual void DrawFrame(int32_t frame) = 0;

    // Deletes the GL objects, as a game does when it shuts down.
    virtual void Release() = 0;
};

}  // namespace ovo_sample

#endif
