// Threads against Mesa, through the library: many first calls at once, a thread without a
// context beside stereo frames, and a context made on one thread and drawn with on others.
#include <cstdlib>
#include <vector>

#include "threads_together.h"

namespace {

constexpr int THREAD_COUNT = 12;
constexpr EGLint WIDTH = 64;
constexpr EGLint HEIGHT = 48;

// An OpenGL ES 1.1 game on a pbuffer: one perspective triangle per frame.
class Es1Game {
public:
    // Display, surface and context; nothing is made current.
    void Create() {
        m_display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
        ASSERT_TRUE(eglInitialize(m_display, nullptr, nullptr));
        const EGLint attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_RENDERABLE_TYPE,
                                     EGL_OPENGL_ES_BIT, EGL_RED_SIZE, 8, EGL_NONE};
        EGLConfig config;
        EGLint count = 0;
        ASSERT_TRUE(eglChooseConfig(m_display, attributes, &config, 1, &count) && count == 1);
        const EGLint size[] = {EGL_WIDTH, WIDTH, EGL_HEIGHT, HEIGHT, EGL_NONE};
        m_surface = eglCreatePbufferSurface(m_display, config, size);
        const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, 1, EGL_NONE};
        m_context = eglCreateContext(m_display, config, EGL_NO_CONTEXT, version);
        ASSERT_NE(m_context, EGL_NO_CONTEXT);
    }

    void MakeCurrent() { ASSERT_TRUE(eglMakeCurrent(m_display, m_surface, m_surface, m_context)); }
    void Release() {
        ASSERT_TRUE(eglMakeCurrent(m_display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT));
    }

    // The pixels of one frame as drawn, read just before its swap.
    std::vector<GLubyte> Frame() {
        static const GLfloat TRIANGLE[] = {-1, -1, -2, 1, -1, -2, 0, 1, -3};
        glViewport(0, 0, WIDTH, HEIGHT);
        glClearColor(0.1f, 0.2f, 0.3f, 1.0f);
        glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
        glMatrixMode(GL_PROJECTION);
        glLoadIdentity();
        glFrustumf(-1, 1, -1, 1, 1, 10);
        glMatrixMode(GL_MODELVIEW);
        glLoadIdentity();
        glColor4f(1.0f, 0.5f, 0.0f, 1.0f);
        glEnableClientState(GL_VERTEX_ARRAY);
        glVertexPointer(3, GL_FLOAT, 0, TRIANGLE);
        glDrawArrays(GL_TRIANGLES, 0, 3);
        std::vector<GLubyte> pixels(WIDTH * HEIGHT * 4);
        glReadPixels(0, 0, WIDTH, HEIGHT, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
        eglSwapBuffers(m_display, m_surface);
        return pixels;
    }

    EGLDisplay m_display = EGL_NO_DISPLAY;
    EGLSurface m_surface = EGL_NO_SURFACE;
    EGLContext m_context = EGL_NO_CONTEXT;
};

// Whether the eyes differ: some pixel differs from its right-hand neighbour in a row where
// the flat image has no edge (the triangle's apex row is narrow; the middle row is wide).
bool EyesDiffer(const std::vector<GLubyte>& pixels) {
    const int row = HEIGHT / 2;
    int changes = 0;
    for (int x = 0; x + 1 < WIDTH; ++x) {
        const GLubyte* left = &pixels[(row * WIDTH + x) * 4];
        changes += left[0] != left[4] || left[1] != left[5] || left[2] != left[6];
    }
    return changes > 2;  // more than the triangle's own two edges
}

class ThreadsOnMesa : public ::testing::Test {
protected:
    void SetUp() override {
        setenv("EGL_PLATFORM", "surfaceless", 1);
        InstallProfile(OVO_SHADER_PROFILE);
    }
};

TEST_F(ThreadsOnMesa, FirstCallsOfManyThreadsAtOnceGiveOneWorkingDisplay) {
    ExpectFirstCallsTogetherMeet(THREAD_COUNT, EGL_NO_DISPLAY, EGL_TRUE);
    ASSERT_TRUE(ovo::StereoManager::instance().m_interleave);
    Es1Game game;
    game.Create();
    game.MakeCurrent();
    game.Frame();  // the column mask is drawn at the first swap
    EXPECT_TRUE(EyesDiffer(game.Frame()));
}

TEST_F(ThreadsOnMesa, AThreadWithoutAContextChangesNothingInStereoFrames) {
    Es1Game game;
    game.Create();
    game.MakeCurrent();
    ASSERT_TRUE(ovo::StereoManager::instance().m_interleave);
    game.Frame();
    const std::vector<GLubyte> alone = game.Frame();
    ASSERT_TRUE(EyesDiffer(alone));
    ContextlessCaller caller;
    caller.WaitForFirstRound();
    for (int frame = 0; frame < 10; ++frame) ASSERT_EQ(game.Frame(), alone) << "frame " << frame;
    caller.Stop();
    EXPECT_EQ(caller.Answers(), 0);
}

TEST_F(ThreadsOnMesa, AContextMadeOnOneThreadDrawsOnOthers) {
    Es1Game game;
    RunOnAnotherThread([&] { game.Create(); });
    std::vector<GLubyte> frames[2];
    for (std::vector<GLubyte>& frame : frames) {
        RunOnAnotherThread([&] {
            game.MakeCurrent();
            game.Frame();
            frame = game.Frame();
            game.Release();
        });
    }
    EXPECT_TRUE(EyesDiffer(frames[0]));
    EXPECT_EQ(frames[0], frames[1]);
    EXPECT_EQ(glGetError(), 0u) << "this thread never had the context";
}

}  // namespace
