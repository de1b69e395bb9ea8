// ovo-frames run as a program: a frame through the command line and PNG files, and bad
// input answered with the file's name, a non-zero exit and no output file.
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "common/png_writer.h"
#include "png_reader.h"

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

TEST_F(FramesToolTest, BadInputNamesTheFileAndLeavesNoOutput) {
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
         "ovo-frames: --outside-eye: '2' is neither 0 nor 1"},
        {{"preview", "eye.png", "--eye0-columns", "odd", "--mask-area", "4x1"}, "ovo-frames: --mask-area: unknown option"},
    };
    for (const auto& test : cases) {
        std::vector<std::string> arguments = test.m_arguments;
        arguments.insert(arguments.end(), {"-o", "out.png"});
        SCOPED_TRACE(arguments[0] + " " + arguments[1]);
        const std::pair<int, std::string> result = Run(arguments);
        EXPECT_EQ(result.first, 2);
        EXPECT_EQ(result.second.rfind(test.m_message, 0), 0u) << result.second;
        for (const fs::directory_entry& entry : fs::directory_iterator(m_folder)) {
            EXPECT_EQ(entry.path().filename().string().find("out.png"), std::string::npos) << entry.path();
        }
    }
}

}  // namespace
