// ovo-tune run as a program without a display: bad input answered with the file (and line)
// at fault, exit status 2 and nothing written; and the device loop against a fake adb that
// records the exact commands and answers with a made stereo screen.
#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <regex>
#include <sstream>
#include <string>
#include <vector>

#include "common/png_writer.h"
#include "tool_process.h"
#include "tools/stereo_scene.h"
#include "tune_fixture.h"

namespace {

namespace fs = std::filesystem;

constexpr char SAMPLE_PROFILE[] = "examples/profiles/es2_scene_interleave.txt";
constexpr int TOOL_SECONDS = 30;
constexpr char LIVE_TUNING_FILE[] = "/sdcard/game_profile.txt";
constexpr char PROFILE_FILE[] = "/sdcard/stereoconv/game/stereo_gm.ovo";

struct Outcome {
    int m_status;
    std::string m_report;
    std::string m_errors;
};

class TuneBadInputTest : public TuneToolTest {
protected:
    Outcome Run(const std::vector<std::string>& arguments, const std::vector<std::string>& environment = {}) {
        ToolProcess tool;
        EXPECT_TRUE(tool.Start(arguments, environment, m_errors));
        tool.CloseInput();
        const int status = tool.Wait(TOOL_SECONDS);
        const std::string errors = ReadFile(m_errors);
        fs::remove(m_errors);
        return {status, tool.Report(), errors};
    }

    const std::string m_errors = (fs::path(testing::TempDir()) / "ovo-tune-errors.txt").string();
};

TEST_F(TuneBadInputTest, NamesTheFileAndLineExitsWithTwoAndWritesNothing) {
    const std::string profile = CopyProfile(SAMPLE_PROFILE, "profile.txt");
    const std::string original = ReadFile(profile);
    std::ofstream(In("typo.txt")) << "# a typo\nvalid = true\neye_distanse = 0.02\n";
    std::ofstream(In("plain.txt")) << "valid = true\nshader_convert = false\n";
    std::ofstream(In("file")) << "a file where a folder should be\n";
    const std::vector<std::string> headless = {"--headless", "--keys", "d+ save quit"};
    const std::vector<std::string> sample = {"/bin/true"};
    const struct {
        std::vector<std::string> m_arguments;
        std::string m_message;
    } cases[] = {
        {ToolArguments(profile, headless, {In("no-such-game")}),
         "ovo-tune: " + In("no-such-game") + ": no such program"},
        {ToolArguments(profile, headless, {"no-such-game-on-path"}), "ovo-tune: no-such-game-on-path: no such program"},
        {ToolArguments(In("typo.txt"), headless, sample),
         "ovo-tune: " + In("typo.txt") + ":3: unknown field 'eye_distanse'"},
        {ToolArguments(In("plain.txt"), headless, sample),
         "ovo-tune: " + In("plain.txt") +
             ": the library reads the live-tuning file only when the profile is valid and converts"},
        {ToolArguments(In("missing.txt"), headless, sample), "ovo-tune: cannot read " + In("missing.txt")},
        {ToolArguments(profile, {"--device-root", In("file") + "/root", "--headless", "--keys", "quit"}, sample),
         "ovo-tune: cannot write the live-tuning file in device root " + In("file") + "/root: cannot make the folder " +
             In("file") + "/root/sdcard"},
        {ToolArguments(profile, {"--library-dir", In("nothing"), "--headless", "--keys", "quit"}, sample),
         "ovo-tune: " + In("nothing") + "/libGLES_ovo.so: no library copy there"},
        {ToolArguments(profile, {"--headless", "--keys", "d+ x+ quit"}, sample), "ovo-tune: --keys: unknown key 'x+'"},
        {ToolArguments(profile, {"--headless", "--keys-from", In("no-keys.txt")}, sample),
         "ovo-tune: cannot open the key script " + In("no-keys.txt")},
        {ToolArguments(profile, {"--headless"}, sample), "ovo-tune: --headless needs --keys or --keys-from"},
        {ToolArguments(profile, {"--frames", "0", "--headless", "--keys", "quit"}, sample),
         "ovo-tune: --frames takes a whole number from 1 to 1000"},
        {ToolArguments(profile, {"--device", "--headless", "--keys", "quit"}, {"com.example.game; reboot"}),
         "ovo-tune: with --device the program is one package name"},
        {{OVO_TUNE_TOOL, profile, "--headless", "--keys", "quit"}, "ovo-tune: no program: put it after '--'"},
    };
    for (const auto& each : cases) {
        const Outcome outcome = Run(each.m_arguments);
        EXPECT_EQ(outcome.m_status, 2) << each.m_message;
        EXPECT_EQ(outcome.m_errors.rfind(each.m_message, 0), 0u) << outcome.m_errors;
        EXPECT_EQ(ReadFile(profile), original);
        EXPECT_EQ(FolderEntries(), (std::vector<std::string>{"file", "plain.txt", "profile.txt", "typo.txt"}));
        EXPECT_FALSE(fs::exists(BelowRoot(PROFILE_FILE))) << each.m_message;
        EXPECT_FALSE(fs::exists(BelowRoot(LIVE_TUNING_FILE))) << each.m_message;
    }
}

// The device's loop over adb, as far as it can be seen without a device: the commands in
// their order, the live values through the device's shell, the depth of its screen.
class TuneDeviceTest : public TuneBadInputTest {
protected:
    void SetUp() override {
        TuneBadInputTest::SetUp();
        // Eye pixels 200 wide: textured halves 4 pixels in front of the screen (2 % of the
        // width, beyond the 1 % budget) and 3 behind (1.5 %, within 2 %).
        const ovo_frames::RgbaFrame screen =
            ovo_test::MakeStereoFrame(200, {{64, -4.0f}, {64, 3.0f}}, ovo_frames::COLUMN_PARITY_EVEN);
        ASSERT_TRUE(
            ovo_sample::WritePng(In("screen.png").c_str(), screen.m_width, screen.m_height, screen.m_pixels.data()));
        m_profile = CopyProfile(SAMPLE_PROFILE, "profile.txt");
    }

    std::vector<std::string> Environment() const {
        return {"PATH=" OVO_TUNE_FAKE_ADB_DIR ":" + std::string(std::getenv("PATH")), "FAKE_ADB_LOG=" + In("adb.log"),
                "FAKE_ADB_SCREEN=" + In("screen.png"), "FAKE_ADB_GONE=" + In("gone"),
                "FAKE_ADB_PUSHED=" + In("pushed.ovo")};
    }

    // adb's calls, one a line, without the checks whether the game still runs (they come at
    // a rhythm of their own); their number in `checks`.
    std::vector<std::string> AdbCalls(int* checks) const {
        std::vector<std::string> calls;
        std::istringstream log(ReadFile(In("adb.log")));
        *checks = 0;
        for (std::string line; std::getline(log, line);) {
            if (line == "-s|0123456789ABCDEF|shell|pidof com.example.game || true") {
                ++*checks;
            } else {
                calls.push_back(std::regex_replace(line, std::regex("\\|/[^|]*/stereo_gm.ovo\\|"), "|LOCAL|"));
            }
        }
        return calls;
    }

    std::string m_profile;
};

TEST_F(TuneDeviceTest, IssuesAdbsCommandsInOrderAndReadsTheScreen) {
    const Outcome outcome = Run({OVO_TUNE_TOOL, m_profile, "--device", "--serial", "0123456789ABCDEF", "--headless",
                                 "--keys", "d+ fa- save quit", "--", "com.example.game"},
                                Environment());
    ASSERT_EQ(outcome.m_status, 0) << outcome.m_report << outcome.m_errors;

    const std::string device = "-s|0123456789ABCDEF|";
    const std::string live = device +
                             "shell|echo '%s' > /sdcard/game_profile.txt.tmp && mv /sdcard/game_profile.txt.tmp "
                             "/sdcard/game_profile.txt";
    const std::string screen = device + "exec-out|screencap|-p";
    const std::vector<std::string> expected = {
        std::regex_replace(live, std::regex("%s"), "0.020000 0.050000 0.000000 1.000000 0.000000"),
        device + "shell|mkdir -p /sdcard/stereoconv/game",
        device + "push|LOCAL|/sdcard/stereoconv/game/stereo_gm.ovo",
        device + "shell|am force-stop com.example.game",
        device + "shell|monkey -p com.example.game -c android.intent.category.LAUNCHER 1",
        screen,
        std::regex_replace(live, std::regex("%s"), "0.022000 0.050000 0.000000 1.000000 0.000000"),
        screen,
        std::regex_replace(live, std::regex("%s"), "0.022000 0.049500 0.000000 1.000000 0.000000"),
        screen,
        device + "shell|am force-stop com.example.game",
        device + "shell|rm -f /sdcard/game_profile.txt /sdcard/stereoconv/game/stereo_gm.ovo",
    };
    int checks = 0;
    EXPECT_EQ(AdbCalls(&checks), expected);
    EXPECT_GT(checks, 0) << "the game's process was never looked for";

    // The profile pushed is the one `ovo-profile write` makes; the saved text reads back.
    EXPECT_EQ(ShownProfile(m_profile).find("eye_distance = 0.022\neye_shift = 0\neye_angle = 0.0495\n"), 0u);
    const std::string command = "'" OVO_PROFILE_TOOL "' show '" + In("pushed.ovo") + "' >'" + In("pushed.txt") + "'";
    ASSERT_EQ(std::system(command.c_str()), 0);
    EXPECT_EQ(ReadFile(In("pushed.txt")).find("eye_distance = 0.02\neye_shift = 0\neye_angle = 0.05\n"), 0u);

    // A screen measured after the start and after each key: the made depths, and the
    // warning for the near half.
    const std::regex measured(
        "depth = nearest ([-+0-9.]+) px \\(-2.00 %\\), farthest ([-+0-9.]+) px \\(\\+1.5[0-9] "
        "%\\), 104 of 104 blocks\nwarning = nearest is 2.00 % of the width in front of the "
        "screen, beyond the 1.00 % budget\n");
    std::vector<std::string> after;
    const std::string& report = outcome.m_report;
    for (std::sregex_iterator each(report.begin(), report.end(), measured), end; each != end; ++each) {
        EXPECT_NEAR(std::stof((*each)[1]), -4.0f, 0.1f);
        EXPECT_NEAR(std::stof((*each)[2]), 3.0f, 0.1f);
        const size_t line_end = static_cast<size_t>(each->position()) - 1;
        const size_t line_start = report.rfind('\n', line_end - 1) + 1;
        after.push_back(report.substr(line_start, line_end - line_start));
    }
    EXPECT_EQ(after,
              (std::vector<std::string>{"program = started", "live = 0.022000 0.050000 0.000000 1.000000 0.000000",
                                        "live = 0.022000 0.049500 0.000000 1.000000 0.000000"}))
        << report;
}

TEST_F(TuneDeviceTest, AGameThatEndsOrASaveThatFailsEndsTheScriptWithOne) {
    std::ofstream(In("gone")) << "";
    Outcome outcome = Run({OVO_TUNE_TOOL, m_profile, "--device", "--serial", "0123456789ABCDEF", "--headless", "--keys",
                           "d+ quit", "--", "com.example.game"},
                          Environment());
    EXPECT_EQ(outcome.m_status, 1);
    EXPECT_NE(outcome.m_report.find("program = is no longer running on the device\n"), std::string::npos);
    EXPECT_EQ(outcome.m_errors,
              "ovo-tune: the program is no longer running on the device; the keys were not all done\n");
    fs::remove(In("gone"));

    const std::string original = ReadFile(m_profile);
    outcome = Run({OVO_TUNE_TOOL, m_profile, "--device", "--serial", "0123456789ABCDEF", "--headless", "--keys",
                   "d+ save quit", "--save-to", In("screen.png") + "/saved.txt", "--", "com.example.game"},
                  Environment());
    EXPECT_EQ(outcome.m_status, 1);
    EXPECT_EQ(outcome.m_errors.rfind(
                  "ovo-tune: not saved: cannot create a temporary file next to " + In("screen.png") + "/saved.txt", 0),
              0u)
        << outcome.m_errors;
    EXPECT_EQ(ReadFile(m_profile), original);
}

}  // namespace
