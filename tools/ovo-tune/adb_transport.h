#ifndef OVO_TOOLS_OVO_TUNE_ADB_TRANSPORT_H
#define OVO_TOOLS_OVO_TUNE_ADB_TRANSPORT_H

#include <string>
#include <vector>

#include "tune_transport.h"

// A game on a device, over adb (found on PATH): the profile pushed to where the library
// reads it, the live-tuning file replaced through the device's shell, the game started and
// stopped by its package name, and each frame taken from the screen with screencap. The
// library's reads of the live-tuning file cannot be seen from here.
namespace ovo_tune {

struct AdbSetup {
    std::string m_serial;   // adb -s SERIAL; empty for adb's only device
    std::string m_package;  // the game's package name
    // A folder of this session's own for the files on their way to and from the device.
    std::string m_work_dir;
};

// Android package names: letters, digits, '_' and '.', nothing a shell would read.
bool IsPackageName(const std::string& name);

class AdbTransport final : public TuneTransport {
public:
    explicit AdbTransport(const AdbSetup& setup);
    ~AdbTransport() override;

    std::string Place() const override;
    bool InstallProfile(const std::vector<uint8_t>& bytes, std::string* problem) override;
    bool WriteLiveTuning(const std::string& text, std::string* problem) override;
    bool StartProgram(std::string* problem) override;
    FrameStatus TakeFrame(ovo_frames::RgbaFrame* frame, std::string* problem) override;
    int64_t LiveTuningReads() override;
    bool ProgramRunning(std::string* ending) override;
    void Finish() override;

private:
    // Runs adb with `arguments`; false, with adb's own words in `problem`, when it fails.
    bool Adb(const std::vector<std::string>& arguments, std::string* output, std::string* problem) const;
    bool Shell(const std::string& command, std::string* output, std::string* problem) const;

    AdbSetup m_setup;
    bool m_started = false;
    bool m_finished = false;
};

}  // namespace ovo_tune

#endif
