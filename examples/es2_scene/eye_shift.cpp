#include "es2_scene/eye_shift.h"

#include <algorithm>

namespace ovo_sample {

namespace {

const char EYE_SHIFT_DECLARATION[] = "uniform vec2 uZpDepthShift;\n";
const char EYE_SHIFT_STATEMENT[] =
    "gl_Position.x = gl_Position.x + (uZpDepthShift.y * min((uZpDepthShift.x * gl_Position.w) "
    "- gl_Position.z, 0.0));\n";
const char EYE_SHIFT_UNIFORM[] = "uZpDepthShift";

}  // namespace

std::string EyeShift::VertexShader(const char* source) const {
    std::string text = source;
    if (!m_reference.HasEye()) return text;
    // The scene's shaders have no comments, and main is their last function.
    text.insert(text.rfind('}'), EYE_SHIFT_STATEMENT);
    text.insert(text.find_first_not_of(" \t\r\n"), EYE_SHIFT_DECLARATION);
    return text;
}

void EyeShift::SetForCurrentProgram() {
    if (!m_reference.HasEye()) return;
    GLint program = 0;
    glGetIntegerv(GL_CURRENT_PROGRAM, &program);
    GLint framebuffer = 0;
    glGetIntegerv(GL_FRAMEBUFFER_BINDING, &framebuffer);
    const GLuint name = static_cast<GLuint>(program);
    const GLint location = glGetUniformLocation(name, EYE_SHIFT_UNIFORM);

    const bool into_window = framebuffer == 0;
    const bool drew_into_window =
        std::find(m_window_programs.begin(), m_window_programs.end(), name) !=
        m_window_programs.end();
    if (into_window && !drew_into_window) m_window_programs.push_back(name);

    float sign = m_reference.EyeSign();
    if (!into_window && !m_reference.m_texture_pass_per_eye) {
        sign = drew_into_window ? -1.0f : 0.0f;  // eye 1's, or the uniform's initial 0
    }
    glUniform2f(location, sign * m_reference.m_eye_angle, sign * m_reference.m_eye_distance);
}

}  // namespace ovo_sample
