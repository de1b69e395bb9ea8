#ifndef OVO_CORE_GL_API_H
#define OVO_CORE_GL_API_H

// GL and EGL types and constants for the library's own code. The ES 2.0 and EGL
// prototypes stay hidden: the library reaches the vendor through its raw calls only,
// never through its own exported entry points. (The ES 1.x header has no such switch.)
#ifndef GL_GLES_PROTOTYPES
#define GL_GLES_PROTOTYPES 0
#endif
#ifndef EGL_EGL_PROTOTYPES
#define EGL_EGL_PROTOTYPES 0
#endif

#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <GLES/gl.h>
#include <GLES/glext.h>
#include <GLES2/gl2.h>
#include <GLES2/gl2ext.h>

#endif
