// An OpenGL ES 1.1 game scene: lit cubes and a floor under a perspective projection, then
// a 2D HUD drawn with an orthographic projection, identity modelview and alpha blending.
#include <GLES/gl.h>

#include "cube_mesh.h"
#include "sample.h"

namespace {

struct Scene {
    float m_cube[CUBE_VERTEX_COUNT * CUBE_VERTEX_FLOATS];
    uint16_t m_indices[CUBE_INDEX_COUNT];
    int m_width, m_height;
} scene;

bool SetUp(int width, int height) {
    scene.m_width = width;
    scene.m_height = height;
    BuildCube(scene.m_cube, scene.m_indices);
    glEnable(GL_LIGHT0);
    const GLfloat direction[4] = {0.4f, 0.8f, 0.5f, 0.0f};
    glLightfv(GL_LIGHT0, GL_POSITION, direction);
    glShadeModel(GL_SMOOTH);
    return true;
}

void DrawCube(float x, float y, float z, float angle, const GLfloat color[4]) {
    glPushMatrix();
    glTranslatef(x, y, z);
    glRotatef(angle, 0, 1, 0);
    glRotatef(15, 1, 0, 0);
    glMaterialfv(GL_FRONT_AND_BACK, GL_AMBIENT_AND_DIFFUSE, color);
    const GLsizei stride = CUBE_VERTEX_FLOATS * sizeof(float);
    glVertexPointer(3, GL_FLOAT, stride, scene.m_cube);
    glNormalPointer(GL_FLOAT, stride, scene.m_cube + 3);
    glDrawElements(GL_TRIANGLES, CUBE_INDEX_COUNT, GL_UNSIGNED_SHORT, scene.m_indices);
    glPopMatrix();
}

void DrawWorld(int frame) {
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    float aspect = static_cast<float>(scene.m_width) / static_cast<float>(scene.m_height);
    glFrustumf(-0.5f * aspect, 0.5f * aspect, -0.5f, 0.5f, 1.0f, 60.0f);
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
    glTranslatef(0, -1.5f, -6);
    glRotatef(15, 1, 0, 0);

    glEnable(GL_DEPTH_TEST);
    glEnable(GL_CULL_FACE);
    glEnable(GL_LIGHTING);
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_NORMAL_ARRAY);

    const GLfloat floor_color[4] = {0.45f, 0.4f, 0.3f, 1};
    glMaterialfv(GL_FRONT_AND_BACK, GL_AMBIENT_AND_DIFFUSE, floor_color);
    const GLfloat floor[] = {-10, 0, 10, 10, 0, 10, -10, 0, -30, 10, 0, -30};
    const GLfloat up[] = {0, 1, 0, 0, 1, 0, 0, 1, 0, 0, 1, 0};
    glVertexPointer(3, GL_FLOAT, 0, floor);
    glNormalPointer(GL_FLOAT, 0, up);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);

    const GLfloat orange[4] = {0.95f, 0.55f, 0.1f, 1};
    const GLfloat teal[4] = {0.1f, 0.7f, 0.65f, 1};
    const GLfloat violet[4] = {0.6f, 0.3f, 0.85f, 1};
    float spin = 12.0f * frame;
    DrawCube(-1.8f, 0.5f, 1.0f, 30 + spin, orange);
    DrawCube(0.6f, 0.5f, -2.0f, -20, teal);
    DrawCube(3.0f, 0.5f, -8.0f, 45 - spin, violet);

    glDisableClientState(GL_NORMAL_ARRAY);
    glDisable(GL_LIGHTING);
    glDisable(GL_CULL_FACE);
}

void DrawQuad(float x, float y, float width, float height) {
    const GLfloat corners[] = {x, y, x + width, y, x, y + height, x + width, y + height};
    glVertexPointer(2, GL_FLOAT, 0, corners);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
}

// The HUD, in pixels: a translucent panel with a health bar and a score strip.
void DrawHud(int frame) {
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glOrthof(0, static_cast<float>(scene.m_width), 0, static_cast<float>(scene.m_height), -1, 1);
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
    glDisable(GL_DEPTH_TEST);
    glEnable(GL_BLEND);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);

    glColor4f(0.05f, 0.05f, 0.1f, 0.6f);
    DrawQuad(8, 8, 140, 40);
    glColor4f(0.9f, 0.15f, 0.15f, 0.85f);
    DrawQuad(16, 30, 100.0f - 10.0f * frame, 10);
    glColor4f(0.2f, 0.8f, 0.3f, 0.85f);
    DrawQuad(16, 16, 124, 8);
    glColor4f(1, 1, 1, 0.4f);
    DrawQuad(static_cast<float>(scene.m_width) - 72, static_cast<float>(scene.m_height) - 28, 64, 20);
    glColor4f(1, 1, 1, 1);
    glDisable(GL_BLEND);
}

void DrawFrame(int frame) {
    glViewport(0, 0, scene.m_width, scene.m_height);
    glClearColor(0.5f, 0.7f, 0.95f, 1);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    DrawWorld(frame);
    DrawHud(frame);
    glDisableClientState(GL_VERTEX_ARRAY);
}

}  // namespace

const Sample SAMPLE = {"es1_scene", 1, SetUp, DrawFrame};
