#ifndef OVO_BENCH_BENCH_FIGURES_H
#define OVO_BENCH_BENCH_FIGURES_H

#include <benchmark/benchmark.h>

#include <map>
#include <string>
#include <vector>

// What one benchmark measured, per iteration in nanoseconds, and the bytes it processed per
// second of processor time (0 when it counts none): the median of the repetitions when
// there are several, else the one run.
struct BenchFigure {
    double m_cpu_ns;
    double m_real_ns;
    double m_bytes_per_second;
};

// By benchmark name, as registered.
using BenchFigureTable = std::map<std::string, BenchFigure>;

// The console output as usual, and each benchmark's figure kept. A run that failed keeps
// no figure.
class FigureReporter : public benchmark::ConsoleReporter {
public:
    FigureReporter();

    void ReportRuns(const std::vector<Run>& runs) override;

    const BenchFigureTable& Figures() const { return m_figures; }

private:
    BenchFigureTable m_figures;
};

// One line per figure, "NAME CPU_NS REAL_NS BYTES_PER_SECOND"; names hold no spaces.
std::string FormatFigures(const BenchFigureTable& figures);

// Adds the lines of FormatFigures to `figures`; false on a malformed line.
bool ParseFigures(const std::string& text, BenchFigureTable* figures);

#endif
