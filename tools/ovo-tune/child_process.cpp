#include "child_process.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <cstring>
#include <thread>

namespace ovo_tune {

namespace {

constexpr auto CHILD_STOP_GRACE = std::chrono::seconds(3);
constexpr auto CHILD_STOP_POLL = std::chrono::milliseconds(10);
constexpr size_t COMMAND_READ_BYTES = 65536;
constexpr int EXIT_EXEC_FAILED = 127;

bool IsExecutableFile(const std::string& path) {
    struct stat status;
    return stat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode) && access(path.c_str(), X_OK) == 0;
}

// Pointers into `strings` for exec, built before fork: nothing allocates in the child.
std::vector<char*> Pointers(std::vector<std::string>& strings) {
    std::vector<char*> pointers;
    for (std::string& each : strings) pointers.push_back(&each[0]);
    pointers.push_back(nullptr);
    return pointers;
}

// Reads both descriptors until both are closed.
void ReadBoth(int output, int errors, CommandResult* result) {
    pollfd streams[2] = {{output, POLLIN, 0}, {errors, POLLIN, 0}};
    std::string* targets[2] = {&result->m_output, &result->m_errors};
    int open_streams = 2;
    while (open_streams > 0) {
        if (poll(streams, 2, -1) < 0) {
            if (errno == EINTR) continue;
            break;
        }
        for (int index = 0; index < 2; ++index) {
            if (streams[index].fd < 0 || streams[index].revents == 0) continue;
            char buffer[COMMAND_READ_BYTES];
            const ssize_t count = read(streams[index].fd, buffer, sizeof(buffer));
            if (count < 0 && errno == EINTR) continue;
            if (count <= 0) {
                streams[index].fd = -1;
                --open_streams;
            } else {
                targets[index]->append(buffer, static_cast<size_t>(count));
            }
        }
    }
}

}  // namespace

bool FindProgram(const std::string& name, std::string* path) {
    if (name.empty()) return false;
    if (name.find('/') != std::string::npos) {
        *path = name;
        return IsExecutableFile(name);
    }
    const char* search = std::getenv("PATH");
    const std::string folders = search != nullptr ? search : "/usr/local/bin:/usr/bin:/bin";
    size_t start = 0;
    while (start <= folders.size()) {
        size_t end = folders.find(':', start);
        if (end == std::string::npos) end = folders.size();
        const std::string folder = end > start ? folders.substr(start, end - start) : ".";
        const std::string candidate = folder + "/" + name;
        if (IsExecutableFile(candidate)) {
            *path = candidate;
            return true;
        }
        start = end + 1;
    }
    return false;
}

pid_t StartChild(const std::vector<std::string>& arguments, const std::vector<std::string>& environment,
                 const std::string& output_path, std::string* problem) {
    const int output = open(output_path.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
    if (output < 0) {
        *problem = "cannot open " + output_path + ": " + std::strerror(errno);
        return -1;
    }
    const int nothing = open("/dev/null", O_RDONLY | O_CLOEXEC);
    std::vector<std::string> argument_strings = arguments;
    std::vector<std::string> environment_strings = environment;
    std::vector<char*> argv = Pointers(argument_strings);
    std::vector<char*> envp = Pointers(environment_strings);
    const pid_t child = fork();
    if (child == 0) {
        // The program must not read the key script that may come on this process's input.
        if (nothing >= 0) dup2(nothing, STDIN_FILENO);
        dup2(output, STDOUT_FILENO);
        dup2(output, STDERR_FILENO);
        execve(argv[0], argv.data(), envp.data());
        _exit(EXIT_EXEC_FAILED);
    }
    const int saved = errno;
    close(output);
    if (nothing >= 0) close(nothing);
    if (child < 0) *problem = std::string("cannot start a process: ") + std::strerror(saved);
    return child;
}

std::string DescribeEnding(int wait_status) {
    if (WIFEXITED(wait_status)) return "exited with status " + std::to_string(WEXITSTATUS(wait_status));
    if (WIFSIGNALED(wait_status)) {
        const int signal_number = WTERMSIG(wait_status);
        return "was ended by signal " + std::to_string(signal_number) + " (" + strsignal(signal_number) + ")";
    }
    return "ended";
}

void StopChild(pid_t child) {
    if (child <= 0) return;
    kill(child, SIGTERM);
    const auto deadline = std::chrono::steady_clock::now() + CHILD_STOP_GRACE;
    int status = 0;
    while (waitpid(child, &status, WNOHANG) == 0) {
        if (std::chrono::steady_clock::now() > deadline) {
            kill(child, SIGKILL);
            waitpid(child, &status, 0);
            return;
        }
        std::this_thread::sleep_for(CHILD_STOP_POLL);
    }
}

bool CommandResult::Succeeded() const {
    return m_started && WIFEXITED(m_wait_status) && WEXITSTATUS(m_wait_status) == 0;
}

CommandResult RunCommand(const std::vector<std::string>& arguments) {
    CommandResult result;
    int output[2];
    int errors[2];
    if (pipe2(output, O_CLOEXEC) != 0) return result;
    if (pipe2(errors, O_CLOEXEC) != 0) {
        close(output[0]);
        close(output[1]);
        return result;
    }
    std::vector<std::string> argument_strings = arguments;
    std::vector<char*> argv = Pointers(argument_strings);
    const pid_t child = fork();
    if (child == 0) {
        const int nothing = open("/dev/null", O_RDONLY);
        if (nothing >= 0) dup2(nothing, STDIN_FILENO);
        dup2(output[1], STDOUT_FILENO);
        dup2(errors[1], STDERR_FILENO);
        execvp(argv[0], argv.data());
        _exit(EXIT_EXEC_FAILED);
    }
    close(output[1]);
    close(errors[1]);
    if (child > 0) {
        result.m_started = true;
        ReadBoth(output[0], errors[0], &result);
        waitpid(child, &result.m_wait_status, 0);
    }
    close(output[0]);
    close(errors[0]);
    return result;
}

}  // namespace ovo_tune
