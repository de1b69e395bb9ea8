// ovo-frames run as a program: a frame through the command line and PNG files, the depth of
// a made stereo frame, and bad input answered with the file's name, a non-zero exit and no
// output file.
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "common/png_writer.h"
#include "png_reader.h"
#include "stereo_scene.h"

namespace {

namespace fs = std::filesystem;
using ovo_frames::RgbaFrame;

std::string ReadFile(const fs::path& path) {
    std::stringstream bytes;
    bytes << std::ifstream(path, std::ios::binary).rdbuf();
    return bytes.str();
}

// A frame whose pixel (x, y) is (x, y, blue, alpha).
RgbaFrame Gradient(int32_t width, int32_t height, uint8_t blue = 200, uint8_t alpha = 255) {
    RgbaFrame frame(width, height);
    for (int32_t y = 0; y < height; ++y) {
        for (int32_t x = 0; x < width; ++x) {
            uint8_t* pixel = frame.At(x, y);
            pixel[0] = static_cast<uint8_t>(x);
            pixel[1] = static_cast<uint8_t>(y);
            pixel[2] = blue;
            pixel[3] = alpha;
        }
    }
    return frame;
}

class FramesToolTest : public ::testing::Test {
protected:
    void SetUp() override {
        fs::create_directories(m_folder);
        Save("eye.png", Gradient(4, 2));
        Save("odd.png", Gradient(3, 2));
        Save("wide.png", Gradient(6, 2));
        std::ofstream(In("text.png")) << "not an image\n";
        const std::string bytes = ReadFile(In("eye.png"));
        std::ofstream(In("cut.png"), std::ios::binary) << bytes.substr(0, bytes.size() / 2);
    }
    void TearDown() override { fs::remove_all(m_folder); }

    std::string In(const std::string& name) const { return (m_folder / name).string(); }

    void Save(const std::string& name, const RgbaFrame& frame) const {
        ASSERT_TRUE(ovo_sample::WritePng(In(name).c_str(), frame.m_width, frame.m_height, frame.m_pixels.data()));
    }

    // The exit code and what the tool printed (standard output, then standard error).
    // Arguments name files of the test's folder; none holds a quote.
    std::pair<int, std::string> Run(const std::vector<std::string>& arguments) const {
        std::string command = std::string("cd '") + m_folder.string() + "' && " + OVO_FRAMES_TOOL;
        for (const std::string& argument : arguments) command += " '" + argument + "'";
        const int status = std::system((command + " >.out 2>.err").c_str());
        const std::string output = ReadFile(In(".out")) + ReadFile(In(".err"));
        fs::remove(In(".out"));
        fs::remove(In(".err"));
        return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, output};
    }

    // Every file name that starts with "out" in the folder; the tool must leave none behind.
    std::vector<std::string> Outputs() const {
        std::vector<std::string> names;
        for (const fs::directory_entry& entry : fs::directory_iterator(m_folder)) {
            if (entry.path().filename().string().find("out") != std::string::npos) names.push_back(entry.path().string());
        }
        return names;
    }

    const fs::path m_folder = fs::path(testing::TempDir()) / ("ovo-frames-" + std::to_string(getpid()));
};

TEST_F(FramesToolTest, InterleavesIntoAnOpaquePngThatReadsBack) {
    Save("see_through.png", Gradient(4, 2, 100, 40));
    ASSERT_EQ(Run({"interleave", "eye.png", "see_through.png", "--eye0-columns", "odd", "-o", "out.png"}),
              std::make_pair(0, std::string()));
    RgbaFrame out;
    std::string problem;
    ASSERT_TRUE(ovo_frames::ReadPng(In("out.png").c_str(), &out, &problem)) << problem;
    // Eye 0 (blue 200) on the odd columns; the alpha is dropped on the way out.
    RgbaFrame expected = Gradient(4, 2);
    for (int32_t y = 0; y < 2; ++y) {
        expected.At(0, y)[2] = 100;
        expected.At(2, y)[2] = 100;
    }
    EXPECT_EQ(out.m_pixels, expected.m_pixels);
}

TEST_F(FramesToolTest, CompareDescribesTheDifference) {
    RgbaFrame changed = Gradient(4, 2);
    changed.At(1, 1)[2] = 190;
    changed.At(3, 0)[0] = 0;
    Save("changed.png", changed);
    const std::pair<int, std::string> result = Run({"compare", "eye.png", "changed.png", "--tolerance", "2"});
    EXPECT_EQ(result.first, 1);
    EXPECT_NE(result.second.find("2 pixels by more than 2, largest difference 10, first at (3, 0): "
                                 "(3, 0, 200, 255) and (0, 0, 200, 255)"),
              std::string::npos)
        << result.second;
    EXPECT_EQ(Run({"compare", "eye.png", "changed.png", "--tolerance", "10"}).first, 0);
    EXPECT_EQ(Run({"compare", "eye.png", "wide.png"}).first, 1);
}

TEST_F(FramesToolTest, BadInputNamesTheFileOrOptionAndLeavesNoOutput) {
    const struct {
        std::vector<std::string> m_arguments;
        const char* m_message;
    } cases[] = {
        {{"preview", "missing.png", "--eye0-columns", "odd"}, "ovo-frames: missing.png: No such file"},
        {{"preview", "text.png", "--eye0-columns", "odd"}, "ovo-frames: text.png: not a PNG file"},
        {{"anaglyph", "cut.png", "--eye0-columns", "even"}, "ovo-frames: cut.png: truncated"},
        {{"anaglyph", "odd.png", "--eye0-columns", "even"}, "ovo-frames: odd.png: width 3 is odd"},
        {{"interleave", "eye.png", "wide.png", "--eye0-columns", "even"}, "ovo-frames: wide.png: 6x2, but eye.png is 4x2"},
        {{"interleave", "eye.png", "missing.png", "--eye0-columns", "even"}, "ovo-frames: missing.png: "},
        {{"preview", "eye.png", "--eye0-columns", "left"}, "ovo-frames: --eye0-columns: 'left' is neither"},
        {{"preview", "eye.png", "--eye0-columns", "odd", "--tolerance", "1"}, "ovo-frames: --tolerance: unknown option"},
        {{"preview", "eye.png", "eye.png", "--eye0-columns", "odd"}, "ovo-frames: preview: takes one image"},
        {{"interleave", "eye.png", "eye.png", "--eye0-columns", "odd", "--mask-area", "4x1"},
         "ovo-frames: --mask-area: goes with --outside-eye"},
        {{"interleave", "eye.png", "eye.png", "--eye0-columns", "odd", "--outside-eye", "1"},
         "ovo-frames: --mask-area: goes with --outside-eye"},
        {{"interleave", "eye.png", "eye.png", "--eye0-columns", "odd", "--mask-area", "4x0", "--outside-eye", "1"},
         "ovo-frames: --mask-area: '4x0' is not WxH"},
        {{"interleave", "eye.png", "eye.png", "--eye0-columns", "odd", "--mask-area", "4x1x", "--outside-eye", "1"},
         "ovo-frames: --mask-area: '4x1x' is not WxH"},
        {{"interleave", "eye.png", "eye.png", "--eye0-columns", "odd", "--mask-area", "4x1", "--outside-eye", "2"},
         "ovo-frames: --outside-eye:"},
        {{"preview", "eye.png", "--eye0-columns", "odd", "--mask-area", "4x1"}, "ovo-frames: --mask-area: unknown option"},
        {{"disparity", "missing.png", "--eye0-columns", "odd"}, "ovo-frames: missing.png: No such file"},
        {{"disparity", "text.png", "--eye0-columns", "odd"}, "ovo-frames: text.png: not a PNG file"},
        {{"disparity", "odd.png", "--eye0-columns", "even"}, "ovo-frames: odd.png: width 3 is odd"},
        {{"disparity", "eye.png"}, "ovo-frames: disparity: needs --eye0-columns even|odd"},
        {{"disparity", "eye.png", "--eye0-columns", "even", "--block", "1"}, "ovo-frames: --block: '1' is not a whole number from 2"},
        {{"disparity", "eye.png", "--eye0-columns", "even", "--max-shift", "0"}, "ovo-frames: --max-shift: '0' is not"},
        {{"disparity", "eye.png", "--eye0-columns", "even", "--budget-far", "-1"}, "ovo-frames: --budget-far: '-1' is not a percentage"},
        {{"disparity", "eye.png", "--eye0-columns", "even", "--tolerance", "1"}, "ovo-frames: --tolerance: unknown option"},
        {{"disparity", "eye.png", "--eye0-columns", "even", "--map", "no-folder/out.png"}, "ovo-frames: no-folder/out.png: cannot write"},
        {{"match-eyes", "eye.png", "wide.png", "--eye0-columns", "odd"}, "ovo-frames: wide.png: 6x2, but eye.png is 4x2"},
        {{"match-eyes", "eye.png", "--eye0-columns", "odd"}, "ovo-frames: match-eyes: takes two images"},
    };
    for (const auto& test : cases) {
        std::vector<std::string> arguments = test.m_arguments;
        const std::string command = arguments[0];
        if (command == "disparity" && arguments.back() != "no-folder/out.png") arguments.insert(arguments.end(), {"--map", "out.png"});
        if (command != "disparity" && command != "match-eyes") arguments.insert(arguments.end(), {"-o", "out.png"});
        SCOPED_TRACE(arguments[0] + " " + arguments[1] + " " + arguments.back());
        const std::pair<int, std::string> result = Run(arguments);
        EXPECT_EQ(result.first, 2);
        EXPECT_EQ(result.second.rfind(test.m_message, 0), 0u) << result.second;
        EXPECT_EQ(Outputs(), std::vector<std::string>());
    }
}

// The "name = value" lines of the tool's output.
std::map<std::string, std::string> Values(const std::string& output) {
    std::map<std::string, std::string> values;
    std::istringstream lines(output);
    std::string line;
    while (std::getline(lines, line)) {
        const size_t equals = line.find(" = ");
        if (equals != std::string::npos) values[line.substr(0, equals)] = line.substr(equals + 3);
    }
    return values;
}

float Number(const std::map<std::string, std::string>& values, const std::string& name) {
    const auto found = values.find(name);
    return found == values.end() ? -1000.0f : std::stof(found->second);
}

// 160 x 48 eye pixels: a block row 4 pixels behind the screen, one 2 in front, one flat.
const std::vector<ovo_test::Stripe> SCENE = {{16, 4.0f}, {16, -2.0f}, {16, 0.0f, ovo_test::STRIPE_FLAT}};
constexpr int32_t SCENE_EYE_WIDTH = 160;

TEST_F(FramesToolTest, DisparityPrintsTheRangeHistogramAndBudgetWarnings) {
    Save("scene.png", ovo_test::MakeStereoFrame(SCENE_EYE_WIDTH, SCENE, ovo_frames::COLUMN_PARITY_ODD));
    // 2 pixels of 160 are 1.25 % of the width, 4 are 2.5 %.
    const struct {
        std::vector<std::string> m_options;
        float m_nearest;
        float m_farthest;
        bool m_too_near;
        bool m_too_far;
    } cases[] = {
        {{"--eye0-columns", "odd"}, -2.0f, 4.0f, true, true},
        {{"--eye0-columns", "odd", "--budget-near", "1.5", "--budget-far=3"}, -2.0f, 4.0f, false, false},
        // The wrong parity swaps the eyes, and so the sign.
        {{"--eye0-columns", "even", "--budget-near", "3", "--budget-far", "1.2"}, -4.0f, 2.0f, false, true},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.m_options[1]);
        std::vector<std::string> arguments = {"disparity", "scene.png", "--map", "out.png"};
        arguments.insert(arguments.end(), test.m_options.begin(), test.m_options.end());
        const std::pair<int, std::string> result = Run(arguments);
        ASSERT_EQ(result.first, 0) << result.second;
        const std::map<std::string, std::string> values = Values(result.second);
        EXPECT_NEAR(Number(values, "nearest_px"), test.m_nearest, 0.1f) << result.second;
        EXPECT_NEAR(Number(values, "farthest_px"), test.m_farthest, 0.1f);
        EXPECT_NEAR(Number(values, "nearest_percent"), test.m_nearest * 100.0f / SCENE_EYE_WIDTH, 0.07f);
        EXPECT_NEAR(Number(values, "farthest_percent"), test.m_farthest * 100.0f / SCENE_EYE_WIDTH, 0.07f);
        EXPECT_EQ(values.at("blocks_known"), "20");
        EXPECT_EQ(values.at("blocks_unknown"), "10");
        char bin[32];
        std::snprintf(bin, sizeof(bin), "histogram[%+d]", static_cast<int>(test.m_farthest));
        EXPECT_EQ(values.at(bin).substr(0, 3), "10 ") << bin;
        EXPECT_EQ(result.second.find("warning = nearest") != std::string::npos, test.m_too_near);
        EXPECT_EQ(result.second.find("warning = farthest") != std::string::npos, test.m_too_far);
        ovo_frames::RgbaFrame map;
        std::string problem;
        ASSERT_TRUE(ovo_frames::ReadPng(In("out.png").c_str(), &map, &problem)) << problem;
        EXPECT_EQ(map.m_width, 2 * SCENE_EYE_WIDTH);
        EXPECT_EQ(map.m_height, 48);
    }
}

TEST_F(FramesToolTest, DisparityOfAFlatFrameIsUnknownWithExit1) {
    Save("flat.png", ovo_test::MakeStereoFrame(32, {{32, 1.0f, ovo_test::STRIPE_FLAT}}, ovo_frames::COLUMN_PARITY_EVEN));
    const std::pair<int, std::string> result = Run({"disparity", "flat.png", "--eye0-columns", "even"});
    EXPECT_EQ(result.first, 1);
    const std::map<std::string, std::string> values = Values(result.second);
    EXPECT_EQ(values.at("blocks_known"), "0");
    EXPECT_EQ(values.at("nearest_px"), "unknown");
    EXPECT_EQ(values.count("warning"), 0u);
}

TEST_F(FramesToolTest, MatchEyesFindsEachEyeMovedByTheDisparityInScreenPixels) {
    Save("scene.png", ovo_test::MakeStereoFrame(SCENE_EYE_WIDTH, SCENE, ovo_frames::COLUMN_PARITY_EVEN));
    Save("native.png", ovo_test::MakeFlatFrame(SCENE_EYE_WIDTH, SCENE));
    const std::pair<int, std::string> result = Run({"match-eyes", "scene.png", "native.png", "--eye0-columns", "even"});
    ASSERT_EQ(result.first, 0) << result.second;
    const std::map<std::string, std::string> values = Values(result.second);
    // Disparities of 4 and -2 eye pixels: eye 0 moves 4 screen pixels left and 2 right.
    EXPECT_NEAR(Number(values, "eye0.nearest_screen_px"), -4.0f, 0.1f) << result.second;
    EXPECT_NEAR(Number(values, "eye0.farthest_screen_px"), 2.0f, 0.1f);
    EXPECT_NEAR(Number(values, "eye1.nearest_screen_px"), -2.0f, 0.1f);
    EXPECT_NEAR(Number(values, "eye1.farthest_screen_px"), 4.0f, 0.1f);
    EXPECT_NEAR(Number(values, "eye1.farthest_percent"), 4.0f * 100.0f / (2 * SCENE_EYE_WIDTH), 0.01f);
    for (const char* eye : {"eye0.", "eye1."}) {
        EXPECT_NEAR(Number(values, std::string(eye) + "unknown_fraction"), 1.0f / 3.0f, 0.001f);
        EXPECT_LT(Number(values, std::string(eye) + "residual_worst"), 1.0f);
    }
}

}  // namespace
