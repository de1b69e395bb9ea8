#include "tune_session.h"

#include <cstdio>
#include <thread>

#include "common/png_writer.h"

namespace ovo_tune {

namespace {

// The library reads the live-tuning file at a swap, after the stand-in has written that
// swap's frame, and every read follows a panel request. The second request counted after
// the file was written comes from a read that followed one which already took the new
// values, so every frame written from then on was drawn with them.
constexpr int64_t READS_TO_SETTLE = 2;
// Where the reads cannot be counted (a device): the library reads every 0.1 s of the
// game's processor time, within half a second for a game that keeps a fifth of a core busy.
constexpr auto UNCOUNTED_SETTLE_TIME = std::chrono::seconds(1);
constexpr auto SETTLE_TIMEOUT = std::chrono::seconds(20);
constexpr auto PROGRAM_CHECK_INTERVAL = std::chrono::milliseconds(500);
// A window that was covered, and the status, are drawn again at least this often.
constexpr auto REDRAW_INTERVAL = std::chrono::milliseconds(100);
constexpr auto IDLE_PAUSE = std::chrono::milliseconds(5);
constexpr char ANAGLYPH_FILE[] = "anaglyph.png";
constexpr char SIDE_BY_SIDE_FILE[] = "side_by_side.png";
constexpr char RAW_FILE[] = "raw.png";

void Report(const char* name, const std::string& value) { std::printf("%s = %s\n", name, value.c_str()); }

std::string ValuesText(const EyeValues& values) {
    char text[1024];
    std::snprintf(text, sizeof(text), "eye_distance %f eye_angle %f eye_shift %f", values.m_parameters[EYE_DISTANCE],
                  values.m_parameters[EYE_ANGLE], values.m_parameters[EYE_SHIFT]);
    return text;
}

std::string StepsText(const EyeSteps& steps) {
    char text[1024];
    std::snprintf(text, sizeof(text), "eye_distance %f eye_angle %f eye_shift %f (fine: a tenth)",
                  steps.m_coarse[EYE_DISTANCE], steps.m_coarse[EYE_ANGLE], steps.m_coarse[EYE_SHIFT]);
    return text;
}

std::string WithoutLineEnd(std::string text) {
    while (!text.empty() && text.back() == '\n') text.pop_back();
    return text;
}

}  // namespace

volatile std::sig_atomic_t g_stop_requested = 0;

TuneSession::TuneSession(TuneTransport& transport, TunedProfile& profile, KeyScript& script, PreviewWindow* window,
                         const SessionSettings& settings)
    : m_transport(transport),
      m_profile(profile),
      m_script(script),
      m_window(window),
      m_settings(settings),
      m_values(profile.StartValues()) {}

void TuneSession::Fail(int status, const std::string& problem) {
    std::fprintf(stderr, "ovo-tune: %s\n", problem.c_str());
    m_exit_status = status;
    m_quit = true;
}

bool TuneSession::Start() {
    Report("place", m_transport.Place());
    Report("values", ValuesText(m_values));
    Report("steps", StepsText(m_settings.m_steps));
    if (m_profile.RampOn()) Report("warning", "ramp = on: the library's ramp moves the eye parameters by itself");
    std::string problem;
    // Written before the start: a file left from another session would set other values.
    if (!m_transport.WriteLiveTuning(LiveTuningText(m_values), &problem)) {
        Fail(EXIT_TUNE_BAD_INPUT, "cannot write the live-tuning file in " + m_transport.Place() + ": " + problem);
        return false;
    }
    if (!m_transport.InstallProfile(m_profile.Binary(), &problem)) {
        Fail(EXIT_TUNE_BAD_INPUT, "cannot install the profile in " + m_transport.Place() + ": " + problem);
        return false;
    }
    if (!m_transport.StartProgram(&problem)) {
        Fail(EXIT_TUNE_TROUBLE, "cannot start the program: " + problem);
        return false;
    }
    Report("program", "started");
    m_program_checked = Clock::now();
    BeginSettling(READS_TO_SETTLE);
    return true;
}

void TuneSession::BeginSettling(int64_t reads_needed) {
    m_phase = PHASE_SETTLING;
    m_reads_needed = reads_needed;
    m_settle_start = Clock::now();
    m_frames_left = m_settings.m_frames_per_key;
    m_status = "waiting for the program to take the values";
}

void TuneSession::Apply(const TuneAction& action) {
    Report("key", ActionWord(action));
    std::string problem;
    switch (action.m_kind) {
        case ACTION_STEP: {
            Step(m_values, m_settings.m_steps, action.m_parameter, action.m_direction, action.m_fine);
            const std::string text = LiveTuningText(m_values);
            if (!m_transport.WriteLiveTuning(text, &problem)) {
                Fail(EXIT_TUNE_TROUBLE, "cannot write the live-tuning file: " + problem);
                return;
            }
            Report("live", WithoutLineEnd(text));
            const int64_t reads = m_transport.LiveTuningReads();
            if (!m_program_ended) BeginSettling(reads < 0 ? reads : reads + READS_TO_SETTLE);
            return;
        }
        case ACTION_NEXT_VIEW:
        case ACTION_VIEW:
            m_view = action.m_kind == ACTION_VIEW ? action.m_view
                                                  : static_cast<PreviewView>((m_view + 1) % PREVIEW_VIEW_COUNT);
            Report("view", ViewWord(m_view));
            return;
        case ACTION_SAVE:
            if (m_profile.Save(m_values, m_settings.m_save_path, &problem)) {
                Report("saved", m_settings.m_save_path);
                m_status = "saved to " + m_settings.m_save_path;
            } else if (m_window == nullptr) {
                Fail(EXIT_TUNE_TROUBLE, "not saved: " + problem);
            } else {
                Report("warning", "not saved: " + problem);
                m_status = "NOT SAVED: " + problem;
            }
            return;
        case ACTION_QUIT: m_quit = true; return;
    }
}

void TuneSession::FollowSettling() {
    if (m_phase != PHASE_SETTLING) return;
    const int64_t reads = m_transport.LiveTuningReads();
    const Clock::duration waited = Clock::now() - m_settle_start;
    if (reads < 0 ? waited >= UNCOUNTED_SETTLE_TIME : reads >= m_reads_needed) {
        m_phase = PHASE_MEASURING;
        m_status = "the program shows these values";
        return;
    }
    if (waited < SETTLE_TIMEOUT) return;
    const std::string problem =
        "the program has not read the live-tuning file in 20 s (the library reads it every "
        "0.1 s of the program's processor time, while the program draws)";
    if (m_window == nullptr) {
        Fail(EXIT_TUNE_TROUBLE, problem);
    } else {
        Report("warning", problem);
        m_status = problem;
        m_phase = PHASE_READY;
    }
}

bool TuneSession::TakeFrame() {
    // Headless, only the frames that are measured are fetched (a device's screen is slow to take).
    if (m_window == nullptr && m_phase != PHASE_MEASURING) return false;
    ovo_frames::RgbaFrame frame;
    std::string problem;
    const FrameStatus status = m_transport.TakeFrame(&frame, &problem);
    if (status == FRAME_NONE) return false;
    if (status == FRAME_FAILED) {
        if (m_window == nullptr) Fail(EXIT_TUNE_TROUBLE, "cannot take the program's frame: " + problem);
        m_status = "cannot take the program's frame: " + problem;
        return false;
    }
    m_frame = std::move(frame);
    m_depth = MeasureDepth(m_frame, m_settings.m_eye0_columns, m_settings.m_budget);
    m_have_depth = true;
    if (m_phase != PHASE_MEASURING) return true;
    Report("depth", DescribeDepth(m_depth));
    for (const std::string& warning : ComfortWarnings(m_depth, m_settings.m_budget)) Report("warning", warning);
    if (--m_frames_left <= 0) m_phase = PHASE_READY;
    return true;
}

void TuneSession::CheckProgram() {
    if (m_program_ended || Clock::now() - m_program_checked < PROGRAM_CHECK_INTERVAL) return;
    m_program_checked = Clock::now();
    std::string ending;
    if (m_transport.ProgramRunning(&ending)) return;
    m_program_ended = true;
    Report("program", ending);
    if (m_window == nullptr) {
        Fail(EXIT_TUNE_TROUBLE, "the program " + ending + "; the keys were not all done");
        return;
    }
    m_status = "the program " + ending;
    m_phase = PHASE_READY;
}

void TuneSession::Redraw() {
    std::vector<WindowLine> lines;
    char text[1024];
    std::snprintf(text, sizeof(text), "eye distance %f   eye angle %f   eye shift %f",
                  m_values.m_parameters[EYE_DISTANCE], m_values.m_parameters[EYE_ANGLE],
                  m_values.m_parameters[EYE_SHIFT]);
    lines.push_back({text});
    lines.push_back({"depth: " + (m_have_depth ? DescribeDepth(m_depth) : std::string("no frame yet"))});
    const std::vector<std::string> warnings =
        m_have_depth ? ComfortWarnings(m_depth, m_settings.m_budget) : std::vector<std::string>();
    for (const std::string& warning : warnings) lines.push_back({"WARNING: " + warning, true});
    if (warnings.empty()) {
        std::snprintf(text, sizeof(text), "comfort budget: %.2f %% of the width in front, %.2f %% behind",
                      m_settings.m_budget.m_near_percent, m_settings.m_budget.m_far_percent);
        lines.push_back({text});
    }
    const bool alert = m_program_ended || m_status.rfind("NOT", 0) == 0;
    lines.push_back({std::string(ViewDescription(m_view)) + "  |  " + m_status, alert});
    lines.push_back({WINDOW_KEY_HELP});
    m_window->Show(m_frame.m_width > 0 ? ViewOf(m_frame, m_view, m_settings.m_eye0_columns) : ovo_frames::RgbaFrame(),
                   lines);
}

void TuneSession::WriteImages() {
    if (m_settings.m_out_dir.empty()) return;
    if (m_frame.m_width == 0) {
        Fail(EXIT_TUNE_TROUBLE, "no frame came from the program: no images written");
        return;
    }
    const struct {
        const char* m_name;
        const char* m_file;
        PreviewView m_view;
    } images[] = {{"anaglyph", ANAGLYPH_FILE, VIEW_ANAGLYPH},
                  {"side_by_side", SIDE_BY_SIDE_FILE, VIEW_SIDE_BY_SIDE},
                  {"raw", RAW_FILE, VIEW_RAW}};
    for (const auto& image : images) {
        const std::string path = m_settings.m_out_dir + "/" + image.m_file;
        const ovo_frames::RgbaFrame view = ViewOf(m_frame, image.m_view, m_settings.m_eye0_columns);
        if (!ovo_sample::WritePng(path.c_str(), view.m_width, view.m_height, view.m_pixels.data())) {
            Fail(EXIT_TUNE_TROUBLE, "cannot write " + path);
            return;
        }
        Report(image.m_name, path);
    }
}

bool TuneSession::TakeScriptKey() {
    if (m_phase != PHASE_READY || m_quit) return false;
    std::string word;
    if (!m_script.NextWord(&word)) {
        if (m_window == nullptr && m_script.Finished()) m_quit = true;
        return false;
    }
    TuneAction action;
    std::string problem;
    if (!ParseActionWord(word, &action, &problem)) {
        Fail(EXIT_TUNE_BAD_INPUT, "key script: " + problem);
        return false;
    }
    Apply(action);
    return true;
}

int TuneSession::Run() {
    if (Start()) {
        Clock::time_point drawn;
        while (!m_quit && g_stop_requested == 0) {
            std::vector<TuneAction> pressed;
            bool closed = false;
            if (m_window != nullptr) m_window->TakeActions(&pressed, &closed);
            m_quit = closed;
            for (const TuneAction& action : pressed) Apply(action);
            const bool scripted = TakeScriptKey();
            FollowSettling();
            const bool new_frame = TakeFrame();
            CheckProgram();
            std::fflush(stdout);
            const bool changed = new_frame || scripted || !pressed.empty();
            if (m_window != nullptr && (changed || Clock::now() - drawn > REDRAW_INTERVAL)) {
                Redraw();
                drawn = Clock::now();
            }
            std::this_thread::sleep_for(IDLE_PAUSE);
        }
        if (g_stop_requested != 0) Report("stop", "signal");
        WriteImages();
    }
    m_transport.Finish();
    std::fflush(stdout);
    return m_exit_status;
}

}  // namespace ovo_tune
