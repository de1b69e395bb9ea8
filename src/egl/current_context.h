#ifndef OVO_EGL_CURRENT_CONTEXT_H
#define OVO_EGL_CURRENT_CONTEXT_H

#include <EGL/egl.h>

namespace ovo {

// What the calling thread last made current through eglMakeCurrent. Kept here so that
// finding it costs no EGL call: every EGL call sets the error that eglGetError reports,
// and that error belongs to the application's last call.
struct EglBinding {
    EGLDisplay m_display;
    EGLSurface m_draw;
    EGLSurface m_read;
    EGLContext m_context;
    // The application ended the context, a surface or the display while they were
    // current: they live on only while they stay current, so nothing may switch away.
    bool m_ending;
    // The draw surface holds the column mask: it was presented, or masked at its first
    // stereo draw, since it was made current.
    bool m_surface_masked;
};

const EglBinding& CurrentBinding();
// The context of CurrentBinding(), or EGL_NO_CONTEXT.
EGLContext CurrentContext();
// A successful eglMakeCurrent (or eglReleaseThread, with nothing current).
void NoteCurrentBinding(EGLDisplay display, EGLSurface draw, EGLSurface read,
                        EGLContext context);
// The calling thread's draw surface now holds the column mask.
void NoteSurfaceMasked();
// The application ended `handle` of `display`, a context or a surface, or with a null
// handle the whole display. Marks the calling thread's binding when that is in it.
void NoteEndedHandle(EGLDisplay display, const void* handle);

}  // namespace ovo

#endif
