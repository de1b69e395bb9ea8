#include "egl/stencil_attributes.h"

#include <cstring>

namespace ovo {

EGLint* CopyWithStencil(const EGLint* attributes) {
    size_t pairs = 0;
    bool has_stencil = false;
    if (attributes != nullptr) {
        for (; attributes[2 * pairs] != EGL_NONE; ++pairs) {
            if (attributes[2 * pairs] == EGL_STENCIL_SIZE) has_stencil = true;
        }
    }
    size_t words = 2 * pairs + (has_stencil ? 1 : 3);
    EGLint* copy = new EGLint[words];
    if (pairs > 0) std::memcpy(copy, attributes, 2 * pairs * sizeof(EGLint));
    if (has_stencil) {
        for (size_t pair = 0; pair < pairs; ++pair) {
            if (copy[2 * pair] == EGL_STENCIL_SIZE && copy[2 * pair + 1] == 0) copy[2 * pair + 1] = 1;
        }
    } else {
        copy[2 * pairs] = EGL_STENCIL_SIZE;
        copy[2 * pairs + 1] = 1;
    }
    copy[words - 1] = EGL_NONE;
    return copy;
}

}  // namespace ovo
