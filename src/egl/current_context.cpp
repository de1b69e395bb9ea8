#include "egl/current_context.h"

namespace ovo {

namespace {
thread_local EGLContext g_current_context = EGL_NO_CONTEXT;
}  // namespace

EGLContext CurrentContext() { return g_current_context; }

void NoteCurrentContext(EGLContext context) { g_current_context = context; }

}  // namespace ovo
