#include "tool_process.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstring>
#include <thread>

namespace {

using Clock = std::chrono::steady_clock;

int RemainingMilliseconds(Clock::time_point deadline) {
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now()).count();
    return left > 0 ? static_cast<int>(left) : 0;
}

}  // namespace

ToolProcess::~ToolProcess() {
    CloseInput();
    if (m_pid > 0) Wait(0);
    if (m_output >= 0) close(m_output);
}

bool ToolProcess::Start(const std::vector<std::string>& arguments, const std::vector<std::string>& environment,
                        const std::string& errors_path) {
    int input[2];
    int output[2];
    if (pipe2(input, O_CLOEXEC) != 0 || pipe2(output, O_CLOEXEC) != 0) return false;
    std::vector<std::string> strings = arguments;
    std::vector<char*> argv;
    for (std::string& each : strings) argv.push_back(&each[0]);
    argv.push_back(nullptr);
    std::vector<std::string> variables = environment;
    m_pid = fork();
    if (m_pid == 0) {
        for (std::string& each : variables) putenv(&each[0]);
        const int errors = open(errors_path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
        dup2(input[0], STDIN_FILENO);
        dup2(output[1], STDOUT_FILENO);
        if (errors >= 0) dup2(errors, STDERR_FILENO);
        execv(argv[0], argv.data());
        _exit(127);
    }
    close(input[0]);
    close(output[1]);
    m_input = input[1];
    m_output = output[0];
    return m_pid > 0;
}

void ToolProcess::Send(const std::string& text) {
    if (m_input >= 0 && write(m_input, text.data(), text.size()) != static_cast<ssize_t>(text.size())) CloseInput();
}

void ToolProcess::CloseInput() {
    if (m_input >= 0) close(m_input);
    m_input = -1;
}

bool ToolProcess::ReadLine(int milliseconds, std::string* line) {
    const Clock::time_point deadline = Clock::now() + std::chrono::milliseconds(milliseconds);
    while (true) {
        const size_t end = m_unread.find('\n');
        if (end != std::string::npos) {
            *line = m_unread.substr(0, end);
            m_unread.erase(0, end + 1);
            m_report += *line + "\n";
            return true;
        }
        pollfd ready = {m_output, POLLIN, 0};
        if (m_output < 0 || poll(&ready, 1, RemainingMilliseconds(deadline)) != 1) return false;
        char buffer[4096];
        const ssize_t count = read(m_output, buffer, sizeof(buffer));
        if (count <= 0) {
            close(m_output);
            m_output = -1;
            return false;
        }
        m_unread.append(buffer, static_cast<size_t>(count));
    }
}

bool ToolProcess::WaitForLine(const std::regex& pattern, int seconds, std::smatch* match, std::string* line) {
    const Clock::time_point deadline = Clock::now() + std::chrono::seconds(seconds);
    while (ReadLine(RemainingMilliseconds(deadline), line)) {
        if (std::regex_search(*line, *match, pattern)) return true;
    }
    return false;
}

int ToolProcess::Wait(int seconds) {
    std::string line;
    const Clock::time_point deadline = Clock::now() + std::chrono::seconds(seconds);
    while (ReadLine(RemainingMilliseconds(deadline), &line)) {
    }
    int status = 0;
    while (waitpid(m_pid, &status, WNOHANG) == 0) {
        if (Clock::now() > deadline) {
            kill(m_pid, SIGKILL);
            waitpid(m_pid, &status, 0);
            m_pid = -1;
            return -1;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    m_pid = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}
