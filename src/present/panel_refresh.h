#ifndef OVO_PRESENT_PANEL_REFRESH_H
#define OVO_PRESENT_PANEL_REFRESH_H

namespace ovo {

class StereoManager;

// Once per swap: in the shader modes, about every 0.1 s of processor time, re-asserts the
// panel's 3D mode for the picture's orientation and polls the live-tuning file.
void RefreshPanel(StereoManager& manager);

}  // namespace ovo

#endif
