#ifndef OVO_STEREO_FRAME_PARAMETERS_H
#define OVO_STEREO_FRAME_PARAMETERS_H

namespace ovo {

class StereoManager;

// At every swap, before the vendor's: the viewer's eye estimate, the depth planes' restart,
// the overlay collected during the frame drawn into it, the frame count.
void BeginFrame(StereoManager& manager);

// The ramp: at each change of the bound 2D texture within a frame, one live parameter steps
// from its configured value toward zero, then keeps a small value of the opposite sign.
// The ES 1.x form ramps the eye distance, angle or shift and restarts all three per frame.
void StepRampEs1(StereoManager& manager);
// The ES 2.0 form ramps the eye angle or distance and restarts those two per frame.
void StepRampEs2(StereoManager& manager);

// Moves a sprite draw to the next depth plane when the bound 2D texture changed.
void StepDepthPlane(StereoManager& manager);

}  // namespace ovo

#endif
