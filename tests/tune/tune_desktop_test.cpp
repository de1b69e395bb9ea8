// The whole loop under Xvfb, as a person and a script use it: ovo-tune runs a sample and a
// third-party program through the tests' library copy, keys change the live-tuning file
// (checked after each), the program's frames change their depth with it (measured), the
// preview window shows the anaglyph (a screenshot), and the saved profile reads back.
#include <gtest/gtest.h>

#include <cstdlib>
#include <regex>
#include <string>
#include <thread>
#include <vector>

#include "png_reader.h"
#include "programs/xvfb_server.h"
#include "tool_process.h"
#include "tune_fixture.h"

namespace {

namespace fs = std::filesystem;

constexpr int STEP_SECONDS = 20;
// The window is drawn anew at least every 0.1 s.
constexpr auto REDRAWN = std::chrono::milliseconds(300);
constexpr char LIVE_TUNING_FILE[] = "/sdcard/game_profile.txt";
constexpr char PROFILE_FILE[] = "/sdcard/stereoconv/game/stereo_gm.ovo";
// Eye distance steps as large as the profiles' values, so that each moves the depth clearly.
constexpr char STEPS[] = "0.02,0.02,0.001";
const std::regex DEPTH_LINE("^depth = nearest ([-+0-9.]+) px .*, farthest ([-+0-9.]+) px");
const std::regex LIVE_LINE("^live = (.*)$");

float Farthest(const std::smatch& depth) { return std::stof(depth[2]); }

class TuneDesktopTest : public TuneToolTest {
protected:
    void SetUp() override {
        TuneToolTest::SetUp();
        std::string problem;
        ASSERT_TRUE(m_server.Start(&problem)) << problem;
    }

    // A screenshot of the X window `id`, taken as a person would (ImageMagick's import).
    ovo_frames::RgbaFrame Screenshot(const std::string& id, const std::string& name) {
        const std::string path = In(name);
        const std::string command = "import -display " + m_server.Display() + " -window " + id + " '" + path + "'";
        EXPECT_EQ(std::system(command.c_str()), 0) << command;
        ovo_frames::RgbaFrame frame;
        std::string problem;
        EXPECT_TRUE(ovo_frames::ReadPng(path.c_str(), &frame, &problem)) << problem;
        return frame;
    }

    // Presses `keys` in the X window `id`, as a person at the keyboard would (xdotool).
    void Press(const std::string& id, const std::string& keys) {
        const std::string command = "xdotool key --window " + id + " " + keys;
        EXPECT_EQ(std::system(("DISPLAY=" + m_server.Display() + " " + command).c_str()), 0) << command;
    }

    XvfbServer m_server;
};

TEST_F(TuneDesktopTest, SampleFollowsEachKeyInThePreviewWindowAndTheSavedProfileReadsBack) {
    const std::string profile = CopyProfile("examples/profiles/es2_scene_interleave.txt", "profile.txt");
    const std::string shown_before = ShownProfile(profile);
    ToolProcess tool;
    ASSERT_TRUE(tool.Start(ToolArguments(profile, {"--keys-from", "-", "--steps", STEPS, "--out", m_folder.string()},
                                         {OVO_TUNE_SAMPLE, In("own.png"), "--cpu-seconds", "600"}),
                           {"DISPLAY=" + m_server.Display(), "EGL_PLATFORM=surfaceless"}, In("errors.txt")));
    std::smatch match;
    std::string line;
    ASSERT_TRUE(tool.WaitForLine(std::regex("^window = (0x[0-9a-f]+)$"), STEP_SECONDS, &match, &line))
        << tool.Report() << ReadFile(In("errors.txt"));
    const std::string window = match[1];
    ASSERT_TRUE(tool.WaitForLine(DEPTH_LINE, STEP_SECONDS, &match, &line))
        << tool.Report() << ReadFile(In("errors.txt"));
    const float start = Farthest(match);
    EXPECT_GT(start, 2.0f) << line;

    // The preview shows the frame as a red-cyan anaglyph: cyan from one eye's grey, red from
    // the other's, apart where the eyes differ.
    std::this_thread::sleep_for(REDRAWN);
    const AnaglyphShare shown = MeasureAnaglyph(Screenshot(window, "window.png"));
    EXPECT_GT(shown.m_cyan_grey, 0.99);
    EXPECT_GT(shown.m_eyes_apart, 0.005);
    EXPECT_GT(shown.m_lit, 0.4);

    // Keys from the script (standard input) and from the keyboard: the file after each, and
    // the depth the frames then show. The sample's depth grows with the eye distance. The
    // eye angle moves only vertices that lie within it of the screen, and the sample's lie
    // far behind; its shaders take no eye shift: neither changes its depth.
    const struct {
        const char* m_script;  // or
        const char* m_pressed;
        const char* m_file;
        float m_depth_low;
        float m_depth_high;  // times the start's farthest disparity
    } steps[] = {
        {"d+", nullptr, "0.040000 0.050000 0.000000 1.000000 0.000000", 1.7f, 2.3f},
        {nullptr, "Up", "0.060000 0.050000 0.000000 1.000000 0.000000", 2.6f, 3.4f},
        {nullptr, "shift+Down", "0.058000 0.050000 0.000000 1.000000 0.000000", 2.5f, 3.3f},
        {"a-", nullptr, "0.058000 0.030000 0.000000 1.000000 0.000000", 2.5f, 3.3f},
        {"s+", nullptr, "0.058000 0.030000 0.001000 1.000000 0.000000", 2.5f, 3.3f},
    };
    for (const auto& step : steps) {
        SCOPED_TRACE(step.m_file);
        if (step.m_script != nullptr) tool.Send(std::string(step.m_script) + "\n");
        if (step.m_pressed != nullptr) Press(window, step.m_pressed);
        ASSERT_TRUE(tool.WaitForLine(LIVE_LINE, STEP_SECONDS, &match, &line)) << tool.Report();
        EXPECT_EQ(match[1], step.m_file);
        EXPECT_EQ(ReadFile(BelowRoot(LIVE_TUNING_FILE)), std::string(step.m_file) + "\n");
        ASSERT_TRUE(tool.WaitForLine(DEPTH_LINE, STEP_SECONDS, &match, &line)) << tool.Report();
        EXPECT_GE(Farthest(match), start * step.m_depth_low) << line;
        EXPECT_LE(Farthest(match), start * step.m_depth_high) << line;
    }

    // Another view is another picture: the side by side keeps the scene's colours.
    tool.Send("sbs\n");
    ASSERT_TRUE(tool.WaitForLine(std::regex("^view = sbs$"), STEP_SECONDS, &match, &line));
    std::this_thread::sleep_for(REDRAWN);
    EXPECT_LT(MeasureAnaglyph(Screenshot(window, "window-sbs.png")).m_cyan_grey, 0.8);

    tool.Send("save\nquit\n");
    ASSERT_TRUE(tool.WaitForLine(std::regex("^saved = (.*)$"), STEP_SECONDS, &match, &line)) << tool.Report();
    EXPECT_EQ(match[1], profile);
    EXPECT_EQ(tool.Wait(STEP_SECONDS), 0) << tool.Report() << ReadFile(In("errors.txt"));

    // The saved text reads back with the tuned values and every other field as it was.
    const std::string shown_after = ShownProfile(profile);
    EXPECT_EQ(shown_after.substr(0, shown_after.find("ramp_steps")),
              "eye_distance = 0.058\neye_shift = 0.001\neye_angle = 0.03\n");
    EXPECT_EQ(shown_after.substr(shown_after.find("ramp_steps")), shown_before.substr(shown_before.find("ramp_steps")));
    // Nothing of the session is left in the device root.
    EXPECT_FALSE(fs::exists(BelowRoot(LIVE_TUNING_FILE)));
    EXPECT_FALSE(fs::exists(BelowRoot(PROFILE_FILE)));
}

// glmark2's horse turns 36 degrees a second by its clock; the tests' frame clock moves that
// clock 10 s at each swap, so every frame shows the same pose and only the keys change the
// depth (the benchmark runs until it is stopped).
TEST_F(TuneDesktopTest, Glmark2HeadlessRunsTheScriptedLoop) {
    const std::string profile = CopyProfile("examples/profiles/third_party_800x480.txt", "profile.txt");
    ToolProcess tool;
    ASSERT_TRUE(tool.Start(ToolArguments(profile,
                                         {"--headless", "--keys", "d+ d+ a- save quit", "--frames", "2", "--steps",
                                          STEPS, "--out", m_folder.string(), "--save-to", In("saved.txt")},
                                         // The clock for glmark2 alone: ovo-tune keeps time by the real one. This
                                         // preload takes the place of ovo-tune's, so it names the panel's too.
                                         {"/usr/bin/env", "LD_PRELOAD=" OVO_PANEL_DRIVER " " OVO_FRAME_CLOCK_LIBRARY,
                                          "OVO_FRAME_CLOCK_STEP_MS=10000", "glmark2-es2", "-b", "build:duration=100000",
                                          "--visual-config", "stencil=8", "--size", "800x480"}),
                           {"DISPLAY=" + m_server.Display()}, In("errors.txt")));
    tool.CloseInput();
    ASSERT_EQ(tool.Wait(60), 0) << tool.Report() << ReadFile(In("errors.txt"));

    // The live values after each key, and two frames' depth at the start and after each.
    std::vector<std::string> live;
    std::vector<float> farthest;
    std::smatch match;
    const std::string report = tool.Report();
    for (auto line = report.begin(); std::regex_search(line, report.end(), match, std::regex("(depth|live) = [^\n]*"));
         line = match.suffix().first) {
        const std::string text = match[0];
        std::smatch value;
        if (std::regex_search(text, value, LIVE_LINE)) live.push_back(value[1]);
        if (std::regex_search(text, value, DEPTH_LINE)) farthest.push_back(Farthest(value));
    }
    EXPECT_EQ(live, (std::vector<std::string>{"0.040000 0.050000 0.020000 1.000000 0.000000",
                                              "0.060000 0.050000 0.020000 1.000000 0.000000",
                                              "0.060000 0.030000 0.020000 1.000000 0.000000"}));
    ASSERT_EQ(farthest.size(), 8u) << report;
    // The depth follows the eye distance, somewhat less than in proportion (measured:
    // farthest 4.5, 8.5 and 10.5 eye pixels at 0.02, 0.04 and 0.06, of 114, 110 and 99
    // blocks that matched). The eye angle leaves it (see the sample's test).
    const struct {
        float m_low;
        float m_high;  // times the start's farthest disparity
    } ratios[] = {{1.6f, 2.4f}, {2.1f, 3.6f}, {2.1f, 3.6f}};
    for (size_t key = 0; key < 3; ++key) {
        EXPECT_EQ(farthest[2 * key + 2], farthest[2 * key + 3]) << "one pose: " << report;
        EXPECT_GE(farthest[2 * key + 2], farthest[0] * ratios[key].m_low) << report;
        EXPECT_LE(farthest[2 * key + 2], farthest[0] * ratios[key].m_high) << report;
    }
    EXPECT_GT(farthest[4], farthest[2]) << report;

    EXPECT_EQ(ShownProfile(In("saved.txt")).find("eye_distance = 0.06\neye_shift = 0.02\neye_angle = 0.03\n"), 0u);
    ovo_frames::RgbaFrame anaglyph;
    ovo_frames::RgbaFrame side_by_side;
    std::string problem;
    ASSERT_TRUE(ovo_frames::ReadPng(In("anaglyph.png").c_str(), &anaglyph, &problem)) << problem;
    ASSERT_TRUE(ovo_frames::ReadPng(In("side_by_side.png").c_str(), &side_by_side, &problem)) << problem;
    EXPECT_EQ(anaglyph.m_width, 800);
    EXPECT_EQ(side_by_side.m_width, 1600);
    EXPECT_TRUE(fs::exists(In("raw.png")));
    const AnaglyphShare share = MeasureAnaglyph(anaglyph);
    EXPECT_GT(share.m_cyan_grey, 0.999);
    EXPECT_GT(share.m_eyes_apart, 0.001);
    EXPECT_FALSE(fs::exists(BelowRoot(LIVE_TUNING_FILE)));
}

}  // namespace
