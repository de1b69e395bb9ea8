#ifndef OVO_TOOLS_GL_OBJECT_COUNT_RESIDENT_MEMORY_H
#define OVO_TOOLS_GL_OBJECT_COUNT_RESIDENT_MEMORY_H

namespace ovo_gl_count {

// The process's resident memory in kB (VmRSS of /proc/self/status); -1 when it cannot be
// read. Allocates nothing, so that reading it does not move it.
long ResidentKilobytes();

}  // namespace ovo_gl_count

#endif
