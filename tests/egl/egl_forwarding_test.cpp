// Every exported EGL function but eglGetProcAddress reaches the vendor slot of its index.
#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <gtest/gtest.h>

#include "core/entry_tables.h"
#include "support/forwarding_check.h"
#include "support/vendor_root.h"

namespace {

TEST(EglForwardingTest, EveryEglFunctionReachesTheVendorSlotOfItsIndex) {
    vendor_root::InstallRecorder();
    ASSERT_NE(eglGetDisplay(EGL_DEFAULT_DISPLAY), EGL_NO_DISPLAY);
    uint32_t walked = 0;
#define OVO_EGL_ENTRY(index, result, name, params, args)                                    \
    ExpectForwarded<DistinctEglArguments>(#name, index, RECORDER_API_EGL, index, &::name); \
    ++walked;
#define OVO_EGL_NULL(index, result, name, params, args)
#include "core/egl_entry_table.inc"
    EXPECT_EQ(walked, 37u);
}

TEST(EglForwardingTest, ProcAddressesAreNeverHandedOut) {
    vendor_root::InstallRecorder();
    ASSERT_NE(eglGetDisplay(EGL_DEFAULT_DISPLAY), EGL_NO_DISPLAY);
    ResetRecorder();
    for (const char* name : {"glDrawArrays", "eglGetDisplay", "glNoSuchFunction"}) {
        EXPECT_EQ(eglGetProcAddress(name), nullptr) << name;
    }
    EXPECT_EQ(RecorderGetState()->m_call_count, 0u);
}

}  // namespace
