#include "command_line.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace ovo_frames_tool {

const char USAGE[] =
    "usage: ovo-frames interleave EYE0.png EYE1.png --eye0-columns even|odd\n"
    "                  [--mask-area WxH --outside-eye 0|1] -o OUT.png\n"
    "       ovo-frames preview RAW.png --eye0-columns even|odd -o OUT.png\n"
    "       ovo-frames anaglyph RAW.png --eye0-columns even|odd -o OUT.png\n"
    "       ovo-frames compare A.png B.png [--tolerance N]\n"
    "       ovo-frames disparity RAW.png --eye0-columns even|odd [--block N] [--max-shift N]\n"
    "                  [--map OUT.png] [--budget-near P] [--budget-far P] [--bands N]\n"
    "       ovo-frames match-eyes RAW.png NATIVE.png --eye0-columns even|odd [--block N]\n"
    "                  [--max-shift N]\n"
    "\n"
    "interleave  the frame the panel receives: the columns of one parity (0, 2, 4, ... are\n"
    "            even) from eye 0's image, the others from eye 1's image of the same size.\n"
    "            With a mask area, only its lower-left W x H pixels are interleaved (the\n"
    "            mask's reach) and the rest comes from the outside eye's image.\n"
    "preview     the two eyes of an interleaved frame side by side, eye 0 on the left, each\n"
    "            at full width (its columns doubled): 2W x H.\n"
    "anaglyph    red-cyan anaglyph of an interleaved frame: red from eye 0 (left), green\n"
    "            and blue from eye 1 (right), each eye in grey and at full width.\n"
    "compare     exit 0 when every channel of every pixel is within N (default 0), else\n"
    "            exit 1 and describe the difference. Frames of different sizes differ.\n"
    "disparity   the horizontal disparity x_eye1 - x_eye0 on the screen of an interleaved\n"
    "            frame in eye pixels (one column of each eye; W/2 of them span the screen;\n"
    "            flat content is at 0 although eye 1's columns lie a screen column beside\n"
    "            eye 0's), by blocks of N x N eye pixels (default 16) and shifts up to N\n"
    "            (default 32): the nearest and farthest (2nd and 98th percentile of the\n"
    "            measured blocks) in pixels and percent of the width, and a histogram, as\n"
    "            'name = value' lines. Negative is in front of the screen. --map writes the\n"
    "            blocks' depths as grey levels (white nearest, magenta unknown), --bands N\n"
    "            measures bands of N rows too. A 'warning' line when the range passes the\n"
    "            budget in percent of the width (default 1 in front, 2 behind: the BSkyB 3D\n"
    "            guidelines). Exit 0 when measured, 1 when no block had texture enough to\n"
    "            measure.\n"
    "match-eyes  each eye of an interleaved frame against every column of the flat frame\n"
    "            NATIVE.png of the same size: the shifts x_eye - x_native in screen pixels\n"
    "            (*_screen_px; shifts up to twice --max-shift) and what remains after moving\n"
    "            each block back (mean absolute difference per channel).\n"
    "Output files are written as 8-bit RGB (alpha dropped), complete or not at all.\n"
    "Bad input: a message on standard error, exit 2, no output file.\n";

namespace {

struct Option {
    const char* m_name;
    const char* Arguments::*m_value;
    OptionSet m_set;
    // How the usage writes it, for "needs ..."; null for a second name of an option.
    const char* m_usage;
};

const Option OPTIONS[] = {
    {"-o", &Arguments::m_output, OPTION_OUTPUT, "-o OUT.png"},
    {"--output", &Arguments::m_output, OPTION_OUTPUT, nullptr},
    {"--eye0-columns", &Arguments::m_eye0_columns, OPTION_EYE0_COLUMNS, "--eye0-columns even|odd"},
    {"--tolerance", &Arguments::m_tolerance, OPTION_TOLERANCE, "--tolerance N"},
    {"--block", &Arguments::m_block, OPTION_MATCHING, "--block N"},
    {"--max-shift", &Arguments::m_max_shift, OPTION_MATCHING, "--max-shift N"},
    {"--map", &Arguments::m_map, OPTION_MAP, "--map OUT.png"},
    {"--budget-near", &Arguments::m_budget_near, OPTION_BUDGET, "--budget-near P"},
    {"--budget-far", &Arguments::m_budget_far, OPTION_BUDGET, "--budget-far P"},
    {"--bands", &Arguments::m_bands, OPTION_BANDS, "--bands N"},
    {"--mask-area", &Arguments::m_mask_area, OPTION_MASK_AREA, "--mask-area WxH"},
    {"--outside-eye", &Arguments::m_outside_eye, OPTION_MASK_AREA, "--outside-eye 0|1"},
};

// The option of `command` that `argument` names, as "NAME" or "NAME=VALUE" (then `value`
// points at VALUE); null when there is none.
const Option* FindOption(const Command& command, const char* argument, const char** value) {
    for (const Option& option : OPTIONS) {
        if ((option.m_set & command.m_offered) == 0) continue;
        const size_t length = std::strlen(option.m_name);
        if (std::strncmp(argument, option.m_name, length) != 0) continue;
        if (argument[length] == '=') *value = argument + length + 1;
        if (argument[length] == '=' || argument[length] == '\0') return &option;
    }
    return nullptr;
}

std::string Quoted(const char* text) { return std::string("'") + text + "'"; }

}  // namespace

int Fail(const char* subject, const std::string& problem) {
    std::fprintf(stderr, "ovo-frames: %s: %s\n", subject, problem.c_str());
    return EXIT_TROUBLE;
}

int UsageError(const char* subject, const std::string& problem) {
    Fail(subject, problem);
    std::fputs(USAGE, stderr);
    return EXIT_TROUBLE;
}

int ParseArguments(const Command& command, int argc, char** argv, Arguments* arguments) {
    for (int index = 0; index < argc; ++index) {
        const char* argument = argv[index];
        if (argument[0] != '-' || argument[1] == '\0') {
            arguments->m_files.push_back(argument);
            continue;
        }
        const char* value = nullptr;
        const Option* option = FindOption(command, argument, &value);
        if (option == nullptr) return UsageError(argument, std::string("unknown option of ") + command.m_name);
        if (value == nullptr && index + 1 < argc) value = argv[++index];
        if (value == nullptr || value[0] == '\0') return UsageError(option->m_name, "needs a value");
        arguments->*(option->m_value) = value;
    }
    if (arguments->m_files.size() != command.m_file_count) {
        return UsageError(command.m_name, command.m_file_count == 1 ? "takes one image" : "takes two images");
    }
    for (const Option& option : OPTIONS) {
        if ((option.m_set & command.m_needed) != 0 && option.m_usage != nullptr && arguments->*(option.m_value) == nullptr) {
            return UsageError(command.m_name, std::string("needs ") + option.m_usage);
        }
    }
    const char* columns = arguments->m_eye0_columns;
    if (columns != nullptr && std::strcmp(columns, "even") != 0 && std::strcmp(columns, "odd") != 0) {
        return UsageError("--eye0-columns", Quoted(columns) + " is neither even nor odd");
    }
    return 0;
}

bool ParseWholeNumber(const char* option, const char* text, long lowest, long highest, int32_t* value) {
    if (text == nullptr) return true;
    char* end = nullptr;
    errno = 0;
    const long number = std::strtol(text, &end, 10);
    if (end == text || *end != '\0' || errno != 0 || number < lowest || number > highest) {
        UsageError(option, Quoted(text) + " is not a whole number from " + std::to_string(lowest) + " to " +
                               std::to_string(highest));
        return false;
    }
    *value = static_cast<int32_t>(number);
    return true;
}

bool ParseSize(const char* option, const char* text, long largest, int32_t* width, int32_t* height) {
    if (text == nullptr) return true;
    long sides[2] = {0, 0};
    const char* at = text;
    for (int side = 0; side < 2; ++side) {
        char* end = nullptr;
        errno = 0;
        if (*at >= '0' && *at <= '9') sides[side] = std::strtol(at, &end, 10);
        if (end == nullptr || errno != 0 || sides[side] < 1 || sides[side] > largest ||
            *end != (side == 0 ? 'x' : '\0')) {
            UsageError(option, std::string("'") + text + "' is not WxH");
            return false;
        }
        at = end + 1;
    }
    *width = static_cast<int32_t>(sides[0]);
    *height = static_cast<int32_t>(sides[1]);
    return true;
}

bool ParsePercent(const char* option, const char* text, float* value) {
    if (text == nullptr) return true;
    char* end = nullptr;
    errno = 0;
    const float number = std::strtof(text, &end);
    // Written so that NaN fails too.
    if (end == text || *end != '\0' || errno != 0 || !(number > 0.0f && number <= 100.0f)) {
        UsageError(option, Quoted(text) + " is not a percentage above 0 and at most 100");
        return false;
    }
    *value = number;
    return true;
}

}  // namespace ovo_frames_tool
