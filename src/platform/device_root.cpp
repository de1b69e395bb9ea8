#include "platform/device_path.h"

#ifndef OVO_DEVICE_ROOT
#error "OVO_DEVICE_ROOT must name the device root (empty on Android)"
#endif

namespace ovo {

const char DEVICE_ROOT[] = OVO_DEVICE_ROOT;

}  // namespace ovo
