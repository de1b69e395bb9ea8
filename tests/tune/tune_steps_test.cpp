// ovo-tune's parts that need no program: the steps and the live-tuning file's text, the key
// words, key scripts that arrive in pieces, and the profile text saved with tuned values.
#include <fcntl.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "eye_values.h"
#include "key_script.h"
#include "profile_text_edit.h"
#include "tune_action.h"
#include "tuned_profile.h"

namespace {

namespace fs = std::filesystem;
using ovo_tune::EyeValues;

EyeValues Values(double distance, double angle, double shift, double ramp_steps) {
    EyeValues values;
    values.m_parameters[ovo_tune::EYE_DISTANCE] = distance;
    values.m_parameters[ovo_tune::EYE_ANGLE] = angle;
    values.m_parameters[ovo_tune::EYE_SHIFT] = shift;
    values.m_ramp_steps = ramp_steps;
    return values;
}

std::string ReadFile(const fs::path& path) {
    std::stringstream bytes;
    bytes << std::ifstream(path, std::ios::binary).rdbuf();
    return bytes.str();
}

TEST(TuneSteps, KeysMoveTheValuesByTheProfilesScaleAndTheFileCarriesThem) {
    const struct {
        EyeValues m_start;
        std::vector<std::string> m_keys;
        const char* m_file;
    } cases[] = {
        // A tenth of each value; the ramp steps pass through unchanged.
        {Values(0.02, 0.05, 0.0, 1.0), {"d+", "d+", "a-"}, "0.024000 0.045000 0.000000 1.000000 0.000000\n"},
        // A fine step is a tenth of a step; the shift of 0 steps by its own default.
        {Values(0.02, 0.05, 0.0, 2.0), {"fd-", "s+", "fs+"}, "0.019800 0.050000 0.001100 2.000000 0.000000\n"},
        // Negative values step by a tenth of their size too; crossing 0 writes no "-0".
        {Values(-0.035, -0.05, 0.0, 1.0),
         {"d+", "fa+", "s-", "s+"},
         "-0.031500 -0.049500 0.000000 1.000000 0.000000\n"},
        // A sprite game's scale: eye distance 200, step 20; zero angle steps by 0.005.
        {Values(200.0, 0.0, 0.0, 1.0), {"d-", "a+", "fa+"}, "180.000000 0.005500 0.000000 1.000000 0.000000\n"},
        // A tenth that rounds to nothing in six decimals counts as 0.
        {Values(0.000004, 0.0, 0.0, 0.0), {"d+"}, "0.005004 0.000000 0.000000 0.000000 0.000000\n"},
    };
    for (const auto& each : cases) {
        EyeValues values = each.m_start;
        const ovo_tune::EyeSteps steps = ovo_tune::DefaultSteps(each.m_start);
        std::string keys;
        for (const std::string& word : each.m_keys) {
            ovo_tune::TuneAction action;
            std::string problem;
            ASSERT_TRUE(ovo_tune::ParseActionWord(word, &action, &problem)) << problem;
            ASSERT_EQ(action.m_kind, ovo_tune::ACTION_STEP);
            ovo_tune::Step(values, steps, action.m_parameter, action.m_direction, action.m_fine);
            keys += word + " ";
        }
        EXPECT_EQ(ovo_tune::LiveTuningText(values), each.m_file) << keys;
    }
}

TEST(TuneSteps, EveryKeyWordReadsBackAsItselfAndOthersAreRefused) {
    for (const char* word : {"d+", "d-", "a+", "a-", "s+", "s-", "fd+", "fd-", "fa+", "fa-", "fs+", "fs-", "view",
                             "anaglyph", "sbs", "raw", "save", "quit"}) {
        ovo_tune::TuneAction action;
        std::string problem;
        ASSERT_TRUE(ovo_tune::ParseActionWord(word, &action, &problem)) << word;
        EXPECT_EQ(ovo_tune::ActionWord(action), word);
    }
    for (const char* word : {"d", "d*", "x+", "ffd+", "fd", "D+", "Save", "fview", "d+ "}) {
        ovo_tune::TuneAction action;
        std::string problem;
        EXPECT_FALSE(ovo_tune::ParseActionWord(word, &action, &problem)) << word;
        EXPECT_NE(problem.find(std::string("unknown key '") + word + "'"), std::string::npos) << problem;
    }
}

// A script written into a pipe in pieces: a word is taken only once it is whole.
TEST(TuneSteps, KeyScriptTakesWholeWordsAsTheyArrive) {
    int channel[2];
    ASSERT_EQ(pipe(channel), 0);
    ASSERT_EQ(dup2(channel[0], STDIN_FILENO), STDIN_FILENO);
    close(channel[0]);
    ovo_tune::KeyScript script;
    std::string problem;
    ASSERT_TRUE(script.OpenFile("-", &problem));
    const struct {
        const char* m_written;
        std::vector<std::string> m_taken;
    } steps[] = {
        {"d+ f", {"d+"}},
        {"d- # a comment: save", {"fd-"}},
        {" quit\n  sa", {}},
        {"ve\n", {"save"}},
    };
    std::string word;
    for (const auto& step : steps) {
        ASSERT_EQ(write(channel[1], step.m_written, std::strlen(step.m_written)),
                  static_cast<ssize_t>(std::strlen(step.m_written)));
        for (const std::string& expected : step.m_taken) {
            ASSERT_TRUE(script.NextWord(&word)) << expected;
            EXPECT_EQ(word, expected);
        }
        EXPECT_FALSE(script.NextWord(&word)) << step.m_written << " gave " << word;
        EXPECT_FALSE(script.Finished());
    }
    ASSERT_EQ(write(channel[1], "raw", 3), 3);
    close(channel[1]);
    ASSERT_TRUE(script.NextWord(&word));
    EXPECT_EQ(word, "raw");
    EXPECT_TRUE(script.Finished());

    ovo_tune::KeyScript missing;
    EXPECT_FALSE(missing.OpenFile("/nonexistent/keys.txt", &problem));
    EXPECT_NE(problem.find("/nonexistent/keys.txt"), std::string::npos) << problem;
}

TEST(TuneSteps, EditedTextKeepsEveryOtherLineAndItsComments) {
    const struct {
        const char* m_text;
        const char* m_edited;
    } cases[] = {
        {"# depth\neye_distance = 0.02   # crates 4 px\neye_angle=0.05\nvalid = true\n",
         "# depth\neye_distance = 0.04   # crates 4 px\neye_angle=0.03\nvalid = true\n"},
        // A commented-out line is no field; fields the text does not set are added.
        {"# eye_distance = 1\r\nvalid = true\r\n",
         "# eye_distance = 1\r\nvalid = true\r\neye_distance = 0.04\r\neye_angle = 0.03\r\n"},
        // Tabs and a comment right after the value stay; a last line without its end keeps none.
        {"  eye_angle\t=\t0.05# by hand\neye_distance = 9", "  eye_angle\t=\t0.03# by hand\neye_distance = 0.04"},
        {"", "eye_distance = 0.04\neye_angle = 0.03\n"},
    };
    for (const auto& each : cases) {
        EXPECT_EQ(ovo_profile::SetFieldValues(each.m_text, {{"eye_distance", "0.04"}, {"eye_angle", "0.03"}}),
                  each.m_edited);
    }
}

TEST(TuneSteps, SavedProfileHoldsTheTunedValuesAndReadsBack) {
    const fs::path folder = fs::path(testing::TempDir()) / ("tune-steps-" + std::to_string(getpid()));
    fs::create_directories(folder);
    const std::string original = ReadFile(OVO_SOURCE_DIR "/examples/profiles/es2_scene_interleave.txt");
    std::ofstream(folder / "profile.txt", std::ios::binary) << original;
    ovo_tune::TunedProfile profile;
    std::string problem;
    ASSERT_TRUE(profile.Load((folder / "profile.txt").string(), &problem)) << problem;
    EXPECT_EQ(ovo_tune::LiveTuningText(profile.StartValues()), "0.020000 0.050000 0.000000 1.000000 0.000000\n");

    ASSERT_TRUE(profile.Save(Values(0.022, 0.045, -0.001, 1.0), (folder / "saved.txt").string(), &problem)) << problem;
    std::string expected = original;
    for (const auto& [from, to] : {std::make_pair("eye_distance = 0.02\n", "eye_distance = 0.022\n"),
                                   std::make_pair("eye_shift = 0\n", "eye_shift = -0.001\n"),
                                   std::make_pair("eye_angle = 0.05\n", "eye_angle = 0.045\n")}) {
        expected.replace(expected.find(from), std::string(from).size(), to);
    }
    EXPECT_EQ(ReadFile(folder / "saved.txt"), expected);

    ovo_tune::TunedProfile again;
    ASSERT_TRUE(again.Load((folder / "saved.txt").string(), &problem)) << problem;
    EXPECT_EQ(ovo_tune::LiveTuningText(again.StartValues()), "0.022000 0.045000 -0.001000 1.000000 0.000000\n");

    // A place that cannot be written leaves the file there as it was and no temporary file.
    std::ofstream(folder / "file") << "a file, not a folder\n";
    EXPECT_FALSE(profile.Save(Values(1, 2, 3, 1), (folder / "file" / "saved.txt").string(), &problem));
    EXPECT_NE(problem.find((folder / "file" / "saved.txt").string()), std::string::npos) << problem;
    EXPECT_FALSE(profile.Save(Values(1, 2, 3, 1), folder.string(), &problem)) << "a folder in the way";
    EXPECT_EQ(std::distance(fs::directory_iterator(folder), {}), 3) << "profile.txt, saved.txt, file";
    fs::remove_all(folder);
}

}  // namespace
