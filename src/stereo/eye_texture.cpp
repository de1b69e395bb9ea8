#include "stereo/eye_texture.h"

#include "core/raw_gl.h"
#include "stereo/gl_state_guard.h"

namespace ovo {

namespace {

constexpr GLuint COPY_POSITION = 0;
constexpr GLuint COPY_TEXTURE_COORDINATE = 1;

constexpr char COPY_VERTEX_SHADER[] =
    "attribute vec2 aPosition;\n"
    "attribute vec2 aTexCoord;\n"
    "varying vec2 vTexCoord;\n"
    "void main() {\n"
    "    vTexCoord = aTexCoord;\n"
    "    gl_Position = vec4(aPosition, 0.0, 1.0);\n"
    "}\n";
constexpr char COPY_FRAGMENT_SHADER[] =
    "precision mediump float;\n"
    "uniform sampler2D uTexture;\n"
    "varying vec2 vTexCoord;\n"
    "void main() {\n"
    "    gl_FragColor = texture2D(uTexture, vTexCoord);\n"
    "}\n";

constexpr GLfloat QUAD_POSITIONS[8] = {-1, 1, -1, -1, 1, 1, 1, -1};
constexpr GLfloat LEFT_HALF[8] = {0, 1, 0, 0, 0.5f, 1, 0.5f, 0};
constexpr GLfloat RIGHT_HALF[8] = {0.5f, 1, 0.5f, 0, 1, 1, 1, 0};

GLuint CompileShader(GLenum type, const char* text) {
    const GLuint shader = raw::glCreateShader(type);
    raw::glShaderSource(shader, 1, &text, nullptr);
    raw::glCompileShader(shader);
    return shader;
}

// 0 when the program does not link: the copies then draw nothing.
GLuint CreateCopyProgram() {
    const GLuint vertex = CompileShader(GL_VERTEX_SHADER, COPY_VERTEX_SHADER);
    const GLuint fragment = CompileShader(GL_FRAGMENT_SHADER, COPY_FRAGMENT_SHADER);
    GLuint program = raw::glCreateProgram();
    raw::glAttachShader(program, vertex);
    raw::glAttachShader(program, fragment);
    raw::glBindAttribLocation(program, COPY_POSITION, "aPosition");
    raw::glBindAttribLocation(program, COPY_TEXTURE_COORDINATE, "aTexCoord");
    raw::glLinkProgram(program);
    // The program keeps what it needs; the shaders go when it goes.
    raw::glDeleteShader(vertex);
    raw::glDeleteShader(fragment);
    GLint linked = GL_FALSE;
    raw::glGetProgramiv(program, GL_LINK_STATUS, &linked);
    if (linked != GL_FALSE) return program;
    raw::glDeleteProgram(program);
    return 0;
}

// A colour texture without storage yet, attached to a framebuffer of its own.
void CreateTarget(EyeTexture& eye) {
    raw::glGenTextures(1, &eye.m_texture);
    raw::glBindTexture(GL_TEXTURE_2D, eye.m_texture);
    raw::glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
    raw::glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    raw::glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    raw::glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE);
    raw::glGenFramebuffers(1, &eye.m_framebuffer);
    raw::glBindFramebuffer(GL_FRAMEBUFFER, eye.m_framebuffer);
    raw::glFramebufferTexture2D(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D,
                                eye.m_texture, 0);
    eye.m_width = 0;
    eye.m_height = 0;
}

}  // namespace

void EyeTexture::Resize(GLuint width, GLuint height) {
    if (width != 0 && height != 0 && (width != m_width || height != m_height)) {
        GlStateGuard guard;
        guard.Save(GUARD_TEXTURE);
        raw::glBindTexture(GL_TEXTURE_2D, m_texture);
        raw::glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, static_cast<GLsizei>(width),
                          static_cast<GLsizei>(height), 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
        guard.Restore();
    }
    m_width = width;
    m_height = height;
}

void EyeTexture::CopyHalfLeft() const { CopyHalf(LEFT_HALF); }

void EyeTexture::CopyHalfRight() const { CopyHalf(RIGHT_HALF); }

void EyeTexture::CopyHalf(const GLfloat* coordinates) const {
    GlStateGuard guard;
    guard.Save(GUARD_ALL);
    raw::glDisable(GL_DEPTH_TEST);
    raw::glBindFramebuffer(GL_FRAMEBUFFER, m_framebuffer);
    raw::glUseProgram(m_program);
    raw::glEnableVertexAttribArray(COPY_POSITION);
    raw::glEnableVertexAttribArray(COPY_TEXTURE_COORDINATE);
    // The quad lives in client memory: with the game's vertex buffer still bound its
    // addresses would be read as offsets into that buffer.
    raw::glBindBuffer(GL_ARRAY_BUFFER, 0);
    raw::glVertexAttribPointer(COPY_POSITION, 2, GL_FLOAT, GL_FALSE, 0, QUAD_POSITIONS);
    raw::glVertexAttribPointer(COPY_TEXTURE_COORDINATE, 2, GL_FLOAT, GL_FALSE, 0, coordinates);
    raw::glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
    guard.Restore();
}

void EyeTexturePair::Create() {
    GlStateGuard guard;
    guard.Save(GUARD_TEXTURE | GUARD_FRAMEBUFFER);
    const GLuint program = CreateCopyProgram();
    for (EyeTexture& eye : m_eyes) {
        CreateTarget(eye);
        eye.m_program = program;
    }
    guard.Restore();
}

void EyeTexturePair::Delete() const {
    for (const EyeTexture& eye : m_eyes) {
        raw::glDeleteFramebuffers(1, &eye.m_framebuffer);
        raw::glDeleteTextures(1, &eye.m_texture);
    }
    raw::glDeleteProgram(m_eyes[0].m_program);
}

}  // namespace ovo
