#ifndef OVO_TOOLS_OVO_FRAMES_PNG_READER_H
#define OVO_TOOLS_OVO_FRAMES_PNG_READER_H

#include <string>

#include "rgba_frame.h"

namespace ovo_frames {

// Reads any PNG (grey, palette, 16-bit, with or without alpha) as 8-bit RGBA; a file
// without alpha reads as opaque. On failure returns false and says why in `problem`.
bool ReadPng(const char* path, RgbaFrame* frame, std::string* problem);

}  // namespace ovo_frames

#endif
