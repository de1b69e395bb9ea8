// Tests in processes of their own: the manager takes the application's name from the first
// argument of its command line; and calls made after the manager has been released at
// process exit, as an exit handler or a thread that runs on makes them, pass straight to the
// vendor and the process exits cleanly, with stereo on or off.
#include <EGL/egl.h>
#include <GLES/gl.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

#include "core/entry_tables.h"
#include "core/stereo_manager.h"
#include "support/device_files.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/recorded_calls.h"
#include "support/scenario_process.h"
#include "support/vendor_root.h"

namespace {

TEST(ProcessNameTest, DISABLED_PrintName) {
    char name[ovo::PROCESS_NAME_CAPACITY];
    ovo::StereoManager::ReadProcessName(name);
    std::printf("name=[%s]\n", name);
}

TEST(ProcessNameTest, IsTheFirstArgumentCutAtWhitespace) {
    struct Case {
        std::string m_command_line;
        std::string m_expected;
    } cases[] = {
        {"com.example.game", "com.example.game"},
        {"app --flag", "app"},
        {"tab\tseparated", "tab"},
        {std::string(2000, 'n'), std::string(ovo::PROCESS_NAME_CAPACITY - 1, 'n')},
    };
    for (const Case& each : cases) {
        ScenarioResult result =
            RunScenario(each.m_command_line.c_str(), "ProcessNameTest.DISABLED_PrintName");
        EXPECT_EQ(result.m_exit_code, 0);
        EXPECT_NE(result.m_output.find("name=[" + each.m_expected + "]\n"), std::string::npos)
            << result.m_output.substr(0, 200);
    }
}

EglSession g_game;

void CallAfterTheRelease() {
    ResetRecorder();
    glFlush();
    glDrawArrays(GL_TRIANGLES, 4, 3);
    std::string gl_calls;
    for (const std::string& call : recorded_calls::RecordedGlCalls()) gl_calls += call + " ";
    ResetRecorder();
    const EGLBoolean swapped = eglSwapBuffers(g_game.m_display, EglSession::Surface());
    const EGLBoolean released = g_game.MakeCurrent(EGL_NO_CONTEXT);
    std::printf("late: %segl_calls=%u swap=%d make_current=%d\n", gl_calls.c_str(),
                RecorderGetState()->m_call_count, swapped != EGL_FALSE, released == EGL_TRUE);
    std::fflush(stdout);
}

// Registered before the manager exists, the exit handler runs after its release.
void PlayAFrameThenExit(bool stereo) {
    std::atexit(CallAfterTheRelease);
    vendor_root::InstallRecorder();
    std::filesystem::remove_all(OVO_TEST_DEVICE_ROOT "/sdcard");
    if (stereo) {
        device_files::Write("/sdcard/stereoconv/game/stereo_gm.ovo",
                            device_files::ProfileFile({{0x2301, {1}}, {0x2403, {1}}, {0x2201, {800, 480}}}));
    }
    g_game.Open();
    ASSERT_EQ(g_game.MakeCurrent(g_game.CreateContext(1)), EGL_TRUE);
    glDrawArrays(GL_TRIANGLES, 0, 3);
    eglSwapBuffers(g_game.m_display, EglSession::Surface());
    std::printf("alive: interleave=%d\n", ovo::StereoManager::instance().m_interleave);
}

TEST(LateCallsScenario, DISABLED_Flat) { PlayAFrameThenExit(false); }
TEST(LateCallsScenario, DISABLED_Stereo) { PlayAFrameThenExit(true); }

TEST(LateCallsTest, PassToTheVendorAfterTheManagersReleaseAtExit) {
    const std::pair<const char*, const char*> cases[] = {{"LateCallsScenario.DISABLED_Flat", "interleave=0"},
                                                         {"LateCallsScenario.DISABLED_Stereo", "interleave=1"}};
    for (const auto& [scenario, interleave] : cases) {
        const ScenarioResult result = RunScenario("com.example.game", scenario);
        EXPECT_EQ(result.m_exit_code, 0) << scenario << ":\n" << result.m_output;
        EXPECT_NE(result.m_output.find(std::string("alive: ") + interleave + "\n"), std::string::npos)
            << result.m_output;
        // One vendor call each: nothing drawn per eye, no mask, no overlay.
        EXPECT_NE(result.m_output.find("late: glFlush() glDrawArrays(4, 4, 3) egl_calls=2 swap=1 make_current=1\n"),
                  std::string::npos)
            << scenario << ":\n" << result.m_output;
    }
}

}  // namespace
