// The OpenGL ES 2.0 drawing path of the column mask, with a program of its own: built once
// per share group, where the mask is first drawn. Compiled at every swap, it cost llvmpipe
// up to 20 ms a frame without Mesa's shader cache (bench/README.md).
#include <iterator>

#include "core/gl_state_table.h"
#include "core/raw_gl.h"
#include "present/composition_renderer.h"
#include "present/matrix4.h"

namespace ovo {

namespace {

// Each a one-string list that lives as long as the process, as glShaderSource takes it.
constexpr const char* COMPOSITION_VERTEX_SOURCE[] = {
    "attribute vec4 myVertex;uniform mat4 myPMVMatrix;void main(void){\tgl_Position = myPMVMatrix * myVertex;}"};
constexpr const char* COMPOSITION_FRAGMENT_SOURCE[] = {
    "uniform mediump vec4 color;void main (void){\tgl_FragColor = color;}"};

// Positions in COMPOSITION_GL2_SAVED.
enum CompositionGl2Saved : uint8_t {
    GL2_SAVED_PROGRAM,
    GL2_SAVED_COLOR_MASK,
    GL2_SAVED_DEPTH_MASK,
    GL2_SAVED_VIEWPORT,
    GL2_SAVED_SCISSOR_BOX,
    GL2_SAVED_BLEND,
    GL2_SAVED_DEPTH_TEST,
    GL2_SAVED_ARRAY_BUFFER,
    GL2_SAVED_ATTRIBUTE_0,
    GL2_SAVED_CULL_FACE,
    GL2_SAVED_CULL_FACE_MODE,
    GL2_SAVED_FRONT_FACE,
    GL2_SAVED_COUNT
};

constexpr GlStateItem COMPOSITION_GL2_SAVED[] = {
    {GL_STATE_PROGRAM, 0, false, {}},
    {GL_STATE_COLOR_MASK, 0, false, {}},
    {GL_STATE_DEPTH_MASK, 0, false, {}},
    {GL_STATE_VIEWPORT, 0, false, {}},
    {GL_STATE_SCISSOR_BOX, 0, false, {}},
    {GL_STATE_ENABLE, GL_BLEND, false, {}},
    {GL_STATE_ENABLE, GL_DEPTH_TEST, false, {}},
    {GL_STATE_ARRAY_BUFFER, 0, false, {}},
    {GL_STATE_VERTEX_ATTRIB, 0, false, {}},
    {GL_STATE_ENABLE, GL_CULL_FACE, false, {}},
    {GL_STATE_CULL_FACE_MODE, 0, false, {}},
    {GL_STATE_FRONT_FACE, 0, false, {}},
};
static_assert(std::size(COMPOSITION_GL2_SAVED) == GL2_SAVED_COUNT, "one position per item");

// The attribute binds its own buffer to be put back; the application's binding comes after.
constexpr uint8_t COMPOSITION_GL2_RESTORE_ORDER[] = {
    GL2_SAVED_BLEND,          GL2_SAVED_DEPTH_TEST,     GL2_SAVED_VIEWPORT,
    GL2_SAVED_SCISSOR_BOX,    GL2_SAVED_ATTRIBUTE_0,    GL2_SAVED_ARRAY_BUFFER,
    GL2_SAVED_CULL_FACE,      GL2_SAVED_CULL_FACE_MODE, GL2_SAVED_FRONT_FACE,
    GL2_SAVED_DEPTH_MASK,     GL2_SAVED_COLOR_MASK,     GL2_SAVED_PROGRAM,
};

constexpr GlStateItem COMPOSITION_GL2_SET[] = {
    {GL_STATE_COLOR_MASK, 0, true, {GL_FALSE, GL_FALSE, GL_FALSE, GL_FALSE}},
    {GL_STATE_DEPTH_MASK, 0, true, {GL_FALSE}},
    {GL_STATE_CULL_FACE_MODE, 0, true, {GL_BACK}},
    {GL_STATE_FRONT_FACE, 0, true, {GL_CCW}},
    {GL_STATE_ARRAY_BUFFER, 0, true, {0}},
};

constexpr GlStateItem COMPOSITION_GL2_DISABLED[] = {
    {GL_STATE_ENABLE, GL_CULL_FACE, true, {0}},
    {GL_STATE_ENABLE, GL_DEPTH_TEST, true, {0}},
};

GLuint CompileShader(GLenum type, const char* const* source) {
    GLuint shader = raw::glCreateShader(type);
    raw::glShaderSource(shader, 1, source, nullptr);
    raw::glCompileShader(shader);
    return shader;
}

// A failed compile or link is not looked at: the mask then draws nothing.
MaskProgram BuildMaskProgram() {
    MaskProgram built;
    built.m_program = raw::glCreateProgram();
    const GLuint vertex = CompileShader(GL_VERTEX_SHADER, COMPOSITION_VERTEX_SOURCE);
    const GLuint fragment = CompileShader(GL_FRAGMENT_SHADER, COMPOSITION_FRAGMENT_SOURCE);
    raw::glAttachShader(built.m_program, vertex);
    raw::glAttachShader(built.m_program, fragment);
    raw::glBindAttribLocation(built.m_program, 0, "myVertex");
    raw::glLinkProgram(built.m_program);
    // The program keeps what it needs; the shaders go when it goes.
    raw::glDeleteShader(vertex);
    raw::glDeleteShader(fragment);
    GLint linked = GL_FALSE;
    raw::glGetProgramiv(built.m_program, GL_LINK_STATUS, &linked);
    built.m_matrix_location = raw::glGetUniformLocation(built.m_program, "myPMVMatrix");
    built.m_color_location = raw::glGetUniformLocation(built.m_program, "color");
    return built;
}

}  // namespace

void MaskProgram::Delete() const { raw::glDeleteProgram(m_program); }

// A context of no known share group (past the registry's capacity, or destroyed while
// still current) has no group to keep the program for: it gets one for this frame only.
void CompositionRenderer::DrawLinesGl2(GLsizei width, GLsizei height, uint32_t share_group) {
    GlStateSnapshot saved;
    saved.Save(COMPOSITION_GL2_SAVED, std::size(COMPOSITION_GL2_SAVED));
    GlStateSnapshot::Set(COMPOSITION_GL2_SET, std::size(COMPOSITION_GL2_SET));
    Mat4PixelProjection(m_projection, static_cast<float>(width), static_cast<float>(height));
    raw::glViewport(0, 0, width, height);
    raw::glScissor(0, 0, width, height);
    GlStateSnapshot::Set(COMPOSITION_GL2_DISABLED, std::size(COMPOSITION_GL2_DISABLED));

    MaskProgram* kept = m_programs.Find(share_group);
    if (kept == nullptr && (kept = m_programs.Claim(share_group)) != nullptr) {
        *kept = BuildMaskProgram();
    }
    const MaskProgram program = kept != nullptr ? *kept : BuildMaskProgram();
    raw::glUseProgram(program.m_program);
    raw::glUniformMatrix4fv(program.m_matrix_location, 1, GL_FALSE, m_projection);
    raw::glUniform4f(program.m_color_location, 1.0f, 1.0f, 1.0f, 1.0f);
    raw::glEnableVertexAttribArray(0);
    raw::glVertexAttribPointer(0, 2, GL_FLOAT, GL_FALSE, 0, m_vertices);
    raw::glDrawArrays(GL_LINES, 0, 2 * m_line_count);
    if (kept == nullptr) program.Delete();
    saved.Restore(COMPOSITION_GL2_RESTORE_ORDER, std::size(COMPOSITION_GL2_RESTORE_ORDER));
}

}  // namespace ovo
