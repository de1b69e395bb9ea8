#include "es1_scene/es1_scene.h"

#include <cmath>

#include "common/eye_projection.h"
#include "common/game_viewport.h"
#include "common/gl_texture.h"
#include "common/rgba_image.h"
#include "es1_scene/cube_draw.h"

namespace ovo_sample {

namespace {

constexpr float PI = 3.14159265358979f;
constexpr GLfloat VIEW_NEAR = 1.0f;
constexpr GLfloat VIEW_FAR = 60.0f;
constexpr float VIEW_FOVY_DEGREES = 50.0f;
constexpr GLfloat CAMERA_PITCH = 16.0f;
constexpr GLfloat CAMERA_HEIGHT = 3.2f;
constexpr GLfloat CAMERA_DISTANCE = 9.0f;

constexpr int32_t FLOOR_TILES = 12;
constexpr GLfloat FLOOR_TILE_SIZE = 2.0f;
constexpr int32_t CRATE_TEXTURE_SIZE = 64;
constexpr int32_t CRATE_CHECKER_CELL = 16;

constexpr GLfloat SKY[4] = {0.55f, 0.70f, 0.85f, 1.0f};
constexpr GLfloat FOG_START = 10.0f;
constexpr GLfloat FOG_END = 32.0f;
// Directional (w = 0), towards the light.
constexpr GLfloat LIGHT_DIRECTION[4] = {0.4f, 0.8f, 0.45f, 0.0f};
constexpr GLfloat LIGHT_AMBIENT[4] = {0.3f, 0.3f, 0.3f, 1.0f};
constexpr GLfloat LIGHT_DIFFUSE[4] = {0.8f, 0.8f, 0.8f, 1.0f};

struct Crate {
    GLfloat m_position[3];
    GLfloat m_size;
    GLfloat m_yaw;
    GLfloat m_spin;  // degrees per frame
    GLfloat m_color[3];
};

constexpr Crate CRATES[] = {
    {{-2.8f, 0.7f, 1.5f}, 0.7f, 20.0f, 12.0f, {0.9f, 0.25f, 0.2f}},
    {{3.0f, 0.5f, 2.5f}, 0.5f, -30.0f, -20.0f, {0.25f, 0.45f, 0.95f}},
    {{-4.5f, 1.2f, -6.0f}, 1.2f, 45.0f, 0.0f, {0.95f, 0.8f, 0.25f}},
    {{5.5f, 1.5f, -12.0f}, 1.5f, 10.0f, 0.0f, {0.6f, 0.3f, 0.8f}},
};

}  // namespace

bool Es1Scene::Init(const char* program, int32_t width, int32_t height) {
    m_width = width;
    m_height = height;
    BuildFloor();
    const RgbaImage crate = MakeCheckerboard(CRATE_TEXTURE_SIZE, CRATE_CHECKER_CELL,
                                             {200, 150, 90, 255}, {130, 85, 45, 255});
    m_crate_texture = CreateTexture(crate, {GL_LINEAR, GL_LINEAR, GL_REPEAT, GL_REPEAT});
    m_hud.Init(width, height, m_reference);
    return !m_reference.m_overlay || m_overlay.Create(program, m_surface);
}

void Es1Scene::Release() {
    m_overlay.Release();
    m_hud.Release();
    DeleteTexture(&m_crate_texture);
}

void Es1Scene::UseCrateTexture(uint32_t texture) { ReplaceTexture(&m_crate_texture, texture); }

void Es1Scene::BuildFloor() {
    const GLfloat origin = -FLOOR_TILES * FLOOR_TILE_SIZE * 0.5f;
    for (int32_t row = 0; row < FLOOR_TILES; ++row) {
        for (int32_t column = 0; column < FLOOR_TILES; ++column) {
            const GLfloat x0 = origin + column * FLOOR_TILE_SIZE;
            const GLfloat z0 = origin + row * FLOOR_TILE_SIZE;
            const GLfloat x1 = x0 + FLOOR_TILE_SIZE;
            const GLfloat z1 = z0 + FLOOR_TILE_SIZE;
            const bool light = ((row + column) & 1) != 0;
            const GLubyte near_green = light ? 120 : 85;
            const GLubyte far_green = light ? 160 : 115;
            const GLubyte n[4] = {40, near_green, 35, 255};
            const GLubyte f[4] = {60, far_green, 45, 255};
            // Counter-clockwise seen from above.
            const FloorVertex tile[6] = {
                {{x0, 0, z1}, {n[0], n[1], n[2], n[3]}}, {{x1, 0, z1}, {n[0], n[1], n[2], n[3]}},
                {{x1, 0, z0}, {f[0], f[1], f[2], f[3]}}, {{x0, 0, z1}, {n[0], n[1], n[2], n[3]}},
                {{x1, 0, z0}, {f[0], f[1], f[2], f[3]}}, {{x0, 0, z0}, {f[0], f[1], f[2], f[3]}},
            };
            m_floor.insert(m_floor.end(), tile, tile + 6);
        }
    }
}

void Es1Scene::DrawFrame(int32_t frame) {
    SetGameViewport(m_reference, 0, 0, m_width, m_height);
    glClearColor(SKY[0], SKY[1], SKY[2], SKY[3]);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);

    SetUpPerspective();
    glEnable(GL_DEPTH_TEST);
    glDepthFunc(GL_LEQUAL);
    glEnable(GL_CULL_FACE);
    glShadeModel(GL_SMOOTH);
    glEnable(GL_FOG);
    glFogf(GL_FOG_MODE, GL_LINEAR);
    glFogf(GL_FOG_START, FOG_START);
    glFogf(GL_FOG_END, FOG_END);
    glFogfv(GL_FOG_COLOR, SKY);

    DrawFloor();
    DrawCrates(frame);
    DrawTower(frame);

    DrawHud(frame);
}

void Es1Scene::DrawHud(int32_t frame) const {
    if (m_reference.m_hud_left_out) return;
    if (!m_reference.m_overlay) {
        m_hud.Draw(frame);
        return;
    }
    m_overlay.Begin();
    m_hud.Draw(frame);
    m_overlay.End();
    m_overlay.ComposeStereo(m_reference);
}

void Es1Scene::SetUpPerspective() const {
    const GLfloat top = VIEW_NEAR * std::tan(VIEW_FOVY_DEGREES * 0.5f * PI / 180.0f);
    const GLfloat right = top * m_width / m_height;
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glFrustumf(-right, right, -top, top, VIEW_NEAR, VIEW_FAR);
    LoadEyePerspective(m_reference);

    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
    glRotatef(CAMERA_PITCH, 1.0f, 0.0f, 0.0f);
    glTranslatef(0.0f, -CAMERA_HEIGHT, -CAMERA_DISTANCE);
    // Set after the camera so the light stays fixed in the world.
    glLightfv(GL_LIGHT0, GL_POSITION, LIGHT_DIRECTION);
}

void Es1Scene::DrawFloor() const {
    glDisable(GL_LIGHTING);
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_COLOR_ARRAY);
    glVertexPointer(3, GL_FLOAT, sizeof(FloorVertex), m_floor[0].m_position);
    glColorPointer(4, GL_UNSIGNED_BYTE, sizeof(FloorVertex), m_floor[0].m_color);
    glDrawArrays(GL_TRIANGLES, 0, static_cast<GLsizei>(m_floor.size()));
    glDisableClientState(GL_COLOR_ARRAY);
    glDisableClientState(GL_VERTEX_ARRAY);
}

void Es1Scene::DrawCrates(int32_t frame) const {
    glEnable(GL_LIGHTING);
    glEnable(GL_LIGHT0);
    glLightfv(GL_LIGHT0, GL_AMBIENT, LIGHT_AMBIENT);
    glLightfv(GL_LIGHT0, GL_DIFFUSE, LIGHT_DIFFUSE);
    glEnable(GL_COLOR_MATERIAL);
    // Scaled cubes have scaled normals.
    glEnable(GL_NORMALIZE);

    for (const Crate& crate : CRATES) {
        glPushMatrix();
        glTranslatef(crate.m_position[0], crate.m_position[1], crate.m_position[2]);
        glRotatef(crate.m_yaw + crate.m_spin * frame, 0.0f, 1.0f, 0.0f);
        glScalef(crate.m_size, crate.m_size, crate.m_size);
        glColor4f(crate.m_color[0], crate.m_color[1], crate.m_color[2], 1.0f);
        DrawCube(false);
        glPopMatrix();
    }

    // A wooden crate: the lit colour modulates the texture.
    glEnable(GL_TEXTURE_2D);
    glBindTexture(GL_TEXTURE_2D, m_crate_texture);
    glTexEnvf(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_MODULATE);
    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);
    glPushMatrix();
    glTranslatef(1.1f, 0.8f, 1.0f);
    glRotatef(-25.0f + 8.0f * frame, 0.0f, 1.0f, 0.0f);
    glScalef(0.8f, 0.8f, 0.8f);
    DrawCube(true);
    glPopMatrix();
    glDisable(GL_TEXTURE_2D);
}

void Es1Scene::DrawTower(int32_t frame) const {
    // Each block sits on the one below and turns relative to it, as a game's jointed
    // models do on the matrix stack.
    const GLfloat colors[3][3] = {{0.8f, 0.8f, 0.8f}, {0.3f, 0.8f, 0.5f}, {0.9f, 0.5f, 0.2f}};
    glPushMatrix();
    glTranslatef(-1.0f, 0.0f, -3.5f);
    for (int32_t level = 0; level < 3; ++level) {
        const GLfloat size = 0.9f - 0.2f * level;
        glTranslatef(0.0f, size, 0.0f);
        glRotatef(15.0f + 10.0f * frame, 0.0f, 1.0f, 0.0f);
        glPushMatrix();
        glScalef(size, size, size);
        glColor4f(colors[level][0], colors[level][1], colors[level][2], 1.0f);
        DrawCube(false);
        glPopMatrix();
        glTranslatef(0.0f, size, 0.0f);
    }
    glPopMatrix();
    glDisable(GL_NORMALIZE);
    glDisable(GL_COLOR_MATERIAL);
    glDisable(GL_LIGHTING);
}

}  // namespace ovo_sample
