// The OpenGL ES 1.x layers: the exact calls of one application draw in each path.
#include <functional>
#include <memory>

#include "stereo/es1_scaled_layer.h"
#include "stereo/es1_sprite_stereo_layer.h"
#include "stereo/es1_stereo_layer.h"
#include "stereo/overlay_target.h"
#include "stereo_fixture.h"

namespace {

using namespace recorded_calls;

const Calls MATRIX_QUERIES = {"glGetFloatv(0x0BA7, ptr)", "glGetFloatv(0x0BA6, ptr)", "glGetIntegerv(0x0BA0, ptr)"};
const Calls MATRIX_RESTORE = {"glMatrixMode(0x1701)", "glLoadMatrixf(ptr)", "glMatrixMode(0x1700)",
                              "glLoadMatrixf(ptr)", "glMatrixMode(0x1700)"};

class Es1LayerTest : public StereoFixture {
protected:
    // The overlay's framebuffer is 7.
    void CreateOverlay() {
        Profile().m_eye_target = true;
        AnswerIntegers(ovo::GL_ENTRY_glGenFramebuffersOES, 1, {7});
        Manager().m_overlay->Create();
        ResetRecorder();
    }

    void Blending(bool enabled, GLint source, GLint destination) {
        AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_BLEND, enabled ? 1 : 0);
        AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_BLEND_SRC, {source});
        AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_BLEND_DST, {destination});
    }

    ovo::Es1StereoLayer m_stereo;
};

TEST_F(Es1LayerTest, APerspectiveDrawMovesEachEyeAndItsImageBackThroughTheMask) {
    Interleave(true);
    AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
    m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 6, 3);
    // Eye 0: T(-angle) P T(+distance); eye 1 negated. Eye 0 passes where the mask is 1.
    const Calls expected = Join(
        {MATRIX_QUERIES,
         {"glEnable(0x0B90)", "glMatrixMode(0x1701)", "glLoadIdentity()", "glTranslatef(-0.25, 0, 0)",
          "glMultMatrixf(ptr)", "glTranslatef(0.5, 0, 0)", "glStencilFunc(0x0202, 1, 1)", "glDrawArrays(4, 6, 3)",
          "glMatrixMode(0x1701)", "glLoadIdentity()", "glTranslatef(0.25, 0, 0)", "glMultMatrixf(ptr)",
          "glTranslatef(-0.5, 0, 0)", "glStencilFunc(0x0202, 0, 1)", "glDrawArrays(4, 6, 3)", "glDisable(0x0B90)"},
         MATRIX_RESTORE});
    EXPECT_EQ(RecordedGlCalls(), expected);
}

TEST_F(Es1LayerTest, AFlatDrawIsShiftedInClipSpaceIntoEachHalf) {
    Interleave(false);
    AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
    m_stereo.glDrawElements(Manager(), GL_TRIANGLES, 6, GL_UNSIGNED_SHORT, &m_egl);
    const Calls expected = Join(
        {MATRIX_QUERIES,
         {"glMatrixMode(0x1701)", "glLoadIdentity()", "glTranslatef(0.125, 0, 0)", "glMultMatrixf(ptr)",
          "glViewport(0, 0, 400, 480)", "glScissor(0, 0, 400, 480)", "glDrawElements(4, 6, 0x1403, ptr)",
          "glMatrixMode(0x1701)", "glLoadIdentity()", "glTranslatef(-0.125, 0, 0)", "glMultMatrixf(ptr)",
          "glViewport(400, 0, 400, 480)", "glScissor(400, 0, 400, 480)", "glDrawElements(4, 6, 0x1403, ptr)"},
         MATRIX_RESTORE});
    EXPECT_EQ(RecordedGlCalls(), expected);
}

// Flat draws get one translation per eye, perspective ones two. The layer acts on the
// classifier's answer for the corner cases, not on element 11 alone. A viewport of the target's
// full width off the left edge keeps the projection: the test is against the target's width,
// and here the output (the screen) is wider.
TEST_F(Es1LayerTest, TheProjectionTestLooksAtElementsElevenAndFifteenAndTheViewport) {
    const struct {
        GLfloat m_11;
        GLfloat m_15;
        ovo::GlRect m_viewport;
        size_t m_translations;
    } cases[] = {{0, 0, {0, 0, 800, 480}, 2},    {-1, 1, {0, 0, 800, 480}, 2},    {-1, 0, {0, 0, 800, 480}, 4},
                 {0.5f, 2, {0, 0, 800, 480}, 4}, {-1, 0, {5, 0, 1280, 720}, 4}, {-1, 0, {5, 0, 799, 480}, 4},
                 {-1, 0, {5, 0, 800, 480}, 0}};
    Interleave(false);
    Profile().m_width = 1280;
    Profile().m_height = 720;
    for (const auto& each : cases) {
        std::vector<GLfloat> projection = IDENTITY;
        projection[11] = each.m_11;
        projection[15] = each.m_15;
        AnswerMatrix(GL_PROJECTION_MATRIX, projection);
        Manager().m_viewport = each.m_viewport;
        EXPECT_EQ(Drawn(m_stereo, {"glTranslatef"}).size(), each.m_translations)
            << each.m_11 << ", " << each.m_15 << " at " << each.m_viewport.m_x << " " << each.m_viewport.m_width;
    }
    // The last one, kept, still goes into each half.
    EXPECT_EQ(Only({"glViewport"}), (Calls{"glViewport(2, 0, 400, 480)", "glViewport(642, 0, 400, 480)"}));
}

TEST_F(Es1LayerTest, OnlyUnmovedDrawsWithOrdinaryBlendingGoToTheOverlay) {
    struct Case {
        bool m_blend;
        GLint m_source;
        GLint m_destination;
        const std::vector<GLfloat>* m_modelview;
        bool m_overlay;
    } cases[] = {{false, GL_ONE, GL_ONE, &IDENTITY, true},
                 {true, GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA, &IDENTITY, true},
                 {true, GL_SRC_ALPHA, GL_ONE, &IDENTITY, false},
                 {true, GL_ONE, GL_ONE_MINUS_SRC_ALPHA, &IDENTITY, false},
                 {false, GL_ONE, GL_ZERO, &ORTHO, false}};
    Interleave(true);
    CreateOverlay();
    AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
    for (const Case& each : cases) {
        Blending(each.m_blend, each.m_source, each.m_destination);
        AnswerMatrix(GL_MODELVIEW_MATRIX, *each.m_modelview);
        Manager().m_overlay->Clear();
        Manager().m_overlay->SetBoundFramebuffer(0);
        ResetRecorder();
        m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        const Calls expected = each.m_overlay ? Calls{"glBindFramebufferOES(0x8D40, 7)", "glViewport(0, 0, 800, 480)",
                                                      "glScissor(0, 0, 800, 480)", "glDrawArrays(4, 0, 3)"}
                                              : Calls(2, "glDrawArrays(4, 0, 3)");
        EXPECT_EQ(Only({"glDrawArrays", "glBindFramebufferOES", "glViewport", "glScissor"}), expected)
            << each.m_source << " " << each.m_destination;
    }
}

// eye 0's and eye 1's translations: T(-angle) P T(+distance) for perspective draws, the shift
// for flat ones, on the profile's axis.
TEST_F(Es1LayerTest, TheEyeAndShiftAxesChooseWhereTheEyesMove) {
    const struct {
        bool m_perspective;
        uint32_t m_axis;
        Calls m_translations;
    } cases[] = {
        {true, ovo::STEREO_AXIS_Y,
         {"glTranslatef(0, -0.25, 0)", "glTranslatef(0, 0.5, 0)", "glTranslatef(0, 0.25, 0)", "glTranslatef(0, -0.5, 0)"}},
        {true, ovo::STEREO_AXIS_Z,
         {"glTranslatef(0, 0, -0.25)", "glTranslatef(0, 0, 0.5)", "glTranslatef(0, 0, 0.25)", "glTranslatef(0, 0, -0.5)"}},
        {true, 0x3999, Calls(4, "glTranslatef(0, 0, 0)")},
        {false, ovo::STEREO_AXIS_Y, {"glTranslatef(0, 0.125, 0)", "glTranslatef(0, -0.125, 0)"}},
        {false, ovo::STEREO_AXIS_Z, {"glTranslatef(0, 0, 0.125)", "glTranslatef(0, 0, -0.125)"}},
        {false, 0x3999, Calls(2, "glTranslatef(0, 0, 0)")},
    };
    Interleave(true);
    AnswerMatrix(GL_MODELVIEW_MATRIX, ORTHO);  // moved: no overlay candidate
    for (const auto& each : cases) {
        AnswerMatrix(GL_PROJECTION_MATRIX, each.m_perspective ? PERSPECTIVE : ORTHO);
        Profile().m_eye_axis = each.m_perspective ? each.m_axis : ovo::STEREO_AXIS_X;
        Profile().m_shift_axis = each.m_perspective ? ovo::STEREO_AXIS_X : each.m_axis;
        EXPECT_EQ(Drawn(m_stereo, {"glTranslatef"}), each.m_translations) << std::hex << each.m_axis;
    }
}

// Scaled as EyeViewportTest's rounding cases: each layer passes the manager's two factors.
TEST_F(Es1LayerTest, EachLayerScalesTheEyesHalvesByTheOutputsFactors) {
    ovo::Es1SpriteStereoLayer sprites;
    Interleave(false);
    ScaleOutput();
    AnswerMatrix(GL_MODELVIEW_MATRIX, ORTHO);
    const struct {
        ovo::GlLayer* m_layer;
        const std::vector<GLfloat>* m_projection;
    } cases[] = {{&m_stereo, &PERSPECTIVE}, {&m_stereo, &ORTHO}, {&sprites, &ORTHO}};
    for (const auto& each : cases) {
        AnswerMatrix(GL_PROJECTION_MATRIX, *each.m_projection);
        EXPECT_EQ(Drawn(*each.m_layer, {"glViewport", "glScissor"}), SCALED_HALVES) << &each - cases;
    }
}

// Eye 0's eye distance at three textures in a row: the ramp runs only while interleaving,
// and in its OpenGL ES 1.x form (which ramps the shift for the z selector).
TEST_F(Es1LayerTest, TheRampMovesInterleavedDrawsAtEachNewTexture) {
    const RampCase cases[] = {
        {ovo::STEREO_RAMP_ON, true, ovo::STEREO_AXIS_X,
         {"glTranslatef(-0.04, 0, 0)", "glTranslatef(-0.03, 0, 0)", "glTranslatef(-0.02, 0, 0)"}},
        {ovo::STEREO_RAMP_ON, true, ovo::STEREO_AXIS_Z, Calls(3, "glTranslatef(-0.04, 0, 0)")},
        {ovo::STEREO_RAMP_ON, false, ovo::STEREO_AXIS_X, Calls(3, "glTranslatef(0.5, 0, 0)")},
        {ovo::STEREO_RAMP_OFF, true, ovo::STEREO_AXIS_X, Calls(3, "glTranslatef(0.5, 0, 0)")},
    };
    AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
    Profile().m_eye_distance_set = -0.04f;
    Profile().m_ramp_steps = 4.0f;
    for (const RampCase& each : cases) {
        Profile().m_eye_distance = 0.5f;
        const Calls seen =
            AtThreeTextures(each, [&] { m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3); }, "glTranslatef", 1);
        EXPECT_EQ(seen, each.m_seen) << std::hex << each.m_ramp << " " << each.m_param;
    }
}

TEST_F(Es1LayerTest, SpriteDrawsSitOnTheirTexturesDepthPlane) {
    ovo::Es1SpriteStereoLayer sprites;
    Interleave(true);
    AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
    AnswerIntegers(ovo::GL_ENTRY_glGetTexParameteriv, GL_TEXTURE_MAG_FILTER, {GL_NEAREST});
    AnswerIntegers(ovo::GL_ENTRY_glGetTexParameteriv, GL_TEXTURE_MIN_FILTER, {GL_LINEAR});
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_TEXTURE_BINDING_2D, {3});
    Profile().m_eye_distance = 4.0f;
    Manager().m_depth_plane = -5.0f;
    sprites.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    // trunc(4 x -5) x 0.0025 for eye 0.
    const Calls expected = Join(
        {{"glGetFloatv(0x0BA7, ptr)", "glGetFloatv(0x0BA6, ptr)", "glGetFloatv(0x0BA8, ptr)",
          "glGetIntegerv(0x0BA0, ptr)", "glGetTexParameteriv(0x0DE1, 0x2800, ptr)",
          "glGetTexParameteriv(0x0DE1, 0x2801, ptr)", "glMatrixMode(0x1701)", "glGetIntegerv(0x8069, ptr)",
          "glEnable(0x0B90)", "glLoadMatrixf(ptr)", "glTranslatef(-0.05, 0, 0)", "glStencilFunc(0x0202, 1, 1)",
          "glDrawArrays(4, 0, 3)", "glLoadMatrixf(ptr)", "glTranslatef(0.05, 0, 0)", "glStencilFunc(0x0202, 0, 1)",
          "glDrawArrays(4, 0, 3)", "glDisable(0x0B90)", "glTexParameterx(0x0DE1, 0x2800, 9728)",
          "glTexParameterx(0x0DE1, 0x2801, 9729)"},
         MATRIX_RESTORE});
    EXPECT_EQ(RecordedGlCalls(), expected);

    // Below one whole unit of the plane there is no shift at all.
    Profile().m_eye_distance = 0.15f;
    EXPECT_EQ(Drawn(sprites, {"glTranslatef"}), Calls(2, "glTranslatef(0, 0, 0)"));
}

TEST_F(Es1LayerTest, ThePlainModeDrawsOnceWithTheScaledViewport) {
    ovo::Es1ScaledLayer scaled;
    Interleave(false);
    AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
    ScaleOutput();
    scaled.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    // Only the width gets 0.5 before truncation: 601.5 -> 602, 303.75 -> 303.
    const Calls expected = Join(
        {MATRIX_QUERIES,
         {"glGetTexParameteriv(0x0DE1, 0x2800, ptr)", "glGetTexParameteriv(0x0DE1, 0x2801, ptr)",
          "glViewport(15, 25, 602, 303)", "glScissor(6, 7, 152, 63)", "glDrawArrays(4, 0, 3)",
          "glTexParameterx(0x0DE1, 0x2800, 9729)", "glTexParameterx(0x0DE1, 0x2801, 9986)"},
         MATRIX_RESTORE});
    EXPECT_EQ(RecordedGlCalls(), expected);
}

// Clears cover the output (here the screen, wider than the target), on the window; the
// plain mode's clear simply goes where the application's framebuffer is bound.
TEST_F(Es1LayerTest, ClearsCoverTheOutputAndReachTheWindowEvenWhileTheOverlayIsBound) {
    ovo::Es1SpriteStereoLayer sprites;
    ovo::Es1ScaledLayer scaled;
    CreateOverlay();
    Interleave(false);
    Profile().m_width = 1280;
    Profile().m_height = 720;
    const struct {
        ovo::GlLayer* m_layer;
        bool m_to_window;
    } cases[] = {{&m_stereo, true}, {&sprites, true}, {&scaled, false}};
    for (const auto& each : cases) {
        Manager().m_overlay->SetBoundFramebuffer(0);
        ResetRecorder();
        each.m_layer->glClear(Manager(), GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
        EXPECT_EQ(RecordedGlCalls(), (Calls{"glScissor(0, 0, 1280, 720)", "glClear(0x4100)"})) << &each - cases;

        Manager().m_overlay->Bind();
        ResetRecorder();
        each.m_layer->glClear(Manager(), GL_COLOR_BUFFER_BIT);
        const Calls expected = each.m_to_window ? Calls{"glScissor(0, 0, 1280, 720)", "glBindFramebufferOES(0x8D40, 0)",
                                                        "glClear(0x4000)", "glBindFramebufferOES(0x8D40, 7)"}
                                                : Calls{"glScissor(0, 0, 1280, 720)", "glClear(0x4000)"};
        EXPECT_EQ(RecordedGlCalls(), expected) << &each - cases;
    }
}

// Before a draw that is no overlay draw, the plain mode composes what the overlay holds as
// one 1280 x 720 quad, then empties the overlay and leaves it unbound.
TEST_F(Es1LayerTest, ThePlainModeComposesPendingOverlayOnceBeforeADraw) {
    ovo::Es1ScaledLayer scaled;
    Interleave(false);
    CreateOverlay();
    Blending(false, GL_ONE, GL_ZERO);
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_VIEWPORT, {1, 2, 3, 4});
    AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
    scaled.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);  // an overlay draw
    AnswerMatrix(GL_MODELVIEW_MATRIX, ORTHO);
    ResetRecorder();
    scaled.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    const Calls expected = {
        "glBindFramebufferOES(0x8D40, 0)", "glOrthof(0, 1280, 720, 0, -1, 1)", "glViewport(0, 0, 1280, 720)",
        "glDrawArrays(5, 0, 4)", "glViewport(1, 2, 3, 4)",
        // emptied: bound, cleared, the window's binding back
        "glBindFramebufferOES(0x8D40, 7)", "glViewport(0, 0, 800, 480)", "glClear(0x4100)",
        "glBindFramebufferOES(0x8D40, 0)", "glViewport(0, 0, 800, 480)", "glDrawArrays(4, 0, 3)"};
    EXPECT_EQ(Only({"glBindFramebufferOES", "glOrthof", "glViewport", "glDrawArrays", "glClear"}), expected);
    EXPECT_FALSE(Manager().m_overlay->HasContent());
    EXPECT_EQ(Manager().m_overlay->BoundFramebuffer(), 0u);
    // Bound without content, the overlay is still unbound before the draw.
    Manager().m_overlay->Bind();
    EXPECT_EQ(Drawn(scaled, {"glBindFramebufferOES", "glDrawArrays"}),
              (Calls{"glBindFramebufferOES(0x8D40, 0)", "glDrawArrays(4, 0, 3)"}));
}

TEST_F(Es1LayerTest, EachModeHasItsLayer) {
    struct Case {
        ovo::StereoMode m_mode;
        size_t m_draws;
        size_t m_queries;
    } cases[] = {{ovo::STEREO_MODE_OFF, 1, 0}, {ovo::STEREO_MODE_PLAIN, 1, 2}, {ovo::STEREO_MODE_SHADER, 2, 2},
                 {ovo::STEREO_MODE_SHADER_LISTED, 2, 3}};
    Interleave(false);
    AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
    for (const Case& each : cases) {
        std::unique_ptr<ovo::GlLayer> layer(ovo::StereoManager::CreateLayerForMode(each.m_mode));
        EXPECT_EQ(Drawn(*layer, {"glDrawArrays"}).size(), each.m_draws) << each.m_mode;
        EXPECT_EQ(Only({"glGetFloatv"}).size(), each.m_queries) << each.m_mode;
    }
}

// Overlay content still pending at a 3D draw is composed inside that draw's eye bracket,
// with the mask test on: right after the mask is drawn (every swap) the mask's stencil
// function, which passes nothing, is still set, and later in the frame eye 1's. Only the
// composition at the swap reaches every column, and it is always two side-by-side halves
// (640 x 720 within a draw, whatever the output size).
TEST_F(Es1LayerTest, PendingOverlayIsComposedUnderTheStencilStateOfTheMoment) {
    Interleave(true);
    CreateOverlay();
    Profile().m_shader_convert = true;
    Blending(false, GL_ONE, GL_ZERO);
    auto overlay_draw = [&] {
        AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
        m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    };
    auto draw_3d = [&] {
        AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
        m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    };
    auto draw_moved_flat = [&] {
        AnswerMatrix(GL_MODELVIEW_MATRIX, ORTHO);
        m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        AnswerMatrix(GL_MODELVIEW_MATRIX, IDENTITY);
    };
    // Both quads within a draw, then the draw's two eyes.
    auto in_draw = [](const std::string& state) {
        return Calls{state + " glViewport(0, 0, 640, 720)", state + " glViewport(640, 0, 640, 720)", "eye", "eye"};
    };
    const struct {
        const char* m_when;
        std::function<void()> m_compose;
        Calls m_quads;  // the stencil state and viewport of each composed quad, and the eyes' draws
    } cases[] = {
        {"at the swap", [&] { eglSwapBuffers(m_egl.m_display, EglSession::Surface()); },
         {"off glViewport(0, 0, 400, 480)", "off glViewport(400, 0, 400, 480)"}},
        {"at the first 3D draw after the swap", draw_3d, in_draw("on glStencilFunc(0x0200, 0, 1)")},
        // Eye 1 passes where the mask holds 0.
        {"at a later 3D draw", draw_3d, in_draw("on glStencilFunc(0x0202, 0, 1)")},
        {"at a later flat draw", draw_moved_flat, in_draw("on glStencilFunc(0x0202, 0, 1)")},
    };
    // The state the vendor holds, followed through every case.
    std::string test = "off";
    std::string function;
    std::string viewport;
    for (const auto& each : cases) {
        overlay_draw();
        ResetRecorder();
        each.m_compose();
        Calls quads;
        for (const std::string& call : RecordedGlCalls()) {
            if (call == "glEnable(0x0B90)") test = "on";
            if (call == "glDisable(0x0B90)") test = "off";
            if (call.rfind("glStencilFunc(", 0) == 0) function = " " + call;
            if (call.rfind("glViewport(", 0) == 0) viewport = " " + call;
            if (call == "glDrawArrays(4, 0, 3)") quads.push_back("eye");
            if (call != "glDrawArrays(5, 0, 4)") continue;
            quads.push_back(test + (test == "on" ? function : "") + viewport);
        }
        EXPECT_EQ(quads, each.m_quads) << each.m_when;
    }
}

// A make-current without a context deletes the overlay's objects; they are made again only
// after a new context or window surface. The same context and surface made current again
// drop every overlay draw.
TEST_F(Es1LayerTest, AfterAReleaseOnlyANewContextOrSurfaceBringsTheOverlayBack) {
    Profile().m_eye_target = true;
    AnswerIntegers(ovo::GL_ENTRY_glGenFramebuffersOES, 1, {7});
    AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
    Blending(false, GL_ONE, GL_ZERO);
    const EGLContext game = m_egl.CreateContext(1);
    const struct {
        const char* m_between;
        std::function<EGLContext()> m_next;  // what is made current after the release
        size_t m_draws;
    } cases[] = {
        {"nothing", [&] { return game; }, 0},
        {"a new window surface",
         [&] {
             eglCreateWindowSurface(m_egl.m_display, nullptr, 0, nullptr);
             return game;
         },
         1},
        {"a new context", [&] { return m_egl.CreateContext(1); }, 1},
    };
    for (const auto& each : cases) {
        ASSERT_EQ(m_egl.MakeCurrent(game), EGL_TRUE);
        ASSERT_EQ(m_egl.MakeCurrent(EGL_NO_CONTEXT), EGL_TRUE);
        ASSERT_EQ(m_egl.MakeCurrent(each.m_next()), EGL_TRUE);
        EXPECT_EQ(Drawn(m_stereo, {"glDrawArrays"}).size(), each.m_draws) << each.m_between;
    }
}

}  // namespace
