// On Mesa, through the library: application objects whose names the library takes for
// itself or cannot keep a record of, and render textures whose size it never learns.
#include <EGL/egl.h>
#include <GLES/gl.h>
#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <initializer_list>
#include <string>

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "stereo/es2_stereo_layer.h"
#include "stereo/overlay_target.h"
#include "support/mesa_context.h"
#include "support/render_texture_draw.h"

namespace {

// The pixel at (x, y) of the bound framebuffer by its colour; "-" when it lies outside.
std::string ColourAt(GLint x, GLint y) {
    GLubyte pixel[4] = {1, 2, 3, 4};
    ovo::raw::glReadPixels(x, y, 1, 1, GL_RGBA, GL_UNSIGNED_BYTE, pixel);
    if (pixel[0] == 1 && pixel[1] == 2 && pixel[2] == 3 && pixel[3] == 4) return "-";
    static const char* const NAMES[] = {"black", "red", "green", "other", "blue", "other", "other", "other"};
    return NAMES[(pixel[0] > 127 ? 1 : 0) | (pixel[1] > 127 ? 2 : 0) | (pixel[2] > 127 ? 4 : 0)];
}

constexpr GLsizei SURFACE_SIZE = 16;

// The overlay takes texture name 65535 without generating it. An application texture of
// that name is the overlay's: the swap empties it to transparent black, so the game draws
// nothing where it drew its texture.
TEST(OverlayTextureOnMesa, AnApplicationTextureNamed65535IsEmptiedAtEverySwap) {
    ASSERT_NO_FATAL_FAILURE(MakeMesaContextCurrent(1, SURFACE_SIZE, SURFACE_SIZE));
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    manager.m_profile->m_eye_target = true;
    delete manager.m_overlay;
    // The overlay a profile with the overlay target and this size gives, made as the
    // make-current makes it.
    manager.m_overlay = new ovo::OverlayTarget(SURFACE_SIZE, SURFACE_SIZE, ovo::OVERLAY_CREATE_OBJECTS);
    manager.m_overlay->Create();
    static const GLfloat QUAD[] = {-1, -1, 1, -1, -1, 1, 1, 1};
    static const GLfloat COORDINATES[] = {0, 0, 1, 0, 0, 1, 1, 1};
    const GLubyte red[4] = {255, 0, 0, 255};
    for (GLuint name : {65534u, 65535u}) {
        glBindTexture(GL_TEXTURE_2D, name);
        glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, 1, 1, 0, GL_RGBA, GL_UNSIGNED_BYTE, red);
        glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_NEAREST);
        eglSwapBuffers(eglGetCurrentDisplay(), eglGetCurrentSurface(EGL_DRAW));
        glViewport(0, 0, SURFACE_SIZE, SURFACE_SIZE);
        glBindTexture(GL_TEXTURE_2D, name);
        glEnable(GL_TEXTURE_2D);
        glTexEnvi(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_REPLACE);
        glEnableClientState(GL_VERTEX_ARRAY);
        glEnableClientState(GL_TEXTURE_COORD_ARRAY);
        glVertexPointer(2, GL_FLOAT, 0, QUAD);
        glTexCoordPointer(2, GL_FLOAT, 0, COORDINATES);
        glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
        EXPECT_EQ(ColourAt(8, 8), name == 65535u ? "black" : "red") << name;
    }
}

// The tracked game's render textures: each eye draws into its half of a texture made twice
// as wide, and each eye samples its own half. Only names below 4096 have a record, only one
// framebuffer of the names equal modulo 64 has one, and only a size set by glTexImage2D is
// known.
class TrackedRenderTexturesOnMesa : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_NO_FATAL_FAILURE(MakeMesaContextCurrent(2, SURFACE_SIZE, SURFACE_SIZE));
        ovo::StereoManager& manager = ovo::StereoManager::instance();
        delete manager.m_layer;
        manager.m_layer = new ovo::Es2StereoLayer(ovo::LAYER_SUBMODE_TRACKED);
        // Not interleaved, top and bottom: the window's upper half shows what eye 0 sees,
        // its lower half what eye 1 sees.
        ovo::StereoProfile& profile = *manager.m_profile;
        profile.m_split = ovo::STEREO_SPLIT_TOP_BOTTOM;
        profile.m_width = profile.m_target_width = SURFACE_SIZE;
        profile.m_height = profile.m_target_height = SURFACE_SIZE;
        profile.m_eye_distance = 0.5f;
        manager.UpdateScale();
        // Red where eye 0 draws, green where eye 1 does: the injected uniform's gain has
        // each eye's sign.
        m_eye_colours = LinkProgram("attribute vec2 position; varying float eye; void main() {"
                                    " eye = uZpDepthShift.y; gl_Position = vec4(position, 0.0, 1.0); }",
                                    "precision mediump float; varying float eye; void main() {"
                                    " gl_FragColor = eye > 0.0 ? vec4(1, 0, 0, 1) : vec4(0, 1, 0, 1); }");
        m_sampling = LinkProgram(SAMPLING_VERTEX_SHADER, SAMPLING_FRAGMENT_SHADER);
    }

    // An 8 x 8 render texture made as the game makes it, cleared blue and drawn over by
    // both eyes; then drawn over the window. The texture's colour at x = 2 and x = 10, then
    // what each eye sees of it.
    std::string RenderAndShow(GLuint texture, GLuint framebuffer, bool copied) {
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        glBindTexture(GL_TEXTURE_2D, texture);
        if (copied) {
            // From the window, without alpha, as any window can give it.
            glCopyTexImage2D(GL_TEXTURE_2D, 0, GL_RGB, 0, 0, 8, 8, 0);
        } else {
            glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, 8, 8, 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
        }
        glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_NEAREST);
        glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_NEAREST);
        glBindFramebuffer(GL_FRAMEBUFFER, framebuffer);
        glFramebufferTexture2D(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D, texture, 0);
        glViewport(0, 0, 8, 8);
        glClearColor(0, 0, 1, 1);
        glClear(GL_COLOR_BUFFER_BIT);
        DrawViewportQuad(m_eye_colours);
        const std::string halves = ColourAt(2, 4) + "|" + ColourAt(10, 4);

        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        glViewport(0, 0, SURFACE_SIZE, SURFACE_SIZE);
        glClearColor(1, 1, 1, 1);
        glClear(GL_COLOR_BUFFER_BIT);
        RenderTextureDraw{texture, framebuffer, m_sampling}.DrawToWindow();
        return "texture " + halves + ", eyes see " + ColourAt(8, 12) + "|" + ColourAt(8, 4);
    }

    GLuint m_eye_colours = 0;
    GLuint m_sampling = 0;
};

TEST_F(TrackedRenderTexturesOnMesa, OnlyTexturesWithARecordAndAKnownSizeAreDrawnPerEye) {
    // Names the application chose itself, away from those Mesa generates for the eye
    // textures (one past the highest name in use).
    const struct {
        const char* m_name;
        GLuint m_texture;
        GLuint m_framebuffer;
        bool m_copied;
        std::string m_expected;
    } cases[] = {
        {"tracked", 100, 3, false, "texture red|green, eyes see red|green"},
        // Drawn twice into the same place; both eyes sample the same texture.
        {"texture name 4096 and up", 5000, 10, false, "texture green|-, eyes see green|green"},
        // 67 shares 3's record: both eyes draw into the left half, the right one stays as
        // cleared, and eye 1 sees that.
        {"framebuffer 67 after 3", 200, 67, false, "texture green|blue, eyes see green|blue"},
        // No size known: not widened, both eyes draw into the same place, and the eye
        // textures keep what the last render texture left in them.
        {"sized by glCopyTexImage2D", 300, 11, true, "texture green|-, eyes see green|blue"},
    };
    for (const auto& each : cases) {
        EXPECT_EQ(RenderAndShow(each.m_texture, each.m_framebuffer, each.m_copied), each.m_expected)
            << each.m_name;
    }
}

}  // namespace
