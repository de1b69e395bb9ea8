#ifndef OVO_TESTS_SUPPORT_SCENARIO_PROCESS_H
#define OVO_TESTS_SUPPORT_SCENARIO_PROCESS_H

#include <string>

// Runs one test of this same program in a new process whose command line is exactly
// `command_line` (its arguments separated by NULs, as /proc/self/cmdline shows them; the
// first is what the application's name is read from), and returns what that process printed
// on standard output. The test is usually a DISABLED_ one, so that it runs only when asked
// for; it is chosen through the environment, which begins with `environment` (strings
// separated by NULs) and then holds this process's own.
struct ScenarioResult {
    int m_exit_code;
    std::string m_output;
};

ScenarioResult RunScenario(const std::string& command_line, const char* test_name,
                           const std::string& environment = std::string());

// This process's /proc/self/cmdline as the file reads now.
std::string CommandLineFile();

// Whether /proc/self/cmdline follows a name written over the arguments in place. Under
// qemu-user it does not: the emulator serves its own copy of the arguments.
bool CommandLineFileFollowsRenames();

#endif
