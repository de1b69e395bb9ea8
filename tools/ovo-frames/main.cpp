// ovo-frames: makes and inspects the column-interleaved frames of a stereo panel.
#include <cstdio>
#include <cstring>

#include "command_line.h"
#include "disparity_commands.h"
#include "frame_commands.h"

namespace {

using namespace ovo_frames_tool;

constexpr uint32_t MAKES_FRAME = OPTION_OUTPUT | OPTION_EYE0_COLUMNS;
constexpr uint32_t MEASURES = OPTION_EYE0_COLUMNS | OPTION_MATCHING;

const Command COMMANDS[] = {
    {"interleave", 2, MAKES_FRAME | OPTION_MASK_AREA, MAKES_FRAME, RunInterleave},
    {"preview", 1, MAKES_FRAME, MAKES_FRAME, RunPreview},
    {"anaglyph", 1, MAKES_FRAME, MAKES_FRAME, RunAnaglyph},
    {"compare", 2, OPTION_TOLERANCE, 0, RunCompare},
    {"disparity", 1, MEASURES | OPTION_MAP | OPTION_BUDGET | OPTION_BANDS, OPTION_EYE0_COLUMNS, RunDisparity},
    {"match-eyes", 2, MEASURES, OPTION_EYE0_COLUMNS, RunMatchEyes},
};

bool IsHelp(const char* argument) { return std::strcmp(argument, "--help") == 0 || std::strcmp(argument, "-h") == 0; }

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
