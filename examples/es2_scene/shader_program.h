#ifndef OVO_EXAMPLES_ES2_SCENE_SHADER_PROGRAM_H
#define OVO_EXAMPLES_ES2_SCENE_SHADER_PROGRAM_H

#include <GLES2/gl2.h>

namespace ovo_sample {

// Compiles and links a vertex and a fragment shader. Answers 0 after printing the info
// log under `program` and `label` when either step fails.
GLuint BuildProgram(const char* program, const char* label, const char* vertex_source,
                    const char* fragment_source);

}  // namespace ovo_sample

#endif
