// Which contexts share their objects, and the library's own GL objects on the recording
// vendor: the ES 2.0 mask's program made once per share group and deleted with the group's
// last context, and the exact EGL and GL calls by which contexts are made current for that
// and the thread's binding put back.
#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "present/composition_renderer.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/recorded_calls.h"
#include "support/vendor_root.h"

namespace {

using namespace recorded_calls;
using Calls = std::vector<std::string>;

EGLDisplay Display(uintptr_t n) { return reinterpret_cast<EGLDisplay>(n); }
EGLContext Context(uintptr_t n) { return reinterpret_cast<EGLContext>(n); }

TEST(ContextRegistryTest, SharingContextsShareAGroupThatEndsWithTheLastOfThem) {
    ovo::ContextRegistry registry;
    registry.NoteCreated(Display(1), Context(10), EGL_NO_CONTEXT, 1);
    registry.NoteCreated(Display(1), Context(11), Context(10), 1);
    registry.NoteCreated(Display(1), Context(12), EGL_NO_CONTEXT, 1);
    // Sharing with a context the library never saw starts a group of its own.
    registry.NoteCreated(Display(1), Context(13), Context(99), 1);
    const uint32_t first = registry.ShareGroupOf(Context(10));
    EXPECT_NE(first, ovo::SHARE_GROUP_NONE);
    EXPECT_EQ(registry.ShareGroupOf(Context(11)), first);
    EXPECT_NE(registry.ShareGroupOf(Context(12)), first);
    EXPECT_NE(registry.ShareGroupOf(Context(13)), registry.ShareGroupOf(Context(12)));
    EXPECT_EQ(registry.ShareGroupOf(Context(99)), ovo::SHARE_GROUP_NONE);

    EXPECT_EQ(registry.NoteDestroyed(Display(2), Context(10)), ovo::SHARE_GROUP_NONE)
        << "a context of another display";
    EXPECT_EQ(registry.NoteDestroyed(Display(1), Context(10)), ovo::SHARE_GROUP_NONE);
    EXPECT_EQ(registry.ShareGroupOf(Context(11)), first);
    EXPECT_EQ(registry.NoteDestroyed(Display(1), Context(11)), first);
    EXPECT_EQ(registry.NoteDestroyed(Display(1), Context(11)), ovo::SHARE_GROUP_NONE)
        << "destroyed twice";
    // A handle the driver gives out again is a new context, in a new group.
    registry.NoteCreated(Display(1), Context(11), EGL_NO_CONTEXT, 1);
    EXPECT_NE(registry.ShareGroupOf(Context(11)), first);
}

TEST(ContextRegistryTest, TerminatingADisplayEndsTheGroupsOfItsContextsOnly) {
    ovo::ContextRegistry registry;
    registry.NoteCreated(Display(1), Context(10), EGL_NO_CONTEXT, 1);
    registry.NoteCreated(Display(1), Context(11), Context(10), 0);
    registry.NoteCreated(Display(1), Context(12), EGL_NO_CONTEXT, 1);
    registry.NoteCreated(Display(2), Context(20), EGL_NO_CONTEXT, 1);
    // Each group's objects go with one of its contexts: the last listed.
    ovo::ContextFacts listed[ovo::CONTEXT_REGISTRY_CAPACITY];
    ASSERT_EQ(registry.ContextsOf(Display(1), listed), 3u);
    const std::vector<std::pair<EGLContext, bool>> ends = {
        {listed[0].m_context, listed[0].m_ends_group}, {listed[1].m_context, listed[1].m_ends_group},
        {listed[2].m_context, listed[2].m_ends_group}};
    EXPECT_EQ(ends, (std::vector<std::pair<EGLContext, bool>>{
                        {Context(10), false}, {Context(11), true}, {Context(12), true}}));
    EXPECT_EQ(listed[1].m_client_api_index, 0u);
    ovo::ContextFacts facts{};
    ASSERT_TRUE(registry.Lookup(Display(1), Context(10), &facts));
    EXPECT_FALSE(facts.m_ends_group) << "11 shares its group";
    EXPECT_EQ(facts.m_client_api_index, 1u);
    EXPECT_FALSE(registry.Lookup(Display(2), Context(10), &facts)) << "of another display";
    const std::vector<uint32_t> expected = {registry.ShareGroupOf(Context(10)),
                                            registry.ShareGroupOf(Context(12))};
    std::vector<uint32_t> ended;
    registry.NoteTerminated(Display(1), [&](uint32_t group) { ended.push_back(group); });
    EXPECT_EQ(ended, expected);
    EXPECT_EQ(registry.ShareGroupOf(Context(11)), ovo::SHARE_GROUP_NONE);
    EXPECT_NE(registry.ShareGroupOf(Context(20)), ovo::SHARE_GROUP_NONE);
}

// More live contexts than the table holds: the ones past it have no known group, and a
// freed slot takes the next one.
TEST(ContextRegistryTest, ContextsPastTheCapacityHaveNoGroup) {
    ovo::ContextRegistry registry;
    const uintptr_t count = ovo::CONTEXT_REGISTRY_CAPACITY;
    for (uintptr_t n = 1; n <= count + 1; ++n) registry.NoteCreated(Display(1), Context(n), EGL_NO_CONTEXT, 1);
    EXPECT_NE(registry.ShareGroupOf(Context(count)), ovo::SHARE_GROUP_NONE);
    EXPECT_EQ(registry.ShareGroupOf(Context(count + 1)), ovo::SHARE_GROUP_NONE);
    registry.NoteDestroyed(Display(1), Context(1));
    registry.NoteCreated(Display(1), Context(count + 1), EGL_NO_CONTEXT, 1);
    EXPECT_NE(registry.ShareGroupOf(Context(count + 1)), ovo::SHARE_GROUP_NONE);
}

class ContextObjectsTest : public ::testing::Test {
protected:
    void SetUp() override {
        vendor_root::InstallRecorder();
        m_egl.Open();
        ASSERT_NE(m_egl.m_display, EGL_NO_DISPLAY);
        ovo::StereoManager& manager = ovo::StereoManager::instance();
        manager.m_es2_layer_installed = true;
        manager.m_profile->m_target_width = 800;
        manager.m_profile->m_target_height = 480;
        manager.m_composer = new ovo::CompositionRenderer(1);  // released at exit
        ClearAnswers();
    }

    EGLContext Create(EGLContext share = EGL_NO_CONTEXT, EGLint client_version = 2) {
        const EGLint attributes[] = {EGL_CONTEXT_CLIENT_VERSION, client_version, EGL_NONE};
        return eglCreateContext(m_egl.m_display, nullptr, share, attributes);
    }

    // `frames` swaps' masks in `context`, which makes the programs that the vendor names
    // `program` from now on.
    void Frames(EGLContext context, int frames, GLuint program) {
        ASSERT_EQ(m_egl.MakeCurrent(context), EGL_TRUE);
        AnswerResult(ovo::GL_ENTRY_glCreateProgram, 0, program);
        AnswerResult(ovo::GL_ENTRY_glGetUniformLocation, program, 3);
        ResetRecorder();
        for (int i = 0; i < frames; ++i) {
            ovo::StereoManager::instance().m_composer->Present(ovo::StereoManager::instance());
        }
    }

    // The calls that eglDestroyContext(context) makes.
    Calls Destroy(EGLContext context) {
        ResetRecorder();
        EXPECT_NE(eglDestroyContext(m_egl.m_display, context), EGL_FALSE);
        return RecordedCalls(true);
    }

    std::string MakeCurrentCall(EGLSurface surface, EGLContext context) const {
        const std::string drawn = FormatHandle(surface);
        return "eglMakeCurrent(" + FormatHandle(m_egl.m_display) + ", " + drawn + ", " + drawn +
               ", " + FormatHandle(context) + ")";
    }
    std::string DestroyCall(EGLContext context) const {
        return "eglDestroyContext(" + FormatHandle(m_egl.m_display) + ", " + FormatHandle(context) + ")";
    }

    EglSession m_egl;
};

size_t Count(const Calls& calls, const std::string& call) {
    return static_cast<size_t>(std::count(calls.begin(), calls.end(), call));
}

size_t CountNamed(const Calls& calls, const std::string& name) {
    return static_cast<size_t>(std::count_if(calls.begin(), calls.end(), [&](const std::string& call) {
        return call.compare(0, name.size() + 1, name + "(") == 0;
    }));
}

TEST_F(ContextObjectsTest, TheMaskProgramIsMadeOncePerShareGroupAndGoesWithItsLastContext) {
    const EGLContext first = Create();
    const EGLContext other = Create();
    const EGLContext sharing = Create(first);
    struct Phase {
        EGLContext m_context;
        GLuint m_vendor_program;  // what a glCreateProgram now answers
        size_t m_builds;
        GLuint m_used;
    } phases[] = {{first, 7, 1, 7}, {sharing, 8, 0, 7}, {first, 8, 0, 7}, {other, 8, 1, 8}};
    for (const Phase& phase : phases) {
        Frames(phase.m_context, 3, phase.m_vendor_program);
        const Calls calls = RecordedGlCalls();
        EXPECT_EQ(CountNamed(calls, "glCreateProgram"), phase.m_builds) << phase.m_vendor_program;
        EXPECT_EQ(CountNamed(calls, "glLinkProgram"), phase.m_builds);
        EXPECT_EQ(Count(calls, "glUseProgram(" + std::to_string(phase.m_used) + ")"), 3u);
    }
    // `other` is current. The group lives on in `first`; then it ends, and its program is
    // deleted in `first`, made current without a surface, before the application's call.
    EXPECT_EQ(Destroy(sharing), Calls({DestroyCall(sharing)}));
    const EGLSurface surface = EglSession::Surface();
    EXPECT_EQ(Destroy(first), Calls({MakeCurrentCall(EGL_NO_SURFACE, first), "glDeleteProgram(7)",
                                     MakeCurrentCall(surface, other), DestroyCall(first)}));
    // A new group gets a program of its own; the old name is neither used nor deleted again.
    const EGLContext later = Create();
    Frames(later, 2, 10);
    const Calls frames = RecordedGlCalls();
    EXPECT_EQ(Count(frames, "glUseProgram(10)"), 2u);
    for (const std::string& call : frames) EXPECT_EQ(call.find("Program(7)"), std::string::npos) << call;
    EXPECT_EQ(Destroy(other), Calls({MakeCurrentCall(EGL_NO_SURFACE, other), "glDeleteProgram(8)",
                                     MakeCurrentCall(surface, later), DestroyCall(other)}));
    // The current context's objects go without any switch.
    EXPECT_EQ(Destroy(later), Calls({"glDeleteProgram(10)", DestroyCall(later)}));
}

// The thread's table follows the last created context (an ES 1.x one here), but the
// program of the ES 2.0 context goes through its own table, and the thread's comes back.
TEST_F(ContextObjectsTest, ObjectsAreDeletedThroughTheirContextsOwnGlTable) {
    const EGLContext es2 = Create();
    Create(EGL_NO_CONTEXT, 1);
    Frames(es2, 1, 7);
    ASSERT_NE(FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glCreateProgram), nullptr);
    Destroy(es2);
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glDeleteProgram), nullptr);
    EXPECT_EQ(FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glDeleteProgram), nullptr);
    ovo::raw::glFinish();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glFinish), nullptr);
}

// Where the ended context cannot be made current here, or the thread could not come back
// to its own, the names are forgotten: the driver frees them with the context.
TEST_F(ContextObjectsTest, TheThreadsOwnBindingComesBackOrIsNeverLeft) {
    struct Case {
        const char* m_label;
        std::function<void(EglSession&)> m_before;
        bool m_released;      // the thread has nothing current at the end
        bool m_refused;       // the vendor refuses the switch
        bool m_left_alone;    // no switch is tried
    } cases[] = {
        {"the vendor refuses", [](EglSession&) { RecorderGetState()->m_make_current_fails = true; },
         false, true, false},
        {"the thread's surface was destroyed while current",
         [](EglSession& egl) { eglDestroySurface(egl.m_display, EglSession::Surface()); }, false,
         false, true},
        {"the thread released everything", [](EglSession&) { eglReleaseThread(); }, true, false,
         false},
    };
    for (const Case& each : cases) {
        SCOPED_TRACE(each.m_label);
        RecorderGetState()->m_make_current_fails = false;
        const EGLContext ended = Create();
        const EGLContext own = Create();
        Frames(ended, 1, 7);
        ASSERT_EQ(m_egl.MakeCurrent(own), EGL_TRUE);
        each.m_before(m_egl);
        Calls expected;
        if (!each.m_left_alone) expected.push_back(MakeCurrentCall(EGL_NO_SURFACE, ended));
        if (!each.m_left_alone && !each.m_refused) {
            expected.push_back("glDeleteProgram(7)");
            expected.push_back(each.m_released ? MakeCurrentCall(EGL_NO_SURFACE, EGL_NO_CONTEXT)
                                               : MakeCurrentCall(EglSession::Surface(), own));
        }
        expected.push_back(DestroyCall(ended));
        EXPECT_EQ(Destroy(ended), expected);
    }
}

// Every context of the display goes: each group's objects are deleted in one of its
// contexts, and the thread's own context comes back before the vendor's eglTerminate.
TEST_F(ContextObjectsTest, TerminatingDeletesEveryGroupsObjectsFirst) {
    const EGLContext first = Create();
    const EGLContext other = Create();
    const EGLContext sharing = Create(first);
    Frames(other, 1, 8);
    Frames(first, 1, 7);
    ResetRecorder();
    EXPECT_NE(eglTerminate(m_egl.m_display), EGL_FALSE);
    const Calls expected = {MakeCurrentCall(EGL_NO_SURFACE, other), "glDeleteProgram(8)",
                            MakeCurrentCall(EGL_NO_SURFACE, sharing), "glDeleteProgram(7)",
                            MakeCurrentCall(EglSession::Surface(), first),
                            "eglTerminate(" + FormatHandle(m_egl.m_display) + ")"};
    EXPECT_EQ(RecordedCalls(true), expected);
}

}  // namespace
