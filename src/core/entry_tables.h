#ifndef OVO_CORE_ENTRY_TABLES_H
#define OVO_CORE_ENTRY_TABLES_H

#include <cstddef>

// "(a, b)" -> ", a, b" and "()" -> "": lets a table row's parameter list follow a
// leading parameter of the library's own.
#define OVO_TAIL(...) __VA_OPT__(, ) __VA_ARGS__
#define OVO_PREPEND(first, list) (first OVO_TAIL list)

namespace ovo {

// A GL function's index: its slot in every DriverHooks table and its GlLayer operation.
enum GlEntryIndex : unsigned {
#define OVO_GL_ENTRY(index, result, name, params, args) GL_ENTRY_##name = index,
#include "core/gl_entry_table.inc"
    GL_ENTRY_COUNT
};
static_assert(GL_ENTRY_COUNT == 376, "the GL entry-point set has 376 names");

// An EGL function's slot in EglDriverTable.
enum EglEntryIndex : unsigned {
#define OVO_EGL_ENTRY(index, result, name, params, args) EGL_ENTRY_##name = index,
#define OVO_EGL_SLOT(index, name) EGL_ENTRY_##name = index,
#include "core/egl_entry_table.inc"
    EGL_ENTRY_COUNT
};
static_assert(EGL_ENTRY_COUNT == 40, "the EGL driver table has 40 slots");

// The names by index, each list ending with a null entry.
extern const char* const GlEntryTable[GL_ENTRY_COUNT + 1];
extern const char* const EglEntryTable[EGL_ENTRY_COUNT + 1];

}  // namespace ovo

#endif
