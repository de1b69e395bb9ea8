#include "rewriter_throughput_part.h"

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <system_error>
#include <vector>

#include "stereo/glsl_rewriter.h"

namespace {

constexpr char REWRITER_PRE_STRING[] = "uniform vec2 uZpDepthShift;\n";
constexpr char REWRITER_POST_STRING[] =
    "gl_Position.x = gl_Position.x + (uZpDepthShift.y * min((uZpDepthShift.x * gl_Position.w) - "
    "gl_Position.z, 0.0));\n";

// Standard output goes to /dev/null while this lives; the rewriter writes its trace there.
class SilencedStdout {
public:
    SilencedStdout() : m_saved(-1) {
        std::fflush(stdout);
        const int null_file = open("/dev/null", O_WRONLY);
        if (null_file < 0) return;
        m_saved = dup(STDOUT_FILENO);
        dup2(null_file, STDOUT_FILENO);
        close(null_file);
    }
    ~SilencedStdout() {
        std::fflush(stdout);
        if (m_saved < 0) return;
        dup2(m_saved, STDOUT_FILENO);
        close(m_saved);
    }
    SilencedStdout(const SilencedStdout&) = delete;
    SilencedStdout& operator=(const SilencedStdout&) = delete;

private:
    int m_saved;
};

void RewriteCorpus(benchmark::State& state, const std::vector<std::string>& sources) {
    size_t largest = 0;
    int64_t bytes = 0;
    for (const std::string& source : sources) {
        largest = std::max(largest, source.size());
        bytes += static_cast<int64_t>(source.size());
    }
    std::vector<char> out(largest + 1 + sizeof(REWRITER_PRE_STRING) + sizeof(REWRITER_POST_STRING));
    SilencedStdout silenced;
    for (auto _ : state) {
        for (const std::string& source : sources) {
            ovo::GlslRewriter rewriter;
            rewriter.SetPreString(REWRITER_PRE_STRING);
            rewriter.SetPostString(REWRITER_POST_STRING);
            benchmark::DoNotOptimize(rewriter.Rewrite(out.data(), source.c_str(),
                                                      static_cast<int32_t>(source.size() + 1), 1));
        }
    }
    state.SetBytesProcessed(state.iterations() * bytes);
    state.counters["shaders"] = static_cast<double>(sources.size());
}

}  // namespace

bool RegisterRewriterBenchmark(const char* corpus_dir) {
    std::vector<std::string> sources;
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(corpus_dir, error)) {
        if (!entry.is_regular_file()) continue;
        std::ifstream file(entry.path(), std::ios::binary);
        if (!file) {
            std::fprintf(stderr, "rewriter/corpus: cannot read %s\n", entry.path().c_str());
            return false;
        }
        sources.emplace_back(std::istreambuf_iterator<char>(file),
                             std::istreambuf_iterator<char>());
    }
    if (error || sources.empty()) {
        std::fprintf(stderr, "rewriter/corpus: no shader sources in %s\n", corpus_dir);
        return false;
    }
    benchmark::RegisterBenchmark(
        "rewriter/corpus", [sources](benchmark::State& state) { RewriteCorpus(state, sources); });
    return true;
}
