// The exported GL functions, defined against the Khronos prototypes so that the compiler
// rejects any signature that differs from the headers.
#define GL_GLEXT_PROTOTYPES 1
#define GL_GLES_PROTOTYPES 1
#include <GLES/gl.h>
#include <GLES/glext.h>
#include <GLES2/gl2.h>
#include <GLES2/gl2ext.h>

#include <type_traits>

#include "entry/export.h"
#include "entry/gl_dispatch.h"

extern "C" {

#define OVO_GL_ENTRY(index, result, name, params, args)                                       \
    static_assert(std::is_same<decltype(&::name), result(GL_APIENTRY*) params>::value, #name); \
    OVO_EXPORT result GL_APIENTRY name params {                                                \
        return ovo::GlEntryPoint<ovo::GL_ENTRY_##name>::Call OVO_PREPEND(                      \
            ovo::StereoManager::instance(), args);                                             \
    }
#include "core/gl_entry_table.inc"

}  // extern "C"
