// What the OpenGL ES 1.x stereo draw path costs. Each of the three ES 1.x layers on the
// recording vendor in its do-nothing mode: glDrawArrays through the library's export
// against the vendor's glDrawArrays called directly, the difference being the library's own
// processor time per application draw (a pair of vendor draws for the stereo layers). And
// the OpenGL ES 1.1 sample scene at 800x480 on Mesa through the library, flat and
// interleaved in stereo, swapping every frame so that the column mask is drawn as in a game.
// Every part runs in a process of its own; a summary of all of them follows at the end.
#include <benchmark/benchmark.h>

#include <cstdio>
#include <string>
#include <vector>

#include "bench_figures.h"
#include "layer_draw_part.h"
#include "part_process.h"
#include "scene_frame_part.h"

namespace {

// One of the listed sprite games: under its name a shader-conversion profile gives the
// sprite layer.
constexpr char SPRITE_GAME_PROCESS[] = "com.rovio.angrybirds";

const LayerCase LAYER_CASES[] = {
    // A 3D game: the eye projection is moved twice per eye.
    {"shader", nullptr, OVO_BENCH_PROFILE_INTERLEAVE, "Es1StereoLayer", true, {2, 4, false}},
    // A 2D game: the sprite plane is shifted once per eye.
    {"sprite", SPRITE_GAME_PROCESS, OVO_BENCH_PROFILE_INTERLEAVE, "Es1SpriteStereoLayer", false,
     {2, 2, true}},
    // A 3D game drawn once, its viewport scaled.
    {"plain", nullptr, OVO_BENCH_PROFILE_PLAIN, "Es1ScaledLayer", true, {1, 0, false}},
};

const SceneCase SCENE_CASES[] = {
    {"scene/flat", nullptr},
    {"scene/stereo", OVO_BENCH_PROFILE_INTERLEAVE},
};

constexpr double BAR_ADDED_NS = 500.0;
constexpr double BAR_FRAME_RATIO = 2.0;

bool RegisterPart(const std::string& part) {
    for (const LayerCase& layer_case : LAYER_CASES) {
        if (part == layer_case.m_name) return RegisterLayerBenchmarks(layer_case);
    }
    for (const SceneCase& scene_case : SCENE_CASES) {
        if (part == scene_case.m_name) return RegisterSceneBenchmark(scene_case);
    }
    std::fprintf(stderr, "stereo_draw_bench: no part named %s\n", part.c_str());
    return false;
}

int RunPartHere(const PartFlags& flags, int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    if (!RegisterPart(flags.m_part)) return 1;
    FigureReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    benchmark::Shutdown();
    return ReportFigures(flags, reporter.Figures()) ? 0 : 1;
}

const BenchFigure* Find(const BenchFigureTable& figures, const std::string& name) {
    const auto found = figures.find(name);
    return found != figures.end() ? &found->second : nullptr;
}

const char* BarVerdict(bool met) { return met ? "met" : "NOT met"; }

void PrintLayerSummary(const BenchFigureTable& figures) {
    std::printf("\nAdded by the library per glDrawArrays, processor time "
                "(recording vendor doing nothing):\n");
    std::printf("%-22s %12s %14s %12s   bar <= %.0f ns\n", "layer", "direct", "through library",
                "added", BAR_ADDED_NS);
    for (const LayerCase& layer_case : LAYER_CASES) {
        const std::string name = layer_case.m_name;
        const BenchFigure* direct = Find(figures, name + "/direct");
        const BenchFigure* library = Find(figures, name + "/library");
        if (direct == nullptr || library == nullptr) {
            std::printf("%-22s not measured\n", layer_case.m_layer);
            continue;
        }
        const double added = library->m_cpu_ns - direct->m_cpu_ns;
        std::printf("%-22s %9.1f ns %12.1f ns %9.1f ns   %s\n", layer_case.m_layer,
                    direct->m_cpu_ns, library->m_cpu_ns, added,
                    BarVerdict(added <= BAR_ADDED_NS));
    }
}

void PrintSceneSummary(const BenchFigureTable& figures) {
    const BenchFigure* flat = Find(figures, SCENE_CASES[0].m_name);
    const BenchFigure* stereo = Find(figures, SCENE_CASES[1].m_name);
    std::printf("\nOpenGL ES 1.1 scene, 800x480 on Mesa through the library, "
                "real time per frame:\n");
    if (flat == nullptr || stereo == nullptr) {
        std::printf("not measured\n");
        return;
    }
    const double ratio = stereo->m_real_ns / flat->m_real_ns;
    std::printf("flat %.2f ms, stereo interleaved %.2f ms, stereo / flat %.2f   bar <= %.1f: %s\n",
                flat->m_real_ns / 1e6, stereo->m_real_ns / 1e6, ratio, BAR_FRAME_RATIO,
                BarVerdict(ratio <= BAR_FRAME_RATIO));
}

int RunAllParts(int argc, char** argv) {
    const std::vector<std::string> arguments(argv + 1, argv + argc);
    // Answers --help and turns down unknown flags before any part runs.
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    BenchFigureTable figures;
    for (const LayerCase& layer_case : LAYER_CASES) {
        const char* process_name =
            layer_case.m_process_name != nullptr ? layer_case.m_process_name : argv[0];
        if (!RunPart(process_name, layer_case.m_name, arguments, &figures)) return 1;
    }
    for (const SceneCase& scene_case : SCENE_CASES) {
        if (!RunPart(argv[0], scene_case.m_name, arguments, &figures)) return 1;
    }
    PrintLayerSummary(figures);
    PrintSceneSummary(figures);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    PartFlags flags;
    if (TakePartFlags(&argc, argv, &flags)) return RunPartHere(flags, argc, argv);
    return RunAllParts(argc, argv);
}
