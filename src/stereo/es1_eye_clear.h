#ifndef OVO_STEREO_ES1_EYE_CLEAR_H
#define OVO_STEREO_ES1_EYE_CLEAR_H

#include "core/gl_api.h"

namespace ovo {

class StereoManager;

// glClear of the OpenGL ES 1.x stereo layers: over the whole output, and always on the
// window surface, so that the application's clears never erase the collected overlay.
void ClearBothEyes(StereoManager& manager, GLbitfield mask);

}  // namespace ovo

#endif
