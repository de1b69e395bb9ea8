#include "es2_scene/shader_program.h"

#include <cstdio>

namespace ovo_sample {

namespace {

constexpr GLsizei INFO_LOG_CAPACITY = 1024;

GLuint CompileShader(const char* program, const char* label, GLenum type, const char* source) {
    const GLuint shader = glCreateShader(type);
    glShaderSource(shader, 1, &source, nullptr);
    glCompileShader(shader);
    GLint compiled = GL_FALSE;
    glGetShaderiv(shader, GL_COMPILE_STATUS, &compiled);
    if (compiled == GL_TRUE) return shader;
    char log[INFO_LOG_CAPACITY] = "";
    glGetShaderInfoLog(shader, INFO_LOG_CAPACITY, nullptr, log);
    std::fprintf(stderr, "%s: the %s %s shader does not compile: %s\n", program, label,
                 type == GL_VERTEX_SHADER ? "vertex" : "fragment", log);
    glDeleteShader(shader);
    return 0;
}

}  // namespace

GLuint BuildProgram(const char* program, const char* label, const char* vertex_source,
                    const char* fragment_source) {
    const GLuint vertex = CompileShader(program, label, GL_VERTEX_SHADER, vertex_source);
    const GLuint fragment = CompileShader(program, label, GL_FRAGMENT_SHADER, fragment_source);
    if (vertex == 0 || fragment == 0) {
        glDeleteShader(vertex);
        glDeleteShader(fragment);
        return 0;
    }
    GLuint linked_program = glCreateProgram();
    glAttachShader(linked_program, vertex);
    glAttachShader(linked_program, fragment);
    glLinkProgram(linked_program);
    // The program keeps them alive while attached.
    glDeleteShader(vertex);
    glDeleteShader(fragment);
    GLint linked = GL_FALSE;
    glGetProgramiv(linked_program, GL_LINK_STATUS, &linked);
    if (linked == GL_TRUE) return linked_program;
    char log[INFO_LOG_CAPACITY] = "";
    glGetProgramInfoLog(linked_program, INFO_LOG_CAPACITY, nullptr, log);
    std::fprintf(stderr, "%s: the %s program does not link: %s\n", program, label, log);
    glDeleteProgram(linked_program);
    return 0;
}

}  // namespace ovo_sample
