#include "es2_scene/es2_scene.h"

#include <cstddef>

#include "common/cube_mesh.h"
#include "common/gl_texture.h"

namespace ovo_sample {

namespace {

constexpr GLsizei MONITOR_SIZE = 128;
constexpr int32_t FLOOR_TEXTURE_SIZE = 64;
constexpr int32_t FLOOR_CHECKER_CELL = 8;
constexpr float FLOOR_HALF_SIZE = 10.0f;
constexpr float FLOOR_TILING = 10.0f;

constexpr float CAMERA_EYE[3] = {0.0f, 3.0f, 7.5f};
constexpr float CAMERA_TARGET[3] = {0.0f, 0.6f, 0.0f};
constexpr float CAMERA_UP[3] = {0.0f, 1.0f, 0.0f};
constexpr float CAMERA_FOVY = 55.0f;
constexpr float CAMERA_NEAR = 0.5f;
constexpr float CAMERA_FAR = 60.0f;

// World space, towards the light, about unit length.
constexpr float LIGHT_DIRECTION[3] = {0.40f, 0.80f, 0.45f};

constexpr float SKY_COLOR[4] = {0.45f, 0.65f, 0.90f, 1.0f};
constexpr float MONITOR_CLEAR[4] = {0.12f, 0.08f, 0.25f, 1.0f};
constexpr float WHITE[4] = {1.0f, 1.0f, 1.0f, 1.0f};

struct Crate {
    float m_position[3];
    float m_scale[3];
    float m_yaw;
    float m_spin;  // degrees per frame
    float m_color[4];
};

// Front to back, as games sort their opaque draws.
constexpr Crate CRATES[] = {
    {{2.6f, 0.5f, 2.0f}, {0.5f, 0.5f, 0.5f}, 10.0f, -15.0f, {0.20f, 0.35f, 0.95f, 1.0f}},
    {{-2.3f, 0.6f, 0.6f}, {0.6f, 0.6f, 0.6f}, 30.0f, 10.0f, {0.90f, 0.20f, 0.15f, 1.0f}},
    {{0.6f, 1.0f, -3.5f}, {1.0f, 1.0f, 1.0f}, 15.0f, 0.0f, {0.25f, 0.80f, 0.30f, 1.0f}},
    {{-3.8f, 1.5f, -6.0f}, {0.4f, 1.5f, 0.4f}, 0.0f, 0.0f, {0.70f, 0.70f, 0.72f, 1.0f}},
    {{4.5f, 2.0f, -9.0f}, {2.0f, 2.0f, 2.0f}, 40.0f, 0.0f, {0.85f, 0.60f, 0.20f, 1.0f}},
};

constexpr float PYRAMID_SHADES[PYRAMID_SIDE_COUNT] = {1.0f, 0.8f, 0.55f, 0.7f};
constexpr float PYRAMID_COLOR[3] = {0.95f, 0.85f, 0.20f};
constexpr float GLASS_COLOR[4] = {0.55f, 0.95f, 1.0f, 0.35f};

struct HudRect {
    float m_x;  // pixels from the bottom-left corner
    float m_y;
    float m_width;
    float m_height;
    float m_color[4];
};

constexpr HudRect HUD_RECTS[] = {
    {8, 206, 124, 26, {0.0f, 0.0f, 0.0f, 0.55f}},      // panel behind the bars
    {12, 220, 116, 8, {0.35f, 0.05f, 0.05f, 0.9f}},    // health, empty
    {12, 220, 80, 8, {0.90f, 0.15f, 0.10f, 0.9f}},     // health
    {12, 210, 116, 6, {0.05f, 0.15f, 0.35f, 0.9f}},    // energy, empty
    {12, 210, 58, 6, {0.20f, 0.60f, 1.00f, 0.9f}},     // energy
    {248, 8, 64, 64, {0.02f, 0.20f, 0.05f, 0.65f}},    // radar
    {278, 38, 4, 4, {1.0f, 1.0f, 1.0f, 0.9f}},         // radar: the player
    {260, 52, 4, 4, {1.0f, 0.2f, 0.2f, 0.9f}},         // radar: an enemy
    {159, 112, 2, 16, {1.0f, 1.0f, 1.0f, 0.7f}},       // crosshair
    {152, 119, 16, 2, {1.0f, 1.0f, 1.0f, 0.7f}},
};

Mat4 Model(const float position[3], const float scale[3], float yaw) {
    return Mat4Multiply(Mat4Translate(position[0], position[1], position[2]),
                        Mat4Multiply(Mat4RotateY(yaw), Mat4Scale(scale[0], scale[1], scale[2])));
}

// Points the attributes that a program uses (-1: unused) at MeshVertex fields of `buffer`.
void UseMeshVertices(GLuint buffer, GLint position, GLint normal, GLint uv) {
    glBindBuffer(GL_ARRAY_BUFFER, buffer);
    const GLint locations[] = {position, normal, uv};
    const GLint sizes[] = {3, 3, 2};
    const size_t offsets[] = {offsetof(MeshVertex, m_position), offsetof(MeshVertex, m_normal),
                              offsetof(MeshVertex, m_uv)};
    for (int i = 0; i < 3; ++i) {
        if (locations[i] < 0) continue;
        glEnableVertexAttribArray(static_cast<GLuint>(locations[i]));
        glVertexAttribPointer(static_cast<GLuint>(locations[i]), sizes[i], GL_FLOAT, GL_FALSE,
                              sizeof(MeshVertex), reinterpret_cast<const void*>(offsets[i]));
    }
}

void DisableAttributes(GLint first, GLint second) {
    if (first >= 0) glDisableVertexAttribArray(static_cast<GLuint>(first));
    if (second >= 0) glDisableVertexAttribArray(static_cast<GLuint>(second));
}

void DrawCubeElements(GLuint indices) {
    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, indices);
    glDrawElements(GL_TRIANGLES, CUBE_INDEX_COUNT, GL_UNSIGNED_SHORT, nullptr);
}

}  // namespace

bool Es2Scene::Init(const char* program, int32_t width, int32_t height) {
    m_width = width;
    m_height = height;
    if (!CreateScenePrograms(program, m_eye_shift, &m_programs)) return false;
    CreateSceneMeshes(&m_meshes);
    if (!m_monitor.Create(program, MONITOR_SIZE)) return false;

    const RgbaImage floor = MakeCheckerboard(FLOOR_TEXTURE_SIZE, FLOOR_CHECKER_CELL,
                                             {215, 215, 205, 255}, {90, 110, 95, 255});
    m_floor_texture =
        CreateTexture(floor, {GL_LINEAR_MIPMAP_LINEAR, GL_LINEAR, GL_REPEAT, GL_REPEAT});
    glGenerateMipmap(GL_TEXTURE_2D);

    glUseProgram(m_programs.m_textured.m_program);
    glUniform1i(m_programs.m_textured.m_texture, 0);
    glUseProgram(m_programs.m_lit.m_program);
    glUniform3fv(m_programs.m_lit.m_light_direction, 1, LIGHT_DIRECTION);
    return true;
}

void Es2Scene::Release() {
    DeleteTexture(&m_floor_texture);
    m_monitor.Delete();
    DeleteSceneMeshes(&m_meshes);
    DeleteScenePrograms(&m_programs);
    m_eye_shift.ForgetPrograms();
}

void Es2Scene::UseFloorTexture(uint32_t texture) { ReplaceTexture(&m_floor_texture, texture); }

void Es2Scene::DrawFrame(int32_t frame) {
    DrawMonitorPicture(frame);
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
    SetWindowViewport();
    DrawWorld(frame);
    DrawHud();
}

// A scaled viewport truncates every value toward zero, in float arithmetic; the monitor's
// framebuffer keeps its own.
void Es2Scene::SetWindowViewport() const {
    if (!m_reference.m_viewport_scaled) {
        glViewport(0, 0, m_width, m_height);
        return;
    }
    glViewport(0, 0, static_cast<GLsizei>(m_width * m_reference.m_scale_x),
               static_cast<GLsizei>(m_height * m_reference.m_scale_y));
}

void Es2Scene::UseProgram(GLuint program) {
    glUseProgram(program);
    m_eye_shift.SetForCurrentProgram();
}

void Es2Scene::DrawMonitorPicture(int32_t frame) {
    m_monitor.Bind();
    glClearColor(MONITOR_CLEAR[0], MONITOR_CLEAR[1], MONITOR_CLEAR[2], MONITOR_CLEAR[3]);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    glEnable(GL_DEPTH_TEST);
    glEnable(GL_CULL_FACE);
    glDisable(GL_BLEND);

    const float eye[3] = {0.0f, 1.5f, 4.0f};
    const float target[3] = {0.0f, 0.0f, 0.0f};
    const Mat4 view_projection = Mat4Multiply(Mat4Perspective(50.0f, 1.0f, 1.0f, 20.0f),
                                              Mat4LookAt(eye, target, CAMERA_UP));
    const float orange[4] = {1.0f, 0.55f, 0.10f, 1.0f};
    const float teal[4] = {0.10f, 0.85f, 0.75f, 1.0f};
    DrawLitCube(view_projection,
                Mat4Multiply(Mat4RotateY(30.0f + 20.0f * frame), Mat4RotateX(20.0f)), orange);
    const float small[3] = {0.35f, 0.35f, 0.35f};
    const float beside[3] = {1.3f, -0.6f, 1.0f};
    DrawLitCube(view_projection, Model(beside, small, -15.0f * frame), teal);
}

void Es2Scene::DrawWorld(int32_t frame) {
    glClearColor(SKY_COLOR[0], SKY_COLOR[1], SKY_COLOR[2], SKY_COLOR[3]);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    glEnable(GL_DEPTH_TEST);
    glDepthFunc(GL_LESS);
    glDepthMask(GL_TRUE);
    glEnable(GL_CULL_FACE);
    glCullFace(GL_BACK);
    glDisable(GL_BLEND);

    const Mat4 view_projection =
        Mat4Multiply(Mat4Perspective(CAMERA_FOVY, static_cast<float>(m_width) / m_height,
                                     CAMERA_NEAR, CAMERA_FAR),
                     Mat4LookAt(CAMERA_EYE, CAMERA_TARGET, CAMERA_UP));

    DrawGround(view_projection);
    for (const Crate& crate : CRATES) {
        DrawLitCube(view_projection,
                    Model(crate.m_position, crate.m_scale, crate.m_yaw + crate.m_spin * frame),
                    crate.m_color);
    }
    const float pyramid_position[3] = {1.9f, 0.0f, -0.8f};
    const float unit[3] = {1.0f, 1.0f, 1.0f};
    DrawPyramid(view_projection, Model(pyramid_position, unit, 25.0f));

    // The crate with this frame's picture on every face.
    const float monitor_position[3] = {-0.3f, 0.75f, 1.2f};
    const float monitor_scale[3] = {0.7f, 0.7f, 0.7f};
    const Mat4 monitor = Mat4Multiply(Model(monitor_position, monitor_scale, -30.0f),
                                      Mat4RotateX(-10.0f));
    DrawTexturedCube(Mat4Multiply(view_projection, monitor), m_monitor.Texture());

    // Transparent last: tested against the depth buffer but not writing it.
    glEnable(GL_BLEND);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    glDepthMask(GL_FALSE);
    glDisable(GL_CULL_FACE);
    const float glass_position[3] = {1.2f, 0.8f, 2.6f};
    const float glass_scale[3] = {0.8f, 0.8f, 1.0f};
    DrawFlatQuad(Mat4Multiply(view_projection, Model(glass_position, glass_scale, -20.0f)),
                 GLASS_COLOR);
    glDepthMask(GL_TRUE);
}

void Es2Scene::DrawHud() {
    glDisable(GL_DEPTH_TEST);
    glDisable(GL_CULL_FACE);
    glEnable(GL_BLEND);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    const Mat4 pixels = Mat4Ortho(0.0f, static_cast<float>(m_width), 0.0f,
                                  static_cast<float>(m_height), -1.0f, 1.0f);
    for (const HudRect& rect : HUD_RECTS) {
        // The quad spans -1..1: scale to half the size, move to the centre.
        const float half_width = rect.m_width * 0.5f;
        const float half_height = rect.m_height * 0.5f;
        const Mat4 place = Mat4Multiply(
            Mat4Translate(rect.m_x + half_width, rect.m_y + half_height, 0.0f),
            Mat4Scale(half_width, half_height, 1.0f));
        DrawFlatQuad(Mat4Multiply(pixels, place), rect.m_color);
    }
    glDisable(GL_BLEND);
}

void Es2Scene::DrawLitCube(const Mat4& view_projection, const Mat4& model,
                           const float color[4]) {
    const LitProgram& lit = m_programs.m_lit;
    UseProgram(lit.m_program);
    const Mat4 mvp = Mat4Multiply(view_projection, model);
    float normal_matrix[9];
    Mat4NormalMatrix(model, normal_matrix);
    glUniformMatrix4fv(lit.m_mvp, 1, GL_FALSE, mvp.m);
    glUniformMatrix3fv(lit.m_normal_matrix, 1, GL_FALSE, normal_matrix);
    glUniform4fv(lit.m_color, 1, color);
    UseMeshVertices(m_meshes.m_cube_vertices, lit.m_position, lit.m_normal, -1);
    DrawCubeElements(m_meshes.m_cube_indices);
    DisableAttributes(lit.m_position, lit.m_normal);
}

void Es2Scene::DrawTexturedCube(const Mat4& mvp, GLuint texture) {
    const TexturedProgram& textured = m_programs.m_textured;
    UseProgram(textured.m_program);
    glActiveTexture(GL_TEXTURE0);
    glBindTexture(GL_TEXTURE_2D, texture);
    glUniformMatrix4fv(textured.m_mvp, 1, GL_FALSE, mvp.m);
    glUniform2f(textured.m_uv_scale, 1.0f, 1.0f);
    glUniform4fv(textured.m_tint, 1, WHITE);
    UseMeshVertices(m_meshes.m_cube_vertices, textured.m_position, -1, textured.m_uv);
    DrawCubeElements(m_meshes.m_cube_indices);
    DisableAttributes(textured.m_position, textured.m_uv);
}

void Es2Scene::DrawGround(const Mat4& view_projection) {
    const TexturedProgram& textured = m_programs.m_textured;
    UseProgram(textured.m_program);
    glActiveTexture(GL_TEXTURE0);
    glBindTexture(GL_TEXTURE_2D, m_floor_texture);
    // The quad faces +Z; tipped back it faces up.
    const Mat4 model = Mat4Multiply(Mat4Scale(FLOOR_HALF_SIZE, 1.0f, FLOOR_HALF_SIZE),
                                    Mat4RotateX(-90.0f));
    const Mat4 mvp = Mat4Multiply(view_projection, model);
    glUniformMatrix4fv(textured.m_mvp, 1, GL_FALSE, mvp.m);
    glUniform2f(textured.m_uv_scale, FLOOR_TILING, FLOOR_TILING);
    glUniform4fv(textured.m_tint, 1, WHITE);
    UseMeshVertices(m_meshes.m_quad_vertices, textured.m_position, -1, textured.m_uv);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, QUAD_VERTEX_COUNT);
    DisableAttributes(textured.m_position, textured.m_uv);
}

void Es2Scene::DrawPyramid(const Mat4& view_projection, const Mat4& model) {
    const FlatProgram& flat = m_programs.m_flat;
    UseProgram(flat.m_program);
    const Mat4 mvp = Mat4Multiply(view_projection, model);
    glUniformMatrix4fv(flat.m_mvp, 1, GL_FALSE, mvp.m);
    glBindBuffer(GL_ARRAY_BUFFER, m_meshes.m_pyramid_vertices);
    glEnableVertexAttribArray(static_cast<GLuint>(flat.m_position));
    glVertexAttribPointer(static_cast<GLuint>(flat.m_position), 3, GL_FLOAT, GL_FALSE, 0,
                          nullptr);
    // A shade per side stands in for lighting.
    for (GLsizei side = 0; side < PYRAMID_SIDE_COUNT; ++side) {
        const float shade = PYRAMID_SHADES[side];
        glUniform4f(flat.m_color, PYRAMID_COLOR[0] * shade, PYRAMID_COLOR[1] * shade,
                    PYRAMID_COLOR[2] * shade, 1.0f);
        glDrawArrays(GL_TRIANGLES, side * PYRAMID_FACE_VERTICES, PYRAMID_FACE_VERTICES);
    }
    glUniform4f(flat.m_color, 0.3f, 0.25f, 0.05f, 1.0f);
    const GLsizei base_first = PYRAMID_SIDE_COUNT * PYRAMID_FACE_VERTICES;
    glDrawArrays(GL_TRIANGLES, base_first, PYRAMID_VERTEX_COUNT - base_first);
    DisableAttributes(flat.m_position, -1);
}

void Es2Scene::DrawFlatQuad(const Mat4& mvp, const float color[4]) {
    const FlatProgram& flat = m_programs.m_flat;
    UseProgram(flat.m_program);
    glUniformMatrix4fv(flat.m_mvp, 1, GL_FALSE, mvp.m);
    glUniform4fv(flat.m_color, 1, color);
    UseMeshVertices(m_meshes.m_quad_vertices, flat.m_position, -1, -1);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, QUAD_VERTEX_COUNT);
    DisableAttributes(flat.m_position, -1);
}

}  // namespace ovo_sample
