// MatrixSnapshot against a real fixed-function pipeline: Mesa's OpenGL ES 1.1, reached
// through the library.
#include "present/matrix_snapshot.h"

#include <EGL/egl.h>
#include <GLES/gl.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cstdlib>

namespace {

using Matrix = std::array<float, 16>;

Matrix Product(const Matrix& a, const Matrix& b) {
    Matrix r{};
    for (int column = 0; column < 4; ++column)
        for (int row = 0; row < 4; ++row)
            for (int k = 0; k < 4; ++k) r[column * 4 + row] += a[k * 4 + row] * b[column * 4 + k];
    return r;
}

Matrix Translation(float x, float y, float z) { return {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, x, y, z, 1}; }

Matrix Read(GLenum which) {
    Matrix m{};
    glGetFloatv(which, m.data());
    return m;
}

void ExpectNear(const Matrix& got, const Matrix& expected) {
    for (int i = 0; i < 16; ++i) EXPECT_NEAR(got[i], expected[i], 1e-5f) << "element " << i;
}

class MatrixSnapshotOnMesa : public ::testing::Test {
protected:
    void SetUp() override {
        setenv("EGL_PLATFORM", "surfaceless", 1);
        EGLDisplay display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
        ASSERT_TRUE(eglInitialize(display, nullptr, nullptr));
        const EGLint config_attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_RENDERABLE_TYPE,
                                            EGL_OPENGL_ES_BIT, EGL_NONE};
        EGLConfig config;
        EGLint count = 0;
        ASSERT_TRUE(eglChooseConfig(display, config_attributes, &config, 1, &count) && count == 1);
        const EGLint size[] = {EGL_WIDTH, 16, EGL_HEIGHT, 16, EGL_NONE};
        EGLSurface surface = eglCreatePbufferSurface(display, config, size);
        const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, 1, EGL_NONE};
        EGLContext context = eglCreateContext(display, config, EGL_NO_CONTEXT, version);
        ASSERT_TRUE(eglMakeCurrent(display, surface, surface, context));
    }
};

TEST_F(MatrixSnapshotOnMesa, CapturesVariesPerEyeAndRestores) {
    // A frustum written out by hand: l -1, r 1, b -0.75, t 0.75, n 1, f 100.
    const Matrix frustum = {1, 0, 0, 0, 0, 1 / 0.75f, 0, 0, 0, 0, -101.0f / 99, -1, 0, 0, -200.0f / 99, 0};
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glFrustumf(-1, 1, -0.75f, 0.75f, 1, 100);
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
    glTranslatef(1, 2, -5);
    glMatrixMode(GL_TEXTURE);

    ovo::MatrixSnapshot snapshot;
    Matrix captured;
    std::copy(snapshot.Projection(), snapshot.Projection() + 16, captured.begin());
    ExpectNear(captured, frustum);
    EXPECT_EQ(snapshot.ProjectionKind(), ovo::PROJECTION_PERSPECTIVE);
    EXPECT_EQ(snapshot.Modelview()[14], -5.0f);

    const float eye[3] = {0.1f, 0, 0};
    const float image[3] = {-0.05f, 0, 0};
    snapshot.LoadEyeProjection(eye, image);
    ExpectNear(Read(GL_PROJECTION_MATRIX),
               Product(Product(Translation(-0.05f, 0, 0), frustum), Translation(0.1f, 0, 0)));
    snapshot.LoadShiftedProjection(image);
    ExpectNear(Read(GL_PROJECTION_MATRIX), Product(Translation(-0.05f, 0, 0), frustum));

    snapshot.Restore();
    ExpectNear(Read(GL_PROJECTION_MATRIX), frustum);
    ExpectNear(Read(GL_MODELVIEW_MATRIX), Translation(1, 2, -5));
    GLint mode = 0;
    glGetIntegerv(GL_MATRIX_MODE, &mode);
    EXPECT_EQ(mode, GL_TEXTURE);
}

TEST_F(MatrixSnapshotOnMesa, OverlaysAreUnmovedAndBlendedOrdinarilyOrNotAtAll) {
    struct Case {
        bool m_identity;
        bool m_blend;
        GLenum m_source;
        GLenum m_destination;
        bool m_overlay;
    } cases[] = {{true, false, GL_ONE, GL_ONE, true},
                 {true, true, GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA, true},
                 {true, true, GL_ONE, GL_ONE, false},
                 {false, false, GL_ONE, GL_ZERO, false}};
    for (const Case& each : cases) {
        glMatrixMode(GL_MODELVIEW);
        glLoadIdentity();
        if (!each.m_identity) glTranslatef(0, 0, -1);
        each.m_blend ? glEnable(GL_BLEND) : glDisable(GL_BLEND);
        glBlendFunc(each.m_source, each.m_destination);
        EXPECT_EQ(ovo::MatrixSnapshot().IsOverlayCandidate(), each.m_overlay)
            << each.m_identity << each.m_blend << each.m_source;
    }
}

}  // namespace
