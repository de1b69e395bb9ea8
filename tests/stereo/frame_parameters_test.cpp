// The ramp, the sprite depth planes and the frame boundary.
#include "present/viewer_tracker.h"
#include "stereo/draw_call.h"
#include "stereo/es1_stereo_layer.h"
#include "stereo/frame_parameters.h"
#include "stereo/overlay_target.h"
#include "stereo_fixture.h"

namespace {

class FrameParametersTest : public StereoFixture {
protected:
    static void BindTexture(GLint texture) {
        recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_TEXTURE_BINDING_2D, {texture});
    }

    static void StartFrame() {
        Manager().m_frame_draws = 0;
        Manager().m_last_texture = 0;
        Manager().m_depth_plane = -Manager().m_depth_start;
    }
};

TEST_F(FrameParametersTest, TheRampStepsTowardZeroThenKeepsTheRestartValue) {
    struct Case {
        float m_steps;
        float m_steps_kept;  // a stepless ramp takes one step
        float m_configured;
        std::vector<float> m_seen;  // by the draws of textures 1, 2, ...
    } cases[] = {
        {4.0f, 4.0f, -0.04f, {-0.04f, -0.03f, -0.02f, -0.01f, 0.004f, 0.004f}},
        {4.0f, 4.0f, 0.04f, {0.04f, 0.03f, 0.02f, 0.01f, -0.004f, -0.004f}},
        {4.0f, 4.0f, 0.0f, {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f}},
        {0.0f, 1.0f, 0.5f, {0.5f, -0.05f}},  // reached zero at once: restarted
    };
    Profile().m_ramp_restart = 10.0f;
    Profile().m_ramp_param = ovo::STEREO_AXIS_X;
    for (const Case& each : cases) {
        Profile().m_ramp_steps = each.m_steps;
        Profile().m_eye_distance_set = each.m_configured;
        Profile().m_eye_distance = 123.0f;  // the first step of a frame restores the configured value
        StartFrame();
        for (size_t texture = 1; texture <= each.m_seen.size(); ++texture) {
            BindTexture(static_cast<GLint>(texture));
            ovo::StepRampEs1(Manager());
            EXPECT_NEAR(Profile().m_eye_distance, each.m_seen[texture - 1], 1e-7)
                << "configured " << each.m_configured << ", texture " << texture;
            // The same texture again moves nothing.
            ovo::StepRampEs1(Manager());
            EXPECT_NEAR(Profile().m_eye_distance, each.m_seen[texture - 1], 1e-7);
        }
        EXPECT_EQ(Profile().m_ramp_steps, each.m_steps_kept);
    }
}

TEST_F(FrameParametersTest, EachFormRampsItsOwnParameter) {
    struct Case {
        void (*m_step)(ovo::StereoManager&);
        uint32_t m_param;
        int m_ramped;  // 0 distance, 1 angle, 2 shift
        bool m_shift_restored;
    } cases[] = {
        {ovo::StepRampEs1, ovo::STEREO_AXIS_X, 0, true},  {ovo::StepRampEs1, ovo::STEREO_AXIS_Y, 1, true},
        {ovo::StepRampEs1, ovo::STEREO_AXIS_Z, 2, true},  {ovo::StepRampEs1, 0x3999, 0, true},
        {ovo::StepRampEs2, ovo::STEREO_AXIS_Y, 1, false}, {ovo::StepRampEs2, ovo::STEREO_AXIS_Z, 0, false},
    };
    Profile().m_ramp_steps = 2.0f;
    for (const Case& each : cases) {
        Profile().m_ramp_param = each.m_param;
        Profile().m_eye_distance_set = 0.4f;
        Profile().m_eye_angle_set = 0.4f;
        Profile().m_eye_shift_set = 0.4f;
        Profile().m_eye_shift = 9.0f;
        StartFrame();
        BindTexture(1);
        each.m_step(Manager());
        BindTexture(2);
        each.m_step(Manager());
        const float values[3] = {Profile().m_eye_distance, Profile().m_eye_angle, Profile().m_eye_shift};
        for (int parameter = 0; parameter < 3; ++parameter) {
            float expected = parameter == each.m_ramped ? 0.2f : 0.4f;
            if (parameter == 2 && !each.m_shift_restored) expected = 9.0f;
            EXPECT_FLOAT_EQ(values[parameter], expected) << std::hex << each.m_param << " " << parameter;
        }
    }
}

TEST_F(FrameParametersTest, SpriteDepthPlanesCycleWithTextureChanges) {
    const GLint textures[] = {4, 4, 7, 9, 2, 5, 5};
    const float planes[] = {-5.0f, -5.0f, -3.0f, -1.0f, -5.0f, -3.0f, -3.0f};
    StartFrame();
    for (size_t draw = 0; draw < sizeof(textures) / sizeof(textures[0]); ++draw) {
        BindTexture(textures[draw]);
        ovo::StepDepthPlane(Manager());
        EXPECT_EQ(Manager().m_depth_plane, planes[draw]) << "draw " << draw;
        EXPECT_EQ(Manager().m_frame_draws, draw + 1);
    }
}

// An off-centre glFrustumf(-1, 3, -1, 1, 1, 10) and an object 4 in front of the eye, drawn
// through the OpenGL ES 1.x layer: its origin lands at depth 2/3, which unprojects from the
// screen's centre to (4, 0, -4), distance 4 and angle 45 degrees. Flat draws show the viewer
// nothing.
TEST_F(FrameParametersTest, TheFrameBoundaryTakesTheViewersEstimateOfPerspectiveDrawsAndRestartsThePlanes) {
    const std::vector<GLfloat> off_centre = {0.5f, 0, 0, 0, 0, 1, 0, 0, 0.5f, 0, -11.0f / 9.0f, -1,
                                             0, 0, -20.0f / 9.0f, 0};
    const struct {
        const std::vector<GLfloat>* m_projection;
        float m_distance;
        float m_angle;
    } cases[] = {{&off_centre, 4.0f, 45.0f}, {&ORTHO, 0.0f, 0.0f}};
    ovo::Es1StereoLayer layer;
    Interleave(true);
    AnswerMatrix(GL_MODELVIEW_MATRIX, {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, -4, 1});
    for (const auto& each : cases) {
        delete Manager().m_viewer;
        Manager().m_viewer = new ovo::ViewerTracker(true);
        AnswerMatrix(GL_PROJECTION_MATRIX, *each.m_projection);
        layer.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        Manager().m_depth_plane = 3.0f;
        Manager().m_frame_draws = 17;
        Manager().m_last_texture = 9;
        const uint32_t frame = Manager().m_frame_number;
        ovo::BeginFrame(Manager());
        EXPECT_NEAR(Profile().m_eye_distance, each.m_distance, 1e-5) << &each - cases;
        EXPECT_NEAR(Profile().m_eye_angle, each.m_angle, 1e-4) << &each - cases;
        EXPECT_EQ(Manager().m_depth_plane, -5.0f);
        EXPECT_EQ(Manager().m_frame_draws, 0u);
        EXPECT_EQ(Manager().m_last_texture, 0u);
        EXPECT_EQ(Manager().m_frame_number, frame + 1);
    }
}

// The overlay collected during the frame goes into it at the mode's size: once, unshifted,
// without shader conversion; into both halves with it, at the screen's or the target's size.
TEST_F(FrameParametersTest, TheFrameBoundaryComposesTheOverlayAtTheModesSize) {
    const Calls single = {"glOrthof(0, 1280, 720, 0, -1, 1)", "glViewport(0, 0, 1280, 720)", "glDrawArrays(5, 0, 4)"};
    const struct {
        bool m_shader_convert;
        bool m_use_screen_size;
        bool m_content;
        Calls m_composed;
    } cases[] = {
        {false, false, true, single},
        {false, true, true, single},
        {true, true, true,
         {"glOrthof(0, 640, 720, 0, -1, 1)", "glViewport(0, 0, 640, 720)", "glDrawArrays(5, 0, 4)",
          "glViewport(640, 0, 640, 720)", "glDrawArrays(5, 0, 4)"}},
        {true, false, true,
         {"glOrthof(0, 400, 480, 0, -1, 1)", "glViewport(0, 0, 400, 480)", "glDrawArrays(5, 0, 4)",
          "glViewport(400, 0, 400, 480)", "glDrawArrays(5, 0, 4)"}},
        {true, false, false, {}},
    };
    Profile().m_eye_target = true;
    recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGenFramebuffersOES, 1, {7});
    recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_VIEWPORT, {1, 2, 3, 4});
    ovo::OverlayTarget& overlay = *Manager().m_overlay;
    overlay.Create();
    for (const auto& each : cases) {
        Profile().m_shader_convert = each.m_shader_convert;
        Profile().m_use_screen_size = each.m_use_screen_size;
        overlay.Clear();
        if (each.m_content) overlay.DrawInto(Manager(), ovo::DrawCall::Arrays(GL_TRIANGLES, 0, 3));
        ResetRecorder();
        ovo::BeginFrame(Manager());
        Calls composed = Only({"glOrthof", "glViewport", "glDrawArrays"});
        if (!composed.empty()) {
            EXPECT_EQ(composed.back(), "glViewport(1, 2, 3, 4)") << "the application's viewport is put back";
            composed.pop_back();
        }
        EXPECT_EQ(composed, each.m_composed) << &each - cases;
    }
}

}  // namespace
