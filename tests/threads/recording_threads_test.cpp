// Threads against the recording vendor: many first calls at once, a thread without a
// context beside a stereo frame, and a context made on one thread and drawn with on another.
#include <filesystem>
#include <string>
#include <utility>
#include <vector>

#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/recorded_calls.h"
#include "support/vendor_root.h"
#include "threads_together.h"

namespace {

constexpr int THREAD_COUNT = 12;

TEST(ThreadsOnRecording, FirstCallsOfManyThreadsAtOnceBuildOneManagerAndBindWholeTables) {
    vendor_root::InstallRecorder();
    InstallProfile(OVO_SHADER_PROFILE);
    // The recorder's call log is not made for threads; its answers are.
    RecorderGetState()->m_recording = false;
    ExpectFirstCallsTogetherMeet(
        THREAD_COUNT, RecorderResult<EGLDisplay>(RECORDER_API_EGL, ovo::EGL_ENTRY_eglGetDisplay),
        RecorderResult<EGLBoolean>(RECORDER_API_EGL, ovo::EGL_ENTRY_eglInitialize));
    // The one manager read the profile before any display request deleted it.
    EXPECT_TRUE(ovo::StereoManager::instance().m_interleave);
    EXPECT_FALSE(std::filesystem::exists(device_files::Path(ovo::PROFILE_PATH)));

    RecorderGetState()->m_recording = true;
    EglSession egl;
    egl.Open();
    for (auto [version, api] :
         {std::pair{1, RECORDER_API_GLES1}, std::pair{2, RECORDER_API_GLES2}}) {
        ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(version)), EGL_TRUE);
        EXPECT_EQ(glGetError(), RecorderResult<GLenum>(api, ovo::GL_ENTRY_glGetError)) << version;
    }
}

// An OpenGL ES 1.x game under a stereo profile (the shader mode interleaved, or the plain
// mode), drawing one perspective triangle per frame on the recording vendor.
class ThreadsBesideStereoOnRecording : public ::testing::Test {
protected:
    void Start(const char* profile) {
        vendor_root::InstallRecorder();
        InstallProfile(profile);
        m_egl.Open();
        ASSERT_TRUE(ovo::StereoManager::instance().m_profile->m_enabled);
        ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(1)), EGL_TRUE);
        // glFrustumf(-1, 1, -1, 1, 1, 10) and an identity modelview, as a driver answers.
        const GLfloat perspective[] = {1, 0, 0, 0,          0, 1, 0, 0,
                                       0, 0, -11.0f / 9, -1, 0, 0, -20.0f / 9, 0};
        const GLfloat identity[] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
        recorded_calls::AnswerBytes(ovo::GL_ENTRY_glGetFloatv, GL_PROJECTION_MATRIX, perspective,
                                    sizeof(perspective));
        recorded_calls::AnswerBytes(ovo::GL_ENTRY_glGetFloatv, GL_MODELVIEW_MATRIX, identity,
                                    sizeof(identity));
        recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_MATRIX_MODE, {GL_MODELVIEW});
    }

    // The GL calls that reached the vendor for one frame, its swap and the mask after it.
    std::vector<std::string> Frame() {
        ResetRecorder();
        glViewport(0, 0, 320, 240);
        glScissor(0, 0, 320, 240);
        glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
        glDrawArrays(GL_TRIANGLES, 0, 3);
        eglSwapBuffers(m_egl.m_display, EglSession::Surface());
        return recorded_calls::RecordedGlCalls();
    }

    // Frames drawn under `profile` while another thread calls GL without a context are the
    // frame drawn alone.
    void ExpectFramesAsAloneBesideAThreadWithoutAContext(const char* profile) {
        ASSERT_NO_FATAL_FAILURE(Start(profile));
        Frame();
        const std::vector<std::string> alone = Frame();
        ContextlessCaller caller;
        caller.WaitForFirstRound();
        for (int frame = 0; frame < 20; ++frame) ASSERT_EQ(Frame(), alone) << "frame " << frame;
        caller.Stop();
        EXPECT_EQ(caller.Answers(), 0);
    }

    EglSession m_egl;
};

TEST_F(ThreadsBesideStereoOnRecording, AThreadWithoutAContextChangesNothingInInterleavedFrames) {
    ExpectFramesAsAloneBesideAThreadWithoutAContext(OVO_SHADER_PROFILE);
}

TEST_F(ThreadsBesideStereoOnRecording, AThreadWithoutAContextChangesNothingInPlainFrames) {
    ExpectFramesAsAloneBesideAThreadWithoutAContext(OVO_PLAIN_PROFILE);
}

// The plain mode scales the application's viewport at each draw: another thread's
// rectangles, set between the application's and its draw, must not be the ones scaled.
TEST_F(ThreadsBesideStereoOnRecording, AThreadWithoutAContextLeavesTheScaledRectanglesAlone) {
    Start(OVO_PLAIN_PROFILE);
    glViewport(0, 0, 320, 240);
    glScissor(0, 0, 320, 240);
    RunOnAnotherThread([] {
        glViewport(0, 0, 1, 1);
        glScissor(0, 0, 1, 1);
    });
    ResetRecorder();
    glDrawArrays(GL_TRIANGLES, 0, 3);
    std::vector<std::string> rectangles;
    for (const std::string& call : recorded_calls::RecordedGlCalls()) {
        if (call.rfind("glViewport(", 0) == 0 || call.rfind("glScissor(", 0) == 0) rectangles.push_back(call);
    }
    EXPECT_EQ(rectangles, (std::vector<std::string>{"glViewport(0, 0, 640, 480)",
                                                    "glScissor(0, 0, 640, 480)"}));
}

TEST(ThreadsOnRecording, AContextMadeOnOneThreadDrawsOnAnother) {
    vendor_root::InstallRecorder();
    EglSession egl;
    egl.Open();
    EGLContext context = EGL_NO_CONTEXT;
    RunOnAnotherThread([&] { context = egl.CreateContext(2); });
    GLenum drawing_error = 0;
    RunOnAnotherThread([&] {
        ASSERT_EQ(egl.MakeCurrent(context), EGL_TRUE);
        ResetRecorder();
        glDrawArrays(GL_TRIANGLES, 0, 3);
        drawing_error = glGetError();
    });
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glDrawArrays), nullptr)
        << "the drawing thread takes the creating thread's OpenGL ES version";
    EXPECT_EQ(drawing_error, RecorderResult<GLenum>(RECORDER_API_GLES2, ovo::GL_ENTRY_glGetError));
    // The thread that made the context never made it current.
    ResetRecorder();
    EXPECT_EQ(glGetError(), 0u);
    EXPECT_EQ(RecorderGetState()->m_call_count, 0u);
}

}  // namespace
