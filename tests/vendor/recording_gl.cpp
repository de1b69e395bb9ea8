// One recording OpenGL ES library; RECORDER_API says which one.
#define GL_GLEXT_PROTOTYPES 1
#include <GLES/gl.h>
#include <GLES/glext.h>
#include <GLES2/gl2.h>
#include <GLES2/gl2ext.h>

#include "recorder.h"

extern "C" {

#define OVO_GL_ENTRY(index, result, name, params, args)                       \
    __attribute__((visibility("default"))) result GL_APIENTRY name params {   \
        return RecordCall<RECORDER_API, index, result> args;                   \
    }
#include "core/gl_entry_table.inc"

}  // extern "C"
