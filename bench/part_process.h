#ifndef OVO_BENCH_PART_PROCESS_H
#define OVO_BENCH_PART_PROCESS_H

#include <string>
#include <vector>

#include "bench_figures.h"

// The benchmark's parts run in processes of their own (the library's manager is built once
// per process, and reads the process name then): this same program, started again with the
// part's flags in front of the user's.

struct PartFlags {
    std::string m_part;
    int m_figures_fd = -1;  // where the part writes its figures
};

// Runs the part `part` in a process whose command line starts with `process_name`, passes
// `arguments` on, and adds the figures it reports to `figures`. Its output goes where this
// program's goes. False after printing why (it did not start, failed or reported nonsense).
bool RunPart(const char* process_name, const std::string& part,
             const std::vector<std::string>& arguments, BenchFigureTable* figures);

// In a part's process: takes the part's flags out of the command line; false when this
// process is not a part.
bool TakePartFlags(int* argc, char** argv, PartFlags* flags);

// In a part's process: sends the figures; false after printing why.
bool ReportFigures(const PartFlags& flags, const BenchFigureTable& figures);

#endif
