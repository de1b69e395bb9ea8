#ifndef OVO_TESTS_STEREO_STEREO_FIXTURE_H
#define OVO_TESTS_STEREO_STEREO_FIXTURE_H

#include <gtest/gtest.h>

#include <cstdio>
#include <initializer_list>
#include <string>
#include <vector>

#include "core/entry_tables.h"
#include "core/gl_layer.h"
#include "core/stereo_manager.h"
#include "present/composition_renderer.h"
#include "stereo/gl_object_tracker.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/recorded_calls.h"
#include "support/vendor_root.h"

using Calls = std::vector<std::string>;

inline Calls Join(std::initializer_list<Calls> parts) {
    Calls all;
    for (const Calls& part : parts) all.insert(all.end(), part.begin(), part.end());
    return all;
}

inline std::string RectCall(const char* name, const ovo::GlRect& r) {
    char text[96];
    std::snprintf(text, sizeof(text), "%s(%d, %d, %d, %d)", name, r.m_x, r.m_y, r.m_width, r.m_height);
    return text;
}

// An OpenGL ES 1.x context on the recording vendor and a manager whose profile the test
// sets field by field; the layers under test are built directly.
class StereoFixture : public ::testing::Test {
protected:
    void SetUp() override {
        vendor_root::InstallRecorder();
        m_egl.Open();
        ASSERT_NE(m_egl.m_display, EGL_NO_DISPLAY);
        ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(1)), EGL_TRUE);
        ovo::StereoProfile& profile = Profile();
        profile.m_width = 800;
        profile.m_height = 480;
        profile.m_target_width = 800;
        profile.m_target_height = 480;
        profile.m_eye_distance = 0.5f;
        profile.m_eye_angle = 0.25f;
        profile.m_eye_shift = 0.125f;
        Manager().m_viewport = {0, 0, 800, 480};
        Manager().m_scissor = {0, 0, 800, 480};
        recorded_calls::ClearAnswers();
        AnswerMatrix(GL_MODELVIEW_MATRIX, IDENTITY);
        recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_MATRIX_MODE, {GL_MODELVIEW});
        ResetRecorder();
    }

    // An OpenGL ES 2.0 context made current; the tracked layer's objects start unbound.
    void UseEs2() {
        ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(2)), EGL_TRUE);
        Manager().m_objects->m_current_framebuffer = 0;
        Manager().m_objects->m_current_texture = 0;
        ResetRecorder();
    }

    // Texture 5, `width` x 64, attached to framebuffer 3, which stays bound.
    static void MakeRenderTexture(ovo::GlLayer& layer, GLsizei width = 128) {
        layer.glBindTexture(Manager(), GL_TEXTURE_2D, 5);
        layer.glTexImage2D(Manager(), GL_TEXTURE_2D, 0, GL_RGBA, width, 64, 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
        layer.glBindFramebuffer(Manager(), GL_FRAMEBUFFER, 3);
        layer.glFramebufferTexture2D(Manager(), GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D, 5, 0);
    }

    // Factors and rectangles chosen so that the 0.5 changes every rounded value: 300.75,
    // 303.75, 601.5, 151.875. SCALED_HALVES are the side-by-side eyes' rectangles.
    static void ScaleOutput() {
        Manager().m_scale_x = 1.5f;
        Manager().m_scale_y = 1.25f;
        Manager().m_viewport = {10, 20, 401, 243};
        Manager().m_scissor = {4, 6, 101, 51};
    }

    static ovo::StereoManager& Manager() { return ovo::StereoManager::instance(); }
    static ovo::StereoProfile& Profile() { return *Manager().m_profile; }

    // Interleaving on (with the default eye swap) or off.
    static void Interleave(bool on) {
        if (on && Manager().m_composer == nullptr) Manager().m_composer = new ovo::CompositionRenderer(1);
        Manager().m_interleave = on;
    }

    static void AnswerMatrix(GLenum which, const std::vector<GLfloat>& matrix) {
        recorded_calls::AnswerBytes(ovo::GL_ENTRY_glGetFloatv, which, matrix.data(),
                                    matrix.size() * sizeof(GLfloat));
    }

    // The recorded calls to the named functions only, in order.
    static Calls Only(const Calls& names) {
        Calls kept;
        for (const std::string& call : recorded_calls::RecordedGlCalls()) {
            for (const std::string& name : names) {
                if (call.compare(0, name.size() + 1, name + "(") == 0) kept.push_back(call);
            }
        }
        return kept;
    }

    // One draw of three vertices through `layer`: its calls, or its calls to the named functions.
    static Calls Drawn(ovo::GlLayer& layer, const Calls& names = {}) {
        ResetRecorder();
        layer.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        return names.empty() ? recorded_calls::RecordedGlCalls() : Only(names);
    }

    // The ramp on or off, interleaving, the ramp's selector, and the call that each draw of
    // a frame shows at textures 1, 2 and 3.
    struct RampCase {
        uint32_t m_ramp;
        bool m_interleave;
        uint32_t m_param;
        Calls m_seen;
    };

    // Starts a frame under `each`'s settings and issues `draw` with each of textures 1, 2 and
    // 3 bound; the call at `index` among each draw's calls to `name`.
    template <typename Draw>
    static Calls AtThreeTextures(const RampCase& each, Draw draw, const std::string& name, size_t index) {
        Interleave(each.m_interleave);
        Profile().m_ramp = each.m_ramp;
        Profile().m_ramp_param = each.m_param;
        Manager().m_frame_draws = 0;
        Manager().m_last_texture = 0;
        Calls seen;
        for (GLint texture = 1; texture <= 3; ++texture) {
            recorded_calls::AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_TEXTURE_BINDING_2D, {texture});
            ResetRecorder();
            draw();
            seen.push_back(Only({name}).at(index));
        }
        return seen;
    }

    static const Calls SCALED_HALVES;
    static const std::vector<GLfloat> IDENTITY;
    // glFrustumf(-1, 1, -1, 1, 1, 10): element 11 is -1, element 15 is 0.
    static const std::vector<GLfloat> PERSPECTIVE;
    // glOrthof(0, 800, 0, 480, -1, 1).
    static const std::vector<GLfloat> ORTHO;

    EglSession m_egl;
};

inline const Calls StereoFixture::SCALED_HALVES = {"glViewport(7, 25, 301, 303)", "glScissor(3, 7, 76, 63)",
                                                   "glViewport(407, 25, 301, 303)", "glScissor(403, 7, 76, 63)"};
inline const std::vector<GLfloat> StereoFixture::IDENTITY = {1, 0, 0, 0, 0, 1, 0, 0,
                                                             0, 0, 1, 0, 0, 0, 0, 1};
inline const std::vector<GLfloat> StereoFixture::PERSPECTIVE = {
    1, 0, 0, 0, 0, 1, 0, 0, 0, 0, -11.0f / 9.0f, -1, 0, 0, -20.0f / 9.0f, 0};
inline const std::vector<GLfloat> StereoFixture::ORTHO = {
    2.0f / 800, 0, 0, 0, 0, 2.0f / 480, 0, 0, 0, 0, -1, 0, -1, -1, 0, 1};

#endif
