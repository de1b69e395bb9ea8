// Where each eye lands without interleaving: the halves, the eye order and the rounding.
#include "stereo/eye_viewport.h"
#include "stereo_fixture.h"

namespace {

using Calls = std::vector<std::string>;

class EyeViewportTest : public StereoFixture {
protected:
    void SetUp() override {
        StereoFixture::SetUp();
        Interleave(false);
        // Chosen so that the 0.5 changes every rounded value: 300.75, 303.75, 601.5, 151.875.
        Manager().m_viewport = {10, 20, 401, 243};
        Manager().m_scissor = {4, 6, 101, 51};
    }

    Calls BothEyes() {
        ResetRecorder();
        ovo::ApplyEyeViewport(Manager(), 0, 1.5f, 1.25f);
        ovo::ApplyEyeViewport(Manager(), 1, 1.5f, 1.25f);
        return recorded_calls::RecordedGlCalls();
    }
};

// The rectangles of the eye drawn into the left (upper) half and of the other one.
const Calls SIDE_BY_SIDE_FIRST = {"glViewport(7, 25, 301, 303)", "glScissor(3, 7, 76, 63)"};
const Calls SIDE_BY_SIDE_OTHER = {"glViewport(407, 25, 301, 303)", "glScissor(403, 7, 76, 63)"};
const Calls TOP_BOTTOM_FIRST = {"glViewport(15, 252, 601, 152)", "glScissor(6, 243, 151, 32)"};
const Calls TOP_BOTTOM_OTHER = {"glViewport(15, 12, 601, 152)", "glScissor(6, 3, 151, 32)"};

Calls Then(const Calls& first, const Calls& second) {
    Calls all = first;
    all.insert(all.end(), second.begin(), second.end());
    return all;
}

TEST_F(EyeViewportTest, EachSplitAndEyeOrderPutsTheEyesInTheirHalves) {
    struct Case {
        uint32_t m_split;
        uint32_t m_eye_order;
        Calls m_expected;
    } cases[] = {
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, ovo::STEREO_EYE_ORDER_NORMAL,
         Then(SIDE_BY_SIDE_FIRST, SIDE_BY_SIDE_OTHER)},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, ovo::STEREO_EYE_ORDER_SWAPPED,
         Then(SIDE_BY_SIDE_OTHER, SIDE_BY_SIDE_FIRST)},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, 0x1234, Then(SIDE_BY_SIDE_FIRST, SIDE_BY_SIDE_OTHER)},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, ovo::STEREO_EYE_ORDER_NORMAL,
         Then(TOP_BOTTOM_FIRST, TOP_BOTTOM_OTHER)},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, ovo::STEREO_EYE_ORDER_SWAPPED,
         Then(TOP_BOTTOM_OTHER, TOP_BOTTOM_FIRST)},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, 0x1234, Then(TOP_BOTTOM_FIRST, TOP_BOTTOM_OTHER)},
        {0x3999, ovo::STEREO_EYE_ORDER_NORMAL, Calls()},
    };
    for (const Case& each : cases) {
        Profile().m_split = each.m_split;
        Profile().m_eye_order = each.m_eye_order;
        EXPECT_EQ(BothEyes(), each.m_expected)
            << std::hex << each.m_split << " " << each.m_eye_order;
    }
}

TEST_F(EyeViewportTest, InterleavingLeavesViewportAndScissorToTheMask) {
    Interleave(true);
    EXPECT_EQ(BothEyes(), Calls());
    ResetRecorder();
    ovo::ApplyScaledViewport(Manager(), 1.5f, 1.25f);
    EXPECT_EQ(recorded_calls::RecordedGlCalls(), Calls());
}

}  // namespace
