#ifndef OVO_TOOLS_OVO_FRAMES_COMMAND_LINE_H
#define OVO_TOOLS_OVO_FRAMES_COMMAND_LINE_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

// The command line of ovo-frames: its commands, their options and the messages for bad
// input.
namespace ovo_frames_tool {

// As cmp and diff: 1 answers the command's question with "no" (the frames differ, nothing
// could be measured), 2 is trouble.
constexpr int EXIT_NO = 1;
constexpr int EXIT_TROUBLE = 2;

extern const char USAGE[];

// Each option's text as given, null when absent.
struct Arguments {
    std::vector<const char*> m_files;
    const char* m_output = nullptr;
    const char* m_eye0_columns = nullptr;
    const char* m_tolerance = nullptr;
    const char* m_block = nullptr;
    const char* m_max_shift = nullptr;
    const char* m_map = nullptr;
    const char* m_budget_near = nullptr;
    const char* m_budget_far = nullptr;
    const char* m_bands = nullptr;
    const char* m_mask_area = nullptr;
    const char* m_outside_eye = nullptr;
};

// Which options a command offers or needs.
enum OptionSet : uint32_t {
    OPTION_OUTPUT = 1u << 0,
    OPTION_EYE0_COLUMNS = 1u << 1,
    OPTION_TOLERANCE = 1u << 2,
    OPTION_MATCHING = 1u << 3,  // --block, --max-shift
    OPTION_MAP = 1u << 4,
    OPTION_BUDGET = 1u << 5,  // --budget-near, --budget-far
    OPTION_BANDS = 1u << 6,
    OPTION_MASK_AREA = 1u << 7,  // --mask-area, --outside-eye
};

struct Command {
    const char* m_name;
    size_t m_file_count;
    uint32_t m_offered;
    uint32_t m_needed;
    int (*m_run)(const Arguments&);
};

// Says what is wrong with `subject` on standard error; returns EXIT_TROUBLE.
int Fail(const char* subject, const std::string& problem);
// The same, followed by the usage.
int UsageError(const char* subject, const std::string& problem);

// Returns 0 when `arguments` holds a complete command line for `command`, else says why
// and returns EXIT_TROUBLE.
int ParseArguments(const Command& command, int argc, char** argv, Arguments* arguments);

// A whole number from `lowest` to `highest` in `text` (left as it is when `text` is null);
// false, after a usage error naming `option`, when it is not one.
bool ParseWholeNumber(const char* option, const char* text, long lowest, long highest, int32_t* value);
// "WxH", each side a whole number from 1 to `largest`, likewise.
bool ParseSize(const char* option, const char* text, long largest, int32_t* width, int32_t* height);
// A percentage above 0 and at most 100, likewise.
bool ParsePercent(const char* option, const char* text, float* value);

}  // namespace ovo_frames_tool

#endif
