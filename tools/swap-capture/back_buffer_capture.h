#ifndef OVO_TOOLS_SWAP_CAPTURE_BACK_BUFFER_CAPTURE_H
#define OVO_TOOLS_SWAP_CAPTURE_BACK_BUFFER_CAPTURE_H

#include <cstdint>

namespace ovo_swap_capture {

// Writes the current context's window-system back buffer, `width` x `height`, to `path` as
// the sample programs write their frames (RGB PNG, top row first), reading it through
// Mesa's GLES library whatever the context's API version. The context's GL state is as it
// was afterwards. False when Mesa's GLES cannot be loaded or the file cannot be written.
bool CaptureBackBuffer(int32_t width, int32_t height, const char* path);

}  // namespace ovo_swap_capture

#endif
