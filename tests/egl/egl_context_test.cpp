// What context creation and make-current set up: the layer, the version report and the
// sizes taken from the draw surface.
#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>
#include <regex>
#include <string>

#include "core/stereo_manager.h"
#include "entry/gl_dispatch.h"
#include "support/device_files.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/recorded_calls.h"
#include "support/scenario_process.h"
#include "support/vendor_root.h"

namespace {

const char REPORT[] = "/sdcard/duoscope/version.txt";

class EglContextTest : public ::testing::Test {
protected:
    void SetUp() override {
        vendor_root::InstallRecorder();
        std::filesystem::remove_all(OVO_TEST_DEVICE_ROOT "/sdcard");
        device_files::Write("/sdcard/duoscope/.keep", "");
        m_egl.Open();
        ASSERT_NE(m_egl.m_display, EGL_NO_DISPLAY);
    }

    ovo::StereoManager& Manager() { return ovo::StereoManager::instance(); }
    ovo::StereoProfile& Profile() { return *Manager().m_profile; }

    EglSession m_egl;
};

// The first ES 2.0 context brings in the ES 2.0 layer, once.
TEST_F(EglContextTest, AnEnabledProcessKeepsItsFirstEs2Layer) {
    Profile().m_enabled = true;
    m_egl.CreateContext(1);
    EXPECT_FALSE(Manager().m_es2_layer_installed);
    m_egl.CreateContext(2);
    EXPECT_TRUE(Manager().m_es2_layer_installed);
    ovo::GlLayer* es2_layer = Manager().m_layer;
    m_egl.CreateContext(2);
    eglCreateContext(m_egl.m_display, nullptr, EGL_NO_CONTEXT, nullptr);
    EXPECT_EQ(Manager().m_layer, es2_layer);
}

// Run under a package name: the report after an ES 2.0 context, then after one without
// an attribute list.
TEST_F(EglContextTest, DISABLED_PrintReports) {
    Profile().m_enabled = true;
    m_egl.CreateContext(2);
    std::printf("report[%s]\n", device_files::Read(REPORT).c_str());
    m_egl.CreateContext(2);
    eglCreateContext(m_egl.m_display, nullptr, EGL_NO_CONTEXT, nullptr);
    std::printf("report[%s]\n", device_files::Read(REPORT).c_str());
}

TEST(VersionReportTest, NamesTheBuildThePackageAndTheLastContextsVersion) {
    const ScenarioResult result = RunScenario("com.example.game", "EglContextTest.DISABLED_PrintReports");
    EXPECT_EQ(result.m_exit_code, 0);
    // The build tag: "(r <source revision>)(<compile date>,<compile time>)".
    const std::string report =
        R"(report\[\(r [^()\n]+\)\((Jan|Feb|Mar|Apr|May|Jun|Jul|Aug|Sep|Oct|Nov|Dec) [ 123][0-9] )"
        R"(20[0-9]{2},[0-2][0-9]:[0-5][0-9]:[0-5][0-9]\)\n\[package name\]\n\tcom\.example\.game\n)"
        R"(\[gl version\]\n\t)";
    const std::regex both(report + R"(OpenGL ES 2\.0\n\]\n)" + report + R"(OpenGL ES 1\.x\n\]\n)");
    EXPECT_TRUE(std::regex_search(result.m_output, both)) << result.m_output;
}

TEST_F(EglContextTest, ADisabledProcessWritesNoReportAndKeepsItsLayer) {
    ovo::GlLayer* layer = Manager().m_layer;
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    EXPECT_FALSE(std::filesystem::exists(device_files::Path(REPORT)));
    EXPECT_EQ(Manager().m_layer, layer);
    EXPECT_FALSE(Manager().m_es2_layer_installed);
    ResetRecorder();
    glFlush();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glFlush), nullptr);
}

TEST_F(EglContextTest, TheFirstSurfaceFillsMissingSizes) {
    Manager().m_viewport = ovo::GlRect{3, 4, 0, 0};
    Manager().m_scissor = ovo::GlRect{0, 0, 640, 360};
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    const ovo::StereoProfile& profile = Profile();
    for (int32_t width : {profile.m_target_width, profile.m_screen_width, profile.m_width}) EXPECT_EQ(width, 1280);
    for (int32_t height : {profile.m_target_height, profile.m_screen_height, profile.m_height}) EXPECT_EQ(height, 720);
    EXPECT_EQ(Manager().ScaleX(), 1.0f);
    EXPECT_EQ(Manager().ScaleY(), 1.0f);
    EXPECT_EQ(Manager().m_viewport.m_x, 3);
    EXPECT_EQ(Manager().m_viewport.m_width, 1280);
    EXPECT_EQ(Manager().m_viewport.m_height, 720);
    EXPECT_EQ(Manager().m_scissor.m_width, 640) << "a set rectangle keeps its size";

    // Later surfaces change nothing that is set.
    RecorderGetState()->m_surface_width = 320;
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    EXPECT_EQ(Profile().m_target_width, 1280);
    EXPECT_EQ(Manager().m_viewport.m_width, 1280);
}

TEST_F(EglContextTest, ProfileSizesWinOverTheSurface) {
    ovo::StereoProfile& profile = Profile();
    profile.m_target_width = 800;
    profile.m_target_height = 480;
    profile.m_width = 1280;
    profile.m_height = 720;
    // A refused make-current still takes the scale from the profile, but asks the surface
    // nothing: the query would replace the vendor's error with its own.
    RecorderGetState()->m_make_current_fails = true;
    const EGLContext context = m_egl.CreateContext(1);
    ResetRecorder();
    EXPECT_EQ(m_egl.MakeCurrent(context), EGL_FALSE);
    EXPECT_EQ(profile.m_target_width, 800);
    EXPECT_EQ(Manager().ScaleX(), 1.6f);
    EXPECT_EQ(Manager().ScaleY(), 1.5f);
    EXPECT_EQ(Manager().m_viewport.m_width, 0);
    EXPECT_EQ(RecorderGetState()->m_call_count, 1u) << "eglMakeCurrent alone";
}

TEST_F(EglContextTest, EveryDisplayRequestDeletesTheProfileFile) {
    const std::string profile = OVO_TEST_DEVICE_ROOT "/sdcard/stereoconv/game/stereo_gm.ovo";
    std::filesystem::create_directories(OVO_TEST_DEVICE_ROOT "/sdcard/stereoconv/game");
    for (int round = 0; round < 2; ++round) {
        std::ofstream(profile) << "profile";
        EXPECT_NE(eglGetDisplay(EGL_DEFAULT_DISPLAY), EGL_NO_DISPLAY);
        EXPECT_FALSE(std::filesystem::exists(profile)) << round;
    }
    EXPECT_NE(eglGetDisplay(EGL_DEFAULT_DISPLAY), EGL_NO_DISPLAY) << "no file is no error";
}

TEST(EglProfileTest, AProfileFileTurnsStereoOnForTheProcess) {
    vendor_root::InstallRecorder();
    std::filesystem::remove_all(OVO_TEST_DEVICE_ROOT "/sdcard");
    device_files::Write("/sdcard/duoscope/.keep", "");
    device_files::Write("/sdcard/stereoconv/game/stereo_gm.ovo",
                        device_files::ProfileFile({{0x2301, {1}}, {0x2403, {1}}, {0x2201, {800, 480}}, {0x2101, {0x3102}}}));
    EglSession egl;
    egl.Open();
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    EXPECT_EQ(manager.m_profile->ResolveMode(), ovo::STEREO_MODE_SHADER);
    EXPECT_EQ(manager.ScaleX(), 1.0f);
    GLint split = 0;
    glGetIntegerv(ovo::STEREO_PARAM_SPLIT, &split);
    EXPECT_EQ(split, ovo::STEREO_SPLIT_TOP_BOTTOM);

    ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(2)), EGL_TRUE);
    EXPECT_TRUE(manager.m_es2_layer_installed);
    EXPECT_EQ(manager.m_profile->m_target_width, 800) << "the profile's size wins over the surface";
    EXPECT_NE(device_files::Read(REPORT).find("\tOpenGL ES 2.0\n"), std::string::npos);
}

// Run under the profile the caller installed: the mode and whether the manager interleaves,
// then the viewport, scissor, stencil and draw calls of one draw of each version for every
// split and eye order set through the control codes, one line per draw.
TEST(EglProfileScenario, DISABLED_PrintEyeDrawsPerSplit) {
    EglSession egl;
    egl.Open();
    const ovo::StereoManager& manager = ovo::StereoManager::instance();
    std::printf("mode=0x%x interleave=%d\n", static_cast<unsigned>(manager.m_profile->ResolveMode()),
                manager.m_interleave ? 1 : 0);
    const char* const kept[] = {"glViewport(", "glScissor(", "glStencilFunc(", "glDrawArrays("};
    for (EGLint version : {1, 2}) {
        ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(version)), EGL_TRUE);
        for (GLint split : {ovo::STEREO_SPLIT_SIDE_BY_SIDE, ovo::STEREO_SPLIT_TOP_BOTTOM}) {
            for (GLint order : {ovo::STEREO_EYE_ORDER_NORMAL, ovo::STEREO_EYE_ORDER_SWAPPED}) {
                glTexParameteri(ovo::STEREO_PARAM_SPLIT, 0, split);
                glTexParameteri(ovo::STEREO_PARAM_EYE_ORDER, 0, order);
                ResetRecorder();
                glDrawArrays(GL_TRIANGLES, 0, 3);
                std::string line = "ES" + std::to_string(version) + ":";
                for (const std::string& call : recorded_calls::RecordedGlCalls()) {
                    for (const char* name : kept) {
                        if (call.rfind(name, 0) == 0) line += " " + call;
                    }
                }
                std::printf("%s\n", line.c_str());
            }
        }
    }
}

// Every accepted profile of a shader mode interleaves, so its split and eye order (from the
// file or the control codes) never reach a draw: both eyes keep the application's viewport
// and scissor and differ only by their stencil reference. The plain mode draws once at the
// scaled viewport, whatever they say.
TEST(EglProfileTest, SplitAndEyeOrderChangeNoDraw) {
    vendor_root::InstallRecorder();
    // Top and bottom, eye order swapped, 800 x 480, with the shader conversion flag given.
    auto profile = [](uint32_t shader_convert) {
        return device_files::ProfileFile({{0x2403, {1}}, {0x2101, {0x3102}}, {0x2102, {0x3107}},
                                          {0x2201, {800, 480}}, {0x2301, {shader_convert}}});
    };
    // Eye 0 passes where the mask holds 1, unless the profile keeps the mask's own eye
    // order (the live-wallpaper presets do).
    auto eyes = [](int eye0_reference) {
        return ": glStencilFunc(0x0202, " + std::to_string(eye0_reference) +
               ", 1) glDrawArrays(4, 0, 3) glStencilFunc(0x0202, " + std::to_string(1 - eye0_reference) +
               ", 1) glDrawArrays(4, 0, 3)";
    };
    const struct {
        const char* m_process;
        std::string m_profile;  // empty: none installed
        std::string m_mode;
        std::string m_es1_draw;
        std::string m_es2_draw;
    } cases[] = {
        {"com.example.game", profile(1), "mode=0x1002 interleave=1", eyes(1), eyes(1)},
        {"com.rovio.angrybirds", profile(1), "mode=0x1003 interleave=1", eyes(1), eyes(1)},
        {"com.android.wallpaper", "", "mode=0x1002 interleave=1", eyes(0), eyes(0)},
        {"com.example.game", profile(0), "mode=0x1001 interleave=0",
         ": glViewport(0, 0, 1280, 720) glScissor(0, 0, 1280, 720) glDrawArrays(4, 0, 3)",
         ": glViewport(0, 0, 1280, 720) glDrawArrays(4, 0, 3)"},
    };
    for (const auto& each : cases) {
        std::filesystem::remove_all(OVO_TEST_DEVICE_ROOT "/sdcard");
        if (!each.m_profile.empty()) {
            device_files::Write("/sdcard/stereoconv/game/stereo_gm.ovo", each.m_profile);
        }
        const ScenarioResult result =
            RunScenario(each.m_process, "EglProfileScenario.DISABLED_PrintEyeDrawsPerSplit");
        // The same draw for all four combinations.
        std::string expected = each.m_mode + "\n";
        for (int combination = 0; combination < 4; ++combination) expected += "ES1" + each.m_es1_draw + "\n";
        for (int combination = 0; combination < 4; ++combination) expected += "ES2" + each.m_es2_draw + "\n";
        EXPECT_NE(result.m_output.find(expected), std::string::npos)
            << each.m_process << "\n" << result.m_output;
    }
}

}  // namespace
