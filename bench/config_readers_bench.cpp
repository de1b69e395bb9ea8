// The readers of the device's configuration files against the size of their input. The
// debug configuration is read as the manager reads it while eglGetDisplay builds it, in
// the shapes that make one element's lists long and in shapes that do not; the
// complexity fit over sizes from 64 KiB to 4 MiB says how the time grows with the size.
// The live-tuning file is read as each poll at eglSwapBuffers reads it, up to 100 MiB.
#include <benchmark/benchmark.h>

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>

#include "config/debug_config.h"
#include "config/stereo_profile.h"
#include "present/live_tuning.h"

namespace {

std::string DevicePath(const char* device_path) { return std::string(OVO_BENCH_CONFIG_ROOT) + device_path; }

// A file made to a size: `head`, then `unit` as often as it fits, then spaces and `tail`.
struct FileShape {
    const char* m_name;
    const char* m_head;
    const char* m_unit;
    const char* m_tail;
};

void WriteFile(const char* device_path, const FileShape& shape, size_t size) {
    const std::filesystem::path path = DevicePath(device_path);
    std::filesystem::create_directories(path.parent_path());
    const std::string unit = shape.m_unit, tail = shape.m_tail;
    std::string text = shape.m_head;
    text.reserve(size);
    while (text.size() + unit.size() + tail.size() <= size) text += unit;
    text.append(size - text.size() - tail.size(), ' ');
    std::ofstream(path, std::ios::binary | std::ios::trunc) << text << tail;
}

// Well-formed configurations whose root element holds one shape, repeated.
const FileShape CONFIGURATION_SHAPES[] = {
    {"children", "<duoscope version=\"1.0\">", "<a/>", "</duoscope>"},
    {"attributes", "<duoscope version=\"1.0\" ", "a=\"\" ", "/>"},
    {"top_level", "<duoscope version=\"1.0\"/>", "<a/>", ""},
    {"nested", "<duoscope version=\"1.0\">", "<d><e x=\"1\">text</e></d>", "</duoscope>"},
    {"comments", "<duoscope version=\"1.0\">", "<!-- a comment --> some text ", "</duoscope>"},
};

void ReadDebugConfiguration(benchmark::State& state, const FileShape& shape) {
    WriteFile(ovo::DEBUG_CONFIG_PATH, shape, static_cast<size_t>(state.range(0)));
    for (auto _ : state) {
        ovo::DebugConfig config;
        benchmark::DoNotOptimize(config.m_log);
    }
    state.SetComplexityN(state.range(0));
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations()) * state.range(0));
    std::filesystem::remove(DevicePath(ovo::DEBUG_CONFIG_PATH));
}

// Live-tuning files: the five numbers and then anything, white space before the numbers,
// or one long number before the other four.
const FileShape LIVE_TUNING_SHAPES[] = {
    {"numbers_first", "0.02 1.5 0 1 0\n", "#", ""},
    {"space_first", "", " ", "0.02 1.5 0 1 0\n"},
    {"long_number", "0.0", "0", "2 1.5 0 1 0\n"},
};

void PollLiveTuning(benchmark::State& state, const FileShape& shape) {
    WriteFile(ovo::LIVE_TUNING_PATH, shape, static_cast<size_t>(state.range(0)));
    ovo::StereoProfile profile;
    for (auto _ : state) {
        ovo::ReadLiveTuning(profile);
        benchmark::DoNotOptimize(profile.m_eye_distance);
    }
    state.SetComplexityN(state.range(0));
    std::filesystem::remove(DevicePath(ovo::LIVE_TUNING_PATH));
}

}  // namespace

int main(int argc, char** argv) {
    for (const FileShape& shape : CONFIGURATION_SHAPES) {
        benchmark::RegisterBenchmark((std::string("DebugConfiguration/") + shape.m_name).c_str(),
                                     ReadDebugConfiguration, shape)
            ->RangeMultiplier(4)
            ->Range(64 << 10, 4 << 20)
            ->Unit(benchmark::kMillisecond)
            ->Complexity();
    }
    for (const FileShape& shape : LIVE_TUNING_SHAPES) {
        benchmark::RegisterBenchmark((std::string("LiveTuningPoll/") + shape.m_name).c_str(), PollLiveTuning,
                                     shape)
            ->Arg(1 << 10)
            ->Arg(1 << 20)
            ->Arg(100 << 20)
            ->Unit(benchmark::kMicrosecond)
            ->Complexity();
    }
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
