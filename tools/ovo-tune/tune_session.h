#ifndef OVO_TOOLS_OVO_TUNE_TUNE_SESSION_H
#define OVO_TOOLS_OVO_TUNE_TUNE_SESSION_H

#include <chrono>
#include <csignal>
#include <string>
#include <vector>

#include "column_ops.h"
#include "depth_readout.h"
#include "eye_values.h"
#include "key_script.h"
#include "preview_view.h"
#include "preview_window.h"
#include "tune_action.h"
#include "tune_transport.h"
#include "tuned_profile.h"

// One tuning session: the profile installed, the program started, keys turned into new
// live values, each change followed until the program's frames show it, the depth
// measured, the values saved on request. Everything it does is reported on standard
// output as `name = value` lines.
namespace ovo_tune {

constexpr int EXIT_TUNE_TROUBLE = 1;    // the program or the transport failed
constexpr int EXIT_TUNE_BAD_INPUT = 2;  // a bad command line, profile, key or place

// Set by a signal handler: the session ends as if quit.
extern volatile std::sig_atomic_t g_stop_requested;

struct SessionSettings {
    std::string m_save_path;
    std::string m_out_dir;  // empty: no images at the end
    EyeSteps m_steps;
    int m_frames_per_key = 1;
    ovo_frames::ColumnParity m_eye0_columns = ovo_frames::COLUMN_PARITY_EVEN;
    ovo_frames::ComfortBudget m_budget;
};

class TuneSession {
public:
    // `window` null: headless, the session ends after the script's last key.
    TuneSession(TuneTransport& transport, TunedProfile& profile, KeyScript& script, PreviewWindow* window,
                const SessionSettings& settings);

    // The exit status: 0, EXIT_TUNE_TROUBLE or EXIT_TUNE_BAD_INPUT.
    int Run();

private:
    using Clock = std::chrono::steady_clock;

    // What the session waits for before it takes the next key of the script.
    enum Phase {
        PHASE_SETTLING,   // the library has not read the newest values yet
        PHASE_MEASURING,  // frames with them come; m_frames_left more are measured
        PHASE_READY,
    };

    bool Start();
    void Apply(const TuneAction& action);
    // The script's next key once the program shows the last one; true when one was applied.
    bool TakeScriptKey();
    void BeginSettling(int64_t reads_needed);
    void FollowSettling();
    // True when a new frame came.
    bool TakeFrame();
    void CheckProgram();
    void Redraw();
    void WriteImages();
    void Fail(int status, const std::string& problem);

    TuneTransport& m_transport;
    TunedProfile& m_profile;
    KeyScript& m_script;
    PreviewWindow* m_window;
    SessionSettings m_settings;

    EyeValues m_values;
    PreviewView m_view = VIEW_ANAGLYPH;
    Phase m_phase = PHASE_SETTLING;
    int64_t m_reads_needed = 0;
    Clock::time_point m_settle_start;
    int m_frames_left = 0;

    ovo_frames::RgbaFrame m_frame;
    bool m_have_depth = false;
    DepthReadout m_depth;
    std::string m_status;
    Clock::time_point m_program_checked;
    bool m_program_ended = false;
    bool m_quit = false;
    int m_exit_status = 0;
};

}  // namespace ovo_tune

#endif
