#include "es2_scene/scene_programs.h"

#include <string>

#include "es2_scene/shader_program.h"

namespace ovo_sample {

namespace {

const char LIT_VERTEX_SHADER[] = R"(
uniform mat4 u_mvp;
uniform mat3 u_normal_matrix;
uniform vec3 u_light_direction;
uniform vec4 u_color;
attribute vec3 a_position;
attribute vec3 a_normal;
varying vec4 v_color;

void main() {
    vec3 normal = normalize(u_normal_matrix * a_normal);
    float diffuse = max(dot(normal, u_light_direction), 0.0);
    v_color = vec4(u_color.rgb * (0.3 + 0.7 * diffuse), u_color.a);
    gl_Position = u_mvp * vec4(a_position, 1.0);
}
)";

const char LIT_FRAGMENT_SHADER[] = R"(
precision mediump float;
varying vec4 v_color;

void main() {
    gl_FragColor = v_color;
}
)";

const char TEXTURED_VERTEX_SHADER[] = R"(
uniform mat4 u_mvp;
uniform vec2 u_uv_scale;
attribute vec4 a_position;
attribute vec2 a_uv;
varying vec2 v_uv;

void main() {
    v_uv = a_uv * u_uv_scale;
    gl_Position = u_mvp * a_position;
}
)";

const char TEXTURED_FRAGMENT_SHADER[] = R"(
precision mediump float;
uniform sampler2D u_texture;
uniform vec4 u_tint;
varying vec2 v_uv;

void main() {
    gl_FragColor = texture2D(u_texture, v_uv) * u_tint;
}
)";

const char FLAT_VERTEX_SHADER[] = R"(
uniform mat4 u_mvp;
attribute vec3 a_position;

void main() {
    gl_Position = u_mvp * vec4(a_position, 1.0);
}
)";

const char FLAT_FRAGMENT_SHADER[] = R"(
precision mediump float;
uniform vec4 u_color;

void main() {
    gl_FragColor = u_color;
}
)";

bool CreateLit(const char* program, const EyeShift& eye_shift, LitProgram* lit) {
    const std::string vertex = eye_shift.VertexShader(LIT_VERTEX_SHADER);
    lit->m_program = BuildProgram(program, "lit", vertex.c_str(), LIT_FRAGMENT_SHADER);
    if (lit->m_program == 0) return false;
    lit->m_position = glGetAttribLocation(lit->m_program, "a_position");
    lit->m_normal = glGetAttribLocation(lit->m_program, "a_normal");
    lit->m_mvp = glGetUniformLocation(lit->m_program, "u_mvp");
    lit->m_normal_matrix = glGetUniformLocation(lit->m_program, "u_normal_matrix");
    lit->m_light_direction = glGetUniformLocation(lit->m_program, "u_light_direction");
    lit->m_color = glGetUniformLocation(lit->m_program, "u_color");
    return true;
}

bool CreateTextured(const char* program, const EyeShift& eye_shift, TexturedProgram* textured) {
    const std::string vertex = eye_shift.VertexShader(TEXTURED_VERTEX_SHADER);
    textured->m_program =
        BuildProgram(program, "textured", vertex.c_str(), TEXTURED_FRAGMENT_SHADER);
    if (textured->m_program == 0) return false;
    textured->m_position = glGetAttribLocation(textured->m_program, "a_position");
    textured->m_uv = glGetAttribLocation(textured->m_program, "a_uv");
    textured->m_mvp = glGetUniformLocation(textured->m_program, "u_mvp");
    textured->m_uv_scale = glGetUniformLocation(textured->m_program, "u_uv_scale");
    textured->m_texture = glGetUniformLocation(textured->m_program, "u_texture");
    textured->m_tint = glGetUniformLocation(textured->m_program, "u_tint");
    return true;
}

bool CreateFlat(const char* program, const EyeShift& eye_shift, FlatProgram* flat) {
    const std::string vertex = eye_shift.VertexShader(FLAT_VERTEX_SHADER);
    flat->m_program = BuildProgram(program, "flat", vertex.c_str(), FLAT_FRAGMENT_SHADER);
    if (flat->m_program == 0) return false;
    flat->m_position = glGetAttribLocation(flat->m_program, "a_position");
    flat->m_mvp = glGetUniformLocation(flat->m_program, "u_mvp");
    flat->m_color = glGetUniformLocation(flat->m_program, "u_color");
    return true;
}

void DeleteProgram(GLuint* program) {
    if (*program != 0) glDeleteProgram(*program);
    *program = 0;
}

}  // namespace

bool CreateScenePrograms(const char* program, const EyeShift& eye_shift,
                         ScenePrograms* programs) {
    return CreateLit(program, eye_shift, &programs->m_lit) &&
           CreateTextured(program, eye_shift, &programs->m_textured) &&
           CreateFlat(program, eye_shift, &programs->m_flat);
}

void DeleteScenePrograms(ScenePrograms* programs) {
    DeleteProgram(&programs->m_lit.m_program);
    DeleteProgram(&programs->m_textured.m_program);
    DeleteProgram(&programs->m_flat.m_program);
}

}  // namespace ovo_sample
