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
using Calls = std::vector<std::string>;

const Calls MATRIX_QUERIES = {"glGetFloatv(0x0BA7, ptr)", "glGetFloatv(0x0BA6, ptr)",
                              "glGetIntegerv(0x0BA0, ptr)"};
const Calls MATRIX_RESTORE = {"glMatrixMode(0x1701)", "glLoadMatrixf(ptr)", "glMatrixMode(0x1700)",
                              "glLoadMatrixf(ptr)", "glMatrixMode(0x1700)"};

Calls Join(std::initializer_list<Calls> parts) {
    Calls all;
    for (const Calls& part : parts) all.insert(all.end(), part.begin(), part.end());
    return all;
}

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
    m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    // Eye 0: T(-angle) P T(+distance); eye 1 negated. Eye 0 passes where the mask is 1.
    const Calls expected = Join(
        {MATRIX_QUERIES,
         {"glEnable(0x0B90)", "glMatrixMode(0x1701)", "glLoadIdentity()",
          "glTranslatef(-0.25, 0, 0)", "glMultMatrixf(ptr)", "glTranslatef(0.5, 0, 0)",
          "glStencilFunc(0x0202, 1, 1)", "glDrawArrays(4, 0, 3)", "glMatrixMode(0x1701)",
          "glLoadIdentity()", "glTranslatef(0.25, 0, 0)", "glMultMatrixf(ptr)",
          "glTranslatef(-0.5, 0, 0)", "glStencilFunc(0x0202, 0, 1)", "glDrawArrays(4, 0, 3)",
          "glDisable(0x0B90)"},
         MATRIX_RESTORE});
    EXPECT_EQ(RecordedGlCalls(), expected);
}

TEST_F(Es1LayerTest, AFlatDrawIsShiftedInClipSpaceIntoEachHalf) {
    Interleave(false);
    AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
    m_stereo.glDrawElements(Manager(), GL_TRIANGLES, 6, GL_UNSIGNED_SHORT, &m_egl);
    const Calls expected = Join(
        {MATRIX_QUERIES,
         {"glMatrixMode(0x1701)", "glLoadIdentity()", "glTranslatef(0.125, 0, 0)",
          "glMultMatrixf(ptr)", "glViewport(0, 0, 400, 480)", "glScissor(0, 0, 400, 480)",
          "glDrawElements(4, 6, 0x1403, ptr)", "glMatrixMode(0x1701)", "glLoadIdentity()",
          "glTranslatef(-0.125, 0, 0)", "glMultMatrixf(ptr)", "glViewport(400, 0, 400, 480)",
          "glScissor(400, 0, 400, 480)", "glDrawElements(4, 6, 0x1403, ptr)"},
         MATRIX_RESTORE});
    EXPECT_EQ(RecordedGlCalls(), expected);
}

// The layer acts on the classifier's answer for the corner cases, not on element 11 alone.
TEST_F(Es1LayerTest, TheProjectionTestLooksAtElementsElevenAndFifteen) {
    const GLfloat cases[][3] = {{0.0f, 0.0f, 1}, {-1.0f, 1.0f, 1}, {-1.0f, 0.0f, 0}, {0.5f, 2.0f, 0}};  // 11, 15, flat
    Interleave(true);
    for (const auto& each : cases) {
        std::vector<GLfloat> projection = IDENTITY;
        projection[11] = each[0];
        projection[15] = each[1];
        AnswerMatrix(GL_PROJECTION_MATRIX, projection);
        ResetRecorder();
        m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        // Flat draws get one translation per eye, perspective ones two.
        EXPECT_EQ(Only({"glTranslatef"}).size(), each[2] != 0 ? 2u : 4u) << each[0] << ", " << each[1];
    }
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
        const Calls overlay = {"glBindFramebufferOES(0x8D40, 7)", "glViewport(0, 0, 800, 480)",
                               "glScissor(0, 0, 800, 480)", "glDrawArrays(4, 0, 3)"};
        const Calls draws = Only({"glDrawArrays", "glBindFramebufferOES", "glViewport", "glScissor"});
        if (each.m_overlay) {
            EXPECT_EQ(draws, overlay) << each.m_source << " " << each.m_destination;
        } else {
            EXPECT_EQ(draws, Calls(2, "glDrawArrays(4, 0, 3)")) << each.m_source;
        }
    }
}

TEST_F(Es1LayerTest, AFullWidthViewportOffTheLeftEdgeKeepsTheProjection) {
    Interleave(false);
    AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
    Manager().m_viewport = {5, 0, 800, 480};
    m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    EXPECT_EQ(Only({"glTranslatef", "glMultMatrixf", "glLoadIdentity"}), Calls());
    EXPECT_EQ(Only({"glViewport"}), (Calls{"glViewport(2, 0, 400, 480)", "glViewport(402, 0, 400, 480)"}));

    Manager().m_viewport = {0, 0, 800, 480};
    ResetRecorder();
    m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    EXPECT_EQ(Only({"glTranslatef"}).size(), 4u) << "at x = 0 the eyes are moved";
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
          "glGetTexParameteriv(0x0DE1, 0x2801, ptr)", "glMatrixMode(0x1701)",
          "glGetIntegerv(0x8069, ptr)", "glEnable(0x0B90)", "glLoadMatrixf(ptr)",
          "glTranslatef(-0.05, 0, 0)", "glStencilFunc(0x0202, 1, 1)", "glDrawArrays(4, 0, 3)",
          "glLoadMatrixf(ptr)", "glTranslatef(0.05, 0, 0)", "glStencilFunc(0x0202, 0, 1)",
          "glDrawArrays(4, 0, 3)", "glDisable(0x0B90)", "glTexParameterx(0x0DE1, 0x2800, 9728)",
          "glTexParameterx(0x0DE1, 0x2801, 9729)"},
         MATRIX_RESTORE});
    EXPECT_EQ(RecordedGlCalls(), expected);

    // Below one whole unit of the plane there is no shift at all.
    Profile().m_eye_distance = 0.15f;
    ResetRecorder();
    sprites.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    EXPECT_EQ(Only({"glTranslatef"}), Calls(2, "glTranslatef(0, 0, 0)"));
}

TEST_F(Es1LayerTest, ThePlainModeDrawsOnceWithTheScaledViewport) {
    ovo::Es1ScaledLayer scaled;
    Interleave(false);
    AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
    Manager().m_scale_x = 1.5f;
    Manager().m_scale_y = 1.25f;
    Manager().m_viewport = {10, 20, 401, 243};
    Manager().m_scissor = {4, 6, 101, 51};
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

TEST_F(Es1LayerTest, ClearsReachTheWindowEvenWhileTheOverlayIsBound) {
    CreateOverlay();
    Interleave(false);
    m_stereo.glClear(Manager(), GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    EXPECT_EQ(RecordedGlCalls(), (Calls{"glScissor(0, 0, 800, 480)", "glClear(0x4100)"}));

    Manager().m_overlay->Bind();
    ResetRecorder();
    m_stereo.glClear(Manager(), GL_COLOR_BUFFER_BIT);
    EXPECT_EQ(RecordedGlCalls(), (Calls{"glScissor(0, 0, 800, 480)", "glBindFramebufferOES(0x8D40, 0)",
                                        "glClear(0x4000)", "glBindFramebufferOES(0x8D40, 7)"}));
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
        ResetRecorder();
        layer->glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        EXPECT_EQ(Only({"glDrawArrays"}).size(), each.m_draws) << each.m_mode;
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
    const struct {
        const char* m_when;
        std::function<void()> m_compose;
        Calls m_quads;  // the stencil state and viewport of each composed quad
    } cases[] = {
        {"at the swap", [&] { eglSwapBuffers(m_egl.m_display, EglSession::Surface()); },
         {"off glViewport(0, 0, 400, 480)", "off glViewport(400, 0, 400, 480)"}},
        {"at the first 3D draw after the swap", draw_3d,
         {"on glStencilFunc(0x0200, 0, 1) glViewport(0, 0, 640, 720)",
          "on glStencilFunc(0x0200, 0, 1) glViewport(640, 0, 640, 720)"}},
        // Eye 1 passes where the mask holds 0.
        {"at a later 3D draw", draw_3d,
         {"on glStencilFunc(0x0202, 0, 1) glViewport(0, 0, 640, 720)",
          "on glStencilFunc(0x0202, 0, 1) glViewport(640, 0, 640, 720)"}},
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
        ResetRecorder();
        m_stereo.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        EXPECT_EQ(Only({"glDrawArrays"}).size(), each.m_draws) << each.m_between;
    }
}

}  // namespace
