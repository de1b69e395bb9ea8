#ifndef OVO_TOOLS_OVO_TUNE_TUNE_OPTIONS_H
#define OVO_TOOLS_OVO_TUNE_TUNE_OPTIONS_H

#include <string>
#include <vector>

#include "tune_session.h"

// ovo-tune's command line.
namespace ovo_tune {

extern const char TUNE_USAGE[];

// Where this build put what the desktop transport needs (see --where).
struct BuiltPlaces {
    const char* m_library_dir;
    const char* m_device_root;
    const char* m_panel_driver;
    const char* m_font;
};

struct TuneOptions {
    std::string m_profile;
    std::vector<std::string> m_program;  // the program and its arguments, as given
    bool m_headless = false;
    std::string m_keys;       // --keys
    std::string m_keys_from;  // --keys-from FILE or -
    bool m_steps_given = false;
    SessionSettings m_session;
    std::string m_library_dir;
    std::string m_device_root;
    std::string m_panel_driver;
    std::string m_font;
    std::string m_program_log;
    bool m_device = false;
    std::string m_serial;
    bool m_where = false;
    bool m_help = false;
};

// False, with what is wrong in `problem`, for a command line that is not whole.
bool ParseTuneOptions(int argc, char** argv, const BuiltPlaces& built, TuneOptions* options, std::string* problem);

}  // namespace ovo_tune

#endif
