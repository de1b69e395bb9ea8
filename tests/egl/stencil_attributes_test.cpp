#include "egl/stencil_attributes.h"

#include <gtest/gtest.h>

#include <vector>

#include "core/stereo_manager.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/vendor_root.h"

namespace {

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
    struct Case {
        std::vector<EGLint> m_list;
        std::vector<EGLint> m_expected;
    } cases[] = {
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
    for (const Case& each : cases) {
        EXPECT_EQ(Copied(each.m_list.data()), each.m_expected);
    }
    EXPECT_EQ(Copied(nullptr), (std::vector<EGLint>{EGL_STENCIL_SIZE, 1, EGL_NONE}));
}

TEST(StencilAttributesTest, ChooseConfigRewritesOnlyWhileInterleaving) {
    vendor_root::InstallRecorder();
    EglSession egl;
    egl.Open();
    const EGLint list[] = {EGL_RED_SIZE, 5, EGL_NONE};
    EGLConfig config;
    EGLint count;

    eglChooseConfig(egl.m_display, list, &config, 1, &count);
    const RecordedCall* call = FindRecordedCall(RECORDER_API_EGL, ovo::EGL_ENTRY_eglChooseConfig);
    ASSERT_NE(call, nullptr);
    EXPECT_EQ(call->m_arguments[1], ArgumentBits(list)) << "the application's own list";

    ovo::StereoManager::instance().m_interleave = true;
    ResetRecorder();
    eglChooseConfig(egl.m_display, list, &config, 1, &count);
    call = FindRecordedCall(RECORDER_API_EGL, ovo::EGL_ENTRY_eglChooseConfig);
    ASSERT_NE(call, nullptr);
    EXPECT_NE(call->m_arguments[1], ArgumentBits(list));
    const EGLint* seen = RecorderGetState()->m_chosen_attributes;
    EXPECT_EQ(std::vector<EGLint>(seen, seen + 5),
              (std::vector<EGLint>{EGL_RED_SIZE, 5, EGL_STENCIL_SIZE, 1, EGL_NONE}));
    EXPECT_EQ(list[2], EGL_NONE) << "the application's list is never changed";
}

}  // namespace
