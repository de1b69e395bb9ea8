// The process name read in place: the area's bounds from /proc/self/stat, and the name
// inside an area as the kernel's reader of /proc/self/cmdline would give it.
#include <gtest/gtest.h>

#include <errno.h>

#include <string>
#include <vector>

#include "config/command_line_area.h"
#include "config/stereo_profile_fields.h"
#include "support/scenario_process.h"

namespace {

// A line of /proc/self/stat with `count` fields after the name (field 3 on), fields 48 and
// 49 as given and every other one its own number.
std::string StatLine(const std::string& start, const std::string& end, int count = 50) {
    std::string line = "4242 (a) b) c)";
    for (int field = 3; field < 3 + count; ++field) {
        line += ' ' + (field == 48 ? start : field == 49 ? end : field == 3 ? "R" : std::to_string(field));
    }
    return line + '\n';
}

TEST(CommandLineAreaTest, TheBoundsAreFields48And49AfterTheName) {
    const struct {
        std::string m_line;
        size_t m_start;
        size_t m_length;
    } cases[] = {
        {StatLine("4096", "4160"), 4096, 64},
        {StatLine("4096", "4160", 47), 4096, 64},  // the last field wanted ends the line
        {StatLine("4096", "4160", 42), 0, 0},      // qemu-user writes 44 fields
        {StatLine("0", "0"), 0, 0},                // withheld by the kernel
        {StatLine("4160", "4096"), 0, 0},
        {StatLine("4096", "4096"), 0, 0},
        {StatLine("40x6", "4160"), 0, 0},
        {StatLine("4096", ""), 0, 0},
        {StatLine("4096", "99999999999999999999999"), 0, 0},
        {"4242 a b c", 0, 0},
    };
    for (const auto& each : cases) {
        const ovo::CommandLineArea area = ovo::ParseCommandLineArea(each.m_line.c_str());
        EXPECT_EQ(reinterpret_cast<size_t>(area.m_start), each.m_start) << each.m_line;
        EXPECT_EQ(area.m_length, each.m_length) << each.m_line;
    }
}

TEST(CommandLineAreaTest, OnThisKernelTheAreaBeginsAtTheFirstArgument) {
    if (!CommandLineFileFollowsRenames()) GTEST_SKIP() << "/proc/self is the emulator's here";
    const ovo::CommandLineArea area = ovo::LocateCommandLineArea();
    EXPECT_EQ(area.m_start, program_invocation_name);
    EXPECT_EQ(area.m_length, CommandLineFile().size());
}

TEST(CommandLineAreaTest, TheNameIsCutAsTheFileReaderCutsIt) {
    const size_t limit = ovo::PROFILE_PROCESS_NAME_CAPACITY - 1;
    const std::string n254(limit - 1, 'n');
    const struct {
        std::string m_area;
        ovo::CommandLineName m_result;
        std::string m_name;
    } cases[] = {
        {std::string("com.android.wallpaper\0--flag\0", 29), ovo::COMMAND_LINE_NAME_READ, "com.android.wallpaper"},
        {std::string("\0com.android.wallpaper\0", 23), ovo::COMMAND_LINE_NAME_READ, ""},
        {std::string(" app \0", 6), ovo::COMMAND_LINE_NAME_READ, " app "},
        // No NUL: the kernel reads on past the area, below its reader's limit.
        {"com", ovo::COMMAND_LINE_NAME_RUNS_ON, "com"},
        {n254, ovo::COMMAND_LINE_NAME_RUNS_ON, n254},
        {n254 + 'n', ovo::COMMAND_LINE_NAME_READ, n254 + 'n'},
        {n254 + 'n' + '\0', ovo::COMMAND_LINE_NAME_READ, n254 + 'n'},
        {n254 + std::string(200, 'n') + '\0', ovo::COMMAND_LINE_NAME_READ, n254 + 'n'},
    };
    for (const auto& each : cases) {
        // Exactly the area's bytes, so that the sanitizers see any read past them.
        const std::vector<char> bytes(each.m_area.begin(), each.m_area.end());
        char name[ovo::PROFILE_PROCESS_NAME_CAPACITY];
        EXPECT_EQ(ovo::ReadNameInArea({bytes.data(), bytes.size()}, name), each.m_result) << each.m_name;
        EXPECT_EQ(name, each.m_name);
    }
    char name[ovo::PROFILE_PROCESS_NAME_CAPACITY] = "stale";
    EXPECT_EQ(ovo::ReadNameInArea({}, name), ovo::COMMAND_LINE_AREA_UNKNOWN);
    EXPECT_STREQ(name, "");
}

}  // namespace
