// Every exported EGL function but eglGetProcAddress reaches the vendor slot of its index, and
// eglChooseConfig's attribute list asks for a stencil buffer while the manager interleaves.
#include <gtest/gtest.h>

#include <vector>

#include "core/driver_hooks.h"
#include "core/stereo_manager.h"
#include "egl/stencil_attributes.h"
#include "support/egl_session.h"
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

template <typename Result, typename... Arguments>
Result CallWithArguments(Result (*function)(Arguments...)) {
    return function(DistinctEglArguments::Make<Arguments>(0, 0)...);
}

// Without a vendor every forwarder answers 0 (EGL_FALSE, EGL_NO_SURFACE, ...) instead of
// jumping through null.
TEST(EglForwardingTest, WithoutAVendorEveryForwarderAnswersZero) {
    vendor_root::Reset();
    uint32_t walked = 0;
#define OVO_EGL_ENTRY(index, result, name, params, args)                       \
    EXPECT_EQ(CallWithArguments(&::name), static_cast<result>(0)) << #name; \
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

std::vector<EGLint> Copied(const EGLint* list) {
    EGLint* copy = ovo::CopyWithStencil(list);
    std::vector<EGLint> words;
    for (size_t word = 0;; word += 2) {
        words.push_back(copy[word]);
        if (copy[word] == EGL_NONE) break;
        words.push_back(copy[word + 1]);
    }
    delete[] copy;
    return words;
}

TEST(StencilAttributesTest, EveryListAsksForAtLeastOneStencilBit) {
    const std::vector<EGLint> cases[][2] = {
        {{EGL_RED_SIZE, 5, EGL_NONE}, {EGL_RED_SIZE, 5, EGL_STENCIL_SIZE, 1, EGL_NONE}},
        {{EGL_STENCIL_SIZE, 0, EGL_NONE}, {EGL_STENCIL_SIZE, 1, EGL_NONE}},
        {{EGL_STENCIL_SIZE, 8, EGL_NONE}, {EGL_STENCIL_SIZE, 8, EGL_NONE}},
        {{EGL_STENCIL_SIZE, EGL_DONT_CARE, EGL_NONE}, {EGL_STENCIL_SIZE, EGL_DONT_CARE, EGL_NONE}},
        // EGL_NONE as a value does not end the list; only a key does.
        {{EGL_CONFIG_CAVEAT, EGL_NONE, EGL_NONE},
         {EGL_CONFIG_CAVEAT, EGL_NONE, EGL_STENCIL_SIZE, 1, EGL_NONE}},
        {{EGL_STENCIL_SIZE, 0, EGL_DEPTH_SIZE, 16, EGL_STENCIL_SIZE, 0, EGL_NONE},
         {EGL_STENCIL_SIZE, 1, EGL_DEPTH_SIZE, 16, EGL_STENCIL_SIZE, 1, EGL_NONE}},
        {{EGL_NONE}, {EGL_STENCIL_SIZE, 1, EGL_NONE}},
    };
    for (const auto& [list, expected] : cases) EXPECT_EQ(Copied(list.data()), expected);
    EXPECT_EQ(Copied(nullptr), (std::vector<EGLint>{EGL_STENCIL_SIZE, 1, EGL_NONE}));
}

TEST(StencilAttributesTest, ChooseConfigRewritesOnlyWhileInterleaving) {
    vendor_root::InstallRecorder();
    EglSession egl;
    egl.Open();
    const EGLint list[] = {EGL_RED_SIZE, 5, EGL_NONE};
    EGLConfig config;
    EGLint count;
    for (bool interleave : {false, true}) {
        SCOPED_TRACE(interleave);
        if (interleave) ovo::StereoManager::instance().m_interleave = true;
        ResetRecorder();
        eglChooseConfig(egl.m_display, list, &config, 1, &count);
        const RecordedCall* call = FindRecordedCall(RECORDER_API_EGL, ovo::EGL_ENTRY_eglChooseConfig);
        ASSERT_NE(call, nullptr);
        EXPECT_EQ(call->m_arguments[1] == ArgumentBits(list), !interleave) << "the application's own list";
    }
    const EGLint* seen = RecorderGetState()->m_chosen_attributes;
    EXPECT_EQ(std::vector<EGLint>(seen, seen + 5),
              (std::vector<EGLint>{EGL_RED_SIZE, 5, EGL_STENCIL_SIZE, 1, EGL_NONE}));
    EXPECT_EQ(list[2], EGL_NONE) << "the application's list is never changed";
}

}  // namespace
