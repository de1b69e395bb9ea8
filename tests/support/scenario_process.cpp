#include "support/scenario_process.h"

#include <sys/wait.h>
#include <unistd.h>

#include <string>

ScenarioResult RunScenario(const char* process_name, const char* test_name) {
    ScenarioResult result{-1, ""};
    int channel[2];
    if (pipe(channel) != 0) return result;
    std::string filter = std::string("--gtest_filter=") + test_name;
    pid_t child = fork();
    if (child == 0) {
        dup2(channel[1], STDOUT_FILENO);
        close(channel[0]);
        close(channel[1]);
        const char* arguments[] = {process_name, filter.c_str(), "--gtest_also_run_disabled_tests",
                                   "--gtest_brief=1", nullptr};
        execv("/proc/self/exe", const_cast<char* const*>(arguments));
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
