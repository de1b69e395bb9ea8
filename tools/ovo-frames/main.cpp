// ovo-frames: makes and inspects the column-interleaved frames of a stereo panel.
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "column_ops.h"
#include "common/png_writer.h"
#include "frame_compare.h"
#include "png_reader.h"

namespace {

using ovo_frames::ColumnParity;
using ovo_frames::RgbaFrame;

// As cmp and diff: 1 answers the question "do they differ", 2 is trouble.
constexpr int EXIT_DIFFERENT = 1;
constexpr int EXIT_TROUBLE = 2;
constexpr long TOLERANCE_MAX = 255;
// As large as the samples' pbuffers go.
constexpr long FRAME_SIDE_MAX = 8192;

const char USAGE[] =
    "usage: ovo-frames interleave EYE0.png EYE1.png --eye0-columns even|odd\n"
    "                  [--mask-area WxH --outside-eye 0|1] -o OUT.png\n"
    "       ovo-frames preview RAW.png --eye0-columns even|odd -o OUT.png\n"
    "       ovo-frames anaglyph RAW.png --eye0-columns even|odd -o OUT.png\n"
    "       ovo-frames compare A.png B.png [--tolerance N]\n"
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
    "Output files are written as 8-bit RGB (alpha dropped), complete or not at all.\n"
    "Bad input: a message on standard error, exit 2, no output file.\n";

struct Arguments {
    std::vector<const char*> m_files;
    const char* m_output = nullptr;
    const char* m_eye0_columns = nullptr;
    const char* m_tolerance = nullptr;
    const char* m_mask_area = nullptr;
    const char* m_outside_eye = nullptr;
};

struct Command {
    const char* m_name;
    size_t m_file_count;
    // interleave, preview and anaglyph: --eye0-columns and -o; compare: --tolerance.
    bool m_makes_frame;
    int (*m_run)(const Arguments&);
};

int Fail(const char* subject, const std::string& problem) {
    std::fprintf(stderr, "ovo-frames: %s: %s\n", subject, problem.c_str());
    return EXIT_TROUBLE;
}

int UsageError(const char* subject, const std::string& problem) {
    Fail(subject, problem);
    std::fputs(USAGE, stderr);
    return EXIT_TROUBLE;
}

std::string SizeText(const RgbaFrame& frame) {
    return std::to_string(frame.m_width) + "x" + std::to_string(frame.m_height);
}

bool Load(const char* path, RgbaFrame* frame) {
    std::string problem;
    if (ovo_frames::ReadPng(path, frame, &problem)) return true;
    Fail(path, problem);
    return false;
}

int Save(const char* path, const RgbaFrame& frame) {
    if (ovo_sample::WritePng(path, frame.m_width, frame.m_height, frame.m_pixels.data())) return 0;
    return Fail(path, "cannot write");
}

ColumnParity Eye0Columns(const Arguments& arguments) {
    return std::strcmp(arguments.m_eye0_columns, "odd") == 0 ? ovo_frames::COLUMN_PARITY_ODD
                                                             : ovo_frames::COLUMN_PARITY_EVEN;
}

// "WxH", both sides from 1 to FRAME_SIDE_MAX.
bool ParseSize(const char* text, int32_t* width, int32_t* height) {
    long sides[2] = {0, 0};
    for (int side = 0; side < 2; ++side) {
        if (*text < '0' || *text > '9') return false;
        char* end = nullptr;
        errno = 0;
        sides[side] = std::strtol(text, &end, 10);
        if (errno != 0 || sides[side] < 1 || sides[side] > FRAME_SIDE_MAX) return false;
        text = end;
        if (*text++ != (side == 0 ? 'x' : '\0')) return false;
    }
    *width = static_cast<int32_t>(sides[0]);
    *height = static_cast<int32_t>(sides[1]);
    return true;
}

// The mask area of the command line, or null without one; false after a usage error.
bool ReadMaskArea(const Arguments& arguments, ovo_frames::MaskArea* area, const ovo_frames::MaskArea** chosen) {
    *chosen = nullptr;
    if (arguments.m_mask_area == nullptr && arguments.m_outside_eye == nullptr) return true;
    if (arguments.m_mask_area == nullptr || arguments.m_outside_eye == nullptr) {
        UsageError("--mask-area", "goes with --outside-eye");
        return false;
    }
    if (!ParseSize(arguments.m_mask_area, &area->m_width, &area->m_height)) {
        UsageError("--mask-area", std::string("'") + arguments.m_mask_area + "' is not WxH");
        return false;
    }
    const std::string eye = arguments.m_outside_eye;
    if (eye != "0" && eye != "1") {
        UsageError("--outside-eye", "'" + eye + "' is neither 0 nor 1");
        return false;
    }
    area->m_outside_eye = eye == "1" ? 1 : 0;
    *chosen = area;
    return true;
}

int RunInterleave(const Arguments& arguments) {
    ovo_frames::MaskArea area = {};
    const ovo_frames::MaskArea* mask_area = nullptr;
    if (!ReadMaskArea(arguments, &area, &mask_area)) return EXIT_TROUBLE;
    RgbaFrame eye0;
    RgbaFrame eye1;
    if (!Load(arguments.m_files[0], &eye0) || !Load(arguments.m_files[1], &eye1)) return EXIT_TROUBLE;
    if (eye1.m_width != eye0.m_width || eye1.m_height != eye0.m_height) {
        return Fail(arguments.m_files[1],
                    SizeText(eye1) + ", but " + arguments.m_files[0] + " is " + SizeText(eye0));
    }
    return Save(arguments.m_output,
                ovo_frames::Interleave(eye0, eye1, Eye0Columns(arguments), mask_area));
}

// An interleaved frame, whose eyes' columns come in pairs.
bool LoadRaw(const char* path, RgbaFrame* raw) {
    if (!Load(path, raw)) return false;
    if (raw->m_width % 2 == 0) return true;
    Fail(path, "width " + std::to_string(raw->m_width) + " is odd; the eyes' columns come in pairs");
    return false;
}

int RunPreview(const Arguments& arguments) {
    RgbaFrame raw;
    if (!LoadRaw(arguments.m_files[0], &raw)) return EXIT_TROUBLE;
    return Save(arguments.m_output, ovo_frames::Preview(raw, Eye0Columns(arguments)));
}

int RunAnaglyph(const Arguments& arguments) {
    RgbaFrame raw;
    if (!LoadRaw(arguments.m_files[0], &raw)) return EXIT_TROUBLE;
    return Save(arguments.m_output, ovo_frames::Anaglyph(raw, Eye0Columns(arguments)));
}

std::string PixelText(const RgbaFrame& frame, int32_t x, int32_t y) {
    const uint8_t* pixel = frame.At(x, y);
    char text[32];
    std::snprintf(text, sizeof(text), "(%u, %u, %u, %u)", pixel[0], pixel[1], pixel[2], pixel[3]);
    return text;
}

int RunCompare(const Arguments& arguments) {
    const char* name_a = arguments.m_files[0];
    const char* name_b = arguments.m_files[1];
    int32_t tolerance = 0;
    if (arguments.m_tolerance != nullptr) {
        char* end = nullptr;
        errno = 0;
        const long value = std::strtol(arguments.m_tolerance, &end, 10);
        if (end == arguments.m_tolerance || *end != '\0' || errno != 0 || value < 0 || value > TOLERANCE_MAX) {
            return UsageError("--tolerance", std::string("'") + arguments.m_tolerance + "' is not a whole number from 0 to 255");
        }
        tolerance = static_cast<int32_t>(value);
    }
    RgbaFrame a;
    RgbaFrame b;
    if (!Load(name_a, &a) || !Load(name_b, &b)) return EXIT_TROUBLE;
    if (a.m_width != b.m_width || a.m_height != b.m_height) {
        std::printf("%s is %s, %s is %s: the sizes differ\n", name_a, SizeText(a).c_str(), name_b,
                    SizeText(b).c_str());
        return EXIT_DIFFERENT;
    }
    const ovo_frames::FrameDifference difference = ovo_frames::CompareFrames(a, b, tolerance);
    if (difference.m_differing_pixels == 0) return 0;
    const int32_t x = difference.m_first_x;
    const int32_t y = difference.m_first_y;
    std::printf("%s and %s differ: %lld pixels by more than %d, largest difference %d, first at (%d, %d): %s and %s\n",
                name_a, name_b, static_cast<long long>(difference.m_differing_pixels), tolerance,
                difference.m_largest, x, y, PixelText(a, x, y).c_str(), PixelText(b, x, y).c_str());
    return EXIT_DIFFERENT;
}

const Command COMMANDS[] = {
    {"interleave", 2, true, RunInterleave},
    {"preview", 1, true, RunPreview},
    {"anaglyph", 1, true, RunAnaglyph},
    {"compare", 2, false, RunCompare},
};

bool IsHelp(const char* argument) { return std::strcmp(argument, "--help") == 0 || std::strcmp(argument, "-h") == 0; }

struct Option {
    const char* m_name;
    const char* Arguments::*m_value;
    // Offered by the commands that make a frame, or by the others.
    bool m_makes_frame;
    // Offered by this command alone; null: by all of its kind.
    const char* m_command;
};

const Option OPTIONS[] = {
    {"-o", &Arguments::m_output, true, nullptr},
    {"--output", &Arguments::m_output, true, nullptr},
    {"--eye0-columns", &Arguments::m_eye0_columns, true, nullptr},
    {"--mask-area", &Arguments::m_mask_area, true, "interleave"},
    {"--outside-eye", &Arguments::m_outside_eye, true, "interleave"},
    {"--tolerance", &Arguments::m_tolerance, false, nullptr},
};

// The option of `command` that `argument` names, as "NAME" or "NAME=VALUE" (then `value`
// points at VALUE); null when there is none.
const Option* FindOption(const Command& command, const char* argument, const char** value) {
    for (const Option& option : OPTIONS) {
        if (option.m_makes_frame != command.m_makes_frame) continue;
        if (option.m_command != nullptr && std::strcmp(option.m_command, command.m_name) != 0) continue;
        const size_t length = std::strlen(option.m_name);
        if (std::strncmp(argument, option.m_name, length) != 0) continue;
        if (argument[length] == '=') *value = argument + length + 1;
        if (argument[length] == '=' || argument[length] == '\0') return &option;
    }
    return nullptr;
}

// Returns 0 when `arguments` holds a complete command line for `command`.
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
    if (!command.m_makes_frame) return 0;
    if (arguments->m_output == nullptr) return UsageError(command.m_name, "needs -o OUT.png");
    if (arguments->m_eye0_columns == nullptr) return UsageError(command.m_name, "needs --eye0-columns even|odd");
    if (std::strcmp(arguments->m_eye0_columns, "even") != 0 && std::strcmp(arguments->m_eye0_columns, "odd") != 0) {
        return UsageError("--eye0-columns", std::string("'") + arguments->m_eye0_columns + "' is neither even nor odd");
    }
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "ovo-frames: missing command\n%s", USAGE);
        return EXIT_TROUBLE;
    }
    for (int index = 1; index < argc; ++index) {
        if (IsHelp(argv[index])) {
            std::fputs(USAGE, stdout);
            return 0;
        }
    }
    for (const Command& command : COMMANDS) {
        if (std::strcmp(argv[1], command.m_name) != 0) continue;
        Arguments arguments;
        const int status = ParseArguments(command, argc - 2, argv + 2, &arguments);
        return status != 0 ? status : command.m_run(arguments);
    }
    return UsageError(argv[1], "unknown command");
}
