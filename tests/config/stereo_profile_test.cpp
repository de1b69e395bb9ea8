// StereoProfile as the manager builds it: the profile file below the device root, the
// mode by process name (each name in a process of its own, started under that name), and
// the live-wallpaper presets.
#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "config/stereo_profile.h"
#include "profile_test_bytes.h"
#include "support/scenario_process.h"

namespace {

using namespace profile_bytes;

const std::string ENABLED_SHADER = Flag(0x2301, true) + Flag(0x2403, true);

class StereoProfileTest : public ::testing::Test {
protected:
    void SetUp() override { Uninstall(); }
    void TearDown() override { Uninstall(); }
};

void ExpectDefaults(const ovo::StereoProfile& profile) {
    EXPECT_EQ(profile.m_width, 0);
    EXPECT_EQ(profile.m_height, 0);
    EXPECT_FALSE(profile.m_enabled);
    EXPECT_EQ(profile.m_eye_distance, 0.0f);
    EXPECT_EQ(profile.m_eye_shift, 0.0f);
    EXPECT_EQ(profile.m_eye_angle, 0.0f);
    EXPECT_EQ(profile.m_ramp_steps, 0.0f);
    EXPECT_EQ(profile.m_eye_axis, ovo::STEREO_AXIS_X);
    EXPECT_EQ(profile.m_shift_axis, ovo::STEREO_AXIS_X);
    EXPECT_EQ(profile.m_ramp_param, ovo::STEREO_AXIS_X);
    EXPECT_EQ(profile.m_split, ovo::STEREO_SPLIT_SIDE_BY_SIDE);
    EXPECT_EQ(profile.m_eye_order, ovo::STEREO_EYE_ORDER_NORMAL);
    EXPECT_EQ(profile.m_ramp, ovo::STEREO_RAMP_OFF);
    EXPECT_EQ(profile.m_target_width, 0);
    EXPECT_EQ(profile.m_target_height, 0);
    EXPECT_EQ(profile.m_screen_width, 0);
    EXPECT_EQ(profile.m_screen_height, 0);
    EXPECT_FALSE(profile.m_shader_convert);
    EXPECT_FALSE(profile.m_use_screen_size);
    EXPECT_FALSE(profile.m_auto_eye);
    EXPECT_FALSE(profile.m_eye_target);
    EXPECT_FALSE(profile.m_valid);
    EXPECT_TRUE(profile.m_swap_eye_mask);
    EXPECT_EQ(profile.m_eye_shift_set, 0.0f);
    EXPECT_EQ(profile.m_eye_distance_set, 0.0f);
    EXPECT_EQ(profile.m_eye_angle_set, 0.0f);
    EXPECT_EQ(profile.m_ramp_restart, 10.0f);
    EXPECT_FALSE(profile.m_force_portrait);
}

TEST_F(StereoProfileTest, WithoutAFileEverythingStaysAtItsDefault) {
    testing::internal::CaptureStderr();
    ovo::StereoProfile profile;
    const std::string log = testing::internal::GetCapturedStderr();
    ExpectDefaults(profile);
    EXPECT_EQ(profile.m_mode, 0u) << "not resolved during construction";
    EXPECT_EQ(profile.ResolveMode(), ovo::STEREO_MODE_OFF);
    EXPECT_EQ(log, "D/ZVT: [Duoscope] LoadPorfile\n");
    EXPECT_FALSE(profile.LoadProfile());
}

TEST_F(StereoProfileTest, LoadingLogsOneCountPerItem) {
    std::string forty_words;
    for (int index = 0; index < 40; ++index) forty_words += Be32(1);
    Install(File({Item(0x2501, 0x1005, -5), Item(0x2303, 0x1003, 40, forty_words), Flag(0x2403, true)}));
    testing::internal::CaptureStderr();
    ovo::StereoProfile profile;
    const std::string log = testing::internal::GetCapturedStderr();
    std::string expected = "D/ZVT: [Duoscope] LoadPorfile\n"
                           "E/ZVT: item.m_data_count = -5\n"
                           "E/ZVT: item.m_data_count = 40\n"
                           "E/ZVT: item.m_data_count = 1\n";
    for (int index = 3; index < 24; ++index) expected += "E/ZVT: item.m_data_count = 0\n";
    EXPECT_EQ(log, expected);
}

TEST_F(StereoProfileTest, ValidityWordZeroChangesNothing) {
    Install(File({Float(0x2001, -0.035f), Words(0x2101, {0x3102}), Words(0x2201, {800, 480}), ENABLED_SHADER},
                 0));
    testing::internal::CaptureStderr();
    ovo::StereoProfile profile;
    const std::string log = testing::internal::GetCapturedStderr();
    ExpectDefaults(profile);
    EXPECT_EQ(profile.ResolveMode(), ovo::STEREO_MODE_OFF);
    EXPECT_NE(log.find("E/ZVT: item.m_data_count = 2\n"), std::string::npos) << "the items are still read";
    EXPECT_FALSE(profile.LoadProfile());
    EXPECT_EQ(profile.ItemTable().m_items[2].m_id, 0x2201u);
}

TEST_F(StereoProfileTest, AnAcceptedFileEnablesAndSizesTheProfile) {
    Install(File({Item(0x2001, 0x1003, 1, "\xBD\x0F\x5C\x29"), Words(0x2201, {640, 720}), Flag(0x2302, false),
                  Flag(0x2301, false), Flag(0x2403, true)}));
    ovo::StereoProfile profile;
    EXPECT_TRUE(profile.m_enabled);
    EXPECT_EQ(profile.m_eye_distance, -0.035f);
    EXPECT_EQ(profile.m_eye_distance_set, -0.035f);
    EXPECT_EQ(profile.m_width, 640);
    EXPECT_EQ(profile.m_height, 720);
    EXPECT_EQ(profile.m_mode, ovo::STEREO_MODE_PLAIN) << "resolved by ApplyScreenSize";
    EXPECT_TRUE(profile.LoadProfile());
}

TEST_F(StereoProfileTest, TheScreenSizeWinsWhenTheFileAsksForIt) {
    Install(File({Words(0x2201, {640, 720}), Flag(0x2302, true), Words(0x2202, {1280, 720}), Flag(0x2403, true)}));
    ovo::StereoProfile profile;
    EXPECT_EQ(profile.m_width, 1280);
    EXPECT_EQ(profile.m_height, 720);
    EXPECT_EQ(profile.m_target_width, 640);
}

TEST_F(StereoProfileTest, TheLaterOfTwoItemsWins) {
    Install(File({Words(0x2101, {0x3101}), Words(0x2101, {0x3102}), Flag(0x2403, true)}));
    ovo::StereoProfile profile;
    EXPECT_EQ(profile.m_split, ovo::STEREO_SPLIT_TOP_BOTTOM);
}

TEST_F(StereoProfileTest, AnInvalidProfileKeepsItsValuesButStaysOff) {
    Install(File({Float(0x2003, -0.05f), Words(0x2201, {800, 480}), Flag(0x2301, true), Flag(0x2403, false)}));
    ovo::StereoProfile profile;
    EXPECT_EQ(profile.m_eye_angle, -0.05f);
    EXPECT_EQ(profile.m_target_width, 800);
    EXPECT_FALSE(profile.m_enabled);
    EXPECT_EQ(profile.m_width, 0) << "ApplyScreenSize is not called";
    EXPECT_EQ(profile.m_mode, 0u);
    EXPECT_EQ(profile.ResolveMode(), ovo::STEREO_MODE_OFF);
    EXPECT_FALSE(profile.LoadProfile());
}

TEST_F(StereoProfileTest, HostileFilesLeaveTheFollowingItemsInPlace) {
    std::string hundred_words;
    for (int index = 0; index < 100; ++index) hundred_words += Be32(0xFFFFFFFF);
    std::string text(300, 'x');
    Install(File({Item(0x2303, 0x1003, 100, hundred_words), Item(0x2501, 0x1005, 300, text),
                  Item(0x2001, 0x1004, -7), Item(0x2002, 0x0777, 12), Words(0x2102, {0x3107}), Flag(0x2403, true)}));
    ovo::StereoProfile profile;
    EXPECT_TRUE(profile.m_enabled);
    EXPECT_EQ(profile.m_eye_order, ovo::STEREO_EYE_ORDER_SWAPPED);
    EXPECT_EQ(profile.ItemTable().m_items[0].m_data_count, 100);
    EXPECT_EQ(profile.ItemTable().m_items[1].m_data_count, 300);
}

TEST_F(StereoProfileTest, ATruncatedFileKeepsWhatArrived) {
    Install((Header() + Flag(0x2403, true) + Words(0x2201, {640, 720})).substr(0, 16 + 12 + 8 + 6));
    ovo::StereoProfile profile;
    EXPECT_TRUE(profile.m_enabled);
    EXPECT_EQ(profile.m_target_width, 640);
    EXPECT_EQ(profile.m_target_height, 0);
    EXPECT_EQ(profile.m_width, 640);
}

TEST_F(StereoProfileTest, TheModeIsResolvedOnceAndKept) {
    Install(File({ENABLED_SHADER}));
    ovo::StereoProfile profile;
    const ovo::StereoMode mode = profile.ResolveMode();
    EXPECT_EQ(mode, ovo::STEREO_MODE_SHADER) << "this test program is not a listed application";
    profile.m_enabled = false;
    profile.m_shader_convert = false;
    EXPECT_EQ(profile.ResolveMode(), mode);
    EXPECT_EQ(profile.ApplyScreenSize(), mode);
}

// ---- The process name ------------------------------------------------------------------

// Run in a process started under the name under test; prints what the profile became.
TEST(StereoProfileScenario, DISABLED_Print) {
    testing::internal::CaptureStderr();  // keep the log out of the way
    ovo::StereoProfile profile;
    testing::internal::GetCapturedStderr();
    char name[ovo::PROFILE_PROCESS_NAME_CAPACITY];
    ovo::StereoProfile::ReadProcessName(name);
    std::printf("kind=%d mode=0x%X enabled=%d distance=%.9g angle=%.9g shift=%.9g shift_set=%.9g "
                "distance_set=%.9g angle_set=%.9g steps=%.9g restart=%.9g size=%dx%d target=%dx%d "
                "screen=%dx%d axis=0x%X shift_axis=0x%X ramp_param=0x%X split=0x%X order=0x%X ramp=0x%X "
                "flags=%d%d%d%d%d%d%d name_length=%zu\n",
                profile.DetectLiveWallpaper(), static_cast<unsigned>(profile.ResolveMode()), profile.m_enabled,
                static_cast<double>(profile.m_eye_distance), static_cast<double>(profile.m_eye_angle),
                static_cast<double>(profile.m_eye_shift), static_cast<double>(profile.m_eye_shift_set),
                static_cast<double>(profile.m_eye_distance_set), static_cast<double>(profile.m_eye_angle_set),
                static_cast<double>(profile.m_ramp_steps), static_cast<double>(profile.m_ramp_restart),
                profile.m_width, profile.m_height, profile.m_target_width, profile.m_target_height,
                profile.m_screen_width, profile.m_screen_height, profile.m_eye_axis, profile.m_shift_axis,
                profile.m_ramp_param, profile.m_split, profile.m_eye_order, profile.m_ramp,
                profile.m_shader_convert, profile.m_use_screen_size, profile.m_auto_eye, profile.m_eye_target,
                profile.m_valid, profile.m_swap_eye_mask, profile.m_force_portrait, std::strlen(name));
}

// The scenario's line for `process_name`, with the profile file `bytes` (none when empty).
std::string RunAs(const std::string& process_name, const std::string& bytes) {
    if (bytes.empty()) {
        Uninstall();
    } else {
        Install(bytes);
    }
    ScenarioResult result = RunScenario(process_name.c_str(), "StereoProfileScenario.DISABLED_Print");
    EXPECT_EQ(result.m_exit_code, 0) << process_name;
    const size_t start = result.m_output.find("kind=");
    if (start == std::string::npos) return "<no output> " + result.m_output;
    return result.m_output.substr(start, result.m_output.find('\n', start) - start);
}

bool Has(const std::string& line, const std::string& part) { return (" " + line + " ").find(" " + part + " ") != std::string::npos; }

TEST_F(StereoProfileTest, TheBuiltInListIsComparedExactly) {
    struct Case {
        const char* m_name;
        const char* m_mode;
    } cases[] = {
        {"com.Paladog.Lite", "mode=0x1003"},
        {"com.Paladog", "mode=0x1002"},
        {"com.paladog.lite", "mode=0x1002"},
        {"com.Paladog.Lite2", "mode=0x1002"},
        {"com.rovio.angrybirdsrio.korean", "mode=0x1003"},
        {"com.rovio.angrybirds", "mode=0x1003"},
        {"com.rovio.angrybirds_lite", "mode=0x1003"},
        {"com.rovio.angrybirdsseasons", "mode=0x1003"},
        {"com.rovio.angrybirdsrio", "mode=0x1003"},
        {"com.rovio.angrybirdsstarwars.ads.iap", "mode=0x1003"},
        {"com.rovio.angrybirdsstarwars", "mode=0x1002"},
        {"com.example.game", "mode=0x1002"},
    };
    const std::string file = File({ENABLED_SHADER});
    for (const Case& each : cases) {
        const std::string line = RunAs(each.m_name, file);
        EXPECT_TRUE(Has(line, each.m_mode)) << each.m_name << ": " << line;
    }
}

TEST_F(StereoProfileTest, WithoutShaderConversionTheModeIsPlainWhateverTheName) {
    const std::string file = File({Flag(0x2301, false), Flag(0x2403, true)});
    for (const char* name : {"com.Paladog.Lite", "com.example.game"}) {
        const std::string line = RunAs(name, file);
        EXPECT_TRUE(Has(line, "mode=0x1001")) << name << ": " << line;
    }
}

TEST_F(StereoProfileTest, WithoutAnAcceptedFileTheModeIsOffWhateverTheName) {
    for (const char* name : {"com.Paladog.Lite", "com.example.game"}) {
        EXPECT_TRUE(Has(RunAs(name, ""), "mode=0x1000")) << name;
        EXPECT_TRUE(Has(RunAs(name, File({ENABLED_SHADER}, 0)), "mode=0x1000")) << name;
    }
}

TEST_F(StereoProfileTest, TheAndroidWallpaperGetsItsPresetWithoutAFile) {
    const std::string line = RunAs("com.android.wallpaper", "");
    for (const char* part : {"kind=2", "mode=0x1002", "enabled=1", "distance=-0.00499999989", "angle=-3",
                             "size=480x800", "ramp=0x3202", "target=480x800", "screen=480x800", "restart=-1",
                             "steps=1", "flags=1000101"}) {
        EXPECT_TRUE(Has(line, part)) << part << " in " << line;
    }
}

TEST_F(StereoProfileTest, AWallpaperPresetOverridesAnAcceptedFile) {
    const std::string file =
        File({Float(0x2001, 0.5f), Float(0x2002, 0.02f), Float(0x2003, 0.7f), Float(0x2004, 9.0f),
              Words(0x2005, {0x3003}), Words(0x2006, {0x3003}), Words(0x2101, {0x3102}), Words(0x2102, {0x3107}),
              Words(0x2111, {0x3201}), Words(0x2201, {1024, 600}), Words(0x2202, {1280, 720}), Flag(0x2301, false),
              Flag(0x2302, true), Flag(0x2304, true), Flag(0x2308, true), Flag(0x2403, true)});
    const std::string line = RunAs("fishnoodle.snowfall", file);
    for (const char* part : {"kind=1", "mode=0x1002", "enabled=1", "distance=-0.0350000001", "angle=-0.0500000007",
                             "shift=0", "distance_set=-0.0350000001", "angle_set=-0.0500000007", "steps=2",
                             "restart=5", "size=480x800", "target=480x800", "screen=480x800", "axis=0x3001",
                             "shift_axis=0x3001", "split=0x3101", "order=0x3106", "ramp=0x3202", "flags=1000101",
                             // kept from the file
                             "shift_set=0.0199999996", "ramp_param=0x3003"}) {
        EXPECT_TRUE(Has(line, part)) << part << " in " << line;
    }
}

TEST_F(StereoProfileTest, EveryLiveWallpaperNameIsRecognisedExactly) {
    struct Case {
        const char* m_name;
        int m_kind;
    } cases[] = {
        {"fishnoodle.snowfall_free", 1}, {"fishnoodle.snowfall", 1}, {"com.android.wallpaper", 2},
        {"fishnoodle.koipond_free", 3},  {"fishnoodle.koipond", 3},  {"fishnoodle.aquarium_free", 4},
        {"fishnoodle.aquarium", 4},      {"fishnoodle.clouds_free", 5}, {"fishnoodle.clouds", 5},
        {"au.com.dealsmap.lwp.cube.PackEarth", 6}, {"com.android.wallpaper.livepicker", 0},
        {"fishnoodle.snowfal", 0},
    };
    for (const Case& each : cases) {
        const std::string line = RunAs(each.m_name, "");
        EXPECT_TRUE(Has(line, "kind=" + std::to_string(each.m_kind))) << each.m_name << ": " << line;
        EXPECT_TRUE(Has(line, each.m_kind != 0 ? "mode=0x1002" : "mode=0x1000")) << each.m_name << ": " << line;
    }
}

TEST_F(StereoProfileTest, ALongProcessNameIsCutInsideTheBuffer) {
    // The name that the buffer keeps is a wallpaper's name only in its first 255 bytes.
    const std::string line = RunAs("com.android.wallpaper" + std::string(400, 'x'), File({ENABLED_SHADER}));
    EXPECT_TRUE(Has(line, "name_length=255")) << line;
    EXPECT_TRUE(Has(line, "kind=0")) << line;
    EXPECT_TRUE(Has(line, "mode=0x1002")) << line;
}

// ---- The presets -----------------------------------------------------------------------

TEST(LiveWallpaperPresetTest, EachKindSetsItsValues) {
    struct Case {
        int m_kind;
        float m_distance;
        float m_angle;
        float m_steps;
        float m_restart;
    } cases[] = {
        {1, -0.035f, -0.05f, 2.0f, 5.0f},  {2, -0.005f, -3.0f, 1.0f, -1.0f}, {3, -0.001f, -20.0f, 1.0f, -1.0f},
        {4, -0.03f, -0.01f, 5.0f, 1.0f},   {5, -0.04f, -0.01f, 30.0f, 1.0f}, {6, -0.001f, -20.0f, 1.0f, -1.0f},
    };
    for (const Case& each : cases) {
        SCOPED_TRACE(each.m_kind);
        ovo::StereoProfileFields fields;
        fields.m_eye_shift = 0.3f;
        fields.m_eye_shift_set = 0.25f;
        fields.m_ramp_param = ovo::STEREO_AXIS_Y;
        fields.m_mode = ovo::STEREO_MODE_PLAIN;
        fields.m_split = ovo::STEREO_SPLIT_TOP_BOTTOM;
        fields.m_use_screen_size = true;
        fields.m_auto_eye = true;
        fields.m_eye_target = true;
        fields.m_shift_axis = ovo::STEREO_AXIS_Z;
        ovo::ApplyLiveWallpaperPreset(fields, each.m_kind);
        EXPECT_TRUE(fields.m_enabled);
        EXPECT_EQ(fields.m_mode, ovo::STEREO_MODE_SHADER);
        EXPECT_EQ(fields.m_width, 480);
        EXPECT_EQ(fields.m_height, 800);
        EXPECT_EQ(fields.m_eye_distance, each.m_distance);
        EXPECT_EQ(fields.m_eye_angle, each.m_angle);
        EXPECT_EQ(fields.m_ramp_steps, each.m_steps);
        EXPECT_EQ(fields.m_ramp_restart, each.m_restart);
        EXPECT_EQ(fields.m_eye_shift, 0.0f);
        EXPECT_EQ(fields.m_eye_distance_set, each.m_distance);
        EXPECT_EQ(fields.m_eye_angle_set, each.m_angle);
        EXPECT_EQ(fields.m_eye_axis, ovo::STEREO_AXIS_X);
        EXPECT_EQ(fields.m_shift_axis, ovo::STEREO_AXIS_X);
        EXPECT_EQ(fields.m_split, ovo::STEREO_SPLIT_SIDE_BY_SIDE);
        EXPECT_EQ(fields.m_eye_order, ovo::STEREO_EYE_ORDER_NORMAL);
        EXPECT_EQ(fields.m_ramp, ovo::STEREO_RAMP_ON);
        EXPECT_EQ(fields.m_target_width, 480);
        EXPECT_EQ(fields.m_target_height, 800);
        EXPECT_EQ(fields.m_screen_width, 480);
        EXPECT_EQ(fields.m_screen_height, 800);
        EXPECT_TRUE(fields.m_shader_convert);
        EXPECT_FALSE(fields.m_use_screen_size);
        EXPECT_FALSE(fields.m_auto_eye);
        EXPECT_FALSE(fields.m_eye_target);
        EXPECT_TRUE(fields.m_valid);
        EXPECT_FALSE(fields.m_swap_eye_mask);
        EXPECT_TRUE(fields.m_force_portrait);
        EXPECT_EQ(fields.m_eye_shift_set, 0.25f) << "kept";
        EXPECT_EQ(fields.m_ramp_param, ovo::STEREO_AXIS_Y) << "kept";
    }
}

TEST(LiveWallpaperPresetTest, OtherKindsChangeNothing) {
    for (int kind : {0, 7, -1}) {
        ovo::StereoProfileFields fields;
        ovo::ApplyLiveWallpaperPreset(fields, kind);
        EXPECT_FALSE(fields.m_enabled) << kind;
        EXPECT_EQ(fields.m_mode, 0u) << kind;
    }
}

}  // namespace
