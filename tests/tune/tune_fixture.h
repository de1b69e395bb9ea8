#ifndef OVO_TESTS_TUNE_TUNE_FIXTURE_H
#define OVO_TESTS_TUNE_TUNE_FIXTURE_H

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "rgba_frame.h"

// What the tests of ovo-tune as a program share: a folder of the test's own, the tool's
// command line with the tests' library copy, files of the device root, and the profile
// tool's view of a saved profile.
class TuneToolTest : public ::testing::Test {
protected:
    void SetUp() override;
    void TearDown() override;

    std::string In(const std::string& name) const { return (m_folder / name).string(); }
    // An example profile's text copied into the folder as `name`; its path.
    std::string CopyProfile(const std::string& source, const std::string& name) const;
    // ovo-tune PROFILE OPTIONS... -- PROGRAM..., on the tests' library copy and device root.
    static std::vector<std::string> ToolArguments(const std::string& profile, const std::vector<std::string>& options,
                                                  const std::vector<std::string>& program);
    // `ovo-profile show` of the binary that `ovo-profile write` makes of the text at `path`.
    std::string ShownProfile(const std::string& path) const;

    static std::string ReadFile(const std::filesystem::path& path);
    // A file below the tests' device root ("/sdcard/game_profile.txt").
    static std::filesystem::path BelowRoot(const char* device_path);
    // The folder's entries, by name.
    std::vector<std::string> FolderEntries() const;

    std::filesystem::path m_folder;
};

// A frame as a red-cyan anaglyph shows it: green and blue equal everywhere (the right eye's
// grey), red apart from them where the eyes differ.
struct AnaglyphShare {
    double m_cyan_grey = 0.0;   // pixels with |G - B| <= 2
    double m_eyes_apart = 0.0;  // pixels with |R - G| > 40
    double m_lit = 0.0;         // pixels brighter than the window's background
};
AnaglyphShare MeasureAnaglyph(const ovo_frames::RgbaFrame& frame);

#endif
