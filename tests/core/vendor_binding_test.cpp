// Which vendor libraries are opened, and what fills each slot when a name is missing.
#include <GLES/gl.h>
#include <GLES/glext.h>
#include <GLES2/gl2.h>

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <fstream>

#include "core/driver_hooks.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/vendor_root.h"

namespace {

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
    ResetRecorder();
    glFlush();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glFlush), nullptr);
    ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(1)), EGL_TRUE);
    ResetRecorder();
    glFlush();
    EXPECT_NE(FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glFlush), nullptr);
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
