// On Mesa, through the library: glGetError and eglGetError after an application's call
// report what Mesa said about that call, never an error of the library's own calls around
// it; and the library's own objects of a context are deleted when the application ends the
// context, in it, with the thread's own binding back afterwards.
#include <EGL/egl.h>
#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <thread>
#include <vector>

#include "core/raw_egl.h"
#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "egl/current_context.h"
#include "present/composition_renderer.h"
#include "stereo/es2_stereo_layer.h"
#include "stereo/eye_texture.h"
#include "support/mesa_context.h"
#include "support/render_texture_draw.h"

namespace {

// The library's eye texture names of one context.
struct EyeNames {
    std::vector<GLuint> m_textures;
    std::vector<GLuint> m_framebuffers;
    GLuint m_program = 0;
};

// One run of a scenario: the application's EGL calls through the library, which draws a
// render texture before each swap (so that it keeps eye textures and a mask program), or
// straight to Mesa, which only swaps. eglGetError is read after each of them.
class EglRun {
public:
    explicit EglRun(bool library) : m_library(library) {
        m_session.Open(2);
        for (EGLSurface& surface : m_surfaces) surface = m_session.CreateSurface(16, 16);
    }

    EGLContext Create(EGLContext share = EGL_NO_CONTEXT) {
        const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, 2, EGL_NONE};
        auto create = m_library ? &::eglCreateContext : &ovo::vendor_egl::eglCreateContext;
        return Noted(create(m_session.m_display, m_session.m_config, share, version));
    }
    // With the surface of the main thread (0) or of another (1): a surface is current on
    // one thread at most.
    void MakeCurrent(EGLContext context, int thread = 0) {
        const EGLSurface surface = context != EGL_NO_CONTEXT ? m_surfaces[thread] : EGL_NO_SURFACE;
        auto make_current = m_library ? &::eglMakeCurrent : &ovo::vendor_egl::eglMakeCurrent;
        Noted(make_current(m_session.m_display, surface, surface, context));
    }
    void Destroy(EGLContext context) {
        auto destroy = m_library ? &::eglDestroyContext : &ovo::vendor_egl::eglDestroyContext;
        Noted(destroy(m_session.m_display, context));
    }
    void Terminate() {
        auto terminate = m_library ? &::eglTerminate : &ovo::vendor_egl::eglTerminate;
        Noted(terminate(m_session.m_display));
    }
    // A frame, swapped. The library's eye textures of the current context that the draw
    // left, if any.
    EyeNames Draw(int thread = 0) {
        if (m_library) {
            RenderTextureDraw draw;
            draw.Create(8);
            draw.DrawToWindow();
        }
        auto swap = m_library ? &::eglSwapBuffers : &ovo::vendor_egl::eglSwapBuffers;
        Noted(swap(m_session.m_display, m_surfaces[thread]));
        if (!m_library) return {};
        const ovo::EyeTexturePair* eyes =
            ovo::StereoManager::instance().m_eye_textures->Find(ovo::CurrentContext());
        if (eyes == nullptr) return {};
        EyeNames names;
        for (const ovo::EyeTexture& eye : eyes->m_eyes) {
            names.m_textures.push_back(eye.m_texture);
            names.m_framebuffers.push_back(eye.m_framebuffer);
        }
        names.m_program = eyes->m_eyes[0].m_program;
        return names;
    }
    // In a run through the library: whether Mesa still has any of `names`, asked in the
    // current context; with `bound`, that the thread is bound to it and this run's surface,
    // as the application left it, and that no GL error is pending.
    void ExpectAlive(const EyeNames& names, bool alive, EGLContext bound = EGL_NO_CONTEXT) const {
        if (!m_library) return;
        bool any = names.m_program != 0 && glIsProgram(names.m_program);
        for (GLuint texture : names.m_textures) any = any || glIsTexture(texture);
        for (GLuint framebuffer : names.m_framebuffers) any = any || glIsFramebuffer(framebuffer);
        EXPECT_EQ(any, alive);
        if (bound == EGL_NO_CONTEXT) return;
        EXPECT_EQ(ovo::vendor_egl::eglGetCurrentContext(), bound);
        EXPECT_EQ(ovo::vendor_egl::eglGetCurrentSurface(EGL_DRAW), m_surfaces[0]);
        EXPECT_EQ(ovo::vendor_egl::eglGetCurrentSurface(EGL_READ), m_surfaces[0]);
        EXPECT_EQ(glGetError(), GL_NO_ERROR);
    }

    bool m_library;
    std::vector<EGLint> m_errors;

private:
    template <typename Result>
    Result Noted(Result result) {
        m_errors.push_back(eglGetError());
        return result;
    }

    MesaSession m_session;
    EGLSurface m_surfaces[2] = {};
};

class ContextObjectsOnMesa : public ::testing::Test {
protected:
    void SetUp() override {
        ovo::StereoManager& manager = ovo::StereoManager::instance();
        delete manager.m_layer;
        manager.m_layer = new ovo::Es2StereoLayer(ovo::LAYER_SUBMODE_TRACKED);
        manager.m_es2_layer_installed = true;
        manager.m_composer = new ovo::CompositionRenderer(1);  // released at exit
        manager.m_interleave = true;
    }

    // `scenario` through the library, then straight to Mesa: the same errors.
    template <typename Scenario>
    void ExpectMesasErrors(Scenario scenario) {
        std::vector<EGLint> errors[2];
        for (bool library : {true, false}) {
            EglRun run(library);
            ASSERT_NO_FATAL_FAILURE(scenario(run));
            ASSERT_GT(run.m_errors.size(), 2u);
            errors[library] = run.m_errors;
        }
        EXPECT_EQ(errors[true], errors[false]);
    }
};

TEST_F(ContextObjectsOnMesa, AContextEndedWhileAnotherIsCurrent) {
    ExpectMesasErrors([](EglRun& run) {
        const EGLContext own = run.Create();
        const EGLContext ended = run.Create(own);  // its textures stay visible in `own`
        run.MakeCurrent(ended);
        const EyeNames names = run.Draw();
        run.MakeCurrent(own);
        run.Draw();
        run.ExpectAlive(names, true);
        run.Destroy(ended);
        run.ExpectAlive(names, false, own);
        run.Destroy(ended);  // no longer a context
        run.MakeCurrent(EGL_NO_CONTEXT);
        run.Destroy(own);
    });
}

TEST_F(ContextObjectsOnMesa, AContextEndedWhileCurrent) {
    ExpectMesasErrors([](EglRun& run) {
        const EGLContext ended = run.Create();
        run.MakeCurrent(ended);
        const EyeNames names = run.Draw();
        run.ExpectAlive(names, true);
        run.Destroy(ended);
        run.ExpectAlive(names, false, ended);  // bound until the thread leaves it
        // Still current: the next frame's objects are the frame's own.
        run.Draw();
        run.ExpectAlive({}, false, ended);
        run.MakeCurrent(EGL_NO_CONTEXT);
    });
}

// A context current on another thread cannot be made current here: its objects are left
// to the driver, and the application learns of no refusal.
TEST_F(ContextObjectsOnMesa, AContextEndedWhileCurrentOnAnotherThread) {
    ExpectMesasErrors([](EglRun& run) {
        const EGLContext own = run.Create();
        const EGLContext elsewhere = run.Create(own);
        EyeNames names;
        std::thread([&] {
            run.MakeCurrent(elsewhere, 1);
            names = run.Draw(1);
        }).join();
        run.MakeCurrent(own);
        run.Destroy(elsewhere);
        run.ExpectAlive(names, true, own);  // forgotten, not deleted from another context
        run.MakeCurrent(EGL_NO_CONTEXT);
    });
}

TEST_F(ContextObjectsOnMesa, TerminatingADisplayWithSeveralContexts) {
    ExpectMesasErrors([](EglRun& run) {
        const EGLContext own = run.Create();
        const EGLContext sharing = run.Create(own);
        const EGLContext alone = run.Create();
        EyeNames names[2];
        run.MakeCurrent(alone);
        run.Draw();
        run.MakeCurrent(sharing);
        names[0] = run.Draw();
        run.MakeCurrent(own);
        names[1] = run.Draw();
        for (const EyeNames& each : names) run.ExpectAlive(each, true);
        run.Terminate();
        // The display's contexts end as the thread leaves them.
        for (const EyeNames& each : names) run.ExpectAlive(each, false, own);
        run.MakeCurrent(EGL_NO_CONTEXT);
    });
}

using ApplicationErrorsOnMesa = MesaSessionTest;

// A context made current without a surface: nothing to take a size from, and no error.
TEST_F(ApplicationErrorsOnMesa, MakingAContextCurrentWithoutASurfaceLeavesSuccess) {
    ASSERT_EQ(eglMakeCurrent(m_session.m_display, EGL_NO_SURFACE, EGL_NO_SURFACE, m_context),
              EGL_TRUE);
    EXPECT_EQ(eglGetError(), EGL_SUCCESS);
}

// A context current on another thread cannot be made current here: the application learns
// why from eglGetError, not that some later query of the library's succeeded.
TEST_F(ApplicationErrorsOnMesa, ARefusedMakeCurrentReportsTheVendorsError) {
    std::thread([&] {
        ASSERT_EQ(eglMakeCurrent(m_session.m_display, m_surface, m_surface, m_context), EGL_TRUE);
    }).join();
    EXPECT_EQ(eglMakeCurrent(m_session.m_display, m_surface, m_surface, m_context), EGL_FALSE);
    EXPECT_EQ(eglGetError(), EGL_BAD_ACCESS);
}

// A draw without a program: whatever Mesa says of the draw, and nothing of the depth-shift
// lookup that the stereo draw makes around it.
TEST_F(ApplicationErrorsOnMesa, AStereoDrawWithoutAProgramRaisesOnlyTheDrawsError) {
    ASSERT_EQ(eglMakeCurrent(m_session.m_display, m_surface, m_surface, m_context), EGL_TRUE);
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    for (uint32_t submode : {ovo::LAYER_SUBMODE_DIRECT, ovo::LAYER_SUBMODE_TRACKED}) {
        SCOPED_TRACE(submode);
        delete manager.m_layer;
        manager.m_layer = new ovo::Es2StereoLayer(submode);
        glUseProgram(0);
        const GLushort indices[3] = {0, 1, 2};
        ovo::raw::glDrawArrays(GL_TRIANGLES, 0, 3);
        const GLenum arrays = ovo::raw::glGetError();
        glDrawArrays(GL_TRIANGLES, 0, 3);
        EXPECT_EQ(glGetError(), arrays);
        ovo::raw::glDrawElements(GL_TRIANGLES, 3, GL_UNSIGNED_SHORT, indices);
        const GLenum elements = ovo::raw::glGetError();
        glDrawElements(GL_TRIANGLES, 3, GL_UNSIGNED_SHORT, indices);
        EXPECT_EQ(glGetError(), elements);
    }
}

}  // namespace
