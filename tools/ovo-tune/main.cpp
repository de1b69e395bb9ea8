// ovo-tune: runs a program through the library with a stereo profile, previews its frames,
// tunes its eye parameters live by keys, measures the depth it shows and saves the tuned
// values into the profile's text (see TUNE_USAGE in tune_options.cpp).
#include <signal.h>
#include <stdlib.h>
#include <unistd.h>

#include <cstdio>
#include <deque>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>

#include "adb_transport.h"
#include "child_process.h"
#include "config/stereo_profile.h"
#include "desktop_transport.h"
#include "present/live_tuning.h"
#include "tune_options.h"

namespace {

using ovo_tune::EXIT_TUNE_BAD_INPUT;

constexpr char PROGRAM_LOG_FILE[] = "program.log";
constexpr char LIBRARY_FILE[] = "libGLES_ovo.so";
constexpr size_t PROGRAM_LOG_TAIL_LINES = 15;

int BadInput(const std::string& problem) {
    std::fprintf(stderr, "ovo-tune: %s\n", problem.c_str());
    return EXIT_TUNE_BAD_INPUT;
}

void RequestStop(int) { ovo_tune::g_stop_requested = 1; }

void PrintWhere(const ovo_tune::TuneOptions& options) {
    std::printf(
        "library_dir = %s\ndevice_root = %s\npanel_driver = %s\nfont = %s\nprofile_file = %s%s\n"
        "live_tuning_file = %s%s\n",
        options.m_library_dir.c_str(), options.m_device_root.c_str(), options.m_panel_driver.c_str(),
        options.m_font.c_str(), options.m_device_root.c_str(), ovo::PROFILE_PATH, options.m_device_root.c_str(),
        ovo::LIVE_TUNING_PATH);
}

// Every word of a --keys text is known before anything starts.
bool CheckKeys(const std::string& keys, std::string* problem) {
    ovo_tune::KeyScript script;
    script.SetText(keys);
    std::string word;
    ovo_tune::TuneAction action;
    while (script.NextWord(&word)) {
        if (!ovo_tune::ParseActionWord(word, &action, problem)) return false;
    }
    return true;
}

std::string MakeWorkDir() {
    const char* temporary = std::getenv("TMPDIR");
    std::string pattern =
        std::string(temporary != nullptr && temporary[0] != '\0' ? temporary : "/tmp") + "/ovo-tune.XXXXXX";
    return mkdtemp(&pattern[0]) != nullptr ? pattern : "";
}

void PrintLogTail(const std::string& log) {
    std::ifstream file(log);
    std::deque<std::string> tail;
    for (std::string line; std::getline(file, line);) {
        tail.push_back(line);
        if (tail.size() > PROGRAM_LOG_TAIL_LINES) tail.pop_front();
    }
    if (tail.empty()) return;
    std::fprintf(stderr, "ovo-tune: the program's last output:\n");
    for (const std::string& line : tail) std::fprintf(stderr, "  %s\n", line.c_str());
}

// The transport for the options, or null after saying what is wrong.
std::unique_ptr<ovo_tune::TuneTransport> MakeTransport(const ovo_tune::TuneOptions& options,
                                                       const std::string& work_dir, const std::string& program_log) {
    std::string path;
    if (options.m_device) {
        if (options.m_program.size() != 1 || !ovo_tune::IsPackageName(options.m_program[0])) {
            BadInput("with --device the program is one package name (letters, digits, '_' and '.')");
            return nullptr;
        }
        if (!ovo_tune::FindProgram("adb", &path)) {
            BadInput("adb is not on PATH (Debian's adb package)");
            return nullptr;
        }
        return std::make_unique<ovo_tune::AdbTransport>(
            ovo_tune::AdbSetup{options.m_serial, options.m_program[0], work_dir});
    }
    if (!ovo_tune::FindProgram(options.m_program[0], &path)) {
        BadInput(options.m_program[0] + ": no such program (not an executable file, nor on PATH)");
        return nullptr;
    }
    const std::string library = options.m_library_dir + "/" + LIBRARY_FILE;
    if (access(library.c_str(), R_OK) != 0) {
        BadInput(library + ": no library copy there (build the target ovo-tune; ovo-tune --where)");
        return nullptr;
    }
    std::vector<std::string> program = options.m_program;
    program[0] = path;
    return std::make_unique<ovo_tune::DesktopTransport>(ovo_tune::DesktopSetup{
        options.m_library_dir, options.m_device_root, options.m_panel_driver, program, work_dir, program_log});
}

}  // namespace

int main(int argc, char** argv) {
    std::setvbuf(stdout, nullptr, _IOLBF, 0);
    const ovo_tune::BuiltPlaces built = {OVO_TUNE_LIBRARY_DIR, OVO_TUNE_DEVICE_ROOT, OVO_TUNE_PANEL_DRIVER,
                                         OVO_TUNE_FONT};
    ovo_tune::TuneOptions options;
    std::string problem;
    if (!ovo_tune::ParseTuneOptions(argc, argv, built, &options, &problem)) {
        std::fprintf(stderr, "ovo-tune: %s\n%s", problem.c_str(), ovo_tune::TUNE_USAGE);
        return EXIT_TUNE_BAD_INPUT;
    }
    if (options.m_help) {
        std::fputs(ovo_tune::TUNE_USAGE, stdout);
        return 0;
    }
    if (options.m_where) {
        PrintWhere(options);
        return 0;
    }

    ovo_tune::KeyScript script;
    if (!options.m_keys.empty()) {
        if (!CheckKeys(options.m_keys, &problem)) return BadInput("--keys: " + problem);
        script.SetText(options.m_keys);
    } else if (!options.m_keys_from.empty() && !script.OpenFile(options.m_keys_from, &problem)) {
        return BadInput(problem);
    }
    ovo_tune::TunedProfile profile;
    if (!profile.Load(options.m_profile, &problem)) return BadInput(problem);
    if (!options.m_steps_given) options.m_session.m_steps = ovo_tune::DefaultSteps(profile.StartValues());

    std::unique_ptr<ovo_tune::PreviewWindow> window;
    if (!options.m_headless) {
        window = std::make_unique<ovo_tune::PreviewWindow>();
        if (!window->Open("ovo-tune: " + options.m_profile, options.m_font, &problem)) {
            return BadInput(problem + " (without a display: --headless with --keys)");
        }
    }
    const std::string work_dir = MakeWorkDir();
    if (work_dir.empty()) return BadInput("cannot make a temporary folder");
    const std::string program_log =
        options.m_program_log.empty() ? work_dir + "/" + PROGRAM_LOG_FILE : options.m_program_log;
    int status = EXIT_TUNE_BAD_INPUT;
    {
        std::unique_ptr<ovo_tune::TuneTransport> transport = MakeTransport(options, work_dir, program_log);
        if (transport != nullptr) {
            std::printf("profile = %s\n", options.m_profile.c_str());
            if (window != nullptr) std::printf("window = 0x%lx\n", window->NativeId());
            signal(SIGINT, RequestStop);
            signal(SIGTERM, RequestStop);
            ovo_tune::TuneSession session(*transport, profile, script, window.get(), options.m_session);
            status = session.Run();
        }
    }
    if (status == ovo_tune::EXIT_TUNE_TROUBLE && !options.m_device) PrintLogTail(program_log);
    std::error_code ignored;
    std::filesystem::remove_all(work_dir, ignored);
    return status;
}
