#ifndef OVO_TESTS_SUPPORT_SCENARIO_PROCESS_H
#define OVO_TESTS_SUPPORT_SCENARIO_PROCESS_H

#include <string>

// Runs one test of this same program in a new process whose command line starts with
// `process_name` (what /proc/self/cmdline then shows as the application's name), and
// returns what that process printed on standard output. The test is usually a DISABLED_
// one, so that it runs only when asked for.
struct ScenarioResult {
    int m_exit_code;
    std::string m_output;
};

ScenarioResult RunScenario(const char* process_name, const char* test_name);

#endif
