#include "desktop_transport.h"

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>

#include "atomic_file.h"
#include "child_process.h"
#include "config/stereo_profile.h"
#include "png_reader.h"
#include "present/live_tuning.h"
#include "present/panel_control.h"

namespace ovo_tune {

namespace {

constexpr char FRAME_FILE[] = "frame.png";
constexpr size_t PANEL_READ_BYTES = 4096;

// This process's environment with the variables that route the program through the
// library copy: put first, what the variable held kept behind a separator (or replaced),
// and a variable without a value of ovo-tune's removed.
std::vector<std::string> ProgramEnvironment(const DesktopSetup& setup, const std::string& frame_path) {
    struct Routed {
        const char* m_name;
        std::string m_first;
        const char* m_separator;  // before what the variable held; null: that is replaced
    };
    const Routed routed[] = {
        {"LD_LIBRARY_PATH", setup.m_library_dir, ":"},
        {"LD_PRELOAD", setup.m_panel_driver, " "},
        {"OVO_SWAP_CAPTURE", frame_path, nullptr},
        {"OVO_SWAP_CAPTURE_STOP", "", nullptr},
    };
    std::vector<std::string> environment;
    for (char** each = environ; *each != nullptr; ++each) {
        const std::string entry = *each;
        bool replaced = false;
        for (const Routed& variable : routed) {
            replaced = replaced || entry.rfind(std::string(variable.m_name) + "=", 0) == 0;
        }
        if (!replaced) environment.push_back(entry);
    }
    for (const Routed& variable : routed) {
        if (variable.m_first.empty()) continue;
        std::string value = variable.m_first;
        const char* held = std::getenv(variable.m_name);
        if (variable.m_separator != nullptr && held != nullptr && held[0] != '\0') {
            value += variable.m_separator + std::string(held);
        }
        environment.push_back(std::string(variable.m_name) + "=" + value);
    }
    return environment;
}

int64_t ModificationTime(const struct stat& status) {
    return static_cast<int64_t>(status.st_mtim.tv_sec) * 1000000000 + status.st_mtim.tv_nsec;
}

}  // namespace

DesktopTransport::DesktopTransport(const DesktopSetup& setup)
    : m_setup(setup), m_frame_path(setup.m_frame_dir + "/" + FRAME_FILE) {}

DesktopTransport::~DesktopTransport() { Finish(); }

std::string DesktopTransport::Place() const { return "device root " + m_setup.m_device_root; }

std::string DesktopTransport::BelowRoot(const char* device_path) const { return m_setup.m_device_root + device_path; }

bool DesktopTransport::WriteBelowRoot(const char* device_path, const std::string& bytes, std::string* problem) const {
    const std::filesystem::path path = BelowRoot(device_path);
    std::error_code error;
    std::filesystem::create_directories(path.parent_path(), error);
    if (error) {
        *problem = "cannot make the folder " + path.parent_path().string() + ": " + error.message();
        return false;
    }
    return ovo_profile::WriteFileAtomically(path.string(), bytes, *problem);
}

bool DesktopTransport::InstallProfile(const std::vector<uint8_t>& bytes, std::string* problem) {
    return WriteBelowRoot(ovo::PROFILE_PATH, std::string(bytes.begin(), bytes.end()), problem);
}

bool DesktopTransport::WriteLiveTuning(const std::string& text, std::string* problem) {
    return WriteBelowRoot(ovo::LIVE_TUNING_PATH, text, problem);
}

bool DesktopTransport::StartProgram(std::string* problem) {
    // Empty nodes: the stand-in appends each request, so the count starts at 0.
    for (const char* node : {ovo::PANEL_MODE_NODE, ovo::COMPOSITION_NODE}) {
        if (!WriteBelowRoot(node, "", problem)) return false;
    }
    m_pid = StartChild(m_setup.m_program, ProgramEnvironment(m_setup, m_frame_path), m_setup.m_program_log, problem);
    return m_pid > 0;
}

FrameStatus DesktopTransport::TakeFrame(ovo_frames::RgbaFrame* frame, std::string* problem) {
    struct stat status;
    if (stat(m_frame_path.c_str(), &status) != 0) return FRAME_NONE;
    if (status.st_ino == m_frame_inode && ModificationTime(status) == m_frame_time) return FRAME_NONE;
    m_frame_inode = status.st_ino;
    m_frame_time = ModificationTime(status);
    // The stand-in renames each frame into place, so the file is always whole.
    return ovo_frames::ReadPng(m_frame_path.c_str(), frame, problem) ? FRAME_NEW : FRAME_FAILED;
}

int64_t DesktopTransport::LiveTuningReads() {
    FILE* node = std::fopen(BelowRoot(ovo::PANEL_MODE_NODE).c_str(), "rb");
    if (node == nullptr) return m_panel_requests;
    if (std::fseek(node, m_panel_offset, SEEK_SET) == 0) {
        char buffer[PANEL_READ_BYTES];
        size_t count;
        while ((count = std::fread(buffer, 1, sizeof(buffer), node)) > 0) {
            for (size_t index = 0; index < count; ++index) m_panel_requests += buffer[index] == '\n' ? 1 : 0;
            m_panel_offset += static_cast<long>(count);
        }
    }
    std::fclose(node);
    return m_panel_requests;
}

bool DesktopTransport::ProgramRunning(std::string* ending) {
    if (!m_ended && m_pid > 0) {
        int status = 0;
        if (waitpid(m_pid, &status, WNOHANG) == m_pid) {
            m_ended = true;
            m_ending = DescribeEnding(status);
        }
    }
    *ending = m_ending;
    return m_pid > 0 && !m_ended;
}

void DesktopTransport::Finish() {
    if (m_finished) return;
    m_finished = true;
    if (m_pid > 0 && !m_ended) StopChild(m_pid);
    m_ended = true;
    // A profile file that no program took would be read by the next start through this root.
    std::remove(BelowRoot(ovo::LIVE_TUNING_PATH).c_str());
    std::remove(BelowRoot(ovo::PROFILE_PATH).c_str());
    std::remove(m_frame_path.c_str());
}

}  // namespace ovo_tune
