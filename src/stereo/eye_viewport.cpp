#include "stereo/eye_viewport.h"

#include "core/raw_gl.h"
#include "core/saturating_math.h"
#include "core/stereo_manager.h"

namespace ovo {

namespace {

// One rectangle as glViewport and glScissor take it; `Set` is either of the two.
using SetRect = void (*)(GLint, GLint, GLsizei, GLsizei);

// The sums are single precision, truncated toward zero. The width gets 0.5 before
// truncation: side by side, and the scaled flat draw.
void SetWidthRounded(SetRect set, const GlRect& r, float x_offset, float scale_x, float scale_y) {
    set(SaturatingTrunc(x_offset + static_cast<float>(r.m_x) * scale_x),
        SaturatingTrunc(static_cast<float>(r.m_y) * scale_y),
        SaturatingTrunc(0.5f + static_cast<float>(r.m_width) * scale_x),
        SaturatingTrunc(static_cast<float>(r.m_height) * scale_y));
}

// The height gets 0.5 before truncation: top and bottom.
void SetHeightRounded(SetRect set, const GlRect& r, float y_offset, float scale_x, float scale_y) {
    set(SaturatingTrunc(static_cast<float>(r.m_x) * scale_x),
        SaturatingTrunc(y_offset + static_cast<float>(r.m_y) * scale_y),
        SaturatingTrunc(static_cast<float>(r.m_width) * scale_x),
        SaturatingTrunc(0.5f + static_cast<float>(r.m_height) * scale_y));
}

void SetViewport(GLint x, GLint y, GLsizei w, GLsizei h) { raw::glViewport(x, y, w, h); }
void SetScissor(GLint x, GLint y, GLsizei w, GLsizei h) { raw::glScissor(x, y, w, h); }

}  // namespace

void ApplyEyeViewport(StereoManager& manager, int eye, float scale_x, float scale_y) {
    if (manager.m_interleave) return;
    const StereoProfile& profile = *manager.m_profile;
    // An unknown order counts eye 0 as the first.
    const int first = profile.m_eye_order == STEREO_EYE_ORDER_SWAPPED ? 1 : 0;
    if (profile.m_split == STEREO_SPLIT_SIDE_BY_SIDE) {
        const float offset = eye == first ? 0.0f : static_cast<float>(profile.m_width / 2);
        const float s = scale_x * 0.5f;
        SetWidthRounded(SetViewport, manager.m_viewport, offset, s, scale_y);
        SetWidthRounded(SetScissor, manager.m_scissor, offset, s, scale_y);
    } else if (profile.m_split == STEREO_SPLIT_TOP_BOTTOM) {
        // The first eye takes the upper half: larger y in window coordinates.
        const float offset = eye == first ? static_cast<float>(profile.m_height / 2) : 0.0f;
        const float s = scale_y * 0.5f;
        SetHeightRounded(SetViewport, manager.m_viewport, offset, scale_x, s);
        SetHeightRounded(SetScissor, manager.m_scissor, offset, scale_x, s);
    }
}

void ApplyScaledViewport(StereoManager& manager, float scale_x, float scale_y) {
    if (manager.m_interleave) return;
    SetWidthRounded(SetViewport, manager.m_viewport, 0.0f, scale_x, scale_y);
    SetWidthRounded(SetScissor, manager.m_scissor, 0.0f, scale_x, scale_y);
}

}  // namespace ovo
