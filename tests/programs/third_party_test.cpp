// Real OpenGL ES programs from Debian, unmodified, run on a private X server once on Mesa
// directly and once through the library with a stereo profile: they must run as they do
// natively, reach the library, and come out as two eyes that differ only by the disparity
// that the profile predicts.
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <regex>
#include <set>
#include <sstream>
#include <string>

#include "png_reader.h"
#include "program_run.h"
#include "stereo_frame_checks.h"
#include "third_party_programs.h"
#include "xvfb_server.h"

namespace {

const std::string INSTALLED_PROFILE = OVO_PROGRAMS_ROOT "/sdcard/stereoconv/game/stereo_gm.ovo";
constexpr char DEPTH_SHIFT_TRACE[] = "PreString uniform vec2 uZpDepthShift;";

// The programs' clocks move by one frame at each swap, so that what they draw depends on
// the frame only and the same frame natively and in stereo shows the same moment; and
// their standard output is line-buffered, so that a program stopped by a signal keeps the
// trace lines that the library printed.
const char* const RUN_ENVIRONMENT[] = {"LD_PRELOAD=" OVO_FRAME_CLOCK_LIBRARY " " OVO_STDBUF_LIBRARY,
                                       "_STDBUF_O=L"};

std::string ReadText(const std::string& path) {
    std::ifstream file(path);
    std::stringstream text;
    text << file.rdbuf();
    return text.str();
}

// "name = value" of the profile's text form.
float ProfileValue(const std::string& name) {
    const std::regex line("(^|\n)" + name + " = ([-0-9.eE]+)");
    std::smatch match;
    const std::string text = ReadText(OVO_PROGRAMS_PROFILE);
    return std::regex_search(text, match, line) ? std::stof(match[2]) : 0.0f;
}

// The lines of a program's output that report an error, without the library's own log.
std::set<std::string> ErrorLines(const std::string& output) {
    static const std::regex ERROR_LINE("error", std::regex::icase);
    static const std::regex LIBRARY_LOG("^[DIE]/ZVT: ");
    std::set<std::string> lines;
    std::istringstream text(output);
    for (std::string line; std::getline(text, line);) {
        if (std::regex_search(line, ERROR_LINE) && !std::regex_search(line, LIBRARY_LOG)) lines.insert(line);
    }
    return lines;
}

ovo_frames::RgbaFrame ReadFrame(const std::string& path) {
    ovo_frames::RgbaFrame frame;
    std::string problem;
    EXPECT_TRUE(ovo_frames::ReadPng(path.c_str(), &frame, &problem)) << problem;
    return frame;
}

class ThirdPartyInStereo : public ::testing::TestWithParam<ThirdPartyProgram> {
protected:
    ProgramRun RunOf(const char* library_directory, const char* label) const {
        const ThirdPartyProgram& program = GetParam();
        ProgramRun run;
        run.m_arguments = program.m_arguments;
        run.m_working_directory = program.m_working_directory;
        run.m_environment = program.m_environment;
        run.m_environment.insert(run.m_environment.end(), std::begin(RUN_ENVIRONMENT), std::end(RUN_ENVIRONMENT));
        run.m_library_directory = library_directory;
        if (!program.m_libraries.empty()) run.m_library_directory += ":" + program.m_libraries;
        run.m_frame_directory = std::string(OVO_PROGRAMS_OUTPUT "/") + program.m_name + "/" + label;
        run.m_frames = program.m_frames;
        run.m_stops_by_itself = program.m_stops_by_itself;
        run.m_redraw = program.m_redraw;
        return run;
    }

    static void InstallProfile() {
        std::filesystem::create_directories(std::filesystem::path(INSTALLED_PROFILE).parent_path());
        const std::string command = std::string("'" OVO_PROFILE_TOOL "' write '" OVO_PROGRAMS_PROFILE "' -o '") +
                                    INSTALLED_PROFILE + "'";
        ASSERT_EQ(std::system(command.c_str()), 0) << command;
    }
};

TEST_P(ThirdPartyInStereo, RunsAsNativelyAndComesOutInStereo) {
    const ThirdPartyProgram& program = GetParam();
    XvfbServer server;
    std::string problem;
    ASSERT_TRUE(server.Start(&problem)) << problem;

    const ProgramRun native_run = RunOf(OVO_PROGRAMS_NATIVE_LIBRARIES, "native");
    const ProgramOutcome native = RunProgram(native_run, server.Display());
    ASSERT_TRUE(native.m_started && !native.m_timed_out) << native.m_output;
    ASSERT_EQ(native.m_frames_captured, program.m_frames) << native.m_output;

    ASSERT_NO_FATAL_FAILURE(InstallProfile());
    const ProgramRun stereo_run = RunOf(OVO_PROGRAMS_STEREO_LIBRARIES, "stereo");
    const ProgramOutcome stereo = RunProgram(stereo_run, server.Display());
    ASSERT_TRUE(stereo.m_started && !stereo.m_timed_out) << stereo.m_output;

    // As natively: the same end, the same frames, no error of its own.
    EXPECT_EQ(stereo.m_status, native.m_status) << stereo.m_output;
    EXPECT_EQ(stereo.m_frames_captured, native.m_frames_captured);
    std::set<std::string> new_errors = ErrorLines(stereo.m_output);
    for (const std::string& line : ErrorLines(native.m_output)) new_errors.erase(line);
    EXPECT_TRUE(new_errors.empty()) << *new_errors.begin();

    // Through the library: eglGetDisplay took the profile, and its shaders were rewritten.
    EXPECT_FALSE(std::filesystem::exists(INSTALLED_PROFILE)) << "eglGetDisplay bypassed the library";
    if (program.m_scene != SCENE_ES1_FLAT) {
        EXPECT_NE(stereo.m_output.find(DEPTH_SHIFT_TRACE), std::string::npos)
            << "no vertex shader went through the library";
    }

    // Frame 1 is drawn before the first column mask exists; every later one is stereo.
    FrameDepth deepest;
    for (int frame = 2; frame <= stereo.m_frames_captured; ++frame) {
        SCOPED_TRACE("frame " + std::to_string(frame));
        const ovo_frames::RgbaFrame stereo_frame = ReadFrame(FramePath(stereo_run.m_frame_directory, frame));
        const DisparityPrediction prediction =
            program.m_scene == SCENE_ES1_FLAT
                ? PredictFlatShift(ProfileValue("eye_shift"), stereo_frame.m_width)
                : PredictDisparity(ProfileValue("eye_distance"), ProfileValue("eye_angle"), stereo_frame.m_width);
        const FrameDepth depth = ExpectStereoFrame(ReadFrame(FramePath(native_run.m_frame_directory, frame)),
                                                   stereo_frame, program.m_scene, prediction);
        deepest.m_separation = std::max(deepest.m_separation, depth.m_separation);
        deepest.m_flat_deviation = std::max(deepest.m_flat_deviation, depth.m_flat_deviation);
    }
    ExpectSceneDepth(program.m_scene, deepest);
}

INSTANTIATE_TEST_SUITE_P(Debian, ThirdPartyInStereo, ::testing::ValuesIn(ThirdPartyPrograms()),
                         [](const ::testing::TestParamInfo<ThirdPartyProgram>& each) {
                             return each.param.m_name;
                         });

}  // namespace
