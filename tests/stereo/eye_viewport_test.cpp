// Where each eye lands without interleaving: the halves, the eye order and the rounding.
#include "stereo/eye_viewport.h"
#include "stereo_fixture.h"

namespace {

class EyeViewportTest : public StereoFixture {
protected:
    Calls BothEyes() {
        ResetRecorder();
        ovo::ApplyEyeViewport(Manager(), 0, 1.5f, 1.25f);
        ovo::ApplyEyeViewport(Manager(), 1, 1.5f, 1.25f);
        return recorded_calls::RecordedGlCalls();
    }
};

// An unknown eye order is the normal one; an unknown split places nothing. Interleaving leaves
// viewport and scissor to the mask.
TEST_F(EyeViewportTest, EachSplitAndEyeOrderPutsTheEyesInTheirHalves) {
    // The rectangles of the eye drawn into the left (upper) half and of the other one.
    const Calls side_first(SCALED_HALVES.begin(), SCALED_HALVES.begin() + 2);
    const Calls side_other(SCALED_HALVES.begin() + 2, SCALED_HALVES.end());
    const Calls top_first = {"glViewport(15, 252, 601, 152)", "glScissor(6, 243, 151, 32)"};
    const Calls top_other = {"glViewport(15, 12, 601, 152)", "glScissor(6, 3, 151, 32)"};
    const struct {
        uint32_t m_split;
        uint32_t m_eye_order;
        Calls m_expected;
    } cases[] = {
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, ovo::STEREO_EYE_ORDER_NORMAL, Join({side_first, side_other})},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, ovo::STEREO_EYE_ORDER_SWAPPED, Join({side_other, side_first})},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, 0x1234, Join({side_first, side_other})},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, ovo::STEREO_EYE_ORDER_NORMAL, Join({top_first, top_other})},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, ovo::STEREO_EYE_ORDER_SWAPPED, Join({top_other, top_first})},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, 0x1234, Join({top_first, top_other})},
        {0x3999, ovo::STEREO_EYE_ORDER_NORMAL, Calls()},
    };
    Interleave(false);
    ScaleOutput();
    for (const auto& each : cases) {
        Profile().m_split = each.m_split;
        Profile().m_eye_order = each.m_eye_order;
        EXPECT_EQ(BothEyes(), each.m_expected) << std::hex << each.m_split << " " << each.m_eye_order;
    }
    Profile().m_split = ovo::STEREO_SPLIT_SIDE_BY_SIDE;
    Interleave(true);
    EXPECT_EQ(BothEyes(), Calls());
    ResetRecorder();
    ovo::ApplyScaledViewport(Manager(), 1.5f, 1.25f);
    EXPECT_EQ(recorded_calls::RecordedGlCalls(), Calls());
}

}  // namespace
