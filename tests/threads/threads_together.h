#ifndef OVO_TESTS_THREADS_THREADS_TOGETHER_H
#define OVO_TESTS_THREADS_THREADS_TOGETHER_H

#include <EGL/egl.h>
#include <GLES/gl.h>
#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <atomic>
#include <fstream>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "config/stereo_profile.h"
#include "core/stereo_manager.h"
#include "support/device_files.h"

// Runs body(number) on `count` threads that all start at the same moment, so that their
// first calls meet, and returns once every one has finished.
template <typename Body>
void RunTogether(int count, Body body) {
    std::atomic<int> waiting{count};
    std::vector<std::thread> threads;
    for (int number = 0; number < count; ++number) {
        threads.emplace_back([&waiting, &body, number] {
            waiting.fetch_sub(1);
            while (waiting.load() > 0) std::this_thread::yield();
            body(number);
        });
    }
    for (std::thread& thread : threads) thread.join();
}

// Runs body() on a thread of its own, to its end.
template <typename Body>
void RunOnAnotherThread(Body body) {
    std::thread(body).join();
}

// The first calls of `count` threads that start at once, half of them through GL and half
// through EGL: each must see the same display, initialised as `initialised` says, no GL
// error (no thread has a context) and the same manager.
inline void ExpectFirstCallsTogetherMeet(int count, EGLDisplay display, EGLBoolean initialised) {
    struct FirstCalls {
        EGLDisplay m_display;
        EGLBoolean m_initialised;
        GLenum m_error;
        const ovo::StereoManager* m_manager;
    };
    std::vector<FirstCalls> calls(static_cast<size_t>(count));
    RunTogether(count, [&](int number) {
        FirstCalls& own = calls[static_cast<size_t>(number)];
        if (number % 2 == 0) own.m_error = glGetError();
        own.m_display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
        own.m_initialised = eglInitialize(own.m_display, nullptr, nullptr);
        if (number % 2 == 1) own.m_error = glGetError();
        own.m_manager = &ovo::StereoManager::instance();
    });
    if (display == EGL_NO_DISPLAY) display = calls[0].m_display;
    EXPECT_NE(display, EGL_NO_DISPLAY);
    for (size_t number = 0; number < calls.size(); ++number) {
        SCOPED_TRACE("thread " + std::to_string(number));
        EXPECT_EQ(calls[number].m_display, display);
        EXPECT_EQ(calls[number].m_initialised, initialised);
        EXPECT_EQ(calls[number].m_error, 0u);
        EXPECT_EQ(calls[number].m_manager, calls[0].m_manager);
    }
}

// Calls GL on a thread that never made a context current, over and over, until Stop():
// the calls of a loader or UI thread that forgot its context. Every call must do nothing.
class ContextlessCaller {
public:
    ContextlessCaller() : m_thread([this] { Run(); }) {}
    ~ContextlessCaller() { Stop(); }

    void Stop() {
        m_stop.store(true);
        if (m_thread.joinable()) m_thread.join();
    }
    // Returns once the calls have gone round at least once.
    void WaitForFirstRound() const {
        while (m_rounds.load() == 0) std::this_thread::yield();
    }
    // What the calls gave back and wrote, summed: 0 while every call did nothing.
    long Answers() const { return m_answers; }

private:
    void Run() {
        static const GLfloat TRIANGLE[] = {-1, -1, -2, 1, -1, -2, 0, 1, -2};
        static const GLubyte PIXEL[] = {255, 0, 0, 255};
        while (!m_stop.load()) {
            GLuint texture = 0;
            glGenTextures(1, &texture);
            glBindTexture(GL_TEXTURE_2D, 7);
            glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, 1, 1, 0, GL_RGBA, GL_UNSIGNED_BYTE, PIXEL);
            glBindFramebuffer(GL_FRAMEBUFFER, 3);
            glViewport(0, 0, 1, 1);
            glScissor(0, 0, 1, 1);
            glClear(GL_COLOR_BUFFER_BIT | GL_STENCIL_BUFFER_BIT);
            glEnableClientState(GL_VERTEX_ARRAY);
            glVertexPointer(3, GL_FLOAT, 0, TRIANGLE);
            glDrawArrays(GL_TRIANGLES, 0, 3);
            GLint viewport[4] = {0, 0, 0, 0};
            glGetIntegerv(GL_VIEWPORT, viewport);
            m_answers += texture + glGetError() + viewport[2] + (glGetString(GL_VERSION) != nullptr);
            m_rounds.fetch_add(1);
        }
    }

    std::atomic<bool> m_stop{false};
    std::atomic<int> m_rounds{0};
    long m_answers = 0;
    std::thread m_thread;
};

// The stereo profile that tests/e2e/profiles/NAME.txt describes, built by ovo-profile,
// installed as the companion application installs it before the game starts.
inline void InstallProfile(const std::string& built_profile) {
    std::stringstream bytes;
    bytes << std::ifstream(built_profile, std::ios::binary).rdbuf();
    device_files::Write(ovo::PROFILE_PATH, bytes.str());
}

#endif
