#include "program_run.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <thread>

namespace {

constexpr auto PROGRAM_POLL_INTERVAL = std::chrono::milliseconds(20);

// Everything the child needs, built before fork: nothing allocates between fork and exec.
struct ChildSetup {
    std::vector<std::string> m_arguments;
    std::vector<std::string> m_environment;
    std::string m_working_directory;
    std::string m_output_path;

    std::vector<char*> Pointers(std::vector<std::string>& strings) const {
        std::vector<char*> pointers;
        for (std::string& each : strings) pointers.push_back(&each[0]);
        pointers.push_back(nullptr);
        return pointers;
    }
};

// This process's environment without what would change how the program finds its window
// system or libraries, with `run`'s own on top.
std::vector<std::string> ProgramEnvironment(const ProgramRun& run, const std::string& display) {
    static const char* const REPLACED[] = {"DISPLAY=", "EGL_PLATFORM=", "LD_LIBRARY_PATH=",
                                           "OVO_SWAP_CAPTURE=", "OVO_SWAP_CAPTURE_STOP="};
    std::vector<std::string> environment;
    for (char** each = environ; *each != nullptr; ++each) {
        const std::string entry = *each;
        bool replaced = false;
        for (const char* prefix : REPLACED) replaced = replaced || entry.rfind(prefix, 0) == 0;
        if (!replaced) environment.push_back(entry);
    }
    environment.push_back("DISPLAY=" + display);
    environment.push_back("LD_LIBRARY_PATH=" + run.m_library_directory);
    environment.push_back("OVO_SWAP_CAPTURE=" + run.m_frame_directory + "/frame%d.png");
    if (!run.m_stops_by_itself) {
        environment.push_back("OVO_SWAP_CAPTURE_STOP=" + std::to_string(run.m_frames));
    }
    environment.insert(environment.end(), run.m_environment.begin(), run.m_environment.end());
    return environment;
}

pid_t Spawn(ChildSetup& setup) {
    std::vector<char*> arguments = setup.Pointers(setup.m_arguments);
    std::vector<char*> environment = setup.Pointers(setup.m_environment);
    const pid_t child = fork();
    if (child != 0) return child;
    const int output = open(setup.m_output_path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
    if (output >= 0) {
        dup2(output, STDOUT_FILENO);
        dup2(output, STDERR_FILENO);
        close(output);
    }
    if (!setup.m_working_directory.empty() && chdir(setup.m_working_directory.c_str()) != 0) _exit(126);
    execvpe(arguments[0], arguments.data(), environment.data());
    _exit(127);
}

// Makes every window of the display draw itself again.
void ExposeWindows(const std::string& display) {
    const pid_t child = fork();
    if (child == 0) {
        execlp("xrefresh", "xrefresh", "-display", display.c_str(), static_cast<char*>(nullptr));
        _exit(127);
    }
    int status = 0;
    if (child > 0) waitpid(child, &status, 0);
}

int CountFrames(const std::string& directory) {
    int count = 0;
    while (std::filesystem::exists(FramePath(directory, count + 1))) ++count;
    return count;
}

int ShellStatus(int status) {
    if (WIFEXITED(status)) return WEXITSTATUS(status);
    if (WIFSIGNALED(status)) return 128 + WTERMSIG(status);
    return -1;
}

}  // namespace

std::string FramePath(const std::string& frame_directory, int number) {
    return frame_directory + "/frame" + std::to_string(number) + ".png";
}

ProgramOutcome RunProgram(const ProgramRun& run, const std::string& display) {
    ProgramOutcome outcome;
    std::filesystem::remove_all(run.m_frame_directory);
    std::filesystem::create_directories(run.m_frame_directory);
    ChildSetup setup{run.m_arguments, ProgramEnvironment(run, display), run.m_working_directory,
                     run.m_frame_directory + "/output.txt"};
    const pid_t child = Spawn(setup);
    if (child < 0) return outcome;
    outcome.m_started = true;

    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(run.m_timeout_seconds);
    int exposed_after = 0;
    int status = 0;
    while (waitpid(child, &status, WNOHANG) == 0) {
        if (std::chrono::steady_clock::now() > deadline) {
            outcome.m_timed_out = true;
            kill(child, SIGKILL);
            waitpid(child, &status, 0);
            break;
        }
        // A program that draws on exposure gets one exposure per frame that it finished.
        const int frames = run.m_redraw == REDRAW_ON_EXPOSE ? CountFrames(run.m_frame_directory) : 0;
        if (frames > exposed_after && frames < run.m_frames) {
            exposed_after = frames;
            ExposeWindows(display);
        }
        std::this_thread::sleep_for(PROGRAM_POLL_INTERVAL);
    }
    outcome.m_status = ShellStatus(status);
    outcome.m_frames_captured = CountFrames(run.m_frame_directory);
    std::ifstream output(setup.m_output_path);
    std::stringstream text;
    text << output.rdbuf();
    outcome.m_output = text.str();
    return outcome;
}
