#include "tune_options.h"

#include <cerrno>
#include <cmath>
#include <cstdlib>
#include <cstring>

namespace ovo_tune {

namespace {

constexpr long FRAMES_PER_KEY_MAX = 1000;
constexpr double BUDGET_PERCENT_MAX = 100.0;

bool ParseNumber(const std::string& text, double* value) {
    char* end = nullptr;
    errno = 0;
    *value = std::strtod(text.c_str(), &end);
    return !text.empty() && end == text.c_str() + text.size() && errno == 0 && std::isfinite(*value);
}

// "D,A,S": three steps above 0.
bool ParseSteps(const std::string& text, EyeSteps* steps) {
    size_t start = 0;
    for (int index = 0; index < EYE_PARAMETER_COUNT; ++index) {
        const size_t end = index + 1 < EYE_PARAMETER_COUNT ? text.find(',', start) : text.size();
        if (end == std::string::npos) return false;
        double step = 0.0;
        if (!ParseNumber(text.substr(start, end - start), &step) || !(step > 0.0)) return false;
        steps->m_coarse[index] = RoundToFileDecimals(step);
        if (steps->m_coarse[index] == 0.0) return false;
        start = end + 1;
    }
    return true;
}

bool ParsePercent(const std::string& text, float* value) {
    double percent = 0.0;
    if (!ParseNumber(text, &percent) || !(percent > 0.0 && percent <= BUDGET_PERCENT_MAX)) return false;
    *value = static_cast<float>(percent);
    return true;
}

bool ParseFrames(const std::string& text, int* frames) {
    double count = 0.0;
    if (!ParseNumber(text, &count) || count != std::floor(count) || count < 1 || count > FRAMES_PER_KEY_MAX) {
        return false;
    }
    *frames = static_cast<int>(count);
    return true;
}

bool ParseColumns(const std::string& text, ovo_frames::ColumnParity* parity) {
    if (text != "even" && text != "odd") return false;
    *parity = text == "even" ? ovo_frames::COLUMN_PARITY_EVEN : ovo_frames::COLUMN_PARITY_ODD;
    return true;
}

}  // namespace

const char TUNE_USAGE[] =
    "usage: ovo-tune PROFILE.txt [OPTION...] -- PROGRAM [ARGUMENT...]\n"
    "       ovo-tune --where | --help\n"
    "\n"
    "Runs PROGRAM through the library with the profile PROFILE.txt (the text that\n"
    "'ovo-profile write' reads), shows its frames in a preview window and tunes its eye\n"
    "parameters while it runs: each key rewrites the live-tuning file, which the library\n"
    "reads every 0.1 s of the program's processor time. The save key writes PROFILE.txt back\n"
    "with the tuned values, every other line kept. Everything done is reported on standard\n"
    "output, one 'name = value' line each (values, key, live, depth, warning, saved).\n"
    "\n"
    "Window keys: Up/Down eye distance, Right/Left eye angle, PgUp/PgDn eye shift (with\n"
    "Shift a fine step, a tenth), Tab or 1/2/3 anaglyph, side by side, raw; S save; Q quit.\n"
    "\n"
    "  --headless           no window: the keys come from --keys or --keys-from, and the\n"
    "                       session ends after the last one\n"
    "  --keys \"K K ...\"     keys in order: d+ d- a+ a- s+ s- (eye distance, angle, shift),\n"
    "                       fd+ ... (fine), view, anaglyph, sbs, raw, save, quit; each waits\n"
    "                       until the program's frames show the one before\n"
    "  --keys-from FILE     the same from a file, '-' for standard input as it comes\n"
    "  --frames N           frames measured at the start and after each key (default 1)\n"
    "  --out DIR            at the end, the last frame as DIR/anaglyph.png,\n"
    "                       DIR/side_by_side.png and DIR/raw.png\n"
    "  --save-to FILE       where the save key writes (default: PROFILE.txt)\n"
    "  --steps D,A,S        steps of eye distance, angle, shift (default: a tenth of the\n"
    "                       profile's value; 0.005, 0.005, 0.001 for a value of 0)\n"
    "  --eye0-columns even|odd   the screen columns of eye 0 (default even, as on Mesa)\n"
    "  --budget-near P, --budget-far P   the comfort budget, percent of the width in front\n"
    "                       of and behind the screen (default 1 and 2: BSkyB 3D guidelines)\n"
    "  --library-dir DIR, --device-root DIR   a capture copy of the library and the device\n"
    "                       root it was built for (default: this build's, see --where)\n"
    "  --program-log FILE   the program's output (default: a temporary file, removed)\n"
    "  --font FILE          the window's font\n"
    "  --device             a game on a device over adb: PROGRAM is its package name\n"
    "  --serial SERIAL      the device, when adb sees more than one\n"
    "\n"
    "Exit status: 0 done, 1 the program or the transport failed, 2 bad input.\n";

bool ParseTuneOptions(int argc, char** argv, const BuiltPlaces& built, TuneOptions* options, std::string* problem) {
    options->m_library_dir = built.m_library_dir;
    options->m_device_root = built.m_device_root;
    options->m_panel_driver = built.m_panel_driver;
    options->m_font = built.m_font;
    std::string frames = "1";
    struct Valued {
        const char* m_name;
        std::string* m_value;
    };
    std::string steps;
    std::string columns;
    std::string budget_near;
    std::string budget_far;
    const Valued valued[] = {
        {"--keys", &options->m_keys},
        {"--keys-from", &options->m_keys_from},
        {"--frames", &frames},
        {"--out", &options->m_session.m_out_dir},
        {"--save-to", &options->m_session.m_save_path},
        {"--steps", &steps},
        {"--eye0-columns", &columns},
        {"--budget-near", &budget_near},
        {"--budget-far", &budget_far},
        {"--library-dir", &options->m_library_dir},
        {"--device-root", &options->m_device_root},
        {"--program-log", &options->m_program_log},
        {"--font", &options->m_font},
        {"--serial", &options->m_serial},
    };
    int index = 1;
    for (; index < argc; ++index) {
        const std::string argument = argv[index];
        if (argument == "--") {
            ++index;
            break;
        }
        if (argument == "--help" || argument == "-h") {
            options->m_help = true;
            return true;
        }
        if (argument == "--where") {
            options->m_where = true;
            return true;
        }
        if (argument == "--headless" || argument == "--device") {
            (argument == "--headless" ? options->m_headless : options->m_device) = true;
            continue;
        }
        const Valued* option = nullptr;
        for (const Valued& each : valued) option = argument == each.m_name ? &each : option;
        if (option != nullptr) {
            if (index + 1 >= argc) {
                *problem = argument + " needs a value";
                return false;
            }
            *option->m_value = argv[++index];
        } else if (argument[0] == '-' && argument.size() > 1) {
            *problem = "unknown option " + argument;
            return false;
        } else if (options->m_profile.empty()) {
            options->m_profile = argument;
        } else {
            *problem = "one PROFILE.txt only; the program follows '--'";
            return false;
        }
    }
    for (; index < argc; ++index) options->m_program.push_back(argv[index]);

    SessionSettings& session = options->m_session;
    const struct {
        bool m_bad;
        const char* m_problem;
    } checks[] = {
        {options->m_profile.empty(), "no PROFILE.txt"},
        {options->m_program.empty(), "no program: put it after '--'"},
        {!ParseFrames(frames, &session.m_frames_per_key), "--frames takes a whole number from 1 to 1000"},
        {!steps.empty() && !(options->m_steps_given = ParseSteps(steps, &session.m_steps)),
         "--steps takes three numbers above 0 (at least 0.000001), D,A,S"},
        {!columns.empty() && !ParseColumns(columns, &session.m_eye0_columns), "--eye0-columns takes even or odd"},
        {!budget_near.empty() && !ParsePercent(budget_near, &session.m_budget.m_near_percent),
         "--budget-near takes a percentage above 0 and at most 100"},
        {!budget_far.empty() && !ParsePercent(budget_far, &session.m_budget.m_far_percent),
         "--budget-far takes a percentage above 0 and at most 100"},
        {!options->m_keys.empty() && !options->m_keys_from.empty(), "--keys and --keys-from do not go together"},
        {options->m_headless && options->m_keys.empty() && options->m_keys_from.empty(),
         "--headless needs --keys or --keys-from"},
        {!options->m_serial.empty() && !options->m_device, "--serial goes with --device"},
    };
    for (const auto& check : checks) {
        if (check.m_bad) {
            *problem = check.m_problem;
            return false;
        }
    }
    if (session.m_save_path.empty()) session.m_save_path = options->m_profile;
    return true;
}

}  // namespace ovo_tune
