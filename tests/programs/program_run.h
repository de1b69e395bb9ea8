#ifndef OVO_TESTS_PROGRAMS_PROGRAM_RUN_H
#define OVO_TESTS_PROGRAMS_PROGRAM_RUN_H

#include <string>
#include <vector>

// How a program produces its frames.
enum RedrawKind {
    REDRAW_CONTINUOUS,  // draws and swaps frame after frame
    REDRAW_ON_EXPOSE,   // draws only when its window is exposed: the run exposes it again
};

// One start of a third-party program on an X display, its frames kept at each swap by
// the swap-capture stand-in (OVO_SWAP_CAPTURE) as <frame directory>/frame<N>.png.
struct ProgramRun {
    std::vector<std::string> m_arguments;  // the program first
    std::string m_working_directory;
    std::vector<std::string> m_environment;  // NAME=VALUE, on top of this process's
    std::string m_library_directory;         // LD_LIBRARY_PATH
    std::string m_frame_directory;
    int m_frames = 0;        // the swap after which the program is told to stop (SIGTERM)
    bool m_stops_by_itself;  // it ends after its own last frame; nobody stops it
    RedrawKind m_redraw = REDRAW_CONTINUOUS;
    int m_timeout_seconds = 60;
};

struct ProgramOutcome {
    bool m_started = false;
    bool m_timed_out = false;
    // The exit code, or 128 + the signal that ended it, as a shell reports it.
    int m_status = -1;
    std::string m_output;  // standard output and standard error, interleaved
    int m_frames_captured = 0;
};

// Runs `run` on `display` and waits for its end.
ProgramOutcome RunProgram(const ProgramRun& run, const std::string& display);

// <frame directory>/frame<number>.png
std::string FramePath(const std::string& frame_directory, int number);

#endif
