// The stereo profile in the library: the file format (hostile counts, types, truncation),
// what the items set, the mode by process name, the live-wallpaper presets, and the process
// name read in place: the area's bounds from /proc/self/stat, and the name inside an area as
// the kernel's reader of /proc/self/cmdline would give it.
#include <errno.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "config/command_line_area.h"
#include "config/profile_file.h"
#include "config/stereo_profile.h"
#include "support/device_files.h"
#include "support/scenario_process.h"

namespace {

// Files are built byte by byte (big-endian), independently of the library's writer.
std::string Be32(uint32_t value) { return {char(value >> 24), char(value >> 16), char(value >> 8), char(value)}; }

// One item exactly as given (the count may be negative or disagree with the payload).
std::string Item(uint32_t id, int type, int count, const std::string& payload = "") {
    return Be32(id) + Be32(uint32_t(type & 0xFFFF) << 16 | uint32_t(count & 0xFFFF)) + payload;
}

std::string Words(uint32_t id, std::initializer_list<uint32_t> values, int type = 0x1003) {
    std::string payload;
    for (uint32_t value : values) payload += Be32(value);
    return Item(id, type, int(values.size()), payload);
}

std::string Float(uint32_t id, float value) {
    uint32_t bits;
    std::memcpy(&bits, &value, sizeof(bits));
    return Words(id, {bits});
}

std::string File(std::vector<std::string> items, uint32_t validity = 1) {
    std::string bytes = Be32(0) + Be32(validity) + Be32(0) + Be32(0);
    items.resize(std::max<size_t>(items.size(), 24), Item(0, 0, 0));
    for (const std::string& item : items) bytes += item;
    return bytes;
}

const std::string ENABLED_SHADER = Words(0x2301, {1}) + Words(0x2403, {1});
constexpr size_t HEADS = 16 + 24 * 8;  // a file of items without payload

// All the fields on one line, so that a check can name just the parts it cares about.
std::string Describe(const ovo::StereoProfileFields& f) {
    char line[640];
    std::snprintf(line, sizeof(line),
                  "enabled=%d mode=0x%X size=%dx%d distance=%g shift=%g angle=%g steps=%g restart=%g distance_set=%g "
                  "shift_set=%g angle_set=%g target=%dx%d screen=%dx%d axis=0x%X shift_axis=0x%X ramp_param=0x%X "
                  "split=0x%X order=0x%X ramp=0x%X flags=%d%d%d%d%d%d%d",
                  f.m_enabled, f.m_mode, f.m_width, f.m_height, double(f.m_eye_distance), double(f.m_eye_shift),
                  double(f.m_eye_angle), double(f.m_ramp_steps), double(f.m_ramp_restart),
                  double(f.m_eye_distance_set), double(f.m_eye_shift_set), double(f.m_eye_angle_set),
                  f.m_target_width, f.m_target_height, f.m_screen_width, f.m_screen_height, f.m_eye_axis,
                  f.m_shift_axis, f.m_ramp_param, f.m_split, f.m_eye_order, f.m_ramp, f.m_shader_convert,
                  f.m_use_screen_size, f.m_auto_eye, f.m_eye_target, f.m_valid, f.m_swap_eye_mask, f.m_force_portrait);
    return line;
}

// A profile that nothing has set, as Describe writes it.
const char DEFAULTS[] =
    "enabled=0 mode=0x0 size=0x0 distance=0 shift=0 angle=0 steps=0 restart=10 distance_set=0 shift_set=0 "
    "angle_set=0 target=0x0 screen=0x0 axis=0x3001 shift_axis=0x3001 ramp_param=0x3001 split=0x3101 "
    "order=0x3106 ramp=0x3201 flags=0000010";

bool Has(const std::string& line, const std::string& parts) {
    std::istringstream words(parts);
    for (std::string part; words >> part;)
        if ((" " + line + " ").find(" " + part + " ") == std::string::npos) return false;
    return true;
}

TEST(ProfileFileTest, ReaderAndWriterCases) {
    std::string words_40;
    for (uint32_t value = 0; value < 40; ++value) words_40 += Be32(value + 100);
    static const std::string bytes_200 = [] { std::string b; for (int v = 0; v < 200; ++v) b += char(v); return b; }();
    // An oversized item in slot 0 shows where the next item is read from; one in the last
    // slot shows whether it spills into slot 24.
    const auto oversized = [&](bool words_first) {
        std::vector<std::string> items(24, Item(0, 0, 0));
        items[words_first ? 0 : 23] = Item(0x2303, 0x1003, 40, words_40);
        items[words_first ? 23 : 0] = Item(0x2501, 0x1005, 200, bytes_200);
        items[1] = Words(0x2102, {0x3107});
        return File(items);
    };
    using T = const ovo::ProfileTable&;
    const struct {
        const char* m_name;
        std::string m_bytes;
        int m_complete_items;
        size_t m_consumed;
        bool m_out_of_range;
        bool (*m_check)(T);
    } cases[] = {
        {"header words; other header bytes kept (by the write-back); 0x1004 like 0x1003; 5 text bytes take 5",
         "\x01\x02\x03\x04" + Be32(0x11223344) + Be32(0xA0B0C0D0) + "\x05\x06\x07\x08" +
             File({Item(0x2001, 0x1003, 1, "\xBD\x0F\x5C\x29"), Words(0x2201, {640, 720}, 0x1004),
                   Item(0x2501, 0x1005, 5, std::string("abcd\0", 5)), Words(0x2101, {0x3102}),
                   Item(0x7777, 0x0042, -9)}).substr(16),
         24, HEADS + 4 + 8 + 5 + 4, false,
         [](T t) {
             return t.m_validity == 0x11223344 && t.m_header_word == 0xA0B0C0D0 &&
                    t.m_items[0].m_data[0] == 0xBD0F5C29 && t.m_items[1].m_data[1] == 720 &&
                    std::memcmp(t.m_items[2].m_data, "abcd", 5) == 0 && t.m_items[3].m_data[0] == 0x3102;
         }},
        {"40 words keep 32 and skip the rest; 128 of 200 text bytes stay in the last slot", oversized(true), 24,
         HEADS + 160 + 4 + 200, true, [](T t) {
             return t.m_items[0].m_data_count == 40 && t.m_items[0].m_data[31] == 131 &&
                    t.m_items[1].m_data[0] == 0x3107 && t.m_items[24].m_id == 0 &&
                    std::memcmp(t.m_items[23].m_data, bytes_200.data(), 128) == 0;
         }},
        {"200 text bytes keep 128 and skip the rest; 32 of 40 words stay in the last slot", oversized(false), 24,
         HEADS + 160 + 4 + 200, true, [](T t) {
             return std::memcmp(t.m_items[0].m_data, bytes_200.data(), 128) == 0 && t.m_items[1].m_data[0] == 0x3107 &&
                    t.m_items[23].m_data[31] == 131 && t.m_items[24].m_id == 0;
         }},
        {"negative counts and an unknown type read no payload",
         File({Item(0x2001, 0x1003, -1), Item(0x2501, 0x1005, -32768), Item(0x2002, 0x0042, 3), Words(0x2003, {7})}),
         24, HEADS + 4, true, [](T t) { return t.m_items[0].m_data[0] == 0 && t.m_items[3].m_data[0] == 7; }},
        {"a count of 32767 words stops at the end of the data, inside a word",
         File({}).substr(0, 16) + Item(0x2001, 0x1003, 32767, Be32(5) + Be32(7) + std::string("\0\x09", 2)), 0,
         16 + 8 + 10, true, [](T t) { return t.m_items[0].m_data[1] == 7 && t.m_items[0].m_data[2] == 0; }},
        {"a count of 40 words, the data ends inside the part that is skipped",
         File({}).substr(0, 16) + Item(0x2303, 0x1003, 40, words_40.substr(0, 33 * 4 + 2)), 0, 16 + 8 + 134, true,
         [](T t) { return t.m_items[0].m_data[31] == 131; }},
        {"a file ending inside a head keeps the numbers that arrived whole",
         File({Words(0x2403, {1}), Be32(0x2101) + "\x10\x03"}).substr(0, 16 + 12 + 6), 1, 16 + 12 + 6, false,
         [](T t) {
             return t.m_items[1].m_id == 0x2101 && t.m_items[1].m_data_type == 0x1003 && t.m_items[1].m_data_count == 0;
         }},
        {"8 bytes of header bring the validity word", File({}, 7).substr(0, 8), 0, 8, false,
         [](T t) { return t.m_validity == 7; }},
        {"an empty file leaves the table clear", "", 0, 0, false,
         [](T t) { return t.m_validity == 0 && t.m_items[0].m_id == 0; }},
        {"bytes after the 24th item are not read", File({}) + Words(0x2403, {1}), 24, HEADS, false,
         [](T t) { return t.m_items[24].m_id == 0; }},
    };
    for (const auto& each : cases) {
        SCOPED_TRACE(each.m_name);
        // The library reads a stream, the fuzz targets memory; dirty tables show what a read fails to clear.
        ovo::ProfileTable table, from_memory;
        std::memset(&table, 0xAB, sizeof(table));
        std::memset(&from_memory, 0xCD, sizeof(from_memory));
        FILE* file = std::tmpfile();
        std::fwrite(each.m_bytes.data(), 1, each.m_bytes.size(), file);
        std::rewind(file);
        const auto result = ovo::ReadProfileTable(file, table);
        std::fclose(file);
        const auto* data = reinterpret_cast<const uint8_t*>(each.m_bytes.data());
        EXPECT_EQ(ovo::ReadProfileTable(data, each.m_bytes.size(), from_memory).m_bytes_consumed, each.m_consumed);
        EXPECT_EQ(std::memcmp(&table, &from_memory, sizeof(table)), 0) << "the readers differ";
        EXPECT_TRUE(each.m_check(table));
        EXPECT_EQ(result.m_complete_items, each.m_complete_items);
        EXPECT_EQ(result.m_bytes_consumed, each.m_consumed);
        EXPECT_EQ(result.m_count_out_of_range, each.m_out_of_range);

        // The writer refuses counts that overflow a slot and needs exactly the bytes it writes.
        uint8_t written[ovo::PROFILE_FILE_CAPACITY];
        const size_t size = result.m_bytes_consumed;
        if (result.m_count_out_of_range) {
            EXPECT_EQ(ovo::WriteProfileTable(table, written, sizeof(written)), 0u);
        } else if (!result.m_truncated) {
            EXPECT_EQ(ovo::WriteProfileTable(table, written, size), size);
            EXPECT_EQ(std::string(reinterpret_cast<const char*>(written), size), each.m_bytes.substr(0, size));
            EXPECT_EQ(ovo::WriteProfileTable(table, written, size - 1), 0u);
        }
    }
}

class StereoProfileTest : public ::testing::Test {
protected:
    void TearDown() override { device_files::Remove(ovo::PROFILE_PATH); }
    void Install(const std::string& bytes) {
        device_files::Remove(ovo::PROFILE_PATH);
        if (!bytes.empty()) device_files::Write(ovo::PROFILE_PATH, bytes);
    }
};

TEST_F(StereoProfileTest, TheFileDecidesTheFieldsAndTheMode) {
    // Every id once (the later split wins; the valid flag arrives as text: the id decides).
    std::vector<std::string> items = {
        Float(0x2001, -0.035f), Float(0x2002, 0.01f), Float(0x2003, -0.05f), Float(0x2004, 2.0f),
        Words(0x2005, {0x3002}), Words(0x2006, {0x3003}), Words(0x2101, {0x3101}), Words(0x2102, {0x3107}),
        Words(0x2111, {0x3202}), Words(0x2201, {800, 480}), Words(0x2202, {1024, 600}), Words(0x2301, {5})};
    for (uint32_t id : {0x2302, 0x2303, 0x2304, 0x2305, 0x2306, 0x2307, 0x2308}) items.push_back(Words(id, {1}));
    items.insert(items.end(), {Item(0x2403, 0x1005, 1, "\x01"), Item(0x2501, 0x1005, 4, std::string("abc\0", 4)),
                               Words(0x9999, {1}), Item(0, 0x1003, 1, Be32(7)), Words(0x2101, {0x3102})});
    const std::string sizes = Words(0x2201, {640, 720}) + Words(0x2202, {1280, 720});
    const struct {
        std::string m_bytes;
        bool m_loaded;
        const char* m_parts;
    } cases[] = {
        {"", false, DEFAULTS},
        {File({Float(0x2001, -0.035f), sizes, ENABLED_SHADER}, 0), false, DEFAULTS},
        {File(items), true,
         "enabled=1 mode=0x1002 size=1024x600 distance=-0.035 shift=0.01 angle=-0.05 steps=2 restart=10 "
         "distance_set=-0.035 shift_set=0.01 angle_set=-0.05 target=800x480 screen=1024x600 axis=0x3002 "
         "shift_axis=0x3001 ramp_param=0x3003 split=0x3102 order=0x3107 ramp=0x3202 flags=1111110"},
        {File({sizes, Words(0x2403, {1})}), true, "enabled=1 mode=0x1001 size=640x720"},
        {File({Float(0x2003, -0.05f), sizes, ENABLED_SHADER, Words(0x2403, {0})}), false,
         "enabled=0 mode=0x0 size=0x0 angle=-0.05 target=640x720"},
    };
    for (const auto& each : cases) {
        Install(each.m_bytes);
        testing::internal::CaptureStderr();
        ovo::StereoProfile profile;
        const std::string log = testing::internal::GetCapturedStderr();
        const std::string line = Describe(profile);
        EXPECT_TRUE(Has(line, each.m_parts)) << line;
        const ovo::StereoMode mode = profile.ResolveMode();
        profile.m_enabled = profile.m_shader_convert = !profile.m_enabled;
        EXPECT_EQ(profile.ResolveMode(), mode) << "resolved once, then kept";
        EXPECT_EQ(profile.LoadProfile(), each.m_loaded) << line;
        // One line per item read, with the count as the file gives it.
        EXPECT_EQ(std::count(log.begin(), log.end(), '\n'), each.m_bytes.empty() ? 1 : 25) << log;
        EXPECT_EQ(log.find("E/ZVT: item.m_data_count = 2\n") != std::string::npos, !each.m_bytes.empty()) << log;
    }
}

// Run in a process started under the name under test; prints what the profile became.
TEST(StereoProfileScenario, DISABLED_Print) {
    testing::internal::CaptureStderr();
    ovo::StereoProfile profile;
    testing::internal::GetCapturedStderr();
    char name[ovo::PROFILE_PROCESS_NAME_CAPACITY];
    ovo::StereoProfile::ReadProcessName(name);
    profile.ResolveMode();
    std::printf(" %s kind=%d name_length=%zu \n", Describe(profile).c_str(), profile.DetectLiveWallpaper(),
                std::strlen(name));
}

TEST_F(StereoProfileTest, TheProcessNameDecidesTheModeAndThePreset) {
    const struct {
        std::string m_name;
        std::string m_bytes;
        const char* m_parts;
    } cases[] = {
        {"com.Paladog.Lite", File({ENABLED_SHADER}), "mode=0x1003"},
        {"com.android.wallpaper", "", "kind=2 enabled=1 mode=0x1002 distance=-0.005 size=480x800"},
        // The preset wins over an accepted file but keeps the file's shift_set and ramp_param.
        {"fishnoodle.snowfall", File({Float(0x2002, 0.02f), Words(0x2006, {0x3003}), Words(0x2101, {0x3102}),
                                      Words(0x2201, {1024, 600}), ENABLED_SHADER}),
         "kind=1 distance=-0.035 shift=0 split=0x3101 size=480x800 shift_set=0.02 ramp_param=0x3003"},
        // Only the first 255 bytes are read, and they are no wallpaper's name.
        {"com.android.wallpaper" + std::string(400, 'x'), File({ENABLED_SHADER}), "name_length=255 kind=0 mode=0x1002"},
    };
    for (const auto& each : cases) {
        Install(each.m_bytes);
        const ScenarioResult result = RunScenario(each.m_name.c_str(), "StereoProfileScenario.DISABLED_Print");
        EXPECT_TRUE(Has(result.m_output, each.m_parts)) << each.m_name.substr(0, 40) << ": " << result.m_output;
    }
}

TEST(ProcessNamesTest, NamesAreComparedExactly) {
    for (const char* name : {"com.rovio.angrybirdsrio.korean", "com.rovio.angrybirds", "com.rovio.angrybirds_lite",
                             "com.rovio.angrybirdsseasons", "com.Paladog.Lite", "com.rovio.angrybirdsrio",
                             "com.rovio.angrybirdsstarwars.ads.iap"})
        EXPECT_TRUE(ovo::IsListedProcess(name)) << name;
    const std::pair<const char*, int> wallpapers[] = {
        {"fishnoodle.snowfall_free", 1}, {"fishnoodle.snowfall", 1},  {"com.android.wallpaper", 2},
        {"fishnoodle.koipond_free", 3},  {"fishnoodle.koipond", 3},   {"fishnoodle.aquarium_free", 4},
        {"fishnoodle.aquarium", 4},      {"fishnoodle.clouds_free", 5}, {"fishnoodle.clouds", 5},
        {"au.com.dealsmap.lwp.cube.PackEarth", 6}};
    for (auto [name, kind] : wallpapers) {
        EXPECT_EQ(ovo::LiveWallpaperKindOf(name), kind) << name;
        EXPECT_TRUE(ovo::IsLiveWallpaperNamePrefix(name)) << name;
        EXPECT_FALSE(ovo::IsListedProcess(name)) << name;
    }
    for (const char* name : {"com.rovio.angrybirdsstarwars", "com.paladog.lite", "com.Paladog", "com.Paladog.Lite2"})
        EXPECT_FALSE(ovo::IsListedProcess(name)) << name;
    const std::pair<const char*, int> cases[] = {{"com.android.wallpaper.livepicker", 0}, {"fishnoodle.snowfal", 0},
                                                 {"Fishnoodle.clouds", 0}, {nullptr, 0}};
    for (auto [name, kind] : cases) EXPECT_EQ(ovo::LiveWallpaperKindOf(name), kind) << (name ? name : "null");
    // What a name cut at the end of the argument area may still grow into.
    const std::pair<const char*, bool> prefixes[] = {{"com", true}, {"com.android.wallpaper", true},
                                                     {"com.android.wallpaperX", false}, {"fishnoodle.clouds_fre", true},
                                                     {"ffishnoodle", false}};
    for (auto [prefix, begins] : prefixes) EXPECT_EQ(ovo::IsLiveWallpaperNamePrefix(prefix), begins) << prefix;
}

// Kinds outside 1..6 would index past the preset table.
TEST(LiveWallpaperTest, EachPresetSetsItsValuesAndOtherKindsNothing) {
    const char* const per_kind[] = {"distance=-0.035 angle=-0.05 steps=2 restart=5",
                                    "distance=-0.005 angle=-3 steps=1 restart=-1",
                                    "distance=-0.001 angle=-20 steps=1 restart=-1",
                                    "distance=-0.03 angle=-0.01 steps=5 restart=1",
                                    "distance=-0.04 angle=-0.01 steps=30 restart=1",
                                    "distance=-0.001 angle=-20 steps=1 restart=-1"};
    for (int kind = -1; kind <= 7; ++kind) {
        SCOPED_TRACE(kind);
        // Start away from the preset, so that every value it sets shows.
        ovo::StereoProfileFields fields;
        fields.m_eye_shift = fields.m_eye_shift_set = 0.25f;
        fields.m_ramp_param = fields.m_shift_axis = fields.m_eye_axis = ovo::STEREO_AXIS_Y;
        fields.m_split = ovo::STEREO_SPLIT_TOP_BOTTOM;
        fields.m_use_screen_size = fields.m_auto_eye = fields.m_eye_target = true;
        const std::string before = Describe(fields);
        ovo::ApplyLiveWallpaperPreset(fields, kind);
        const std::string line = Describe(fields);
        if (kind < 1 || kind > 6) {
            EXPECT_EQ(line, before);
            continue;
        }
        EXPECT_TRUE(Has(line, per_kind[kind - 1])) << line;
        EXPECT_EQ(fields.m_eye_distance_set, fields.m_eye_distance);
        EXPECT_EQ(fields.m_eye_angle_set, fields.m_eye_angle);
        EXPECT_TRUE(Has(line, "enabled=1 mode=0x1002 size=480x800 shift=0 target=480x800 screen=480x800 axis=0x3001 "
                              "shift_axis=0x3001 split=0x3101 order=0x3106 ramp=0x3202 flags=1000101 shift_set=0.25 "
                              "ramp_param=0x3002")) << line;
    }
}

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
