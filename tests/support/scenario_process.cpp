#include "support/scenario_process.h"

#include <errno.h>
#include <sys/wait.h>
#include <unistd.h>

#include <fstream>
#include <sstream>
#include <string>
#include <vector>

namespace {

// NUL-separated strings, each one of them.
std::vector<std::string> Split(const std::string& strings) {
    std::vector<std::string> parts(1);
    for (char byte : strings) {
        if (byte == '\0') {
            parts.emplace_back();
        } else {
            parts.back() += byte;
        }
    }
    return parts;
}

// A list of C strings that execve takes, ended by a null pointer.
std::vector<char*> Pointers(std::vector<std::string>& strings) {
    std::vector<char*> pointers;
    for (std::string& each : strings) pointers.push_back(&each[0]);
    pointers.push_back(nullptr);
    return pointers;
}

}  // namespace

ScenarioResult RunScenario(const std::string& command_line, const char* test_name,
                           const std::string& environment) {
    ScenarioResult result{-1, ""};
    // Everything is built before the fork: the child only executes.
    std::vector<std::string> arguments = Split(command_line);
    std::vector<std::string> variables = environment.empty() ? std::vector<std::string>() : Split(environment);
    variables.push_back(std::string("GTEST_FILTER=") + test_name);
    variables.push_back("GTEST_ALSO_RUN_DISABLED_TESTS=1");
    variables.push_back("GTEST_BRIEF=1");
    for (char** variable = environ; *variable != nullptr; ++variable) variables.push_back(*variable);
    std::vector<char*> argument_list = Pointers(arguments);
    std::vector<char*> variable_list = Pointers(variables);
    int channel[2];
    if (pipe(channel) != 0) return result;
    pid_t child = fork();
    if (child == 0) {
        dup2(channel[1], STDOUT_FILENO);
        close(channel[0]);
        close(channel[1]);
        execve("/proc/self/exe", argument_list.data(), variable_list.data());
        _exit(127);
    }
    close(channel[1]);
    char buffer[4096];
    ssize_t length;
    while ((length = read(channel[0], buffer, sizeof(buffer))) > 0) result.m_output.append(buffer, length);
    close(channel[0]);
    int status = 0;
    if (child > 0 && waitpid(child, &status, 0) == child && WIFEXITED(status)) {
        result.m_exit_code = WEXITSTATUS(status);
    }
    return result;
}

std::string CommandLineFile() {
    std::ifstream file("/proc/self/cmdline", std::ios::binary);
    std::stringstream text;
    text << file.rdbuf();
    return text.str();
}

bool CommandLineFileFollowsRenames() {
    char& first = program_invocation_name[0];
    const char saved = first;
    first = saved == 'a' ? 'b' : 'a';
    const bool follows = CommandLineFile()[0] == first;
    first = saved;
    return follows;
}
