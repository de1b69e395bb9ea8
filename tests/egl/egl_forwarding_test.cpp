// Every exported EGL function but eglGetProcAddress reaches the vendor slot of its index.
#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <gtest/gtest.h>

#include <utility>

#include "core/driver_hooks.h"
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

template <typename Result, typename... Arguments, size_t... POSITIONS>
Result CallWithDistinctArguments(Result (*function)(Arguments...), std::index_sequence<POSITIONS...>) {
    return function(DistinctEglArguments::Make<Arguments>(0, static_cast<uint32_t>(POSITIONS))...);
}

template <typename Result, typename... Arguments>
Result CallWithDistinctArguments(Result (*function)(Arguments...)) {
    return CallWithDistinctArguments(function, std::index_sequence_for<Arguments...>{});
}

// Clients ask eglGetError or eglQueryString(EGL_NO_DISPLAY, EGL_EXTENSIONS) before any
// eglGetDisplay. Each forwarder is called here as the first EGL call of the process: with
// the driver table empty again, it binds the driver and brings the vendor's answer back.
TEST(EglForwardingTest, BeforeTheFirstDisplayEveryForwarderBindsTheDriverAndReachesTheVendor) {
    vendor_root::InstallRecorder();
    uint32_t walked = 0;
#define OVO_EGL_ENTRY(index, result, name, params, args)                                    \
    ovo::g_vendor_driver.m_egl = ovo::EglDriverTable();                                     \
    ExpectForwarded<DistinctEglArguments>(#name, index, RECORDER_API_EGL, index, &::name); \
    ++walked;
#define OVO_EGL_INTERCEPT(index, result, name, params, args)
#define OVO_EGL_NULL(index, result, name, params, args)
#include "core/egl_entry_table.inc"
    EXPECT_EQ(walked, 27u);
}

// Without a vendor every forwarder answers 0 (EGL_FALSE, EGL_NO_SURFACE, ...) instead of
// jumping through null.
TEST(EglForwardingTest, WithoutAVendorEveryForwarderAnswersZero) {
    vendor_root::Reset();
    uint32_t walked = 0;
#define OVO_EGL_ENTRY(index, result, name, params, args)                              \
    EXPECT_EQ(CallWithDistinctArguments(&::name), static_cast<result>(0)) << #name; \
    ++walked;
#define OVO_EGL_INTERCEPT(index, result, name, params, args)
#define OVO_EGL_NULL(index, result, name, params, args)
#include "core/egl_entry_table.inc"
    EXPECT_EQ(walked, 27u);
    EXPECT_EQ(RecorderGetState()->m_call_count, 0u);
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
