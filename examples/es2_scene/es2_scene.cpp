// An OpenGL ES 2.0 game scene: a ground plane and lit, textured and flat cubes at several
// depths under a perspective projection, three shader programs, and a render-to-texture
// pass whose image is shown on one of the cubes.
#include <GLES2/gl2.h>

#include <cstdio>

#include "cube_mesh.h"
#include "mat4.h"
#include "sample.h"

namespace {

const char* const VERTEX_LIT = R"(
attribute vec3 aPosition;
attribute vec3 aNormal;
uniform mat4 uMvp;
uniform mat4 uModel;
varying float vLight;
void main() {
    vec3 normal = normalize((uModel * vec4(aNormal, 0.0)).xyz);
    vLight = 0.3 + 0.7 * max(dot(normal, normalize(vec3(0.4, 0.8, 0.5))), 0.0);
    gl_Position = uMvp * vec4(aPosition, 1.0);
})";
const char* const FRAGMENT_LIT = R"(
precision mediump float;
uniform vec4 uColor;
varying float vLight;
void main() { gl_FragColor = vec4(uColor.rgb * vLight, uColor.a); })";

const char* const VERTEX_TEXTURED = R"(
attribute vec3 aPosition;
attribute vec2 aTexCoord;
uniform mat4 uMvp;
varying vec2 vTexCoord;
void main() {
    vTexCoord = aTexCoord;
    gl_Position = uMvp * vec4(aPosition, 1.0);
})";
const char* const FRAGMENT_TEXTURED = R"(
precision mediump float;
uniform sampler2D uTexture;
varying vec2 vTexCoord;
void main() { gl_FragColor = texture2D(uTexture, vTexCoord); })";

const char* const VERTEX_FLAT = R"(
attribute vec3 aPosition;
uniform mat4 uMvp;
void main() { gl_Position = uMvp * vec4(aPosition, 1.0); })";
const char* const FRAGMENT_FLAT = R"(
precision mediump float;
uniform vec4 uColor;
void main() { gl_FragColor = uColor; })";

constexpr GLuint ATTRIBUTE_POSITION = 0;
constexpr GLuint ATTRIBUTE_NORMAL = 1;
constexpr GLuint ATTRIBUTE_TEXCOORD = 2;
constexpr int TARGET_SIZE = 128;

struct Program {
    GLuint m_id;
    GLint m_mvp;
    GLint m_model;
    GLint m_color;
};

struct Scene {
    Program m_lit, m_textured, m_flat;
    GLuint m_cube_vertices, m_cube_indices, m_ground;
    GLuint m_target_framebuffer, m_target_texture, m_target_depth;
    float m_aspect;
} scene;

GLuint Compile(GLenum kind, const char* source) {
    GLuint shader = glCreateShader(kind);
    glShaderSource(shader, 1, &source, nullptr);
    glCompileShader(shader);
    GLint compiled = 0;
    glGetShaderiv(shader, GL_COMPILE_STATUS, &compiled);
    if (!compiled) {
        char log[512] = "";
        glGetShaderInfoLog(shader, sizeof(log), nullptr, log);
        std::fprintf(stderr, "es2_scene: shader does not compile: %s\n", log);
        return 0;
    }
    return shader;
}

bool Link(Program& program, const char* vertex, const char* fragment) {
    GLuint vertex_shader = Compile(GL_VERTEX_SHADER, vertex);
    GLuint fragment_shader = Compile(GL_FRAGMENT_SHADER, fragment);
    if (vertex_shader == 0 || fragment_shader == 0) return false;
    program.m_id = glCreateProgram();
    glAttachShader(program.m_id, vertex_shader);
    glAttachShader(program.m_id, fragment_shader);
    glBindAttribLocation(program.m_id, ATTRIBUTE_POSITION, "aPosition");
    glBindAttribLocation(program.m_id, ATTRIBUTE_NORMAL, "aNormal");
    glBindAttribLocation(program.m_id, ATTRIBUTE_TEXCOORD, "aTexCoord");
    glLinkProgram(program.m_id);
    GLint linked = 0;
    glGetProgramiv(program.m_id, GL_LINK_STATUS, &linked);
    program.m_mvp = glGetUniformLocation(program.m_id, "uMvp");
    program.m_model = glGetUniformLocation(program.m_id, "uModel");
    program.m_color = glGetUniformLocation(program.m_id, "uColor");
    return linked != 0;
}

bool SetUp(int width, int height) {
    scene.m_aspect = static_cast<float>(width) / static_cast<float>(height);
    if (!Link(scene.m_lit, VERTEX_LIT, FRAGMENT_LIT) ||
        !Link(scene.m_textured, VERTEX_TEXTURED, FRAGMENT_TEXTURED) ||
        !Link(scene.m_flat, VERTEX_FLAT, FRAGMENT_FLAT)) {
        return false;
    }
    float vertices[CUBE_VERTEX_COUNT * CUBE_VERTEX_FLOATS];
    uint16_t indices[CUBE_INDEX_COUNT];
    BuildCube(vertices, indices);
    glGenBuffers(1, &scene.m_cube_vertices);
    glBindBuffer(GL_ARRAY_BUFFER, scene.m_cube_vertices);
    glBufferData(GL_ARRAY_BUFFER, sizeof(vertices), vertices, GL_STATIC_DRAW);
    glGenBuffers(1, &scene.m_cube_indices);
    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, scene.m_cube_indices);
    glBufferData(GL_ELEMENT_ARRAY_BUFFER, sizeof(indices), indices, GL_STATIC_DRAW);
    const float ground[] = {-8, 0, -8, 8, 0, -8, -8, 0, 8, 8, 0, 8};
    glGenBuffers(1, &scene.m_ground);
    glBindBuffer(GL_ARRAY_BUFFER, scene.m_ground);
    glBufferData(GL_ARRAY_BUFFER, sizeof(ground), ground, GL_STATIC_DRAW);

    glGenTextures(1, &scene.m_target_texture);
    glBindTexture(GL_TEXTURE_2D, scene.m_target_texture);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, TARGET_SIZE, TARGET_SIZE, 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    glGenRenderbuffers(1, &scene.m_target_depth);
    glBindRenderbuffer(GL_RENDERBUFFER, scene.m_target_depth);
    glRenderbufferStorage(GL_RENDERBUFFER, GL_DEPTH_COMPONENT16, TARGET_SIZE, TARGET_SIZE);
    glGenFramebuffers(1, &scene.m_target_framebuffer);
    glBindFramebuffer(GL_FRAMEBUFFER, scene.m_target_framebuffer);
    glFramebufferTexture2D(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D, scene.m_target_texture, 0);
    glFramebufferRenderbuffer(GL_FRAMEBUFFER, GL_DEPTH_ATTACHMENT, GL_RENDERBUFFER, scene.m_target_depth);
    bool complete = glCheckFramebufferStatus(GL_FRAMEBUFFER) == GL_FRAMEBUFFER_COMPLETE;
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
    glEnable(GL_DEPTH_TEST);
    glEnable(GL_CULL_FACE);
    return complete;
}

void BindCube(bool normals, bool texcoords) {
    const GLsizei stride = CUBE_VERTEX_FLOATS * sizeof(float);
    glBindBuffer(GL_ARRAY_BUFFER, scene.m_cube_vertices);
    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, scene.m_cube_indices);
    glEnableVertexAttribArray(ATTRIBUTE_POSITION);
    glVertexAttribPointer(ATTRIBUTE_POSITION, 3, GL_FLOAT, GL_FALSE, stride, nullptr);
    if (normals) {
        glEnableVertexAttribArray(ATTRIBUTE_NORMAL);
        glVertexAttribPointer(ATTRIBUTE_NORMAL, 3, GL_FLOAT, GL_FALSE, stride,
                              reinterpret_cast<const void*>(3 * sizeof(float)));
    } else {
        glDisableVertexAttribArray(ATTRIBUTE_NORMAL);
    }
    if (texcoords) {
        glEnableVertexAttribArray(ATTRIBUTE_TEXCOORD);
        glVertexAttribPointer(ATTRIBUTE_TEXCOORD, 2, GL_FLOAT, GL_FALSE, stride,
                              reinterpret_cast<const void*>(6 * sizeof(float)));
    } else {
        glDisableVertexAttribArray(ATTRIBUTE_TEXCOORD);
    }
}

void DrawLitCube(const Mat4& view_projection, const Mat4& model, const float color[4]) {
    glUseProgram(scene.m_lit.m_id);
    Mat4 mvp = view_projection * model;
    glUniformMatrix4fv(scene.m_lit.m_mvp, 1, GL_FALSE, mvp.m);
    glUniformMatrix4fv(scene.m_lit.m_model, 1, GL_FALSE, model.m);
    glUniform4fv(scene.m_lit.m_color, 1, color);
    BindCube(true, false);
    glDrawElements(GL_TRIANGLES, CUBE_INDEX_COUNT, GL_UNSIGNED_SHORT, nullptr);
}

// The offscreen pass: a spinning cube on its own background, later used as a texture.
void DrawIntoTarget(int frame) {
    glBindFramebuffer(GL_FRAMEBUFFER, scene.m_target_framebuffer);
    glViewport(0, 0, TARGET_SIZE, TARGET_SIZE);
    glClearColor(0.9f, 0.8f, 0.3f, 1.0f);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    Mat4 view_projection = Mat4::Perspective(50, 1, 0.5f, 20) * Mat4::Translation(0, 0, -3);
    const float red[4] = {0.8f, 0.15f, 0.1f, 1};
    DrawLitCube(view_projection, Mat4::Rotation(30.0f + 15.0f * frame, 0.6f, 0.8f, 0), red);
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
}

void DrawFrame(int frame) {
    DrawIntoTarget(frame);
    glViewport(0, 0, SAMPLE_WIDTH, SAMPLE_HEIGHT);
    glClearColor(0.35f, 0.55f, 0.85f, 1.0f);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    Mat4 view_projection = Mat4::Perspective(60, scene.m_aspect, 0.5f, 50) *
                           Mat4::Rotation(20, 1, 0, 0) * Mat4::Translation(0, -2.5f, -7);

    // Ground, flat colour.
    glUseProgram(scene.m_flat.m_id);
    glUniformMatrix4fv(scene.m_flat.m_mvp, 1, GL_FALSE, view_projection.m);
    const float grass[4] = {0.25f, 0.5f, 0.2f, 1};
    glUniform4fv(scene.m_flat.m_color, 1, grass);
    glBindBuffer(GL_ARRAY_BUFFER, scene.m_ground);
    glEnableVertexAttribArray(ATTRIBUTE_POSITION);
    glDisableVertexAttribArray(ATTRIBUTE_NORMAL);
    glDisableVertexAttribArray(ATTRIBUTE_TEXCOORD);
    glVertexAttribPointer(ATTRIBUTE_POSITION, 3, GL_FLOAT, GL_FALSE, 0, nullptr);
    glDisable(GL_CULL_FACE);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
    glEnable(GL_CULL_FACE);

    // Lit cubes near and far.
    const float blue[4] = {0.2f, 0.35f, 0.9f, 1};
    const float white[4] = {0.9f, 0.9f, 0.9f, 1};
    float spin = 10.0f * frame;
    DrawLitCube(view_projection, Mat4::Translation(-2.2f, 0.5f, 1.5f) * Mat4::Rotation(25 + spin, 0, 1, 0), blue);
    DrawLitCube(view_projection, Mat4::Translation(2.5f, 0.5f, -4) * Mat4::Rotation(-40, 0, 1, 0), white);

    // The cube that shows the offscreen image.
    glUseProgram(scene.m_textured.m_id);
    Mat4 mvp = view_projection * Mat4::Translation(0.3f, 1.2f, -1) * Mat4::Rotation(35 - spin, 0, 1, 0) *
               Mat4::Rotation(20, 1, 0, 0);
    glUniformMatrix4fv(scene.m_textured.m_mvp, 1, GL_FALSE, mvp.m);
    glBindTexture(GL_TEXTURE_2D, scene.m_target_texture);
    BindCube(false, true);
    glDrawElements(GL_TRIANGLES, CUBE_INDEX_COUNT, GL_UNSIGNED_SHORT, nullptr);
}

}  // namespace

const Sample SAMPLE = {"es2_scene", 2, SetUp, DrawFrame};
