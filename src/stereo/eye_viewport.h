#ifndef OVO_STEREO_EYE_VIEWPORT_H
#define OVO_STEREO_EYE_VIEWPORT_H

namespace ovo {

class StereoManager;

// +1 for eye 0, -1 for eye 1.
inline float EyeSign(int eye) { return eye == 0 ? 1.0f : -1.0f; }

// Viewport and scissor of one eye: the application's rectangles scaled into the eye's half
// (side by side or top and bottom). Nothing while interleaving: the mask picks the columns.
void ApplyEyeViewport(StereoManager& manager, int eye, float scale_x, float scale_y);

// Viewport and scissor scaled from the game's size to the output size, for one flat draw.
void ApplyScaledViewport(StereoManager& manager, float scale_x, float scale_y);

}  // namespace ovo

#endif
