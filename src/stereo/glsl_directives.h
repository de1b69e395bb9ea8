#ifndef OVO_STEREO_GLSL_DIRECTIVES_H
#define OVO_STEREO_GLSL_DIRECTIVES_H

#include <cstdint>

namespace ovo {

// How many bytes at the start of a shader's source nothing may be inserted in front of: its
// leading `#version` and `#extension` lines with the comments and blank lines among them, up
// to and with the last such line's end. 0 when the source starts otherwise. Reads no further
// than `length` bytes and stops at a NUL.
int32_t LeadingDirectivesLength(const char* source, int32_t length);

}  // namespace ovo

#endif
