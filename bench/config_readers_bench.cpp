// The readers of the device's configuration files against the size of their input. The
// debug configuration is read as the manager reads it while eglGetDisplay builds it, in
// the shapes that make one element's lists long and in shapes that do not; the
// complexity fit over sizes from 64 KiB to 4 MiB says how the time grows with the size.
#include <benchmark/benchmark.h>

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>

#include "config/debug_config.h"

namespace {

std::string DevicePath(const char* device_path) { return std::string(OVO_BENCH_CONFIG_ROOT) + device_path; }

// Writes `size` bytes at `device_path`: `head`, then `unit` as often as it fits, then
// `tail`, padded with spaces.
void WriteFile(const char* device_path, const std::string& head, const std::string& unit,
               const std::string& tail, size_t size) {
    const std::filesystem::path path = DevicePath(device_path);
    std::filesystem::create_directories(path.parent_path());
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    file << head;
    size_t written = head.size() + tail.size();
    for (; written + unit.size() <= size; written += unit.size()) file << unit;
    file << std::string(size - written, ' ') << tail;
}

// A well-formed configuration whose root element holds one shape, repeated.
struct ConfigurationShape {
    const char* m_name;
    const char* m_head;
    const char* m_unit;
    const char* m_tail;
};

const ConfigurationShape SHAPES[] = {
    {"children", "<duoscope version=\"1.0\">", "<a/>", "</duoscope>"},
    {"attributes", "<duoscope version=\"1.0\" ", "a=\"\" ", "/>"},
    {"top_level", "<duoscope version=\"1.0\"/>", "<a/>", ""},
    {"nested", "<duoscope version=\"1.0\">", "<d><e x=\"1\">text</e></d>", "</duoscope>"},
    {"comments", "<duoscope version=\"1.0\">", "<!-- a comment --> some text ", "</duoscope>"},
};

void ReadDebugConfiguration(benchmark::State& state, const ConfigurationShape& shape) {
    const size_t size = static_cast<size_t>(state.range(0));
    WriteFile(ovo::DEBUG_CONFIG_PATH, shape.m_head, shape.m_unit, shape.m_tail, size);
    for (auto _ : state) {
        ovo::DebugConfig config;
        benchmark::DoNotOptimize(config.m_log);
    }
    state.SetComplexityN(state.range(0));
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations()) * state.range(0));
    std::filesystem::remove(DevicePath(ovo::DEBUG_CONFIG_PATH));
}

}  // namespace

int main(int argc, char** argv) {
    for (const ConfigurationShape& shape : SHAPES) {
        benchmark::RegisterBenchmark((std::string("DebugConfiguration/") + shape.m_name).c_str(),
                                     ReadDebugConfiguration, shape)
            ->RangeMultiplier(4)
            ->Range(64 << 10, 4 << 20)
            ->Unit(benchmark::kMillisecond)
            ->Complexity();
    }
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
