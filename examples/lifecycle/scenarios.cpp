#include "lifecycle/scenarios.h"

#include <cstdio>
#include <cstring>
#include <utility>

namespace ovo_sample {

namespace {

constexpr int32_t RETURN_TIMES = 3;
// Enough for a context's objects, or the library's for it, to pile up if they leak.
constexpr int32_t CONTEXT_TIMES = 50;
constexpr int32_t TERMINATE_TIMES = 2;

const Scenario COMMON_SCENARIOS[] = {
    {"leave-and-return", LeaveAndReturn, "nothing current, a new surface, three times"},
    {"turn", Turn, "a new surface with width and height exchanged"},
    {"renew-contexts", RenewContexts, "the context destroyed and made anew, fifty times"},
    {"reinitialize", Reinitialize, "eglTerminate and eglInitialize, twice"},
};

// The surface goes while nothing is current; the new one, of `size`, is made current.
bool ReplaceSurface(PbufferContext* context, PixelSize size) {
    return context->ReleaseCurrent() && context->DestroySurface() &&
           context->CreateSurface(size.m_width, size.m_height) && context->MakeCurrent();
}

bool InitScene(const SampleInfo& info, SampleScene* scene, const SampleArgs& args) {
    return scene->Init(info.m_program, args.m_game_size.m_width, args.m_game_size.m_height);
}

void PrintScenarios(const Scenario* extra) {
    std::fprintf(stderr, "scenarios:\n");
    for (const Scenario& scenario : COMMON_SCENARIOS) {
        std::fprintf(stderr, "  %-18s %s\n", scenario.m_name, scenario.m_help);
    }
    if (extra != nullptr) std::fprintf(stderr, "  %-18s %s\n", extra->m_name, extra->m_help);
}

const Scenario* FindScenario(const Scenario* extra, const char* name) {
    for (const Scenario& scenario : COMMON_SCENARIOS) {
        if (std::strcmp(scenario.m_name, name) == 0) return &scenario;
    }
    return extra != nullptr && std::strcmp(extra->m_name, name) == 0 ? extra : nullptr;
}

}  // namespace

bool LeaveAndReturn(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                    SampleArgs* args) {
    for (int32_t time = 1; time < RETURN_TIMES; ++time) {
        if (!ReplaceSurface(context, args->m_size) ||
            !DrawFrames(info.m_program, *args, scene, context, nullptr)) {
            return false;
        }
    }
    return ReplaceSurface(context, args->m_size);
}

bool Turn(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
          SampleArgs* args) {
    std::swap(args->m_size.m_width, args->m_size.m_height);
    std::swap(args->m_game_size.m_width, args->m_game_size.m_height);
    if (!ReplaceSurface(context, args->m_size)) return false;
    scene->Release();
    return InitScene(info, scene, *args);
}

bool RenewContexts(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                   SampleArgs* args) {
    const SampleArgs one = OneFrame(*args);
    for (int32_t time = 0; time < CONTEXT_TIMES; ++time) {
        scene->Release();
        if (!context->ReleaseCurrent() || !context->DestroyContext() ||
            !context->CreateContext(EGL_NO_CONTEXT) || !context->MakeCurrent() ||
            !InitScene(info, scene, one) ||
            !DrawFrames(info.m_program, one, scene, context, nullptr)) {
            return false;
        }
    }
    return true;
}

bool Reinitialize(const SampleInfo& info, PbufferContext* context, SampleScene* scene,
                  SampleArgs* args) {
    const PixelSize size = args->m_size;
    for (int32_t time = 0; time < TERMINATE_TIMES; ++time) {
        scene->Release();
        if (!context->ReleaseCurrent() || !context->Terminate() || !context->OpenDisplay() ||
            !context->CreateSurface(size.m_width, size.m_height) ||
            !context->CreateContext(EGL_NO_CONTEXT) || !context->MakeCurrent() ||
            !InitScene(info, scene, *args) ||
            !DrawFrames(info.m_program, *args, scene, context, nullptr)) {
            return false;
        }
    }
    return true;
}

SampleArgs OneFrame(const SampleArgs& args) {
    SampleArgs one = args;
    one.m_frames = 1;
    one.m_cpu_seconds = 0.0;
    return one;
}

bool TakeScenario(const SampleInfo& info, const Scenario* extra, int* argc, char** argv,
                  SampleLife* life) {
    const char* name = nullptr;
    int kept = 0;
    for (int index = 0; index < *argc; ++index) {
        if (std::strcmp(argv[index], "--scenario") == 0 && index + 1 < *argc) {
            name = argv[++index];
        } else {
            argv[kept++] = argv[index];
        }
    }
    const Scenario* chosen = name != nullptr ? FindScenario(extra, name) : nullptr;
    if (chosen == nullptr) {
        if (name == nullptr) {
            std::fprintf(stderr, "%s: needs --scenario NAME\n", info.m_program);
        } else {
            std::fprintf(stderr, "%s: no scenario is called '%s'\n", info.m_program, name);
        }
        PrintScenarios(extra);
        return false;
    }
    *argc = kept;
    argv[kept] = nullptr;
    *life = chosen->m_run;
    return true;
}

}  // namespace ovo_sample
