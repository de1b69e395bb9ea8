#ifndef OVO_TOOLS_OVO_TUNE_DESKTOP_TRANSPORT_H
#define OVO_TOOLS_OVO_TUNE_DESKTOP_TRANSPORT_H

#include <sys/types.h>

#include <string>
#include <vector>

#include "tune_transport.h"

// A program on this desktop, run through a copy of the library whose vendor EGL is the
// swap-capture stand-in: the stand-in writes each frame, as the panel would receive it, to
// a PNG that the transport reads; the panel driver's stand-in records every panel request,
// and the library makes one each time it reads the live-tuning file.
namespace ovo_tune {

struct DesktopSetup {
    // A folder with the library copy as libGLES_ovo.so and under the names of the system's
    // EGL and OpenGL ES libraries, put first on the program's LD_LIBRARY_PATH.
    std::string m_library_dir;
    // The device root that the copy was built for: the profile, the live-tuning file and
    // the panel's nodes lie below it.
    std::string m_device_root;
    // The panel driver's stand-in, preloaded into the program.
    std::string m_panel_driver;
    // The program's full path, then its arguments.
    std::vector<std::string> m_program;
    // Where the frames are written (a folder of this session's own).
    std::string m_frame_dir;
    // The program's standard output and error.
    std::string m_program_log;
};

class DesktopTransport final : public TuneTransport {
public:
    explicit DesktopTransport(const DesktopSetup& setup);
    ~DesktopTransport() override;

    std::string Place() const override;
    bool InstallProfile(const std::vector<uint8_t>& bytes, std::string* problem) override;
    bool WriteLiveTuning(const std::string& text, std::string* problem) override;
    bool StartProgram(std::string* problem) override;
    FrameStatus TakeFrame(ovo_frames::RgbaFrame* frame, std::string* problem) override;
    int64_t LiveTuningReads() override;
    bool ProgramRunning(std::string* ending) override;
    void Finish() override;

private:
    std::string BelowRoot(const char* device_path) const;
    bool WriteBelowRoot(const char* device_path, const std::string& bytes, std::string* problem) const;

    DesktopSetup m_setup;
    std::string m_frame_path;
    pid_t m_pid = -1;
    bool m_ended = false;
    std::string m_ending;
    // The frame file last taken: a new one has another inode or time.
    ino_t m_frame_inode = 0;
    int64_t m_frame_time = -1;
    // Panel requests counted so far, and where the count stopped in the node's file.
    int64_t m_panel_requests = 0;
    long m_panel_offset = 0;
    bool m_finished = false;
};

}  // namespace ovo_tune

#endif
