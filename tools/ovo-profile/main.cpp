// ovo-profile: shows a binary stereo profile file as text and writes one from text.
//   ovo-profile show FILE [--process NAME]
//   ovo-profile write TEXT_FILE -o FILE
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <string>

#include "atomic_file.h"
#include "config/profile_file.h"
#include "profile_text_format.h"
#include "profile_text_parse.h"

namespace {

constexpr int EXIT_BAD_INPUT = 1;
constexpr int EXIT_USAGE = 2;

const char USAGE[] =
    "usage: ovo-profile show FILE [--process NAME]\n"
    "       ovo-profile write TEXT_FILE -o FILE\n"
    "       ovo-profile COMMAND --help\n";

const char SHOW_HELP[] =
    "usage: ovo-profile show FILE [--process NAME]\n"
    "\n"
    "Prints the binary stereo profile FILE as text: one 'name = value' line for every\n"
    "profile field that the file sets (the last item wins when an id repeats), an\n"
    "'item = ID TYPE ...' line for every item that sets no field, and the mode that a\n"
    "process named NAME (default: an empty name) runs in with this file, including the\n"
    "built-in live-wallpaper presets. Notes (validity word 0, truncated file, counts that\n"
    "do not fit a slot) are '#' comments. The output is accepted by 'ovo-profile write'.\n"
    "\n"
    "Fields: eye_distance, eye_shift, eye_angle, ramp_steps (floats; a NaN other than\n"
    "'nan' is shown by its mantissa bits, 'nan(0x1)'); eye_axis,\n"
    "ramp_param (x, y, z); split (side_by_side, top_bottom); eye_order (normal, swapped);\n"
    "ramp (on, off); target_width, target_height, screen_width, screen_height (integers);\n"
    "shader_convert, use_screen_size, auto_eye, eye_target, valid (true, false).\n"
    "Modes: off, plain, shader, shader_listed.\n";

const char WRITE_HELP[] =
    "usage: ovo-profile write TEXT_FILE -o FILE\n"
    "\n"
    "Writes the binary stereo profile FILE from the text form in TEXT_FILE ('-' reads\n"
    "standard input): 'name = value' lines as 'ovo-profile show' prints them, '#'\n"
    "comments and blank lines. The file gets a 16-byte header with validity word 1 and\n"
    "exactly 24 items: the fields' items in one fixed order, then the 'item' lines in\n"
    "their order, then padding (id 0, type 0, count 0).\n"
    "\n"
    "  name = value                 a profile field (see 'ovo-profile show --help');\n"
    "                               target_width/target_height and screen_width/\n"
    "                               screen_height are one item each and come in pairs\n"
    "  item = ID 0x1003 WORD...     an item that sets no field: up to 32 words (also 0x1004),\n"
    "  item = ID 0x1005 \"TEXT\"      up to 128 text bytes (escapes \\\\ \\\" \\0 \\n \\t \\xNN),\n"
    "  item = ID TYPE COUNT         or a type without payload and its count\n"
    "  process = NAME               the process name for checking the mode line\n"
    "  mode = MODE                  checked: it must be the mode the profile resolves to\n"
    "\n"
    "Errors are reported as 'TEXT_FILE:LINE: what is wrong'; FILE is then left as it was.\n";

void PrintUsage(FILE* stream) { std::fputs(USAGE, stream); }

int UsageError(const char* problem) {
    std::fprintf(stderr, "ovo-profile: %s\n", problem);
    PrintUsage(stderr);
    return EXIT_USAGE;
}

bool IsHelp(const char* argument) { return std::strcmp(argument, "--help") == 0 || std::strcmp(argument, "-h") == 0; }

int Show(int argc, char** argv) {
    const char* file_name = nullptr;
    const char* process = nullptr;
    for (int index = 0; index < argc; ++index) {
        const char* argument = argv[index];
        if (IsHelp(argument)) {
            std::fputs(SHOW_HELP, stdout);
            return 0;
        }
        if (std::strcmp(argument, "--process") == 0) {
            if (index + 1 >= argc) return UsageError("--process needs a name");
            process = argv[++index];
        } else if (std::strncmp(argument, "--process=", 10) == 0) {
            process = argument + 10;
        } else if (argument[0] == '-' && argument[1] != '\0') {
            return UsageError((std::string("unknown option ") + argument).c_str());
        } else if (file_name == nullptr) {
            file_name = argument;
        } else {
            return UsageError("show takes one FILE");
        }
    }
    if (file_name == nullptr) return UsageError("show needs a FILE");

    FILE* file = std::fopen(file_name, "rb");
    if (file == nullptr) {
        std::fprintf(stderr, "ovo-profile: cannot open %s: %s\n", file_name, std::strerror(errno));
        return EXIT_BAD_INPUT;
    }
    ovo::ProfileTable table;
    ovo::ProfileReadResult read = ovo::ReadProfileTable(file, table);
    size_t trailing = 0;
    char scratch[4096];
    size_t got;
    while ((got = std::fread(scratch, 1, sizeof(scratch), file)) > 0) trailing += got;
    const bool failed = std::ferror(file) != 0;
    std::fclose(file);
    if (failed) {
        std::fprintf(stderr, "ovo-profile: cannot read %s\n", file_name);
        return EXIT_BAD_INPUT;
    }
    std::fputs(ovo_profile::FormatProfileText(table, read, process, trailing).c_str(), stdout);
    return std::fflush(stdout) == 0 ? 0 : EXIT_BAD_INPUT;
}

bool ReadText(const char* file_name, std::string& text) {
    const bool standard_input = std::strcmp(file_name, "-") == 0;
    FILE* file = standard_input ? stdin : std::fopen(file_name, "r");
    if (file == nullptr) return false;
    char buffer[4096];
    size_t got;
    while ((got = std::fread(buffer, 1, sizeof(buffer), file)) > 0) text.append(buffer, got);
    const bool failed = std::ferror(file) != 0;
    if (!standard_input) std::fclose(file);
    return !failed;
}

int Write(int argc, char** argv) {
    const char* text_name = nullptr;
    const char* output = nullptr;
    for (int index = 0; index < argc; ++index) {
        const char* argument = argv[index];
        if (IsHelp(argument)) {
            std::fputs(WRITE_HELP, stdout);
            return 0;
        }
        if (std::strcmp(argument, "-o") == 0 || std::strcmp(argument, "--output") == 0) {
            if (index + 1 >= argc) return UsageError("-o needs a FILE");
            if (output != nullptr) return UsageError("write takes one -o FILE");
            output = argv[++index];
        } else if (argument[0] == '-' && argument[1] != '\0') {
            return UsageError((std::string("unknown option ") + argument).c_str());
        } else if (text_name == nullptr) {
            text_name = argument;
        } else {
            return UsageError("write takes one TEXT_FILE");
        }
    }
    if (text_name == nullptr) return UsageError("write needs a TEXT_FILE");
    if (output == nullptr || output[0] == '\0') return UsageError("write needs -o FILE");

    std::string text;
    if (!ReadText(text_name, text)) {
        std::fprintf(stderr, "ovo-profile: cannot read %s: %s\n", text_name, std::strerror(errno));
        return EXIT_BAD_INPUT;
    }
    ovo::ProfileTable table;
    std::string error;
    const std::string shown_name = std::strcmp(text_name, "-") == 0 ? "<stdin>" : text_name;
    if (!ovo_profile::ParseProfileText(text, shown_name, table, error)) {
        std::fprintf(stderr, "%s\n", error.c_str());
        return EXIT_BAD_INPUT;
    }
    uint8_t bytes[ovo::PROFILE_FILE_CAPACITY];
    const size_t size = ovo::WriteProfileTable(table, bytes, sizeof(bytes));
    if (size == 0) {
        std::fprintf(stderr, "ovo-profile: %s: the items do not fit a profile file\n", shown_name.c_str());
        return EXIT_BAD_INPUT;
    }
    if (!ovo_profile::WriteFileAtomically(output, bytes, size, error)) {
        std::fprintf(stderr, "ovo-profile: %s\n", error.c_str());
        return EXIT_BAD_INPUT;
    }
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) return UsageError("missing command");
    const char* command = argv[1];
    if (IsHelp(command) || std::strcmp(command, "help") == 0) {
        PrintUsage(stdout);
        return 0;
    }
    if (std::strcmp(command, "show") == 0) return Show(argc - 2, argv + 2);
    if (std::strcmp(command, "write") == 0) return Write(argc - 2, argv + 2);
    return UsageError((std::string("unknown command ") + command).c_str());
}
