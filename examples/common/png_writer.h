#ifndef OVO_EXAMPLES_COMMON_PNG_WRITER_H
#define OVO_EXAMPLES_COMMON_PNG_WRITER_H

#include <cstdint>

namespace ovo_sample {

// Writes `width` x `height` RGBA pixels, rows top first, to `path` as an 8-bit RGB PNG.
// The same pixels always give the same bytes (fixed compression, no time stamp), so renders
// compare as files. Alpha is left out: a device's screen never shows the framebuffer's
// alpha, and where blending left it below 255 image viewers would show see-through spots.
// The file appears complete or not at all; false when it cannot be written.
bool WritePng(const char* path, int32_t width, int32_t height, const uint8_t* rgba);

}  // namespace ovo_sample

#endif
