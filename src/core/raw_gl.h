#ifndef OVO_CORE_RAW_GL_H
#define OVO_CORE_RAW_GL_H

#include "core/driver_hooks.h"

// The library's own GL calls: straight to the vendor through the calling thread's table,
// never through the exported entry points and their layer.
namespace ovo::raw {

#define OVO_GL_ENTRY(index, result, name, params, args) \
    inline result name params { return LoadSlot(CurrentHooks().name) args; }
#include "core/gl_entry_table.inc"

}  // namespace ovo::raw

#endif
