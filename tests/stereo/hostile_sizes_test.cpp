// Where each eye lands without interleaving: the halves, the eye order and the rounding. Sizes
// and eye parameters at the ends of their ranges: what reaches the vendor is held to the int32
// range (NaN as 0), never undefined; values within the range are untouched.
#include <limits>

#include "core/saturating_math.h"
#include "entry/gl_dispatch.h"
#include "stereo/es1_scaled_layer.h"
#include "stereo/es1_sprite_stereo_layer.h"
#include "stereo/es2_scaled_layer.h"
#include "stereo/es2_stereo_layer.h"
#include "stereo/eye_viewport.h"
#include "stereo_fixture.h"

namespace {

using namespace recorded_calls;

constexpr GLint MAX = std::numeric_limits<GLint>::max();
constexpr GLint MIN = std::numeric_limits<GLint>::min();
constexpr float INF = std::numeric_limits<float>::infinity();
constexpr float NOT_A_NUMBER = std::numeric_limits<float>::quiet_NaN();

class EyeViewportTest : public StereoFixture {
protected:
    static Calls BothEyes(float scale_x = 1.5f, float scale_y = 1.25f) {
        ResetRecorder();
        ovo::ApplyEyeViewport(Manager(), 0, scale_x, scale_y);
        ovo::ApplyEyeViewport(Manager(), 1, scale_x, scale_y);
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

TEST_F(EyeViewportTest, EyeViewportsOfExtremeRectanglesAndScalesSaturate) {
    struct Case {
        uint32_t m_split;
        ovo::GlRect m_rect;
        float m_scale_x;
        float m_scale_y;
        ovo::GlRect m_first;
        ovo::GlRect m_other;
    } cases[] = {
        // Side by side: x and width scaled by half of scale x; the other eye 400 further.
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, {MAX, MAX, MAX, MAX}, 4, 2, {MAX, MAX, MAX, MAX}, {MAX, MAX, MAX, MAX}},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, {MIN, MIN, MIN, MIN}, 4, 2, {MIN, MIN, MIN, MIN}, {MIN, MIN, MIN, MIN}},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, {0, 0, 0, 0}, 4, 2, {0, 0, 0, 0}, {400, 0, 0, 0}},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, {-10, -20, -30, -40}, 4, 2, {-20, -40, -59, -80}, {380, -40, -59, -80}},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, {10, 20, 401, 243}, INF, INF, {MAX, MAX, MAX, MAX}, {MAX, MAX, MAX, MAX}},
        // 0 x infinity is NaN, and so is the other eye's 400 + NaN.
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, {0, -20, 401, 243}, INF, INF, {0, MIN, MAX, MAX}, {0, MIN, MAX, MAX}},
        {ovo::STEREO_SPLIT_SIDE_BY_SIDE, {10, 20, 401, 243}, NOT_A_NUMBER, NOT_A_NUMBER, {0, 0, 0, 0}, {0, 0, 0, 0}},
        // Top and bottom: the first eye 240 higher.
        {ovo::STEREO_SPLIT_TOP_BOTTOM, {MAX, MAX, MAX, MAX}, 2, 4, {MAX, MAX, MAX, MAX}, {MAX, MAX, MAX, MAX}},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, {MIN, MIN, MIN, MIN}, 2, 4, {MIN, MIN, MIN, MIN}, {MIN, MIN, MIN, MIN}},
        {ovo::STEREO_SPLIT_TOP_BOTTOM, {-10, -20, -30, -40}, 2, 4, {-20, 200, -60, -79}, {-20, -40, -60, -79}},
    };
    Interleave(false);
    Profile().m_eye_order = ovo::STEREO_EYE_ORDER_NORMAL;
    for (const Case& each : cases) {
        Profile().m_split = each.m_split;
        const ovo::GlRect& r = each.m_rect;
        glViewport(r.m_x, r.m_y, r.m_width, r.m_height);
        glScissor(r.m_x, r.m_y, r.m_width, r.m_height);
        const Calls expected = {RectCall("glViewport", each.m_first), RectCall("glScissor", each.m_first),
                                RectCall("glViewport", each.m_other), RectCall("glScissor", each.m_other)};
        EXPECT_EQ(BothEyes(each.m_scale_x, each.m_scale_y), expected)
            << std::hex << each.m_split << std::dec << " " << RectCall("rect", r) << " scale " << each.m_scale_x;
    }
}

TEST(SaturatingMath, ConversionsHoldToTheInt32RangeAndTruncateWithinIt) {
    const std::pair<float, int32_t> truncations[] = {
        {0.99f, 0},  {-0.99f, 0}, {-59.5f, -59}, {2147483520.0f, 2147483520}, {2147483648.0f, MAX},
        {-2147483648.0f, MIN}, {-2147483904.0f, MIN}, {3e9f, MAX}, {-3e9f, MIN}, {INF, MAX}, {-INF, MIN},
        {NOT_A_NUMBER, 0}, {-NOT_A_NUMBER, 0}};
    for (const auto& [value, expected] : truncations) {
        EXPECT_EQ(ovo::SaturatingTrunc(value), expected) << value;
    }
    struct Pair {
        int32_t m_a;
        int32_t m_b;
        int32_t m_sum;
        int32_t m_product;
    } pairs[] = {{-10, -5, -15, 50}, {MAX, 1, MAX, MAX}, {MIN, -1, MIN, MAX}, {MAX, MIN, -1, MIN},
                 {MAX / 2, 2, MAX / 2 + 2, MAX - 1}, {MAX / 2 + 1, 2, MAX / 2 + 3, MAX},
                 {MIN / 2, 2, MIN / 2 + 2, MIN}, {MIN / 2 - 1, 2, MIN / 2 + 1, MIN}, {MIN, MIN, MIN, MAX}};
    for (const Pair& each : pairs) {
        EXPECT_EQ(ovo::SaturatingAdd(each.m_a, each.m_b), each.m_sum) << each.m_a << " + " << each.m_b;
        EXPECT_EQ(ovo::SaturatingMul(each.m_a, each.m_b), each.m_product) << each.m_a << " * " << each.m_b;
    }
}

class HostileSizesTest : public StereoFixture {
protected:
    void SetUp() override {
        StereoFixture::SetUp();
        Interleave(false);
    }

    ovo::Es2StereoLayer m_tracked{ovo::LAYER_SUBMODE_TRACKED};
};

// Without a target size (screen 800 x 480) the scale is infinite (screen size / 0) or NaN (0 / 0).
TEST_F(HostileSizesTest, PlainModeWithoutATargetSizeSaturatesTheScaledRectangles) {
    const struct {
        int32_t m_target_width;
        int32_t m_target_height;
        ovo::GlRect m_viewport;
        ovo::GlRect m_scissor;
        ovo::GlRect m_scaled_viewport;
        ovo::GlRect m_scaled_scissor;
    } cases[] = {
        {0, 0, {10, 20, 401, 243}, {0, 0, 800, 480}, {MAX, MAX, MAX, MAX}, {0, 0, MAX, MAX}},
        {0, 0, {-10, 0, 0, 243}, {MIN, MAX, -1, 1}, {MIN, 0, 0, MAX}, {MIN, MAX, MIN, MAX}},
        {0, 480, {10, 20, 401, 243}, {-4, 6, 101, 51}, {MAX, 20, MAX, 243}, {MIN, 6, MAX, 51}},
    };
    ovo::Es1ScaledLayer es1;
    ovo::Es2ScaledLayer es2;
    AnswerMatrix(GL_PROJECTION_MATRIX, PERSPECTIVE);
    for (ovo::GlLayer* layer : {static_cast<ovo::GlLayer*>(&es1), static_cast<ovo::GlLayer*>(&es2)}) {
        if (layer == &es2) UseEs2();
        for (const auto& each : cases) {
            Profile().m_target_width = each.m_target_width;
            Profile().m_target_height = each.m_target_height;
            Manager().UpdateScale();
            Manager().m_viewport = each.m_viewport;
            Manager().m_scissor = each.m_scissor;
            ResetRecorder();
            // The OpenGL ES 2.0 layer scales the scissor of its clears.
            if (layer == &es2) layer->glClear(Manager(), GL_COLOR_BUFFER_BIT);
            layer->glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
            const std::string viewport = RectCall("glViewport", each.m_scaled_viewport);
            const std::string scissor = RectCall("glScissor", each.m_scaled_scissor);
            const Calls expected = layer == &es1 ? Calls{viewport, scissor} : Calls{scissor, viewport};
            EXPECT_EQ(Only({"glViewport", "glScissor"}), expected) << RectCall("viewport", each.m_viewport);
        }
    }
}

TEST_F(HostileSizesTest, TrackedDoubleWidthsHoldAtTheInt32Range) {
    UseEs2();
    const std::pair<GLsizei, GLsizei> widths[] = {
        {128, 256}, {0, 0}, {-5, -10}, {1073741823, MAX - 1}, {1073741824, MAX}, {MAX, MAX},
        {-1073741824, MIN}, {-1073741825, MIN}, {MIN, MIN}};
    for (const auto& [width, doubled] : widths) {
        Profile().m_width = width;
        ResetRecorder();
        m_tracked.glClear(Manager(), GL_COLOR_BUFFER_BIT);
        m_tracked.glRenderbufferStorage(Manager(), GL_RENDERBUFFER, GL_DEPTH_COMPONENT16, width, 64);
        const std::string d = std::to_string(doubled);
        EXPECT_EQ(RecordedGlCalls(), (Calls{"glScissor(0, 0, " + d + ", 480)", "glClear(0x4000)",
                                            "glRenderbufferStorage(0x8D41, 0x81A5, " + d + ", 64)"}))
            << width;

        ResetRecorder();
        MakeRenderTexture(m_tracked, width);
        Calls images = {"glTexImage2D(0x0DE1, 0, 6408, " + std::to_string(width) + ", 64, 0, 0x1908, 0x1401, null)"};
        // A texture without a width is never specified again.
        if (width != 0) images.push_back("glTexImage2D(0x0DE1, 0, 6408, " + d + ", 64, 0, 0x1908, 0x1401, null)");
        EXPECT_EQ(Only({"glTexImage2D"}), images) << width;
    }
}

TEST_F(HostileSizesTest, TheSecondEyeOfADoubleWidthDrawSaturates) {
    UseEs2();
    struct Case {
        GLint m_x;
        GLsizei m_texture_width;
        GLint m_second_x;
    } cases[] = {{0, 128, 128}, {-10, -5, -15}, {MAX, 128, MAX}, {10, MAX, MAX},
                 {MIN, -1, MIN}, {-10, MIN, MIN}, {MAX, MIN, -1}};
    for (const Case& each : cases) {
        MakeRenderTexture(m_tracked, each.m_texture_width);
        Manager().m_viewport = {each.m_x, 0, 128, 64};
        EXPECT_EQ(Drawn(m_tracked, {"glViewport"}), (Calls{RectCall("glViewport", {each.m_x, 0, 128, 64}),
                                               RectCall("glViewport", {each.m_second_x, 0, 128, 64})}))
            << each.m_x << " + " << each.m_texture_width;
    }
}

// The sprite shift truncates eye distance x depth plane (-5 here) to whole units.
TEST_F(HostileSizesTest, SpriteShiftsOfExtremeEyeDistancesSaturate) {
    ovo::Es1SpriteStereoLayer sprites;
    AnswerMatrix(GL_PROJECTION_MATRIX, ORTHO);
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_TEXTURE_BINDING_2D, {3});
    struct Case {
        float m_distance;
        const char* m_first;
        const char* m_other;
    } cases[] = {
        {4e8f, "glTranslatef(-5e+06, 0, 0)", "glTranslatef(5e+06, 0, 0)"},
        {3e9f, "glTranslatef(-5.36871e+06, 0, 0)", "glTranslatef(5.36871e+06, 0, 0)"},
        {-3e9f, "glTranslatef(5.36871e+06, 0, 0)", "glTranslatef(-5.36871e+06, 0, 0)"},
        {INF, "glTranslatef(-5.36871e+06, 0, 0)", "glTranslatef(5.36871e+06, 0, 0)"},
        {-INF, "glTranslatef(5.36871e+06, 0, 0)", "glTranslatef(-5.36871e+06, 0, 0)"},
        {NOT_A_NUMBER, "glTranslatef(0, 0, 0)", "glTranslatef(0, 0, 0)"},
    };
    for (const Case& each : cases) {
        glTexParameterf(ovo::STEREO_PARAM_EYE_DISTANCE, GL_TEXTURE_MIN_FILTER, each.m_distance);
        Manager().m_depth_plane = -5.0f;
        EXPECT_EQ(Drawn(sprites, {"glTranslatef"}), (Calls{each.m_first, each.m_other})) << each.m_distance;
    }
}

}  // namespace
