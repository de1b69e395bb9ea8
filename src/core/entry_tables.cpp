#include "core/entry_tables.h"

namespace ovo {

const char* const GlEntryTable[GL_ENTRY_COUNT + 1] = {
#define OVO_GL_ENTRY(index, result, name, params, args) #name,
#include "core/gl_entry_table.inc"
    nullptr,
};

const char* const EglEntryTable[EGL_ENTRY_COUNT + 1] = {
#define OVO_EGL_ENTRY(index, result, name, params, args) #name,
#define OVO_EGL_SLOT(index, name) #name,
#include "core/egl_entry_table.inc"
    nullptr,
};

}  // namespace ovo
