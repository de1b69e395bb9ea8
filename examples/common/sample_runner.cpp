#include "common/sample_runner.h"

#include <cstdio>
#include <ctime>
#include <vector>

#include "common/frame_capture.h"
#include "common/pbuffer_context.h"
#include "common/png_writer.h"

namespace ovo_sample {

namespace {

bool EnoughProcessorTime(double seconds) {
    return static_cast<double>(std::clock()) >= seconds * CLOCKS_PER_SEC;
}

}  // namespace

bool DrawFrames(const char* program, const SampleArgs& args, SampleScene* scene,
                PbufferContext* context, std::vector<uint8_t>* last_frame) {
    const PixelSize size = args.m_size;
    for (int32_t frame = 0;; ++frame) {
        scene->DrawFrame(frame);
        const bool last = frame + 1 >= args.m_frames && EnoughProcessorTime(args.m_cpu_seconds);
        if (last && last_frame != nullptr) *last_frame = ReadFrame(size.m_width, size.m_height);
        if (!context->SwapBuffers()) return false;
        if (last) break;
    }
    const uint32_t error = TakeGlError();
    if (error != 0) {
        std::fprintf(stderr, "%s: GL error 0x%04X\n", program, error);
        return false;
    }
    return true;
}

bool WriteFrame(const char* program, const SampleArgs& args, const std::vector<uint8_t>& pixels) {
    if (!WritePng(args.m_output, args.m_size.m_width, args.m_size.m_height, pixels.data())) {
        std::fprintf(stderr, "%s: cannot write %s\n", program, args.m_output);
        return false;
    }
    std::printf("%s: wrote %s\n", program, args.m_output);
    return true;
}

int RunSample(const SampleInfo& info, SampleScene* scene, int argc, char** argv) {
    SampleArgs args;
    if (!ParseSampleArgs(info, argc, argv, &args)) return SAMPLE_EXIT_USAGE;
    return RunSample(info, args, scene);
}

int RunSample(const SampleInfo& info, const SampleArgs& start_args, SampleScene* scene,
              SampleLife life) {
    SampleArgs args = start_args;
    const PixelSize size = args.m_size;
    // A converter that interleaves the eyes asks every config for a stencil buffer, and on
    // Mesa those configs hold 24 bits of depth instead of 16: one eye of the pair is rendered
    // on such a config too, so that depth ties (a crate standing on the floor) break alike.
    const EGLint stencil_bits = args.m_reference.HasEye() ? 1 : 0;
    PbufferContext context;
    if (!context.Create(info.m_program, info.m_client_version, stencil_bits, size.m_width,
                        size.m_height)) {
        context.Destroy();
        return SAMPLE_EXIT_FAILED;
    }
    if (!scene->Init(info.m_program, args.m_game_size.m_width, args.m_game_size.m_height)) {
        scene->Release();
        context.Destroy();
        return SAMPLE_EXIT_FAILED;
    }
    std::vector<uint8_t> pixels;
    bool ok = life == nullptr || (DrawFrames(info.m_program, args, scene, &context, nullptr) &&
                                  life(info, &context, scene, &args));
    ok = ok && DrawFrames(info.m_program, args, scene, &context, &pixels);
    scene->Release();
    ok = context.Destroy() && ok;
    if (!ok || !WriteFrame(info.m_program, args, pixels)) return SAMPLE_EXIT_FAILED;
    return 0;
}

}  // namespace ovo_sample
