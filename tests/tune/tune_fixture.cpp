#include "tune_fixture.h"

#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <sstream>

namespace fs = std::filesystem;

namespace {

constexpr int ANAGLYPH_GREY_TOLERANCE = 2;
constexpr int ANAGLYPH_EYES_APART = 40;
// Above the preview window's background (24) and its antialiased text's faint edges.
constexpr int ANAGLYPH_LIT_LEVEL = 40;

}  // namespace

void TuneToolTest::SetUp() {
    m_folder = fs::path(testing::TempDir()) /
               ("ovo-tune-" + std::string(testing::UnitTest::GetInstance()->current_test_info()->name()) + "-" +
                std::to_string(getpid()));
    fs::remove_all(m_folder);
    fs::create_directories(m_folder);
}

void TuneToolTest::TearDown() { fs::remove_all(m_folder); }

std::string TuneToolTest::ReadFile(const fs::path& path) {
    std::stringstream bytes;
    bytes << std::ifstream(path, std::ios::binary).rdbuf();
    return bytes.str();
}

fs::path TuneToolTest::BelowRoot(const char* device_path) {
    return fs::path(OVO_TUNE_DEVICE_ROOT + std::string(device_path));
}

std::string TuneToolTest::CopyProfile(const std::string& source, const std::string& name) const {
    std::ofstream(In(name), std::ios::binary) << ReadFile(OVO_SOURCE_DIR "/" + source);
    return In(name);
}

std::vector<std::string> TuneToolTest::ToolArguments(const std::string& profile,
                                                     const std::vector<std::string>& options,
                                                     const std::vector<std::string>& program) {
    std::vector<std::string> arguments = {OVO_TUNE_TOOL,        profile,         "--library-dir",
                                          OVO_TUNE_LIBRARY_DIR, "--device-root", OVO_TUNE_DEVICE_ROOT};
    arguments.insert(arguments.end(), options.begin(), options.end());
    arguments.push_back("--");
    arguments.insert(arguments.end(), program.begin(), program.end());
    return arguments;
}

std::string TuneToolTest::ShownProfile(const std::string& path) const {
    const std::string binary = In("shown.ovo");
    const std::string command = "'" OVO_PROFILE_TOOL "' write '" + path + "' -o '" + binary +
                                "' && '" OVO_PROFILE_TOOL "' show '" + binary + "' >'" + In("shown.txt") + "'";
    EXPECT_EQ(std::system(command.c_str()), 0) << command;
    const std::string shown = ReadFile(In("shown.txt"));
    fs::remove(binary);
    fs::remove(In("shown.txt"));
    return shown;
}

std::vector<std::string> TuneToolTest::FolderEntries() const {
    std::vector<std::string> names;
    for (const fs::directory_entry& entry : fs::directory_iterator(m_folder)) names.push_back(entry.path().filename());
    std::sort(names.begin(), names.end());
    return names;
}

AnaglyphShare MeasureAnaglyph(const ovo_frames::RgbaFrame& frame) {
    AnaglyphShare share;
    const size_t pixels = frame.m_pixels.size() / ovo_frames::FRAME_PIXEL_BYTES;
    for (size_t index = 0; index < pixels; ++index) {
        const uint8_t* pixel = &frame.m_pixels[index * ovo_frames::FRAME_PIXEL_BYTES];
        share.m_cyan_grey += std::abs(pixel[1] - pixel[2]) <= ANAGLYPH_GREY_TOLERANCE ? 1 : 0;
        share.m_eyes_apart += std::abs(pixel[0] - pixel[1]) > ANAGLYPH_EYES_APART ? 1 : 0;
        share.m_lit += std::max({pixel[0], pixel[1], pixel[2]}) > ANAGLYPH_LIT_LEVEL ? 1 : 0;
    }
    if (pixels > 0) {
        share.m_cyan_grey /= pixels;
        share.m_eyes_apart /= pixels;
        share.m_lit /= pixels;
    }
    return share;
}
