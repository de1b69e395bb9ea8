#ifndef OVO_EGL_STENCIL_ATTRIBUTES_H
#define OVO_EGL_STENCIL_ATTRIBUTES_H

#include "core/gl_api.h"

namespace ovo {

// A copy of an EGL attribute list that asks for at least one stencil bit: a stencil size
// of 0 becomes 1, and a list without one gains "EGL_STENCIL_SIZE, 1" before its EGL_NONE.
// A null list counts as an empty one. The caller releases the copy with delete[].
EGLint* CopyWithStencil(const EGLint* attributes);

}  // namespace ovo

#endif
