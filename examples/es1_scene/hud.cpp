#include "es1_scene/hud.h"

#include <cmath>

#include "common/eye_projection.h"
#include "common/gl_texture.h"
#include "common/rgba_image.h"

namespace ovo_sample {

namespace {

constexpr int32_t ICON_SIZE = 32;
constexpr float PANEL_HEIGHT = 34.0f;
constexpr int32_t AMMO_SLOTS = 6;
constexpr int32_t AMMO_LOADED = 4;
constexpr float RADAR_SIZE = 60.0f;
constexpr float RADAR_MARGIN = 8.0f;
constexpr float CROSSHAIR_GAP = 3.0f;
constexpr float CROSSHAIR_REACH = 9.0f;

// Bottom-left corner, size; as a triangle strip.
void DrawRect(float x, float y, float width, float height) {
    const GLfloat corners[] = {x, y, x + width, y, x, y + height, x + width, y + height};
    glVertexPointer(2, GL_FLOAT, 0, corners);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
}

void DrawTexturedRect(float x, float y, float size) {
    static const GLfloat UVS[] = {0, 0, 1, 0, 0, 1, 1, 1};
    glEnable(GL_TEXTURE_2D);
    glEnableClientState(GL_TEXTURE_COORD_ARRAY);
    glTexCoordPointer(2, GL_FLOAT, 0, UVS);
    DrawRect(x, y, size, size);
    glDisableClientState(GL_TEXTURE_COORD_ARRAY);
    glDisable(GL_TEXTURE_2D);
}

}  // namespace

void Hud::Init(int32_t width, int32_t height, const ReferenceOptions& reference) {
    m_reference = reference;
    m_width = width;
    m_height = height;
    const RgbaImage icon =
        MakeDisc(ICON_SIZE, {255, 255, 255, 255}, {150, 150, 150, 255}, 0.15f);
    m_icon_texture =
        CreateTexture(icon, {GL_LINEAR, GL_LINEAR, GL_CLAMP_TO_EDGE, GL_CLAMP_TO_EDGE});
}

void Hud::Release() { DeleteTexture(&m_icon_texture); }

void Hud::Draw(int32_t frame) const {
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glOrthof(0.0f, static_cast<GLfloat>(m_width), 0.0f, static_cast<GLfloat>(m_height), -1.0f,
             1.0f);
    // An overlay target takes the HUD unshifted; its composition gives the HUD its depth.
    if (!m_reference.m_overlay) LoadEyeFlat(m_reference);
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();

    glDisable(GL_DEPTH_TEST);
    glDisable(GL_LIGHTING);
    glDisable(GL_FOG);
    glDisable(GL_CULL_FACE);
    glEnable(GL_BLEND);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    glTexEnvf(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_MODULATE);
    glBindTexture(GL_TEXTURE_2D, m_icon_texture);
    glEnableClientState(GL_VERTEX_ARRAY);

    DrawPanel();
    DrawRadar(frame);
    DrawCrosshair();

    glDisableClientState(GL_VERTEX_ARRAY);
    glDisable(GL_BLEND);
    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);
}

void Hud::DrawPanel() const {
    glColor4f(0.0f, 0.0f, 0.0f, 0.5f);
    DrawRect(0.0f, 0.0f, static_cast<float>(m_width), PANEL_HEIGHT);

    // Health: an icon and a bar fading from red to yellow, colour per vertex.
    glColor4f(1.0f, 0.25f, 0.3f, 1.0f);
    DrawTexturedRect(6.0f, 5.0f, 24.0f);
    glColor4f(0.3f, 0.0f, 0.0f, 0.7f);
    DrawRect(36.0f, 11.0f, 110.0f, 12.0f);
    static const GLubyte HEALTH_COLORS[] = {220, 30, 20, 255, 250, 220, 40, 255,
                                            220, 30, 20, 255, 250, 220, 40, 255};
    glEnableClientState(GL_COLOR_ARRAY);
    glColorPointer(4, GL_UNSIGNED_BYTE, 0, HEALTH_COLORS);
    DrawRect(36.0f, 11.0f, 78.0f, 12.0f);
    glDisableClientState(GL_COLOR_ARRAY);

    // Ammo: loaded slots bright, spent ones faint.
    for (int32_t slot = 0; slot < AMMO_SLOTS; ++slot) {
        const float alpha = slot < AMMO_LOADED ? 0.95f : 0.25f;
        glColor4f(1.0f, 0.65f, 0.1f, alpha);
        DrawRect(m_width - 100.0f + 15.0f * slot, 9.0f, 10.0f, 16.0f);
    }
}

void Hud::DrawRadar(int32_t frame) const {
    const float left = m_width - RADAR_SIZE - RADAR_MARGIN;
    const float bottom = m_height - RADAR_SIZE - RADAR_MARGIN;
    glColor4f(0.2f, 0.9f, 0.3f, 0.35f);
    DrawTexturedRect(left, bottom, RADAR_SIZE);

    // The sweep turns a fixed step per frame.
    const float centre_x = left + RADAR_SIZE * 0.5f;
    const float centre_y = bottom + RADAR_SIZE * 0.5f;
    const float angle = 0.5f + 0.4f * frame;
    const GLfloat sweep[] = {centre_x, centre_y, centre_x + 28.0f * std::cos(angle),
                             centre_y + 28.0f * std::sin(angle)};
    glColor4f(0.6f, 1.0f, 0.6f, 0.9f);
    glVertexPointer(2, GL_FLOAT, 0, sweep);
    glDrawArrays(GL_LINES, 0, 2);

    glColor4f(1.0f, 0.2f, 0.2f, 1.0f);
    DrawRect(centre_x + 10.0f, centre_y + 12.0f, 4.0f, 4.0f);
    DrawRect(centre_x - 18.0f, centre_y - 6.0f, 4.0f, 4.0f);
    glColor4f(1.0f, 1.0f, 1.0f, 1.0f);
    DrawRect(centre_x - 2.0f, centre_y - 2.0f, 4.0f, 4.0f);
}

void Hud::DrawCrosshair() const {
    // Pixel centres, so one-pixel lines do not straddle two rows.
    const float x = m_width * 0.5f + 0.5f;
    const float y = m_height * 0.5f + 0.5f;
    const GLfloat lines[] = {
        x - CROSSHAIR_REACH, y, x - CROSSHAIR_GAP, y, x + CROSSHAIR_GAP, y,
        x + CROSSHAIR_REACH, y, x, y - CROSSHAIR_REACH, x, y - CROSSHAIR_GAP,
        x, y + CROSSHAIR_GAP, x, y + CROSSHAIR_REACH,
    };
    glColor4f(1.0f, 1.0f, 1.0f, 0.8f);
    glVertexPointer(2, GL_FLOAT, 0, lines);
    glDrawArrays(GL_LINES, 0, 8);
}

}  // namespace ovo_sample
