// Every exported GL function reaches the vendor function of the same index through the
// table of the calling thread, and the few that do more do exactly that.
#include <GLES/gl.h>
#include <GLES/glext.h>
#include <GLES2/gl2.h>
#include <GLES2/gl2ext.h>

#include <gtest/gtest.h>

#include <thread>
#include <tuple>
#include <utility>
#include <vector>

#include "core/stereo_manager.h"
#include "entry/gl_dispatch.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/vendor_root.h"

namespace {

using ovo::GlEntryIndex;

// The OES names that dispatch to their core operation.
uint32_t VendorIndexFor(uint32_t index) {
    switch (index) {
        case ovo::GL_ENTRY_glBindFramebufferOES: return ovo::GL_ENTRY_glBindFramebuffer;
        case ovo::GL_ENTRY_glFramebufferTexture2DOES: return ovo::GL_ENTRY_glFramebufferTexture2D;
        case ovo::GL_ENTRY_glRenderbufferStorageOES: return ovo::GL_ENTRY_glRenderbufferStorage;
        default: return index;
    }
}

void ExpectEveryGlFunctionForwarded(int32_t api) {
#define OVO_GL_ENTRY(index, result, name, params, args) \
    ExpectForwarded<DistinctArguments>(#name, index, api, VendorIndexFor(index), &::name);
#include "core/gl_entry_table.inc"
}

class DispatchTest : public ::testing::Test {
protected:
    void SetUp() override {
        vendor_root::InstallRecorder();
        m_egl.Open();
        ASSERT_NE(m_egl.m_display, EGL_NO_DISPLAY);
    }

    EglSession m_egl;
};

TEST_F(DispatchTest, EveryGlFunctionReachesTheVendorSlotOfItsIndex) {
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(1)), EGL_TRUE);
    ExpectEveryGlFunctionForwarded(RECORDER_API_GLES1);
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    ExpectEveryGlFunctionForwarded(RECORDER_API_GLES2);
}

TEST_F(DispatchTest, ControlCodesReadAndSetTheProfileWithoutTheVendor) {
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    ovo::StereoProfile& profile = *ovo::StereoManager::instance().m_profile;
    const std::pair<GLenum, float*> float_codes[] = {
        {ovo::STEREO_PARAM_EYE_DISTANCE, &profile.m_eye_distance},
        {ovo::STEREO_PARAM_EYE_ANGLE, &profile.m_eye_angle},
        {ovo::STEREO_PARAM_EYE_SHIFT, &profile.m_eye_shift}};
    float value = 0.5f;
    for (const auto& [code, field] : float_codes) {
        ResetRecorder();
        glTexParameterf(code, GL_TEXTURE_MIN_FILTER, value);
        GLfloat read[2] = {0.0f, -7.0f};
        glGetFloatv(code, read);
        EXPECT_EQ(*field, value) << code;
        EXPECT_EQ(read[0], value);
        EXPECT_EQ(read[1], -7.0f) << "only one value is written";
        EXPECT_EQ(RecorderGetState()->m_call_count, 0u) << "the vendor saw control code " << code;
        value += 0.25f;
    }
    const std::tuple<GLenum, uint32_t*, GLint> int_codes[] = {
        {ovo::STEREO_PARAM_SPLIT, &profile.m_split, ovo::STEREO_SPLIT_TOP_BOTTOM},
        {ovo::STEREO_PARAM_EYE_ORDER, &profile.m_eye_order, ovo::STEREO_EYE_ORDER_SWAPPED}};
    for (const auto& [code, field, set] : int_codes) {
        ResetRecorder();
        glTexParameteri(code, 0, set);
        GLint read = 0;
        glGetIntegerv(code, &read);
        EXPECT_EQ(*field, static_cast<uint32_t>(set));
        EXPECT_EQ(read, set);
        EXPECT_EQ(RecorderGetState()->m_call_count, 0u) << "the vendor saw control code " << code;
    }
    // Only the target carries a code: as a pname it is an ordinary texture parameter.
    glTexParameterf(GL_TEXTURE_2D, ovo::STEREO_PARAM_EYE_ANGLE, 9.0f);
    EXPECT_EQ(profile.m_eye_angle, 0.75f);
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glTexParameterf), nullptr);
}

TEST_F(DispatchTest, ViewportAndScissorAreRecordedAsGiven) {
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    const ovo::StereoManager& manager = ovo::StereoManager::instance();
    glViewport(-4, 7, 0, -20);
    glScissor(1, 2, 3, 4);
    const ovo::GlRect& v = manager.m_viewport;
    const ovo::GlRect& s = manager.m_scissor;
    EXPECT_EQ(std::vector<int32_t>({v.m_x, v.m_y, v.m_width, v.m_height, s.m_x, s.m_y, s.m_width, s.m_height}),
              std::vector<int32_t>({-4, 7, 0, -20, 1, 2, 3, 4}));
}

TEST_F(DispatchTest, InterleavingKeepsTheStencilMaskFromBeingCleared) {
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    const GLbitfield all = GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT | GL_STENCIL_BUFFER_BIT;
    for (bool interleave : {false, true}) {
        ovo::StereoManager::instance().m_interleave = interleave;
        ResetRecorder();
        glClear(all);
        const RecordedCall* clear = FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glClear);
        ASSERT_NE(clear, nullptr);
        EXPECT_EQ(clear->m_arguments[0],
                  interleave ? ArgumentBits(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT)
                             : ArgumentBits(all));
    }
}

TEST_F(DispatchTest, ThreadsWithoutAContextReachNothing) {
    ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
    ResetRecorder();
    GLenum error = 1;
    GLint untouched[4] = {-1, -1, -1, -1};
    std::thread other([&] {
        glClear(GL_COLOR_BUFFER_BIT);
        glGetIntegerv(GL_VIEWPORT, untouched);
        error = glGetError();
    });
    other.join();
    EXPECT_EQ(RecorderGetState()->m_call_count, 0u);
    EXPECT_EQ(error, 0u);
    EXPECT_EQ(untouched[0], -1);

    // This thread still renders; after releasing its context it too reaches nothing.
    glFlush();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glFlush), nullptr);
    ASSERT_EQ(m_egl.MakeCurrent(EGL_NO_CONTEXT), EGL_TRUE);
    ResetRecorder();
    glFlush();
    EXPECT_EQ(glCreateProgram(), 0u);
    EXPECT_EQ(RecorderGetState()->m_call_count, 0u);
}

TEST_F(DispatchTest, MakeCurrentFollowsTheLastCreatedContext) {
    EGLContext es2 = m_egl.CreateContext(2);
    m_egl.CreateContext(1);
    ASSERT_EQ(m_egl.MakeCurrent(es2), EGL_TRUE);
    ResetRecorder();
    glFlush();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glFlush), nullptr);

    // No attribute list means OpenGL ES 1.x; a failed make-current keeps the thread's table.
    EGLContext plain = eglCreateContext(m_egl.m_display, nullptr, EGL_NO_CONTEXT, nullptr);
    m_egl.CreateContext(2);
    RecorderGetState()->m_make_current_fails = true;
    EXPECT_EQ(m_egl.MakeCurrent(plain), EGL_FALSE);
    ResetRecorder();
    glFlush();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glFlush), nullptr);
    RecorderGetState()->m_make_current_fails = false;
    ASSERT_EQ(m_egl.MakeCurrent(plain), EGL_TRUE);
    ResetRecorder();
    glFlush();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glFlush), nullptr);
}

}  // namespace
