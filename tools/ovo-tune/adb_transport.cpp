#include "adb_transport.h"

#include <cctype>
#include <cstdio>

#include "atomic_file.h"
#include "child_process.h"
#include "config/stereo_profile.h"
#include "png_reader.h"
#include "present/live_tuning.h"

namespace ovo_tune {

namespace {

constexpr char ADB[] = "adb";
constexpr char PROFILE_UPLOAD_FILE[] = "stereo_gm.ovo";
constexpr char SCREEN_FILE[] = "screen.png";
// monkey's answer when the package has no activity to launch.
constexpr char MONKEY_NO_ACTIVITY[] = "No activities found";

std::string Folder(const std::string& path) { return path.substr(0, path.rfind('/')); }

std::string Trimmed(const std::string& text) {
    const size_t begin = text.find_first_not_of(" \t\r\n");
    if (begin == std::string::npos) return "";
    return text.substr(begin, text.find_last_not_of(" \t\r\n") - begin + 1);
}

}  // namespace

bool IsPackageName(const std::string& name) {
    if (name.empty() || name.front() == '.') return false;
    for (char each : name) {
        if (!std::isalnum(static_cast<unsigned char>(each)) && each != '_' && each != '.') return false;
    }
    return true;
}

AdbTransport::AdbTransport(const AdbSetup& setup) : m_setup(setup) {}

AdbTransport::~AdbTransport() { Finish(); }

std::string AdbTransport::Place() const {
    return m_setup.m_serial.empty() ? "the device (adb)" : "the device " + m_setup.m_serial + " (adb)";
}

bool AdbTransport::Adb(const std::vector<std::string>& arguments, std::string* output, std::string* problem) const {
    std::vector<std::string> command = {ADB};
    if (!m_setup.m_serial.empty()) command.insert(command.end(), {"-s", m_setup.m_serial});
    command.insert(command.end(), arguments.begin(), arguments.end());
    const CommandResult result = RunCommand(command);
    if (output != nullptr) *output = result.m_output;
    if (result.Succeeded()) return true;
    std::string shown;
    for (const std::string& each : command) shown += (shown.empty() ? "" : " ") + each;
    *problem = shown + " " + DescribeEnding(result.m_wait_status);
    const std::string said = Trimmed(result.m_errors);
    if (!said.empty()) *problem += ": " + said;
    return false;
}

bool AdbTransport::Shell(const std::string& command, std::string* output, std::string* problem) const {
    return Adb({"shell", command}, output, problem);
}

bool AdbTransport::InstallProfile(const std::vector<uint8_t>& bytes, std::string* problem) {
    const std::string upload = m_setup.m_work_dir + "/" + PROFILE_UPLOAD_FILE;
    return ovo_profile::WriteFileAtomically(upload, bytes.data(), bytes.size(), *problem) &&
           Shell("mkdir -p " + Folder(ovo::PROFILE_PATH), nullptr, problem) &&
           Adb({"push", upload, ovo::PROFILE_PATH}, nullptr, problem);
}

bool AdbTransport::WriteLiveTuning(const std::string& text, std::string* problem) {
    // Written beside it and renamed, so that the library never reads half of it. The text
    // holds numbers and spaces only.
    const std::string file = ovo::LIVE_TUNING_PATH;
    const std::string temporary = file + ".tmp";
    return Shell("echo '" + Trimmed(text) + "' > " + temporary + " && mv " + temporary + " " + file, nullptr, problem);
}

bool AdbTransport::StartProgram(std::string* problem) {
    std::string output;
    if (!Shell("am force-stop " + m_setup.m_package, nullptr, problem) ||
        !Shell("monkey -p " + m_setup.m_package + " -c android.intent.category.LAUNCHER 1", &output, problem)) {
        return false;
    }
    if (output.find(MONKEY_NO_ACTIVITY) != std::string::npos) {
        *problem = "the device has no launchable package " + m_setup.m_package;
        return false;
    }
    m_started = true;
    return true;
}

FrameStatus AdbTransport::TakeFrame(ovo_frames::RgbaFrame* frame, std::string* problem) {
    std::string png;
    if (!Adb({"exec-out", "screencap", "-p"}, &png, problem)) return FRAME_FAILED;
    const std::string screen = m_setup.m_work_dir + "/" + SCREEN_FILE;
    if (!ovo_profile::WriteFileAtomically(screen, png, *problem)) return FRAME_FAILED;
    return ovo_frames::ReadPng(screen.c_str(), frame, problem) ? FRAME_NEW : FRAME_FAILED;
}

int64_t AdbTransport::LiveTuningReads() { return -1; }

bool AdbTransport::ProgramRunning(std::string* ending) {
    std::string output;
    std::string problem;
    // pidof answers with nothing (and status 1) when no process has the name.
    if (!Shell("pidof " + m_setup.m_package + " || true", &output, &problem)) {
        *ending = "cannot be seen: " + problem;
        return false;
    }
    if (!Trimmed(output).empty()) return true;
    *ending = "is no longer running on the device";
    return false;
}

void AdbTransport::Finish() {
    if (m_finished) return;
    m_finished = true;
    std::string problem;
    if (m_started) Shell("am force-stop " + m_setup.m_package, nullptr, &problem);
    Shell(std::string("rm -f ") + ovo::LIVE_TUNING_PATH + " " + ovo::PROFILE_PATH, nullptr, &problem);
}

}  // namespace ovo_tune
