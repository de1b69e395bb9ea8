#ifndef OVO_EXAMPLES_COMMON_REFERENCE_OPTIONS_H
#define OVO_EXAMPLES_COMMON_REFERENCE_OPTIONS_H

#include <cstdint>

namespace ovo_sample {

// Which reference renderings a sample offers (SampleInfo::m_reference_options).
constexpr uint32_t REFERENCE_OPTION_EYE = 1;             // --eye, --eye-distance/-angle/-shift
constexpr uint32_t REFERENCE_OPTION_OVERLAY = 2;         // --overlay-reference
constexpr uint32_t REFERENCE_OPTION_VIEWPORT_SCALE = 4;  // --viewport-scale
constexpr uint32_t REFERENCE_OPTION_TEXTURE_PASS = 8;    // --texture-pass
constexpr uint32_t REFERENCE_OPTION_HUD = 16;            // --hud

constexpr int32_t REFERENCE_NO_EYE = -1;

// How the sample renders the image that a stereo conversion should produce, so that the
// converted frames can be checked against a rendering made without the converter: one eye
// of the pair (the eye axis and the shift axis are x), or the one scaled image.
struct ReferenceOptions {
    int32_t m_eye = REFERENCE_NO_EYE;
    float m_eye_distance = 0.0f;
    float m_eye_angle = 0.0f;
    float m_eye_shift = 0.0f;

    // Draws into the game's own framebuffers are made once per eye, each with that eye's
    // transform, instead of once with whatever transform the last window draw left.
    bool m_texture_pass_per_eye = false;

    // The HUD is collected in a texture and drawn into both halves of an overlay area of
    // m_overlay_width x m_overlay_height per eye, instead of being shifted per eye.
    bool m_overlay = false;
    float m_overlay_width = 0.0f;
    float m_overlay_height = 0.0f;

    // The HUD's draws are left out, as a converter shows the frame when it drops them.
    bool m_hud_left_out = false;

    // Every viewport the game sets is scaled by these factors.
    bool m_viewport_scaled = false;
    float m_scale_x = 1.0f;
    float m_scale_y = 1.0f;

    bool HasEye() const { return m_eye != REFERENCE_NO_EYE; }
    float EyeSign() const { return m_eye == 0 ? 1.0f : -1.0f; }
};

}  // namespace ovo_sample

#endif
