#include "common/sample_runner.h"

#include <cstdio>
#include <vector>

#include "common/frame_capture.h"
#include "common/pbuffer_context.h"
#include "common/png_writer.h"
#include "common/sample_args.h"

namespace ovo_sample {

namespace {

constexpr int EXIT_FAILED = 1;
constexpr int EXIT_USAGE = 2;

// Draws every frame with a swap after each. The last frame is read before its swap, as a
// game's screenshot is: after a swap a window's back buffer holds nothing defined.
bool DrawFrames(const char* program, SampleScene* scene, PbufferContext* context,
                int32_t frames, std::vector<uint8_t>* last_frame) {
    for (int32_t frame = 0; frame < frames; ++frame) {
        scene->DrawFrame(frame);
        if (frame == frames - 1) *last_frame = ReadFrame(SAMPLE_WIDTH, SAMPLE_HEIGHT);
        if (!context->SwapBuffers()) return false;
    }
    const uint32_t error = TakeGlError();
    if (error != 0) {
        std::fprintf(stderr, "%s: GL error 0x%04X\n", program, error);
        return false;
    }
    return true;
}

}  // namespace

int RunSample(const SampleInfo& info, SampleScene* scene, int argc, char** argv) {
    SampleArgs args;
    if (!ParseSampleArgs(info.m_program, argc, argv, &args)) return EXIT_USAGE;

    PbufferContext context;
    if (!context.Create(info.m_program, info.m_client_version, SAMPLE_WIDTH, SAMPLE_HEIGHT)) {
        context.Destroy();
        return EXIT_FAILED;
    }
    if (!scene->Init(info.m_program, SAMPLE_WIDTH, SAMPLE_HEIGHT)) {
        scene->Release();
        context.Destroy();
        return EXIT_FAILED;
    }
    std::vector<uint8_t> pixels;
    bool ok = DrawFrames(info.m_program, scene, &context, args.m_frames, &pixels);
    scene->Release();
    ok = context.Destroy() && ok;
    if (!ok) return EXIT_FAILED;

    if (!WritePng(args.m_output, SAMPLE_WIDTH, SAMPLE_HEIGHT, pixels.data())) {
        std::fprintf(stderr, "%s: cannot write %s\n", info.m_program, args.m_output);
        return EXIT_FAILED;
    }
    std::printf("%s: wrote %s\n", info.m_program, args.m_output);
    return 0;
}

}  // namespace ovo_sample
