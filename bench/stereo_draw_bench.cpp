// What the stereo path costs. The vertex-shader rewriter's throughput on a corpus of real
// shaders, in bytes of source per second of processor time. Each stereo layer on the
// recording vendor in its do-nothing mode: a draw call through the library's export
// against the vendor's own called directly, the difference being the library's own
// processor time per application draw (a pair of vendor draws for the stereo layers). And
// each sample scene at 800x480 on Mesa through the library, flat and interleaved in
// stereo, swapping every frame so that the column mask is drawn as in a game. Every part
// runs in a process of its own; a summary of all of them follows at the end.
#include <benchmark/benchmark.h>

#include <cstdio>
#include <string>
#include <vector>

#include "bench_figures.h"
#include "layer_draw_part.h"
#include "part_process.h"
#include "rewriter_throughput_part.h"
#include "scene_frame_part.h"

namespace {

// One of the listed sprite games: under its name a shader-conversion profile gives the
// sprite layer.
constexpr char SPRITE_GAME_PROCESS[] = "com.rovio.angrybirds";

const LayerCase LAYER_CASES[] = {
    // A 3D game: the eye projection is moved twice per eye.
    {"es1_shader", nullptr, OVO_BENCH_PROFILE_INTERLEAVE, "Es1StereoLayer",
     LAYER_GAME_ES1_PERSPECTIVE, LAYER_DRAW_ARRAYS, {2, 4, false}},
    // A 2D game: the sprite plane is shifted once per eye.
    {"es1_sprite", SPRITE_GAME_PROCESS, OVO_BENCH_PROFILE_INTERLEAVE, "Es1SpriteStereoLayer",
     LAYER_GAME_ES1_FLAT, LAYER_DRAW_ARRAYS, {2, 2, true}},
    // A 3D game drawn once, its viewport scaled.
    {"es1_plain", nullptr, OVO_BENCH_PROFILE_PLAIN, "Es1ScaledLayer", LAYER_GAME_ES1_PERSPECTIVE,
     LAYER_DRAW_ARRAYS, {1, 0, false}},
    // An OpenGL ES 2.0 game drawing into its window: the depth shift set once per eye. Its
    // glDrawArrays also reads the process name per eye, for the stock live wallpaper.
    {"es2_elements", nullptr, OVO_BENCH_PROFILE_INTERLEAVE, "Es2StereoLayer", LAYER_GAME_ES2,
     LAYER_DRAW_ELEMENTS, {2, 2, false}},
    {"es2_arrays", nullptr, OVO_BENCH_PROFILE_INTERLEAVE, "Es2StereoLayer", LAYER_GAME_ES2,
     LAYER_DRAW_ARRAYS, {2, 2, false}},
};

// A sample scene, measured flat and interleaved in stereo: parts NAME/flat and NAME/stereo.
struct SceneSample {
    const char* m_name;
    const char* m_title;
    const char* m_module;
};

const SceneSample SCENE_SAMPLES[] = {
    {"es1_scene", "OpenGL ES 1.1 scene", OVO_BENCH_ES1_SCENE_MODULE},
    {"es2_scene", "OpenGL ES 2.0 scene", OVO_BENCH_ES2_SCENE_MODULE},
};

constexpr char SCENE_FLAT[] = "/flat";
constexpr char SCENE_STEREO[] = "/stereo";

struct SceneVariant {
    const char* m_suffix;
    const char* m_profile;  // null: none
};

const SceneVariant SCENE_VARIANTS[] = {
    {SCENE_FLAT, nullptr},
    {SCENE_STEREO, OVO_BENCH_PROFILE_INTERLEAVE},
};

// The rewriter's part and its benchmark, as that part names it.
constexpr char REWRITER_PART[] = "rewriter";
constexpr char REWRITER_BENCHMARK[] = "rewriter/corpus";

constexpr double BAR_ADDED_NS = 500.0;
constexpr double BAR_FRAME_RATIO = 2.0;

bool RegisterPart(const std::string& part) {
    if (part == REWRITER_PART) return RegisterRewriterBenchmark(OVO_BENCH_SHADER_CORPUS);
    for (const LayerCase& layer_case : LAYER_CASES) {
        if (part == layer_case.m_name) return RegisterLayerBenchmarks(layer_case);
    }
    for (const SceneSample& sample : SCENE_SAMPLES) {
        for (const SceneVariant& variant : SCENE_VARIANTS) {
            if (part == std::string(sample.m_name) + variant.m_suffix) {
                return RegisterSceneBenchmark({part.c_str(), sample.m_module, variant.m_profile});
            }
        }
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

void PrintRewriterSummary(const BenchFigureTable& figures) {
    const BenchFigure* rewriter = Find(figures, REWRITER_BENCHMARK);
    std::printf("\nVertex-shader rewriter on the shaders of %s, processor time:\n",
                OVO_BENCH_SHADER_CORPUS);
    if (rewriter == nullptr) {
        std::printf("not measured\n");
        return;
    }
    std::printf("%.1f MB/s (10^6 bytes of source per second)\n",
                rewriter->m_bytes_per_second / 1e6);
}

void PrintLayerSummary(const BenchFigureTable& figures) {
    std::printf("\nAdded by the library per application draw, processor time "
                "(recording vendor doing nothing):\n");
    std::printf("%-36s %12s %16s %12s   bar <= %.0f ns\n", "layer and draw", "direct",
                "through library", "added", BAR_ADDED_NS);
    for (const LayerCase& layer_case : LAYER_CASES) {
        const std::string name = layer_case.m_name;
        const std::string label =
            std::string(layer_case.m_layer) + " " + LayerDrawCallName(layer_case.m_draw_call);
        const BenchFigure* direct = Find(figures, name + "/direct");
        const BenchFigure* library = Find(figures, name + "/library");
        if (direct == nullptr || library == nullptr) {
            std::printf("%-36s not measured\n", label.c_str());
            continue;
        }
        const double added = library->m_cpu_ns - direct->m_cpu_ns;
        std::printf("%-36s %9.1f ns %13.1f ns %9.1f ns   %s\n", label.c_str(), direct->m_cpu_ns,
                    library->m_cpu_ns, added, BarVerdict(added <= BAR_ADDED_NS));
    }
}

void PrintSceneSummary(const SceneSample& sample, const BenchFigureTable& figures) {
    const std::string name = sample.m_name;
    const BenchFigure* flat = Find(figures, name + SCENE_FLAT);
    const BenchFigure* stereo = Find(figures, name + SCENE_STEREO);
    std::printf("\n%s, 800x480 on Mesa through the library, per frame:\n", sample.m_title);
    if (flat == nullptr || stereo == nullptr) {
        std::printf("not measured\n");
        return;
    }
    const double ratio = stereo->m_real_ns / flat->m_real_ns;
    std::printf("real time: flat %.2f ms, stereo interleaved %.2f ms, stereo / flat %.2f   "
                "bar <= %.1f: %s\n",
                flat->m_real_ns / 1e6, stereo->m_real_ns / 1e6, ratio, BAR_FRAME_RATIO,
                BarVerdict(ratio <= BAR_FRAME_RATIO));
    // Less moved by other work on the machine than real time, and it counts llvmpipe's
    // threads too.
    std::printf("processor time of the process: flat %.2f ms, stereo interleaved %.2f ms, "
                "stereo / flat %.2f\n",
                flat->m_cpu_ns / 1e6, stereo->m_cpu_ns / 1e6, stereo->m_cpu_ns / flat->m_cpu_ns);
}

int RunAllParts(int argc, char** argv) {
    const std::vector<std::string> arguments(argv + 1, argv + argc);
    // Answers --help and turns down unknown flags before any part runs.
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    BenchFigureTable figures;
    if (!RunPart(argv[0], REWRITER_PART, arguments, &figures)) return 1;
    for (const LayerCase& layer_case : LAYER_CASES) {
        const char* process_name =
            layer_case.m_process_name != nullptr ? layer_case.m_process_name : argv[0];
        if (!RunPart(process_name, layer_case.m_name, arguments, &figures)) return 1;
    }
    for (const SceneSample& sample : SCENE_SAMPLES) {
        for (const SceneVariant& variant : SCENE_VARIANTS) {
            const std::string part = std::string(sample.m_name) + variant.m_suffix;
            if (!RunPart(argv[0], part, arguments, &figures)) return 1;
        }
    }
    PrintRewriterSummary(figures);
    PrintLayerSummary(figures);
    for (const SceneSample& sample : SCENE_SAMPLES) PrintSceneSummary(sample, figures);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    PartFlags flags;
    if (TakePartFlags(&argc, argv, &flags)) return RunPartHere(flags, argc, argv);
    return RunAllParts(argc, argv);
}
