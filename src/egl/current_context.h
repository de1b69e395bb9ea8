#ifndef OVO_EGL_CURRENT_CONTEXT_H
#define OVO_EGL_CURRENT_CONTEXT_H

#include <EGL/egl.h>

namespace ovo {

// The context that the calling thread last made current through eglMakeCurrent, or
// EGL_NO_CONTEXT. Kept here so that finding it costs no EGL call: every EGL call sets the
// error that eglGetError reports, and that error belongs to the application's last call.
EGLContext CurrentContext();
void NoteCurrentContext(EGLContext context);

}  // namespace ovo

#endif
