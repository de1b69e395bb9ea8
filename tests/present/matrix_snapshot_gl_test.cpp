// MatrixSnapshot against a real fixed-function pipeline: Mesa's OpenGL ES 1.1, reached
// through the library.
#include "present/matrix_snapshot.h"

#include <GLES/gl.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <array>

#include "support/mesa_context.h"

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

TEST(MatrixSnapshotOnMesa, CapturesVariesPerEyeAndRestores) {
    ASSERT_NO_FATAL_FAILURE(MakeMesaContextCurrent(1));
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

}  // namespace
