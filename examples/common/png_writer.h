#ifndef OVO_EXAMPLES_PNG_WRITER_H
#define OVO_EXAMPLES_PNG_WRITER_H

#include <cstdint>

// Writes 8-bit RGBA pixels, rows given bottom-up as glReadPixels returns them, as a PNG
// file. The output depends on the pixels only, so equal files mean equal images.
bool WritePng(const char* path, int width, int height, const uint8_t* bottom_up_rgba);

#endif
