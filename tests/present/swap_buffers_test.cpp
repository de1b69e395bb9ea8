// The per-frame work at eglSwapBuffers: the vendor's answer, the panel refresh on
// processor time and the live-tuning file; and the panel nodes' requests.
#include <gtest/gtest.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <ctime>
#include <filesystem>
#include <iterator>
#include <string>
#include <vector>

#include "core/stereo_manager.h"
#include "present/composition_renderer.h"
#include "present/live_tuning.h"
#include "present/panel_control.h"
#include "stereo/draw_call.h"
#include "stereo/overlay_target.h"
#include "support/recorded_calls.h"
#include "support/device_files.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/vendor_root.h"

namespace {

// The refresh interval counts processor time, so the test spends some rather than sleep.
void BurnProcessorTime(double seconds) {
    clock_t start = clock();
    volatile unsigned spins = 0;
    while (static_cast<double>(clock() - start) < seconds * CLOCKS_PER_SEC) spins = spins + 1;
}

class SwapBuffersTest : public ::testing::Test {
protected:
    void SetUp() override {
        vendor_root::InstallRecorder();
        m_egl.Open();
        ASSERT_NE(m_egl.m_display, EGL_NO_DISPLAY);
        device_files::Write("/dev/zpx", "");
        device_files::Remove("/sdcard/game_profile.txt");
        Profile().m_shader_convert = true;
        Profile().m_target_width = 800;
        Profile().m_target_height = 480;
    }

    ovo::StereoProfile& Profile() { return *ovo::StereoManager::instance().m_profile; }
    EGLBoolean Swap() { return eglSwapBuffers(m_egl.m_display, EglSession::Surface()); }
    static std::string PanelRequests() { return device_files::Read("/dev/zpx"); }

    EglSession m_egl;
};

const std::string LANDSCAPE = "request=0xc0047602 argument=1\n";
const std::string PORTRAIT = "request=0xc0047602 argument=2\n";

TEST_F(SwapBuffersTest, ThePanelIsReassertedAfterATenthOfASecondOfProcessorTime) {
    Swap();
    BurnProcessorTime(0.15);
    EXPECT_EQ(PanelRequests(), "") << "the first swap only starts the interval";
    Swap();
    EXPECT_EQ(PanelRequests(), LANDSCAPE);
    BurnProcessorTime(0.15);
    Swap();
    EXPECT_EQ(PanelRequests(), LANDSCAPE) << "the new interval starts at the swap after a request";
    BurnProcessorTime(0.15);
    Swap();
    EXPECT_EQ(PanelRequests(), LANDSCAPE + LANDSCAPE);
}

TEST_F(SwapBuffersTest, TheRequestFollowsTheTargetsOrientation) {
    struct Case {
        int32_t m_width, m_height;
        bool m_force_portrait, m_shader_convert, m_node;
        std::string m_request;
        float m_eye_distance;  // 0.02 once the live-tuning file was read
    } cases[] = {{800, 480, false, true, true, LANDSCAPE, 0.02f},
                 {480, 800, false, true, true, PORTRAIT, 0.02f},
                 {600, 600, false, true, true, LANDSCAPE, 0.02f},
                 {800, 480, true, true, true, PORTRAIT, 7.0f},    // forced portrait reads no file
                 {800, 480, false, true, false, "", 0.02f},       // no panel node: the file is still read
                 {800, 480, false, false, true, "", 7.0f}};       // no shader conversion: neither
    for (const Case& each : cases) {
        SCOPED_TRACE(std::to_string(each.m_width) + "x" + std::to_string(each.m_height));
        each.m_node ? device_files::Write("/dev/zpx", "") : device_files::Remove("/dev/zpx");
        device_files::Write("/sdcard/game_profile.txt", "0.02 1.5");
        Profile().m_target_width = each.m_width;
        Profile().m_target_height = each.m_height;
        Profile().m_force_portrait = each.m_force_portrait;
        Profile().m_shader_convert = each.m_shader_convert;
        Profile().m_eye_distance = 7.0f;
        Swap();
        BurnProcessorTime(0.15);
        Swap();
        EXPECT_EQ(PanelRequests(), each.m_request);
        EXPECT_EQ(Profile().m_eye_distance, each.m_eye_distance);
    }
}

TEST_F(SwapBuffersTest, AFailedVendorSwapIsReportedAndTheRefreshStillRuns) {
    RecorderGetState()->m_swap_fails = true;
    EXPECT_EQ(Swap(), EGL_FALSE);
    BurnProcessorTime(0.15);
    EXPECT_EQ(Swap(), EGL_FALSE);
    EXPECT_EQ(PanelRequests(), LANDSCAPE);
    RecorderGetState()->m_swap_fails = false;
    EXPECT_EQ(Swap(), (RecorderResult<EGLBoolean>(RECORDER_API_EGL, ovo::EGL_ENTRY_eglSwapBuffers)));
}

// The overlay collected during the frame goes into it before the vendor's swap; after the
// swap the overlay is emptied and the next frame's mask drawn.
TEST_F(SwapBuffersTest, TheOverlayGoesIntoTheFrameBeforeTheSwapAndTheMaskAfter) {
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(1)), EGL_TRUE);
    Profile().m_eye_target = true;
    recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGenFramebuffersOES, 1, {7});
    manager.m_overlay->Create();
    manager.m_overlay->DrawInto(manager, ovo::DrawCall::Arrays(GL_TRIANGLES, 0, 3));
    manager.m_composer = new ovo::CompositionRenderer(1);  // released at exit
    manager.m_interleave = true;
    ResetRecorder();
    Swap();
    std::vector<std::string> order;
    for (const std::string& call : recorded_calls::RecordedCalls(true)) {
        if (call == "glDrawArrays(5, 0, 4)" || call.compare(0, 15, "eglSwapBuffers(") == 0 ||
            call == "glClear(0x4100)" || call == "glClearStencil(1)")
            order.push_back(call.substr(0, call.find('(')));
    }
    EXPECT_EQ(order, (std::vector<std::string>{"glDrawArrays", "glDrawArrays", "eglSwapBuffers", "glClear",
                                               "glClearStencil"}));
    EXPECT_FALSE(manager.m_overlay->HasContent());
}

// Leaves a non-zero pattern where the next call's locals will lie, so that a value the
// reader uses before it set it shows.
__attribute__((noinline)) void DirtyTheStack() {
    volatile float junk[4096];
    for (size_t i = 0; i < 4096; ++i) junk[i] = 9.0f;
    static_cast<void>(junk[0]);
}

// Positions without a number are 0; how the text reads is
// LiveTuning.ReadsAShortFileAsFscanfReadsIt's.
TEST_F(SwapBuffersTest, TheLiveTuningFileSetsFourParameters) {
    const struct {
        const char* m_text;
        std::vector<float> m_expected;
    } cases[] = {
        {"0.02 1.5", {0.02f, 1.5f, 0.0f, 0.0f}},
        {"", {0.0f, 0.0f, 0.0f, 0.0f}},
        {"1 2 3 4 5 6", {1.0f, 2.0f, 3.0f, 4.0f}},
        {"-1e3\n\t2.5   -0.25\n8", {-1000.0f, 2.5f, -0.25f, 8.0f}},
    };
    ovo::StereoProfile& profile = Profile();
    for (const auto& each : cases) {
        profile.m_eye_distance = profile.m_eye_angle = profile.m_eye_shift = profile.m_ramp_steps = 9.0f;
        device_files::Write("/sdcard/game_profile.txt", each.m_text);
        DirtyTheStack();
        ovo::ReadLiveTuning(profile);
        EXPECT_EQ((std::vector<float>{profile.m_eye_distance, profile.m_eye_angle, profile.m_eye_shift,
                                      profile.m_ramp_steps}),
                  each.m_expected)
            << '"' << each.m_text << '"';
        EXPECT_EQ(profile.m_eye_distance_set, 0.0f) << "configured values stay";
    }
    device_files::Remove("/sdcard/game_profile.txt");
    ovo::ReadLiveTuning(profile);
    EXPECT_EQ(profile.m_eye_distance, -1000.0f) << "a missing file changes nothing";
}

TEST(PanelControlTest, EachModeReachesThePanelNodeByValue) {
    device_files::Write("/dev/zpx", "");
    EXPECT_TRUE(ovo::SetPanelMode(false, true));
    EXPECT_TRUE(ovo::SetPanelMode(true, true));
    EXPECT_TRUE(ovo::SetPanelMode(true, false));
    EXPECT_EQ(device_files::Read("/dev/zpx"),
              "request=0xc0047602 argument=0\n"
              "request=0xc0047602 argument=1\n"
              "request=0xc0047602 argument=2\n");
}

TEST(PanelControlTest, CompositionStartSendsOneAndMissingNodesAreSilent) {
    device_files::Write("/dev/zdriver", "");
    ovo::SendCompositionStart();
    EXPECT_EQ(device_files::Read("/dev/zdriver"), "request=0x616 argument=1\n");
    device_files::Remove("/dev/zpx");
    device_files::Remove("/dev/zdriver");
    EXPECT_FALSE(ovo::SetPanelMode(true, true));
    ovo::SendCompositionStart();
    EXPECT_FALSE(std::filesystem::exists(device_files::Path("/dev/zpx")));
    EXPECT_FALSE(std::filesystem::exists(device_files::Path("/dev/zdriver")));
}

size_t OpenDescriptors() {
    return static_cast<size_t>(std::distance(std::filesystem::directory_iterator("/proc/self/fd"),
                                             std::filesystem::directory_iterator()));
}

// The panel is asked again about ten times a second for as long as the game runs.
TEST(PanelControlTest, EveryPanelRequestClosesItsNode) {
    device_files::Write("/dev/zpx", "");
    const size_t before = OpenDescriptors();
    for (int request = 0; request < 50; ++request) ASSERT_TRUE(ovo::SetPanelMode(true, request % 2 == 0));
    EXPECT_EQ(OpenDescriptors(), before);
}

// The stand-in answers only for its plain-file nodes; everything else reaches the real ioctl.
TEST(PanelControlTest, OtherDescriptorsReachTheRealDriver) {
    int channel[2];
    ASSERT_EQ(pipe(channel), 0);
    ASSERT_EQ(write(channel[1], "abc", 3), 3);
    int pending = 0;
    EXPECT_EQ(ioctl(channel[0], FIONREAD, &pending), 0);
    EXPECT_EQ(pending, 3);
    close(channel[0]);
    close(channel[1]);
}

}  // namespace
