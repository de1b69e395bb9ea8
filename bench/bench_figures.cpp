#include "bench_figures.h"

#include <unistd.h>

#include <cstdio>
#include <sstream>

FigureReporter::FigureReporter()
    : benchmark::ConsoleReporter(isatty(STDOUT_FILENO) ? OO_ColorTabular : OO_Tabular) {}

void FigureReporter::ReportRuns(const std::vector<Run>& runs) {
    benchmark::ConsoleReporter::ReportRuns(runs);
    for (const Run& run : runs) {
        if (run.error_occurred) continue;
        const bool median = run.run_type == Run::RT_Aggregate && run.aggregate_name == "median";
        // The median comes after the repetitions it sums up, so it has the last word.
        if (run.run_type != Run::RT_Iteration && !median) continue;
        const double to_ns = 1e9 / benchmark::GetTimeUnitMultiplier(run.time_unit);
        const auto bytes = run.counters.find("bytes_per_second");
        m_figures[run.run_name.function_name] = {
            run.GetAdjustedCPUTime() * to_ns, run.GetAdjustedRealTime() * to_ns,
            bytes != run.counters.end() ? bytes->second.value : 0.0};
    }
}

std::string FormatFigures(const BenchFigureTable& figures) {
    std::string text;
    char line[256];
    for (const auto& [name, figure] : figures) {
        std::snprintf(line, sizeof(line), " %.6g %.6g %.6g\n", figure.m_cpu_ns, figure.m_real_ns,
                      figure.m_bytes_per_second);
        text += name + line;
    }
    return text;
}

bool ParseFigures(const std::string& text, BenchFigureTable* figures) {
    std::istringstream lines(text);
    std::string line;
    while (std::getline(lines, line)) {
        std::istringstream fields(line);
        std::string name;
        BenchFigure figure;
        if (!(fields >> name >> figure.m_cpu_ns >> figure.m_real_ns >> figure.m_bytes_per_second)) {
            return false;
        }
        (*figures)[name] = figure;
    }
    return true;
}
