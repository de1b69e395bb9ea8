// glGetError and eglGetError after an application's call report what Mesa said about that
// call, never an error of the library's own calls around it.
#include <EGL/egl.h>
#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <thread>

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "stereo/es2_stereo_layer.h"
#include "support/mesa_context.h"

namespace {

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
