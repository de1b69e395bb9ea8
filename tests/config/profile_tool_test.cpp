// The ovo-profile tool, run as a program: show and write round trips, the text form's
// errors, usage, and agreement with the library about the mode.
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "config/stereo_profile.h"
#include "support/device_files.h"

namespace {

namespace fs = std::filesystem;

std::string ReadFile(const std::string& path) {
    std::stringstream bytes;
    bytes << std::ifstream(path, std::ios::binary).rdbuf();
    return bytes.str();
}

std::string Example(const std::string& name) { return OVO_SOURCE_DIR "/examples/profiles/" + name + ".txt"; }

class ProfileToolTest : public ::testing::Test {
protected:
    void SetUp() override { fs::create_directories(m_folder); }
    void TearDown() override { fs::remove_all(m_folder); }

    std::string In(const std::string& name) const { return (m_folder / name).string(); }

    // The exit code and what the tool printed (standard output, then standard error).
    std::pair<int, std::string> Run(const std::vector<std::string>& arguments) const {
        std::string command = OVO_PROFILE_TOOL;
        for (const std::string& argument : arguments) command += " '" + argument + "'";  // none holds a quote
        const int status = std::system((command + " >" + In(".out") + " 2>" + In(".err")).c_str());
        const std::string output = ReadFile(In(".out")) + ReadFile(In(".err"));
        fs::remove(In(".out"));
        fs::remove(In(".err"));
        return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, output};
    }

    std::pair<int, std::string> Write(const std::string& text, const std::string& output) const {
        std::ofstream(In("profile.txt"), std::ios::binary) << text;
        return Run({"write", In("profile.txt"), "-o", In(output)});
    }

    const fs::path m_folder = fs::path(testing::TempDir()) / ("ovo-profile-" + std::to_string(getpid()));
};

TEST_F(ProfileToolTest, ExamplesRoundTripAndAgreeWithTheCorpusAndTheLibrary) {
    // None of these names a process, so the tool's "com.example.game" and this test's own
    // name (neither listed nor a live wallpaper) give the same mode.
    const struct {
        std::string m_name;
        ovo::StereoMode m_mode;
        const char* m_mode_line;
    } examples[] = {{"column_interleave", ovo::STEREO_MODE_SHADER, "mode = shader"},
                    {"side_by_side_plain", ovo::STEREO_MODE_PLAIN, "mode = plain"},
                    {"top_bottom_plain", ovo::STEREO_MODE_PLAIN, "mode = plain"}};
    for (const auto& [example, library_mode, mode_line] : examples) {
        SCOPED_TRACE(example);
        EXPECT_EQ(Run({"write", Example(example), "-o", In("first.ovo")}), std::make_pair(0, std::string()));
        const std::string bytes = ReadFile(In("first.ovo"));
        EXPECT_EQ(ReadFile(OVO_SOURCE_DIR "/fuzz/corpus/profile/example_" + example + ".ovo"), bytes) << "stale copy";

        // Show prints the example's lines and the mode; its output writes back.
        const std::string shown = "\n" + Run({"show", In("first.ovo"), "--process", "com.example.game"}).second;
        std::istringstream lines(ReadFile(Example(example)));
        for (std::string line; std::getline(lines, line);) {
            if (line.empty() || line[0] == '#') continue;
            EXPECT_NE(shown.find("\n" + line + "\n"), std::string::npos) << line;
        }
        device_files::Write(ovo::PROFILE_PATH, bytes);
        testing::internal::CaptureStderr();
        ovo::StereoProfile profile;
        testing::internal::GetCapturedStderr();
        device_files::Remove(ovo::PROFILE_PATH);
        EXPECT_EQ(profile.ResolveMode(), library_mode);
        EXPECT_NE(shown.find(std::string("\n") + mode_line + "\n"), std::string::npos);
        ASSERT_EQ(Write(shown, "again.ovo").first, 0);
        EXPECT_EQ(ReadFile(In("again.ovo")), bytes);
    }
}

TEST_F(ProfileToolTest, CommentsRawItemsExactFloatsAndTheValidityWord) {
    // A live wallpaper's preset resolves to shader although shader_convert is not set.
    ASSERT_EQ(Write("# every kind of line\n\neye_distance = 0.1   # not exact in binary\neye_shift = 1e-45\n"
                    "eye_angle = -0\nramp_steps = 3.40282347e+38\neye_axis = 0x7\nvalid = true\n"
                    "item = 0x2501 0x1005 \"Angry \\\"Birds\\\" #1\\x01\\0\"\n"
                    "item = 0x9000 0x0042 -3\nitem = 0x2305 0x1004 1 2 0xFFFFFFFF\n"
                    "process = fishnoodle.clouds\nmode = shader\n",
                    "first.ovo"),
              std::make_pair(0, std::string()));
    const std::string shown = Run({"show", In("first.ovo")}).second;
    EXPECT_EQ(shown, "eye_distance = 0.1\neye_shift = 1e-45\neye_angle = -0\nramp_steps = 3.4028235e+38\n"
                     "eye_axis = 0x7\nvalid = true\nitem = 0x2501 0x1005 \"Angry \\\"Birds\\\" #1\\x01\\0\"\n"
                     "item = 0x9000 0x0042 -3\nitem = 0x2305 0x1004 1 2 4294967295\nmode = plain\n");
    ASSERT_EQ(Write(shown, "second.ovo").first, 0);
    std::string bytes = ReadFile(In("second.ovo"));
    EXPECT_EQ(bytes, ReadFile(In("first.ovo")));

    bytes[7] = 0;
    std::ofstream(In("zero.ovo"), std::ios::binary) << bytes;
    const std::string zero = Run({"show", In("zero.ovo")}).second;
    EXPECT_EQ(zero.rfind("# validity word is 0: nothing in this file applies", 0), 0u) << zero;
    EXPECT_NE(zero.find("\n# valid = true\n# item = 0x2501 0x1005 \"Angry"), std::string::npos) << zero;
    EXPECT_EQ(zero.substr(zero.size() - 12), "\nmode = off\n") << zero;

    // A NaN keeps its exact bits, which a plain "nan" would not.
    ASSERT_EQ(Write("eye_distance = -nan(0x1)\neye_angle = nan\n", "nan.ovo").first, 0);
    EXPECT_EQ(Run({"show", In("nan.ovo")}).second, "eye_distance = -nan(0x1)\neye_angle = nan\nmode = off\n");
    EXPECT_EQ(ReadFile(In("nan.ovo")).substr(24, 4), std::string("\xFF\x80\x00\x01", 4));
}

TEST_F(ProfileToolTest, BadTextNamesFileAndLineAndWritesNothing) {
    std::string too_many;
    for (int index = 0; index < 24; ++index) too_many += "item = " + std::to_string(0x3000 + index) + " 0x1003 1\n";
    const std::pair<std::string, const char*> cases[] = {
        {"valid = true\neye_distanse = -0.035\n", ":2: unknown field 'eye_distanse'"},
        {"# size\n\ntarget_width = 8O0\ntarget_height = 480\n", ":3: malformed number '8O0' for target_width"},
        {"target_width = 2147483648\ntarget_height = 480\n", ":1: value 2147483648 out of range for target_width"},
        {"item = 0x2501 0x1005 \"" + std::string(129, 'a') + "\"\n", ":1: value out of range: 129 text bytes"},
        {"split = top_bottom\nsplit = top_bottom\n", ":2: duplicate field 'split' (first set on line 1)"},
        {too_many + "valid = true\n", ":25: too many items: a profile holds 24"},
        {"valid = true\nscreen_height = 600\n", ":2: screen_height is set but screen_width is not"},
        {"valid = true\nshader_convert = true\nprocess = com.Paladog.Lite\nmode = shader\n",
         ":4: mode = shader, but this profile resolves to shader_listed"},
        {"item = 0x2101 0x1003 1\n", ":1: item 0x2101 sets split; write 'split = ...' instead"},
        {"item = 0x2501 0x1005 \"bad \\q\"\n", ":1: unknown escape '\\q'"},
    };
    for (const auto& [text, error] : cases) {
        const auto [exit_code, output] = Write(text, "out.ovo");
        EXPECT_EQ(exit_code, 1);
        EXPECT_EQ(output.rfind(In("profile.txt") + error, 0), 0u) << output;
        EXPECT_EQ(std::distance(fs::directory_iterator(m_folder), {}), 1) << "no output, no temporary file";
    }
    fs::create_directory(In("out.ovo"));  // the rename onto a folder fails after the temporary file is written
    EXPECT_EQ(Write("valid = true\n", "out.ovo").first, 1);
    EXPECT_EQ(std::distance(fs::directory_iterator(m_folder), {}), 2) << "the temporary file is removed";
    EXPECT_EQ(Run({"write", In("profile.txt")}).first, 2) << "a usage error: no -o FILE";
}

}  // namespace
