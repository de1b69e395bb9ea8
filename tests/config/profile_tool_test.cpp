// The ovo-profile tool, run as a program: show and write round trips, the text form's
// errors, usage, and agreement with the library about the mode.
#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "config/profile_file.h"
#include "config/stereo_profile.h"
#include "profile_test_bytes.h"

namespace {

namespace fs = std::filesystem;

const char* const EXAMPLES[] = {"column_interleave", "side_by_side_plain", "top_bottom_plain"};

struct ToolResult {
    int m_exit_code;
    std::string m_out;
    std::string m_err;
};

std::string ReadFile(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    std::stringstream bytes;
    bytes << file.rdbuf();
    return bytes.str();
}

void WriteFile(const fs::path& path, const std::string& bytes) { std::ofstream(path, std::ios::binary) << bytes; }

fs::path ExamplePath(const std::string& name) {
    return fs::path(OVO_SOURCE_DIR) / "examples" / "profiles" / (name + ".txt");
}

class ProfileToolTest : public ::testing::Test {
protected:
    void SetUp() override {
        std::string pattern = (fs::path(testing::TempDir()) / "ovo-profile-XXXXXX").string();
        ASSERT_NE(mkdtemp(&pattern[0]), nullptr);
        m_folder = pattern;
    }
    void TearDown() override {
        std::error_code ignored;
        fs::remove_all(m_folder, ignored);
    }

    fs::path In(const std::string& name) const { return m_folder / name; }

    // Runs the tool with `arguments`; standard output and error are kept apart.
    ToolResult Run(const std::vector<std::string>& arguments) const {
        ToolResult result{-1, "", ""};
        const fs::path out_path = In(".stdout");
        const fs::path err_path = In(".stderr");
        pid_t child = fork();
        if (child == 0) {
            int out = open(out_path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
            int err = open(err_path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
            dup2(out, STDOUT_FILENO);
            dup2(err, STDERR_FILENO);
            std::vector<char*> argv{const_cast<char*>(OVO_PROFILE_TOOL)};
            for (const std::string& argument : arguments) argv.push_back(const_cast<char*>(argument.c_str()));
            argv.push_back(nullptr);
            execv(OVO_PROFILE_TOOL, argv.data());
            _exit(127);
        }
        int status = 0;
        if (child > 0 && waitpid(child, &status, 0) == child && WIFEXITED(status)) {
            result.m_exit_code = WEXITSTATUS(status);
        }
        result.m_out = ReadFile(out_path);
        result.m_err = ReadFile(err_path);
        fs::remove(out_path);
        fs::remove(err_path);
        return result;
    }

    // Writes `text` to a text file and runs `write` on it.
    ToolResult WriteText(const std::string& text, const std::string& output) const {
        WriteFile(In("profile.txt"), text);
        return Run({"write", In("profile.txt").string(), "-o", In(output).string()});
    }

    // Files in the folder apart from the given ones (left-over temporary files).
    std::vector<std::string> OtherFiles(std::vector<std::string> expected) const {
        std::vector<std::string> others;
        for (const auto& entry : fs::directory_iterator(m_folder)) {
            const std::string name = entry.path().filename().string();
            bool known = false;
            for (const std::string& each : expected) known |= name == each;
            if (!known) others.push_back(name);
        }
        return others;
    }

    fs::path m_folder;
};

TEST_F(ProfileToolTest, ExamplesRoundTripByteForByte) {
    for (const char* example : EXAMPLES) {
        SCOPED_TRACE(example);
        const std::string first = In(std::string(example) + ".ovo").string();
        ToolResult wrote = Run({"write", ExamplePath(example).string(), "-o", first});
        ASSERT_EQ(wrote.m_exit_code, 0) << wrote.m_err;
        EXPECT_EQ(wrote.m_out + wrote.m_err, "");

        ToolResult shown = Run({"show", first});
        ASSERT_EQ(shown.m_exit_code, 0) << shown.m_err;
        WriteFile(In("shown.txt"), shown.m_out);
        const std::string second = In("again.ovo").string();
        ToolResult rewrote = Run({"write", In("shown.txt").string(), "-o", second});
        ASSERT_EQ(rewrote.m_exit_code, 0) << rewrote.m_err;
        EXPECT_EQ(ReadFile(second), ReadFile(first));
        EXPECT_EQ(Run({"show", second}).m_out, shown.m_out);
    }
}

TEST_F(ProfileToolTest, TheWrittenFileHasAValidHeaderAndExactly24Items) {
    const std::string path = In("profile.ovo").string();
    ASSERT_EQ(Run({"write", ExamplePath("column_interleave").string(), "-o", path}).m_exit_code, 0);
    const std::string bytes = ReadFile(path);
    ovo::ProfileTable table;
    const ovo::ProfileReadResult read =
        ovo::ReadProfileTable(reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size(), table);
    EXPECT_NE(table.m_validity, 0u);
    EXPECT_EQ(read.m_complete_items, 24);
    EXPECT_EQ(read.m_bytes_consumed, bytes.size()) << "nothing after the 24th item";
    // 16 items carry the 18 fields (the two sizes take two words each); the rest is padding.
    EXPECT_EQ(bytes.size(), 16u + 24 * 8 + 14 * 4 + 2 * 8);
    for (int index = 16; index < 24; ++index) {
        EXPECT_EQ(table.m_items[index].m_id, 0u);
        EXPECT_EQ(table.m_items[index].m_data_type, 0);
        EXPECT_EQ(table.m_items[index].m_data_count, 0);
    }
    EXPECT_EQ(bytes.substr(16, 12), std::string("\x00\x00\x20\x01\x10\x03\x00\x01\xBD\x0F\x5C\x29", 12))
        << "eye_distance = -0.035 first, as a big-endian word";
}

TEST_F(ProfileToolTest, ShowPrintsTheFieldsByNameAndTheMode) {
    const std::string path = In("profile.ovo").string();
    ASSERT_EQ(Run({"write", ExamplePath("top_bottom_plain").string(), "-o", path}).m_exit_code, 0);
    const std::string text = Run({"show", path}).m_out;
    for (const char* line : {"eye_distance = -0.03\n", "split = top_bottom\n", "eye_order = swapped\n",
                             "eye_axis = x\n", "ramp = off\n", "target_width = 480\n", "shader_convert = false\n",
                             "valid = true\n", "mode = plain\n"}) {
        EXPECT_NE(text.find(line), std::string::npos) << line << " in\n" << text;
    }
}

TEST_F(ProfileToolTest, TheModeDependsOnTheProcessName) {
    struct Case {
        const char* m_example;
        const char* m_process;  // null: no --process
        const char* m_mode;
    } cases[] = {
        {"column_interleave", nullptr, "mode = shader\n"},
        {"column_interleave", "com.Paladog.Lite", "mode = shader_listed\n"},
        {"column_interleave", "com.Paladog", "mode = shader\n"},
        {"side_by_side_plain", "com.Paladog.Lite", "mode = plain\n"},
        {"top_bottom_plain", nullptr, "mode = plain\n"},
        {"top_bottom_plain", "fishnoodle.clouds", "mode = shader\n"},
    };
    for (const Case& each : cases) {
        const std::string path = In("profile.ovo").string();
        ASSERT_EQ(Run({"write", ExamplePath(each.m_example).string(), "-o", path}).m_exit_code, 0);
        std::vector<std::string> arguments{"show", path};
        if (each.m_process != nullptr) arguments.insert(arguments.end(), {"--process", each.m_process});
        ToolResult shown = Run(arguments);
        EXPECT_EQ(shown.m_exit_code, 0);
        EXPECT_NE(shown.m_out.find(each.m_mode), std::string::npos)
            << each.m_example << " " << (each.m_process ? each.m_process : "") << ":\n" << shown.m_out;
        // The printed text, process line included, is accepted again.
        WriteFile(In("shown.txt"), shown.m_out);
        ToolResult again = Run({"write", In("shown.txt").string(), "-o", In("again.ovo").string()});
        EXPECT_EQ(again.m_exit_code, 0) << again.m_err;
        EXPECT_EQ(ReadFile(In("again.ovo")), ReadFile(path));
    }
}

TEST_F(ProfileToolTest, TheLibraryResolvesTheModeThatShowPrints) {
    char name[ovo::PROFILE_PROCESS_NAME_CAPACITY];
    ASSERT_TRUE(ovo::StereoProfile::ReadProcessName(name));
    for (const char* example : EXAMPLES) {
        const std::string path = In("profile.ovo").string();
        ASSERT_EQ(Run({"write", ExamplePath(example).string(), "-o", path}).m_exit_code, 0);
        profile_bytes::Install(ReadFile(path));
        testing::internal::CaptureStderr();
        ovo::StereoProfile profile;
        testing::internal::GetCapturedStderr();
        const char* mode = nullptr;
        switch (profile.ResolveMode()) {
            case ovo::STEREO_MODE_OFF: mode = "off"; break;
            case ovo::STEREO_MODE_PLAIN: mode = "plain"; break;
            case ovo::STEREO_MODE_SHADER: mode = "shader"; break;
            case ovo::STEREO_MODE_SHADER_LISTED: mode = "shader_listed"; break;
        }
        ASSERT_NE(mode, nullptr);
        const std::string text = Run({"show", path, "--process", name}).m_out;
        EXPECT_NE(text.find(std::string("\nmode = ") + mode + "\n"), std::string::npos) << example << "\n" << text;
        EXPECT_TRUE(profile.m_valid);
        EXPECT_TRUE(profile.m_enabled);
    }
    profile_bytes::Uninstall();
}

TEST_F(ProfileToolTest, TheCheckedInCorpusHoldsTheExamplesAsTheToolWritesThem) {
    for (const char* example : EXAMPLES) {
        const std::string path = In("profile.ovo").string();
        ASSERT_EQ(Run({"write", ExamplePath(example).string(), "-o", path}).m_exit_code, 0);
        const fs::path corpus = fs::path(OVO_SOURCE_DIR) / "fuzz" / "corpus" / "profile" /
                                (std::string("example_") + example + ".ovo");
        EXPECT_EQ(ReadFile(corpus), ReadFile(path)) << corpus << " is stale; rewrite it with ovo-profile write";
    }
}

TEST_F(ProfileToolTest, CommentsBlankLinesRawItemsAndExactFloatsRoundTrip) {
    const std::string text =
        "# a profile with every kind of line\n"
        "\n"
        "eye_distance = 0.1   # not exact in binary\n"
        "eye_shift = 1e-45\n"
        "eye_angle = -0\n"
        "ramp_steps = 3.40282347e+38\n"
        "eye_axis = 0x7\n"
        "split = top_bottom\n"
        "valid = true\n"
        "shader_convert = true\n"
        "item = 0x2303 0x1003 1\n"
        "item = 0x2501 0x1005 \"Angry \\\"Birds\\\" #1\\x01\\0\"\n"
        "item = 0x9000 0x0042 -3\n"
        "item = 0x2305 0x1004 1 2 0xFFFFFFFF\n"
        "process = com.rovio.angrybirds\n"
        "mode = shader_listed\n";
    ToolResult wrote = WriteText(text, "first.ovo");
    ASSERT_EQ(wrote.m_exit_code, 0) << wrote.m_err;
    ToolResult shown = Run({"show", In("first.ovo").string()});
    for (const char* line : {"eye_distance = 0.1\n", "eye_shift = 1e-45\n", "eye_angle = -0\n",
                             "ramp_steps = 3.4028235e+38\n", "eye_axis = 0x7\n",
                             "item = 0x2501 0x1005 \"Angry \\\"Birds\\\" #1\\x01\\0\"\n",
                             "item = 0x9000 0x0042 -3\n", "item = 0x2305 0x1004 1 2 4294967295\n",
                             "mode = shader\n"}) {
        EXPECT_NE(shown.m_out.find(line), std::string::npos) << line << " in\n" << shown.m_out;
    }
    ToolResult again = WriteText(shown.m_out, "second.ovo");
    ASSERT_EQ(again.m_exit_code, 0) << again.m_err;
    EXPECT_EQ(ReadFile(In("second.ovo")), ReadFile(In("first.ovo")));
}

TEST_F(ProfileToolTest, ShowMentionsAValidityWordOfZero) {
    const fs::path path = In("zero.ovo");
    WriteFile(path, profile_bytes::File({profile_bytes::Flag(0x2403, true), profile_bytes::Flag(0x2301, true)}, 0));
    ToolResult shown = Run({"show", path.string(), "--process", "com.Paladog.Lite"});
    EXPECT_EQ(shown.m_exit_code, 0);
    EXPECT_NE(shown.m_out.find("# validity word is 0: nothing in this file applies"), std::string::npos)
        << shown.m_out;
    EXPECT_NE(shown.m_out.find("# valid = true\n"), std::string::npos) << shown.m_out;
    EXPECT_NE(shown.m_out.find("\nmode = off\n"), std::string::npos) << shown.m_out;
}

TEST_F(ProfileToolTest, BadTextNamesFileAndLineAndWritesNothing) {
    std::string too_many;
    for (int index = 0; index < 24; ++index) too_many += "item = " + std::to_string(0x3000 + index) + " 0x1003 1\n";
    too_many += "valid = true\n";
    struct Case {
        std::string m_text;
        int m_line;
        const char* m_what;
    } cases[] = {
        {"valid = true\neye_distanse = -0.035\n", 2, "unknown field 'eye_distanse'"},
        {"eye_distance = -0.035x\n", 1, "malformed number '-0.035x' for eye_distance"},
        {"eye_distance =\n", 1, "malformed number '' for eye_distance"},
        {"# size\n\ntarget_width = 8O0\ntarget_height = 480\n", 3, "malformed number '8O0' for target_width"},
        {"target_width = 4294967296\ntarget_height = 480\n", 1, "value 4294967296 out of range for target_width"},
        {"eye_angle = 1e40\n", 1, "value 1e40 out of range for eye_angle"},
        {"split = 0x100000000\n", 1, "value 0x100000000 out of range for split"},
        {"item = 0x2501 0x1005 \"" + std::string(129, 'a') + "\"\n", 1, "value out of range: 129 text bytes"},
        {"split = top_bottom\nvalid = true\nsplit = side_by_side\n", 3,
         "duplicate field 'split' (first set on line 1)"},
        {"mode = off\nmode = off\n", 2, "duplicate field 'mode' (first set on line 1)"},
        {too_many, 25, "too many items: a profile holds 24"},
        {"valid = yes\n", 1, "valid must be true or false, not 'yes'"},
        {"split = diagonal\n", 1, "unknown value 'diagonal' for split"},
        {"valid true\n", 1, "expected 'name = value'"},
        {"valid = true\nscreen_height = 600\n", 2, "screen_height is set but screen_width is not"},
        {"valid = true\nshader_convert = true\nmode = plain\n", 3,
         "mode = plain, but this profile resolves to shader for the process ''"},
        {"mode = stereo\n", 1, "unknown mode 'stereo'"},
        {"item = 0x2101 0x1003 1\n", 1, "item 0x2101 sets split; write 'split = ...' instead"},
        {"item = 0x2501 0x1005 \"bad \\q\"\n", 1, "unknown escape '\\q'"},
    };
    for (const Case& each : cases) {
        SCOPED_TRACE(each.m_text);
        ToolResult wrote = WriteText(each.m_text, "out.ovo");
        EXPECT_EQ(wrote.m_exit_code, 1);
        const std::string prefix = In("profile.txt").string() + ":" + std::to_string(each.m_line) + ": ";
        EXPECT_EQ(wrote.m_err.rfind(prefix, 0), 0u) << wrote.m_err;
        EXPECT_NE(wrote.m_err.find(each.m_what), std::string::npos) << wrote.m_err;
        EXPECT_FALSE(fs::exists(In("out.ovo")));
        EXPECT_EQ(OtherFiles({"profile.txt"}), std::vector<std::string>{}) << "no temporary file is left";
    }
}

TEST_F(ProfileToolTest, AFailedWriteLeavesTheOldFileAsItWas) {
    WriteFile(In("out.ovo"), "old content");
    ToolResult wrote = WriteText("valid = maybe\n", "out.ovo");
    EXPECT_EQ(wrote.m_exit_code, 1);
    EXPECT_EQ(ReadFile(In("out.ovo")), "old content");
    ToolResult missing_folder = WriteText("valid = true\n", "no/such/folder/out.ovo");
    EXPECT_EQ(missing_folder.m_exit_code, 1);
    EXPECT_NE(missing_folder.m_err.find("cannot create a temporary file"), std::string::npos) << missing_folder.m_err;
    ToolResult replaced = WriteText("valid = true\n", "out.ovo");
    EXPECT_EQ(replaced.m_exit_code, 0) << replaced.m_err;
    EXPECT_EQ(ReadFile(In("out.ovo")).size(), 16u + 24 * 8 + 4);
    EXPECT_EQ(OtherFiles({"profile.txt", "out.ovo"}), std::vector<std::string>{});
}

TEST_F(ProfileToolTest, UsageAndHelp) {
    struct Case {
        std::vector<std::string> m_arguments;
        int m_exit_code;
        const char* m_out;
        const char* m_err;
    } cases[] = {
        {{}, 2, "", "usage: ovo-profile show"},
        {{"--help"}, 0, "usage: ovo-profile show", ""},
        {{"show", "--help"}, 0, "usage: ovo-profile show FILE [--process NAME]", ""},
        {{"write", "--help"}, 0, "usage: ovo-profile write TEXT_FILE -o FILE", ""},
        {{"frobnicate"}, 2, "", "unknown command frobnicate"},
        {{"show"}, 2, "", "show needs a FILE"},
        {{"show", "a", "b"}, 2, "", "show takes one FILE"},
        {{"show", "a", "--process"}, 2, "", "--process needs a name"},
        {{"show", "a", "--verbose"}, 2, "", "unknown option --verbose"},
        {{"write", "a.txt"}, 2, "", "write needs -o FILE"},
        {{"write", "-o", "a.ovo"}, 2, "", "write needs a TEXT_FILE"},
        {{"show", "/no/such/file.ovo"}, 1, "", "cannot open /no/such/file.ovo"},
        {{"write", "/no/such/file.txt", "-o", "/tmp/never.ovo"}, 1, "", "cannot read /no/such/file.txt"},
    };
    for (const Case& each : cases) {
        ToolResult result = Run(each.m_arguments);
        std::string command;
        for (const std::string& argument : each.m_arguments) command += argument + " ";
        SCOPED_TRACE(command);
        EXPECT_EQ(result.m_exit_code, each.m_exit_code);
        EXPECT_NE(result.m_out.find(each.m_out), std::string::npos) << result.m_out;
        EXPECT_NE(result.m_err.find(each.m_err), std::string::npos) << result.m_err;
        if (each.m_exit_code == 2) {
            EXPECT_NE(result.m_err.find("usage:"), std::string::npos) << result.m_err;
        }
    }
}

}  // namespace
