#ifndef OVO_TESTS_SUPPORT_RENDER_TEXTURE_DRAW_H
#define OVO_TESTS_SUPPORT_RENDER_TEXTURE_DRAW_H

// What the one tracked game does that makes the library keep eye textures: a texture
// attached to a framebuffer (a render texture), then drawn to the window. Through the
// exported GL functions of whatever library the program links.
#include <GLES2/gl2.h>

#include <initializer_list>

// A texture sampled over the quad of attribute 0 "position", which spans the viewport.
constexpr char SAMPLING_VERTEX_SHADER[] =
    "attribute vec2 position; varying vec2 coordinate;"
    "void main() { coordinate = position * 0.5 + 0.5; gl_Position = vec4(position, 0.0, 1.0); }";
constexpr char SAMPLING_FRAGMENT_SHADER[] =
    "precision mediump float; uniform sampler2D picture; varying vec2 coordinate;"
    "void main() { gl_FragColor = texture2D(picture, coordinate); }";

// The program of the two shaders, with attribute 0 named "position", in the current context.
inline GLuint LinkProgram(const char* vertex, const char* fragment) {
    const GLuint program = glCreateProgram();
    for (GLenum type : {GL_VERTEX_SHADER, GL_FRAGMENT_SHADER}) {
        const GLuint shader = glCreateShader(type);
        glShaderSource(shader, 1, type == GL_VERTEX_SHADER ? &vertex : &fragment, nullptr);
        glCompileShader(shader);
        glAttachShader(program, shader);
        glDeleteShader(shader);
    }
    glBindAttribLocation(program, 0, "position");
    glLinkProgram(program);
    return program;
}

// Draws the quad of attribute 0 over the viewport with `program`.
inline void DrawViewportQuad(GLuint program) {
    static const GLfloat QUAD[] = {-1, -1, 1, -1, -1, 1, 1, 1};
    glUseProgram(program);
    glBindBuffer(GL_ARRAY_BUFFER, 0);
    glEnableVertexAttribArray(0);
    glVertexAttribPointer(0, 2, GL_FLOAT, GL_FALSE, 0, QUAD);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
}

struct RenderTextureDraw {
    GLuint m_texture = 0;
    GLuint m_framebuffer = 0;
    GLuint m_program = 0;

    // In the current context, which keeps them; a `size` x `size` texture.
    void Create(GLsizei size) {
        glGenTextures(1, &m_texture);
        glBindTexture(GL_TEXTURE_2D, m_texture);
        glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, size, size, 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
        glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_NEAREST);
        glGenFramebuffers(1, &m_framebuffer);
        glBindFramebuffer(GL_FRAMEBUFFER, m_framebuffer);
        glFramebufferTexture2D(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D, m_texture, 0);
        glClearColor(0.5f, 0.25f, 0.75f, 1.0f);
        glClear(GL_COLOR_BUFFER_BIT);
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        m_program = LinkProgram(SAMPLING_VERTEX_SHADER, SAMPLING_FRAGMENT_SHADER);
    }

    // Samples the texture over the whole window (framebuffer 0) of the current context.
    void DrawToWindow() const {
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        glBindTexture(GL_TEXTURE_2D, m_texture);
        DrawViewportQuad(m_program);
    }
};

#endif
