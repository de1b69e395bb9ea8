#ifndef OVO_EXAMPLES_COMMON_PNG_WRITER_H
#define OVO_EXAMPLES_COMMON_PNG_WRITER_H

#include <cstdint>
#include <vector>

namespace ovo_sample {

// An 8-bit RGB PNG of `width` x `height` RGBA pixels, rows top first, in stored
// (uncompressed) deflate blocks. The same pixels always give the same bytes, so renders
// compare as files. Alpha is left out: a device's screen never shows the framebuffer's
// alpha, and where blending left it below 255 image viewers would show see-through spots.
std::vector<uint8_t> EncodePng(int32_t width, int32_t height, const uint8_t* rgba);

// EncodePng written to `path`; false when the file cannot be written.
bool WritePng(const char* path, int32_t width, int32_t height, const uint8_t* rgba);

}  // namespace ovo_sample

#endif
