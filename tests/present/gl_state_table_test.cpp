// The saved-state tables beyond what the mask's two paths exercise: appending saves, the
// capacity and positions that were never saved.
#include "core/gl_state_table.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/recorded_calls.h"
#include "support/vendor_root.h"

namespace {

using namespace recorded_calls;

TEST(GlStateTableTest, SavesAppendUpToTheCapacityAndRestoreOnlyWhatWasSaved) {
    vendor_root::InstallRecorder();
    EglSession egl;
    egl.Open();
    ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(1)), EGL_TRUE);
    const ovo::GlStateItem alpha = {ovo::GL_STATE_ALPHA_FUNC, 0, true, {GL_NOTEQUAL, 0}};
    std::vector<ovo::GlStateItem> many(ovo::GL_STATE_CAPACITY + 5,
                                       {ovo::GL_STATE_ENABLE, GL_DITHER, false, {}});
    many[ovo::GL_STATE_CAPACITY - 2] = {ovo::GL_STATE_ENABLE, GL_FOG, true, {0}};
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_ALPHA_TEST_FUNC, {GL_LESS});
    AnswerFloats(ovo::GL_ENTRY_glGetFloatv, GL_ALPHA_TEST_REF, {0.75f});
    AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_FOG, GL_TRUE);
    AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_DITHER, GL_FALSE);
    ResetRecorder();

    ovo::GlStateSnapshot saved;
    saved.Save(&alpha, 1);
    saved.Save(many.data(), many.size());
    EXPECT_EQ(saved.Count(), ovo::GL_STATE_CAPACITY);
    std::vector<std::string> calls = RecordedGlCalls();
    ASSERT_EQ(calls.size(), 2 + 1 + (ovo::GL_STATE_CAPACITY - 1) + 1);
    EXPECT_EQ(calls[2], "glAlphaFunc(0x0205, 0)");
    EXPECT_EQ(calls[calls.size() - 2], "glIsEnabled(0x0B60)") << "the last item that fits";
    EXPECT_EQ(calls.back(), "glDisable(0x0B60)");

    ResetRecorder();
    const uint8_t order[] = {ovo::GL_STATE_CAPACITY - 1, ovo::GL_STATE_CAPACITY, 0, 200, 1};
    saved.Restore(order, std::size(order));
    EXPECT_EQ(RecordedGlCalls(), (std::vector<std::string>{"glEnable(0x0B60)",
                                                           "glAlphaFunc(0x0201, 0.75)",
                                                           "glDisable(0x0BD0)"}));
}

}  // namespace
