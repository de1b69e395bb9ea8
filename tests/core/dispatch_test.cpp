// Every exported GL function reaches the vendor function of the same index through the
// table of the calling thread, and the few that do more do exactly that; which vendor
// libraries are opened, and what fills each slot when a name is missing.
#include <GLES/gl.h>
#include <GLES/glext.h>
#include <GLES2/gl2.h>
#include <GLES2/gl2ext.h>

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <fstream>
#include <thread>
#include <tuple>
#include <utility>
#include <vector>

#include "core/driver_hooks.h"
#include "core/stereo_manager.h"
#include "entry/gl_dispatch.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/vendor_root.h"

namespace {

using ovo::GlEntryIndex;

// A glFlush from now on reaches the recording vendor of `api`.
void ExpectFlushReaches(RecorderApi api) {
    ResetRecorder();
    glFlush();
    EXPECT_NE(FindRecordedCall(api, ovo::GL_ENTRY_glFlush), nullptr);
}

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
    ExpectFlushReaches(RECORDER_API_GLES1);

    // No attribute list means OpenGL ES 1.x; a failed make-current keeps the thread's table.
    EGLContext plain = eglCreateContext(m_egl.m_display, nullptr, EGL_NO_CONTEXT, nullptr);
    m_egl.CreateContext(2);
    RecorderGetState()->m_make_current_fails = true;
    EXPECT_EQ(m_egl.MakeCurrent(plain), EGL_FALSE);
    ExpectFlushReaches(RECORDER_API_GLES1);
    RecorderGetState()->m_make_current_fails = false;
    ASSERT_EQ(m_egl.MakeCurrent(plain), EGL_TRUE);
    ExpectFlushReaches(RECORDER_API_GLES2);
}

TEST(VendorBindingTest, EachKindIsSearchedInGpuTagOrder) {
    // Every kind sits under a different tag, with a decoy under a later one.
    vendor_root::Reset();
    vendor_root::Install("libEGL", "POWERVR_SGX540_120", vendor_root::RecordingEgl());
    vendor_root::Install("libGLESv1_CM", "SGX530", vendor_root::RecordingGles1());
    vendor_root::Install("libGLESv2", "adreno200", vendor_root::RecordingGles2());
    vendor_root::Install("libGLESv2", "mtk", vendor_root::RecordingGles1());
    vendor_root::Install("libGLESv2", "SGX530", vendor_root::RecordingGles1());
    EglSession egl;
    egl.Open();
    ASSERT_NE(egl.m_display, EGL_NO_DISPLAY);
    ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(2)), EGL_TRUE);
    ExpectFlushReaches(RECORDER_API_GLES2);
    ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(1)), EGL_TRUE);
    ExpectFlushReaches(RECORDER_API_GLES1);
}

TEST(VendorBindingTest, AMissingLibraryGivesNoDisplayAndKeepsWhatWasBound) {
    vendor_root::Reset();
    vendor_root::Install("libEGL", "mali", vendor_root::RecordingEgl());
    vendor_root::Install("libGLESv2", "mali", vendor_root::RecordingGles2());
    std::string profile = OVO_TEST_DEVICE_ROOT "/sdcard/stereoconv/game/stereo_gm.ovo";
    std::filesystem::create_directories(OVO_TEST_DEVICE_ROOT "/sdcard/stereoconv/game");
    std::ofstream(profile) << "kept";

    ResetRecorder();
    EXPECT_EQ(eglGetDisplay(EGL_DEFAULT_DISPLAY), EGL_NO_DISPLAY);
    EXPECT_EQ(FindRecordedCall(RECORDER_API_EGL, ovo::EGL_ENTRY_eglGetDisplay), nullptr);
    EXPECT_NE(ovo::g_vendor_driver.m_egl.eglInitialize, nullptr);
    EXPECT_EQ(ovo::g_vendor_driver.m_es1_hooks.glFlush, nullptr);
    EXPECT_EQ(ovo::g_vendor_driver.m_es2_hooks.glFlush, nullptr);
    EXPECT_TRUE(std::filesystem::exists(profile)) << "the profile belongs to a bound start";

    // A later call binds once the library is there, and consumes the profile.
    vendor_root::Install("libGLESv1_CM", "mtk", vendor_root::RecordingGles1());
    EXPECT_NE(eglGetDisplay(EGL_DEFAULT_DISPLAY), EGL_NO_DISPLAY);
    EXPECT_FALSE(std::filesystem::exists(profile));
}

TEST(VendorBindingTest, MissingNamesFallBackToTheResolverAndTheOtherSuffix) {
    vendor_root::Reset();
    vendor_root::Install("libEGL", "mali", vendor_root::RecordingEgl());
    vendor_root::Install("libGLESv1_CM", "mali", vendor_root::RecordingGles1Sparse());
    vendor_root::Install("libGLESv2", "mali", vendor_root::RecordingGles2());
    RecorderGetState()->m_resolver_knows[ovo::GL_ENTRY_glHint] = true;
    EglSession egl;
    egl.Open();
    ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(1)), EGL_TRUE);

    struct Case {
        const char* m_name;
        void (*m_call)();
        int32_t m_api;
        uint32_t m_vendor_index;
    } cases[] = {
        {"glBlendEquation", [] { glBlendEquationOES(GL_FUNC_ADD_OES); }, RECORDER_API_GLES1,
         ovo::GL_ENTRY_glBlendEquationOES},
        {"glBlendEquation", [] { ovo::g_vendor_driver.m_es1_hooks.glBlendEquation(GL_FUNC_ADD_OES); },
         RECORDER_API_GLES1, ovo::GL_ENTRY_glBlendEquationOES},
        {"glClearDepthfOES", [] { glClearDepthfOES(0.5f); }, RECORDER_API_GLES1,
         ovo::GL_ENTRY_glClearDepthf},
        {"glHint", [] { glHint(GL_FOG_HINT, GL_NICEST); }, RECORDER_API_RESOLVER,
         ovo::GL_ENTRY_glHint},
    };
    for (const Case& each : cases) {
        ResetRecorder();
        each.m_call();
        EXPECT_EQ(RecorderGetState()->m_call_count, 1u) << each.m_name;
        EXPECT_NE(FindRecordedCall(each.m_api, each.m_vendor_index), nullptr) << each.m_name;
    }

    // Found nowhere: the slot does nothing.
    ResetRecorder();
    glFlush();
    EXPECT_EQ(RecorderGetState()->m_call_count, 0u);
    EXPECT_NE(ovo::g_vendor_driver.m_es1_hooks.glFlush, nullptr);
}

TEST(VendorBindingTest, OnlyTheThreeLibraryKindsExist) {
    vendor_root::InstallRecorder();
    EXPECT_NE(ovo::OpenVendorLibrary(ovo::VENDOR_LIBRARY_GLES2), nullptr);
    EXPECT_EQ(ovo::OpenVendorLibrary(3), nullptr);
    EXPECT_EQ(ovo::OpenVendorLibrary(-1), nullptr);
}

TEST(VendorBindingTest, EntryTablesAreInByteOrderAndNullTerminated) {
    for (unsigned index = 1; index < ovo::GL_ENTRY_COUNT; ++index) {
        EXPECT_LT(std::strcmp(ovo::GlEntryTable[index - 1], ovo::GlEntryTable[index]), 0) << index;
    }
    EXPECT_EQ(ovo::GlEntryTable[ovo::GL_ENTRY_COUNT], nullptr);
    EXPECT_EQ(ovo::EglEntryTable[ovo::EGL_ENTRY_COUNT], nullptr);
    EXPECT_STREQ(ovo::GlEntryTable[ovo::GL_ENTRY_glLightModelf], "glLightModelf");
    EXPECT_LT(ovo::GL_ENTRY_glLightModelf, ovo::GL_ENTRY_glLightf);
}

}  // namespace
