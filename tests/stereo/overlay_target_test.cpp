// The overlay target: its objects, its clears and its composition into both eyes.
#include "stereo/draw_call.h"
#include "stereo/gl_object_tracker.h"
#include "stereo/overlay_target.h"
#include "stereo_fixture.h"

namespace {

using namespace recorded_calls;

class OverlayTargetTest : public StereoFixture {
protected:
    void SetUp() override {
        StereoFixture::SetUp();
        Profile().m_eye_target = true;
        AnswerIntegers(ovo::GL_ENTRY_glGenFramebuffersOES, 1, {7});
    }

    ovo::OverlayTarget m_overlay{1280, 720, ovo::OVERLAY_CREATE_OBJECTS};
};

// The calls without their arguments.
Calls Names(const Calls& calls) {
    Calls names;
    for (const std::string& call : calls) names.push_back(call.substr(0, call.find('(')));
    return names;
}

TEST_F(OverlayTargetTest, CreateMakesTheTextureAndFramebufferOnce) {
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_FRAMEBUFFER_BINDING_OES, {3});
    m_overlay.Create();
    m_overlay.Create();
    const Calls expected = {
        "glBindTexture(0x0DE1, 0xFFFF)", "glTexImage2D(0x0DE1, 0, 6408, 1280, 720, 0, 0x1908, 0x1401, null)",
        "glTexParameterf(0x0DE1, 0x2802, 33071)", "glTexParameterf(0x0DE1, 0x2803, 33071)",
        "glTexParameterf(0x0DE1, 0x2800, 9729)", "glTexParameterf(0x0DE1, 0x2801, 9729)", "glBindTexture(0x0DE1, 0)",
        "glGetIntegerv(0x8CA6, ptr)", "glGenFramebuffersOES(1, ptr)", "glBindFramebufferOES(0x8D40, 7)",
        "glFramebufferTexture2DOES(0x8D40, 0x8CE0, 0x0DE1, 0xFFFF, 0)", "glBindFramebufferOES(0x8D40, 3)"};
    EXPECT_EQ(RecordedGlCalls(), expected);
    EXPECT_EQ(m_overlay.BoundFramebuffer(), 0u);
}

TEST_F(OverlayTargetTest, ARepeatedReleaseDeletesNothingTwice) {
    m_overlay.Create();
    ResetRecorder();
    m_overlay.Release();
    m_overlay.Release();
    EXPECT_EQ(RecordedGlCalls(), (Calls{"glDeleteTextures(1, ptr)", "glDeleteFramebuffersOES(1, ptr)"}));
    // Without objects, overlay draws are dropped until a reset makes them again.
    ResetRecorder();
    m_overlay.DrawInto(Manager(), ovo::DrawCall::Arrays(GL_TRIANGLES, 0, 3));
    m_overlay.Create();
    EXPECT_EQ(RecordedGlCalls(), Calls());
    m_overlay.Reset();
    m_overlay.Create();
    EXPECT_EQ(m_overlay.Framebuffer(), 7u);
}

// With the application's own framebuffer bound, overlay draws go there; a clear empties the
// overlay and keeps the binding the application believes in.
TEST_F(OverlayTargetTest, DrawsAndClearsKeepTheApplicationsFramebuffer) {
    m_overlay.Create();
    m_overlay.SetBoundFramebuffer(5);
    ResetRecorder();
    m_overlay.DrawInto(Manager(), ovo::DrawCall::Arrays(GL_TRIANGLES, 0, 3));
    EXPECT_EQ(RecordedGlCalls(),
              (Calls{"glViewport(0, 0, 800, 480)", "glScissor(0, 0, 800, 480)", "glDrawArrays(4, 0, 3)"}));
    ResetRecorder();
    m_overlay.Clear();
    const Calls expected = {
        "glBindFramebufferOES(0x8D40, 7)", "glViewport(0, 0, 800, 480)", "glScissor(0, 0, 800, 480)",
        "glGetFloatv(0x0C22, ptr)", "glGetFloatv(0x0B73, ptr)", "glClearColor(0, 0, 0, 0)", "glClearDepthf(1)",
        "glClear(0x4100)", "glClearColor(0, 0, 0, 0)", "glClearDepthf(1)", "glBindFramebufferOES(0x8D40, 5)"};
    EXPECT_EQ(RecordedGlCalls(), expected);
    EXPECT_EQ(m_overlay.BoundFramebuffer(), 5u);
}

TEST_F(OverlayTargetTest, FlushComposesPendingContentIntoBothHalvesAndPutsStateBack) {
    m_overlay.Create();
    Manager().m_viewport = {0, 0, 1280, 720};
    m_overlay.DrawInto(Manager(), ovo::DrawCall::Arrays(GL_TRIANGLES, 0, 3));
    ASSERT_TRUE(m_overlay.HasContent());
    ResetRecorder();
    m_overlay.Flush(Manager());
    const Calls calls = RecordedGlCalls();
    // Unbound, saved (with the colour and depth masks, the cull face set right after each),
    // matrices pushed, texture set up, alpha test saved and set, the quads, the matrices
    // popped, then put back in its own order; then the overlay is emptied.
    const Calls expected = {
        "glBindFramebufferOES", "glGetBooleanv", "glColorMask", "glGetBooleanv", "glDepthMask", "glGetIntegerv",
        "glGetIntegerv", "glGetIntegerv", "glGetIntegerv", "glIsEnabled", "glIsEnabled", "glIsEnabled",
        "glIsEnabled", "glGetIntegerv", "glGetTexEnviv", "glGetIntegerv", "glIsEnabled", "glIsEnabled",
        "glIsEnabled", "glIsEnabled", "glEnable", "glGetIntegerv", "glCullFace", "glGetIntegerv", "glFrontFace",
        "glGetIntegerv", "glGetIntegerv", "glGetIntegerv", "glGetPointerv", "glGetIntegerv", "glGetIntegerv",
        "glGetIntegerv", "glGetPointerv", "glMatrixMode", "glPushMatrix", "glLoadIdentity", "glOrthof",
        "glMatrixMode", "glPushMatrix", "glLoadIdentity", "glMatrixMode", "glPushMatrix", "glLoadIdentity",
        "glBindTexture", "glBindBuffer", "glTexParameterf", "glTexParameterf", "glTexParameterf",
        "glTexParameterf", "glTexEnvf", "glDisable", "glEnable", "glEnable", "glBlendFunc", "glIsEnabled",
        "glGetIntegerv", "glGetFloatv", "glDisable", "glAlphaFunc", "glDisable", "glTexCoordPointer",
        "glEnableClientState", "glVertexPointer", "glEnableClientState", "glDisableClientState", "glViewport",
        "glScissor", "glDrawArrays", "glViewport", "glScissor", "glDrawArrays", "glMatrixMode", "glPopMatrix",
        "glMatrixMode", "glPopMatrix", "glMatrixMode", "glPopMatrix",
        // put back: alpha test and function, four enables, matrix mode, viewport, blend function,
        // texture, environment, array buffer, three client arrays, cull face, cull mode, front
        // face, the two pointers, depth mask, colour mask
        "glEnable", "glAlphaFunc", "glEnable", "glEnable", "glEnable", "glEnable", "glMatrixMode", "glViewport",
        "glBlendFunc", "glBindTexture", "glTexEnvi", "glBindBuffer", "glEnableClientState", "glEnableClientState",
        "glEnableClientState", "glEnable", "glCullFace", "glFrontFace", "glVertexPointer", "glTexCoordPointer",
        "glDepthMask", "glColorMask",
        // Clear
        "glBindFramebufferOES", "glViewport", "glScissor", "glGetFloatv", "glGetFloatv", "glClearColor",
        "glClearDepthf", "glClear", "glClearColor", "glClearDepthf", "glBindFramebufferOES"};
    EXPECT_EQ(Names(calls), expected);
    // Two side-by-side halves of 640 x 720, and the overlay is empty afterwards.
    EXPECT_EQ(Calls(calls.begin() + 65, calls.begin() + 71),
              (Calls{"glViewport(0, 0, 640, 720)", "glScissor(0, 0, 640, 720)", "glDrawArrays(5, 0, 4)",
                     "glViewport(640, 0, 640, 720)", "glScissor(640, 0, 640, 720)", "glDrawArrays(5, 0, 4)"}));
    EXPECT_EQ(calls[1 + 35], "glOrthof(0, 640, 720, 0, -1, 1)");
    EXPECT_EQ(calls[53], "glBlendFunc(1, 0x0303)") << "the overlay holds premultiplied colour";
    EXPECT_FALSE(m_overlay.HasContent());
    // Nothing pending: a flush only unbinds.
    ResetRecorder();
    m_overlay.Flush(Manager());
    EXPECT_EQ(RecordedGlCalls(), Calls());
}

TEST(GlObjectTrackerTest, NamesPastTheTablesGetNoRecord) {
    ovo::GlObjectTracker tracker;
    EXPECT_NE(tracker.TextureRecordOf(4095), nullptr);
    EXPECT_EQ(tracker.TextureRecordOf(4096), nullptr);
    EXPECT_EQ(tracker.TextureRecordOf(0xFFFFFFFFu), nullptr);
    tracker.TextureRecordOf(12)->m_width = 256;
    tracker.ForgetTexture(12);
    tracker.ForgetTexture(99999);
    EXPECT_EQ(tracker.TextureRecordOf(12)->m_width, 0u);

    // 3 and 67 share one of the 64 slots: the second gets none rather than the first one's size.
    ovo::FramebufferRecord* first = tracker.ClaimFramebufferRecord(3);
    ASSERT_NE(first, nullptr);
    first->m_width = 640;
    EXPECT_EQ(tracker.ClaimFramebufferRecord(67), nullptr);
    ovo::FramebufferRecord* other = tracker.ClaimFramebufferRecord(35);  // a slot of its own
    EXPECT_NE(other, nullptr);
    EXPECT_NE(other, first);
    EXPECT_EQ(tracker.ClaimFramebufferRecord(3), first);
    EXPECT_EQ(tracker.ClaimFramebufferRecord(0), nullptr);
}

}  // namespace
