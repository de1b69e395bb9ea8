#ifndef OVO_TOOLS_OVO_TUNE_TUNE_TRANSPORT_H
#define OVO_TOOLS_OVO_TUNE_TUNE_TRANSPORT_H

#include <cstdint>
#include <string>
#include <vector>

#include "rgba_frame.h"

// How ovo-tune reaches the program it tunes: a program on this desktop through a copy of
// the library, or a game on a device over adb. The session does the same on both.
namespace ovo_tune {

enum FrameStatus {
    FRAME_NEW,     // a frame that had not been taken before
    FRAME_NONE,    // nothing new yet
    FRAME_FAILED,  // the frame could not be taken (the reason in `problem`)
};

class TuneTransport {
public:
    TuneTransport() = default;
    virtual ~TuneTransport() = default;
    TuneTransport(const TuneTransport&) = delete;
    TuneTransport& operator=(const TuneTransport&) = delete;

    // What the session reports as the place it works in ("device root /x", "the device").
    virtual std::string Place() const = 0;
    // Puts the binary profile where the library reads it when the program starts.
    virtual bool InstallProfile(const std::vector<uint8_t>& bytes, std::string* problem) = 0;
    // Replaces the live-tuning file as a whole, so that the library never reads a part.
    virtual bool WriteLiveTuning(const std::string& text, std::string* problem) = 0;
    virtual bool StartProgram(std::string* problem) = 0;
    virtual FrameStatus TakeFrame(ovo_frames::RgbaFrame* frame, std::string* problem) = 0;
    // How often the program's library has read the live-tuning file since the start, or -1
    // when that cannot be seen: the session then waits a while instead.
    virtual int64_t LiveTuningReads() = 0;
    // False once the program has ended, with how in `ending`.
    virtual bool ProgramRunning(std::string* ending) = 0;
    // Stops the program and removes the live-tuning file and a profile that no program read,
    // so that nothing of the session stays behind to change a later start.
    virtual void Finish() = 0;
};

}  // namespace ovo_tune

#endif
