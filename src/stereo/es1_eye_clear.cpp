#include "stereo/es1_eye_clear.h"

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "stereo/overlay_target.h"

namespace ovo {

void ClearBothEyes(StereoManager& manager, GLbitfield mask) {
    const StereoProfile& profile = *manager.m_profile;
    raw::glScissor(0, 0, profile.m_width, profile.m_height);
    manager.m_overlay->ClearScreen(mask);
}

}  // namespace ovo
