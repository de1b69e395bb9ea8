// The library's own drawing on Mesa, reached through the library: the pixel columns the
// column mask marks, the application state that the mask (in both drawing paths) and the
// overlay's composition leave alone, and MatrixSnapshot against a real fixed-function pipeline.
#include <GLES/gl.h>
#include <GLES/glext.h>
#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "core/stereo_manager.h"
#include "present/composition_renderer.h"
#include "present/matrix_snapshot.h"
#include "stereo/draw_call.h"
#include "stereo/overlay_target.h"
#include "support/mesa_context.h"

namespace {

enum DrawingPath : bool { PATH_GL1 = false, PATH_GL2 = true };

class CompositionOnMesa : public ::testing::Test {
protected:
    void Open(DrawingPath path, int32_t width, int32_t height) {
        ASSERT_NO_FATAL_FAILURE(MakeMesaContextCurrent(path == PATH_GL2 ? 2 : 1, width, height));
        GLint stencil_bits = 0;
        glGetIntegerv(GL_STENCIL_BITS, &stencil_bits);
        ASSERT_EQ(stencil_bits, 8);
        ovo::StereoManager& manager = ovo::StereoManager::instance();
        manager.m_es2_layer_installed = path == PATH_GL2;
        manager.m_profile->m_target_width = width;
        manager.m_profile->m_target_height = height;
        m_path = path;
        m_width = width;
        m_height = height;
    }

    void Present() { m_renderer.Present(ovo::StereoManager::instance()); }

    // Fills the window where the stencil is 0 and answers, per pixel column, how many rows
    // got the fill.
    std::vector<int> MaskedRowsPerColumn() {
        static const GLfloat QUAD[] = {-1, -1, 1, -1, -1, 1, 1, 1};
        glViewport(0, 0, m_width, m_height);
        for (GLenum off : {GL_SCISSOR_TEST, GL_DEPTH_TEST, GL_BLEND, GL_CULL_FACE}) glDisable(off);
        glColorMask(GL_TRUE, GL_TRUE, GL_TRUE, GL_TRUE);
        glClearColor(0, 0, 0, 1);
        glClear(GL_COLOR_BUFFER_BIT);
        glEnable(GL_STENCIL_TEST);
        glStencilFunc(GL_EQUAL, 0, 1);
        glStencilOp(GL_KEEP, GL_KEEP, GL_KEEP);
        glBindBuffer(GL_ARRAY_BUFFER, 0);
        if (m_path == PATH_GL2) {
            glUseProgram(FillProgram());
            glEnableVertexAttribArray(0);
            glVertexAttribPointer(0, 2, GL_FLOAT, GL_FALSE, 0, QUAD);
        } else {
            for (GLenum off : {GL_TEXTURE_2D, GL_LIGHTING, GL_ALPHA_TEST}) glDisable(off);
            glMatrixMode(GL_PROJECTION);
            glLoadIdentity();
            glMatrixMode(GL_MODELVIEW);
            glLoadIdentity();
            for (GLenum off :
                 {GL_COLOR_ARRAY, GL_TEXTURE_COORD_ARRAY, GL_NORMAL_ARRAY, GL_POINT_SIZE_ARRAY_OES})
                glDisableClientState(off);
            glEnableClientState(GL_VERTEX_ARRAY);
            glVertexPointer(2, GL_FLOAT, 0, QUAD);
            glColor4f(1, 0, 0, 1);
        }
        glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
        std::vector<GLubyte> pixels(static_cast<size_t>(m_width) * m_height * 4);
        glReadPixels(0, 0, m_width, m_height, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
        std::vector<int> rows(m_width, 0);
        for (int32_t y = 0; y < m_height; ++y)
            for (int32_t x = 0; x < m_width; ++x)
                rows[x] += pixels[(static_cast<size_t>(y) * m_width + x) * 4] > 127;
        return rows;
    }

    // The stencil holds 0 on every column x with x % 2 == parity, from top to bottom, and
    // 1 on the others.
    void ExpectMaskOn(int32_t parity) {
        const std::vector<int> rows = MaskedRowsPerColumn();
        for (int32_t x = 0; x < m_width; ++x)
            ASSERT_EQ(rows[x], x % 2 == parity ? m_height : 0) << "column " << x;
    }

    static GLuint FillProgram() {
        const char* vertex = "attribute vec4 position;void main(){gl_Position = position;}";
        const char* fragment = "void main(){gl_FragColor = vec4(1.0, 0.0, 0.0, 1.0);}";
        GLuint program = glCreateProgram();
        for (auto [type, source] :
             {std::pair{GL_VERTEX_SHADER, vertex}, std::pair{GL_FRAGMENT_SHADER, fragment}}) {
            GLuint shader = glCreateShader(type);
            glShaderSource(shader, 1, &source, nullptr);
            glCompileShader(shader);
            glAttachShader(program, shader);
        }
        glBindAttribLocation(program, 0, "position");
        glLinkProgram(program);
        return program;
    }

    ovo::CompositionRenderer m_renderer{1};
    DrawingPath m_path = PATH_GL1;
    int32_t m_width = 0;
    int32_t m_height = 0;
};

// One piece of GL state as the application reads it back: `m_count` values of `m_name`.
struct Probe {
    enum Kind {
        INTEGERS, BOOLEANS, FLOATS, ENABLED, POINTER, TEX_ENV,
        ATTRIBUTE, ATTRIBUTE_POINTER  // of attribute 0
    } m_kind;
    int m_count;
    GLenum m_name;

    std::vector<double> Read() const {
        GLint integers[16] = {};
        GLboolean booleans[4] = {};
        GLfloat floats[16] = {};
        void* pointer = nullptr;
        switch (m_kind) {
            case INTEGERS: glGetIntegerv(m_name, integers); return {integers, integers + m_count};
            case BOOLEANS: glGetBooleanv(m_name, booleans); return {booleans, booleans + m_count};
            case FLOATS: glGetFloatv(m_name, floats); return {floats, floats + m_count};
            case ENABLED: return {static_cast<double>(glIsEnabled(m_name))};
            case POINTER: glGetPointerv(m_name, &pointer); break;
            case TEX_ENV: glGetTexEnviv(GL_TEXTURE_ENV, m_name, integers); return {double(integers[0])};
            case ATTRIBUTE: glGetVertexAttribiv(0, m_name, integers); return {double(integers[0])};
            case ATTRIBUTE_POINTER: glGetVertexAttribPointerv(0, m_name, &pointer); break;
        }
        return {static_cast<double>(reinterpret_cast<uintptr_t>(pointer))};
    }
};

// Probes of one kind and count.
struct ProbeGroup {
    Probe::Kind m_kind;
    int m_count;
    std::vector<GLenum> m_names;
};

using ProbeGroups = std::vector<ProbeGroup>;

const ProbeGroups SHARED_PROBES = {
    {Probe::INTEGERS, 4, {GL_VIEWPORT, GL_SCISSOR_BOX}},
    {Probe::INTEGERS, 1, {GL_CULL_FACE_MODE, GL_FRONT_FACE, GL_ARRAY_BUFFER_BINDING, GL_TEXTURE_BINDING_2D}},
    {Probe::ENABLED, 1, {GL_SCISSOR_TEST, GL_BLEND, GL_DEPTH_TEST, GL_CULL_FACE}},
    {Probe::BOOLEANS, 4, {GL_COLOR_WRITEMASK}},
    {Probe::BOOLEANS, 1, {GL_DEPTH_WRITEMASK}},
};

const ProbeGroups GL2_PROBES = {
    {Probe::INTEGERS, 1, {GL_CURRENT_PROGRAM}},
    {Probe::ATTRIBUTE, 1, {GL_VERTEX_ATTRIB_ARRAY_ENABLED, GL_VERTEX_ATTRIB_ARRAY_BUFFER_BINDING,
                           GL_VERTEX_ATTRIB_ARRAY_SIZE, GL_VERTEX_ATTRIB_ARRAY_TYPE,
                           GL_VERTEX_ATTRIB_ARRAY_NORMALIZED, GL_VERTEX_ATTRIB_ARRAY_STRIDE}},
    {Probe::ATTRIBUTE_POINTER, 1, {GL_VERTEX_ATTRIB_ARRAY_POINTER}},
};

const ProbeGroups GL1_PROBES = {
    {Probe::INTEGERS, 1, {GL_MATRIX_MODE, GL_BLEND_SRC, GL_BLEND_DST, GL_ALPHA_TEST_FUNC,
                          GL_VERTEX_ARRAY_SIZE, GL_VERTEX_ARRAY_TYPE, GL_VERTEX_ARRAY_STRIDE,
                          GL_TEXTURE_COORD_ARRAY_STRIDE}},
    {Probe::FLOATS, 16, {GL_PROJECTION_MATRIX, GL_MODELVIEW_MATRIX}},
    {Probe::FLOATS, 4, {GL_CURRENT_COLOR}},
    {Probe::FLOATS, 1, {GL_ALPHA_TEST_REF}},
    {Probe::ENABLED, 1, {GL_ALPHA_TEST, GL_TEXTURE_2D, GL_LIGHTING, GL_VERTEX_ARRAY, GL_TEXTURE_COORD_ARRAY,
                         GL_COLOR_ARRAY, GL_NORMAL_ARRAY, GL_POINT_SIZE_ARRAY_OES}},
    {Probe::TEX_ENV, 1, {GL_TEXTURE_ENV_MODE}},
    {Probe::POINTER, 1, {GL_VERTEX_ARRAY_POINTER, GL_TEXTURE_COORD_ARRAY_POINTER}},
};

// State unlike GL's defaults and unlike everything the mask sets.
void SetSharedApplicationState() {
    GLuint names[2];
    glGenBuffers(1, &names[0]);
    glGenTextures(1, &names[1]);
    glBindBuffer(GL_ARRAY_BUFFER, names[0]);
    glBindTexture(GL_TEXTURE_2D, names[1]);
    glViewport(3, 5, 100, 90);
    // Larger than the window: the mask's clear honours the application's scissor test.
    glScissor(0, 0, 100, 90);
    for (GLenum on : {GL_SCISSOR_TEST, GL_BLEND, GL_DEPTH_TEST, GL_CULL_FACE}) glEnable(on);
    glCullFace(GL_FRONT);
    glFrontFace(GL_CW);
    glColorMask(GL_TRUE, GL_FALSE, GL_TRUE, GL_FALSE);
    glDepthMask(GL_FALSE);
}

void SetGl1ApplicationState() {
    static const GLshort VERTICES[12] = {};
    static const GLfloat COORDINATES[8] = {};
    glMatrixMode(GL_PROJECTION);
    glFrustumf(-1, 1, -0.75f, 0.75f, 1, 100);
    glMatrixMode(GL_MODELVIEW);
    glTranslatef(1, 2, -5);
    glMatrixMode(GL_TEXTURE);
    glBlendFunc(GL_SRC_ALPHA, GL_ONE);
    for (GLenum on : {GL_ALPHA_TEST, GL_TEXTURE_2D, GL_LIGHTING}) glEnable(on);
    glAlphaFunc(GL_GREATER, 0.25f);
    glTexEnvi(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_DECAL);
    glDisableClientState(GL_VERTEX_ARRAY);
    for (GLenum array : {GL_TEXTURE_COORD_ARRAY, GL_COLOR_ARRAY, GL_NORMAL_ARRAY, GL_POINT_SIZE_ARRAY_OES})
        glEnableClientState(array);
    glColor4f(0.25f, 0.5f, 0.75f, 0.125f);
    glVertexPointer(3, GL_SHORT, 6, VERTICES);
    glTexCoordPointer(2, GL_FLOAT, 8, COORDINATES);
}

// llvmpipe under qemu-arm samples a GL_LINEAR texture at one place wherever it is drawn
// (measured: a 64 x 32 red | green texture drawn 1:1 came out (129, 125, 0) in every column,
// a 2 x 1 one red in every column), so the overlay's placement cannot be seen there. Draws a
// red | green texture with ES 1.x and reads its first column back red and its last green.
bool LinearTexturesSampleWhereAsked(int32_t width, int32_t height) {
    static const GLubyte TEXELS[] = {255, 0, 0, 255, 0, 255, 0, 255};
    static const GLfloat COORDINATES[] = {0, 0, 1, 0, 0, 1, 1, 1};
    static const GLfloat CORNERS[] = {-1, -1, 1, -1, -1, 1, 1, 1};
    GLuint texture = 0;
    glGenTextures(1, &texture);
    glBindTexture(GL_TEXTURE_2D, texture);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, 2, 1, 0, GL_RGBA, GL_UNSIGNED_BYTE, TEXELS);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    glTexEnvi(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_REPLACE);
    glEnable(GL_TEXTURE_2D);
    glViewport(0, 0, width, height);
    glTexCoordPointer(2, GL_FLOAT, 0, COORDINATES);
    glVertexPointer(2, GL_FLOAT, 0, CORNERS);
    glEnableClientState(GL_TEXTURE_COORD_ARRAY);
    glEnableClientState(GL_VERTEX_ARRAY);
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
    GLubyte first[4] = {};
    GLubyte last[4] = {};
    glReadPixels(0, 0, 1, 1, GL_RGBA, GL_UNSIGNED_BYTE, first);
    glReadPixels(width - 1, 0, 1, 1, GL_RGBA, GL_UNSIGNED_BYTE, last);
    glDisableClientState(GL_TEXTURE_COORD_ARRAY);
    glDisableClientState(GL_VERTEX_ARRAY);
    glDisable(GL_TEXTURE_2D);
    glBindTexture(GL_TEXTURE_2D, 0);
    glDeleteTextures(1, &texture);
    return first[0] > 200 && first[1] < 50 && last[0] < 50 && last[1] > 200;
}

class StateOnMesa : public CompositionOnMesa {
protected:
    // `own` and the shared probes, but for `left_as_drawn`.
    static std::vector<Probe> Probes(const ProbeGroups& own, GLenum left_as_drawn = GL_NONE) {
        std::vector<Probe> probes;
        for (const ProbeGroups* groups : {&own, &SHARED_PROBES})
            for (const ProbeGroup& group : *groups)
                for (GLenum name : group.m_names)
                    if (name != left_as_drawn) probes.push_back({group.m_kind, group.m_count, name});
        return probes;
    }

    // `draw` with the application's state set; then every probe reads what it read before.
    template <typename Draw>
    static void ExpectStateKept(const std::vector<Probe>& probes, Draw draw) {
        std::vector<std::vector<double>> before;
        for (const Probe& probe : probes) before.push_back(probe.Read());
        draw();
        for (size_t i = 0; i < probes.size(); ++i)
            EXPECT_EQ(probes[i].Read(), before[i]) << "state 0x" << std::hex << probes[i].m_name;
    }

    void ExpectPresentKeepsState(const ProbeGroups& own) {
        ExpectStateKept(Probes(own), [this] { Present(); });
        ExpectMaskOn(1);  // and the mask was really drawn, where MaskColumnsOnMesa finds it
    }
};

TEST_F(StateOnMesa, TheGl1PathLeavesTheApplicationsStateAsItWas) {
    Open(PATH_GL1, 64, 32);
    SetSharedApplicationState();
    SetGl1ApplicationState();
    ExpectPresentKeepsState(GL1_PROBES);
}

// The overlay, red on its left half and green on its right, composed once over the window
// and into both halves with an eye shift of 8 pixels: each eye's quad is 40 pixels wide, eye
// 0's from the left edge of its half, eye 1's from 8 pixels left of it, so the colours meet
// at column 20 of eye 0's half and column 12 of eye 1's. The application's state comes back,
// but for the scissor box, which stays as drawn.
TEST_F(StateOnMesa, TheOverlayCompositionPlacesEachEyeAndLeavesTheApplicationsState) {
    Open(PATH_GL1, 64, 32);
    const bool placement_visible = LinearTexturesSampleWhereAsked(64, 32);
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    manager.m_profile->m_eye_shift = 8.0f / 400.0f;
    ovo::OverlayTarget overlay(64, 32, ovo::OVERLAY_CREATE_OBJECTS);
    overlay.Create();
    const struct {
        const char* m_label;
        void (*m_compose)(ovo::OverlayTarget&);
        int m_red_columns[2];  // in the window's left and right half; green in the rest
    } cases[] = {
        {"single", [](ovo::OverlayTarget& target) { target.ComposeSingle(0, 0, 64, 32, 0, 1); }, {32, 0}},
        {"stereo",
         [](ovo::OverlayTarget& target) { target.ComposeStereo(ovo::StereoManager::instance(), 0, 0, 32, 32, 0, 1); },
         {20, 12}},
    };
    for (const auto& each : cases) {
        SCOPED_TRACE(each.m_label);
        manager.m_viewport = manager.m_scissor = {0, 0, 64, 32};
        glColorMask(GL_TRUE, GL_TRUE, GL_TRUE, GL_TRUE);
        overlay.DrawInto(manager, ovo::DrawCall::Arrays(GL_TRIANGLES, 0, 0));  // bound, holds content
        glEnable(GL_SCISSOR_TEST);
        for (const auto& [x, green] : {std::pair{0, 0.0f}, std::pair{32, 1.0f}}) {
            glScissor(x, 0, 32, 32);
            glClearColor(1 - green, green, 0, 1);
            glClear(GL_COLOR_BUFFER_BIT);
        }
        overlay.Unbind();
        glDisable(GL_SCISSOR_TEST);
        glClearColor(0, 0, 1, 1);
        glClear(GL_COLOR_BUFFER_BIT);
        SetSharedApplicationState();
        SetGl1ApplicationState();
        ExpectStateKept(Probes(GL1_PROBES, GL_SCISSOR_BOX), [&] { each.m_compose(overlay); });
        if (!placement_visible) continue;
        std::vector<GLubyte> pixels(64 * 32 * 4);
        glReadPixels(0, 0, 64, 32, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
        for (int half = 0; half < 2; ++half) {
            int red = 0;
            int green = 0;
            for (int y = 0; y < 32; ++y) {
                for (int x = 32 * half; x < 32 * half + 32; ++x) {
                    const GLubyte* pixel = &pixels[(static_cast<size_t>(y) * 64 + x) * 4];
                    red += pixel[0] > 200 && pixel[1] < 50 && pixel[2] < 50;
                    green += pixel[1] > 200 && pixel[0] < 50 && pixel[2] < 50;
                }
            }
            EXPECT_EQ(red, each.m_red_columns[half] * 32) << "half " << half;
            EXPECT_EQ(green, (32 - each.m_red_columns[half]) * 32) << "half " << half;
        }
    }
    if (!placement_visible) GTEST_SKIP() << "state checked; placement not: this Mesa filters GL_LINEAR textures wrongly";
}

// Attribute 0 as an application leaves it, unlike the mask's and GL's defaults.
struct AttributeCase {
    const char* m_label;
    bool m_enabled;
    bool m_from_buffer;  // at offset 8 of a buffer other than the array buffer, or a client array
    GLint m_size;
    GLenum m_type;
    GLsizei m_stride;
};

const AttributeCase ATTRIBUTE_CASES[] = {
    {"enabled, from a buffer object", true, true, 3, GL_SHORT, 12},
    {"disabled, from a client array", false, false, 4, GL_UNSIGNED_BYTE, 8},
};

void SetAttribute0(const AttributeCase& each) {
    static const GLubyte CLIENT_ARRAY[64] = {};
    GLint array_buffer = 0;
    glGetIntegerv(GL_ARRAY_BUFFER_BINDING, &array_buffer);
    GLuint buffer = 0;
    if (each.m_from_buffer) glGenBuffers(1, &buffer);
    glBindBuffer(GL_ARRAY_BUFFER, buffer);
    const void* pointer = each.m_from_buffer ? reinterpret_cast<const void*>(8) : CLIENT_ARRAY;
    glVertexAttribPointer(0, each.m_size, each.m_type, GL_TRUE, each.m_stride, pointer);
    each.m_enabled ? glEnableVertexAttribArray(0) : glDisableVertexAttribArray(0);
    glBindBuffer(GL_ARRAY_BUFFER, static_cast<GLuint>(array_buffer));
}

TEST_F(StateOnMesa, TheGl2PathLeavesTheApplicationsStateAsItWas) {
    Open(PATH_GL2, 64, 32);
    for (const AttributeCase& each : ATTRIBUTE_CASES) {
        SCOPED_TRACE(each.m_label);
        SetSharedApplicationState();
        glUseProgram(FillProgram());
        SetAttribute0(each);
        ExpectPresentKeepsState(GL2_PROBES);
    }
}

// An application that sets its attribute once, as SDL's testgles2 does, draws the same
// frame after the swap that drew the mask.
TEST_F(CompositionOnMesa, AnEs2ProgramThatSetsItsAttributeOnceDrawsAgainAfterTheSwap) {
    Open(PATH_GL2, 64, 32);
    ovo::StereoManager& manager = ovo::StereoManager::instance();
    manager.m_composer = new ovo::CompositionRenderer(1);  // released at exit
    manager.m_interleave = true;
    static const GLfloat TRIANGLE[] = {-0.5f, -0.5f, 0.5f, -0.5f, 0.0f, 0.5f};
    GLuint buffer = 0;
    glGenBuffers(1, &buffer);
    glBindBuffer(GL_ARRAY_BUFFER, buffer);
    glBufferData(GL_ARRAY_BUFFER, sizeof(TRIANGLE), TRIANGLE, GL_STATIC_DRAW);
    glVertexAttribPointer(0, 2, GL_FLOAT, GL_FALSE, 0, nullptr);
    glEnableVertexAttribArray(0);
    glUseProgram(FillProgram());
    std::vector<GLubyte> frames[2];
    for (std::vector<GLubyte>& frame : frames) {
        glClear(GL_COLOR_BUFFER_BIT);
        glDrawArrays(GL_TRIANGLES, 0, 3);
        frame.resize(static_cast<size_t>(m_width) * m_height * 4);
        glReadPixels(0, 0, m_width, m_height, GL_RGBA, GL_UNSIGNED_BYTE, frame.data());
        ASSERT_TRUE(eglSwapBuffers(eglGetCurrentDisplay(), eglGetCurrentSurface(EGL_DRAW)));
    }
    size_t red = 0;
    for (size_t i = 0; i < frames[0].size(); i += 4) red += frames[0][i] > 127;
    EXPECT_GT(red, frames[0].size() / 4 / 16) << "the first frame shows the triangle";
    EXPECT_TRUE(frames[1] == frames[0]) << "the second frame shows it too";
}

struct MaskCase {
    const char* m_label;
    DrawingPath m_path;
    int32_t m_width;
    int32_t m_height;
};

// Names the case in the test list, which otherwise shows its bytes.
void PrintTo(const MaskCase& each, std::ostream* out) { *out << each.m_label; }

// Measured on llvmpipe: a vertical line exactly on the edge x = 2i between two columns is
// rasterised into the left one, 2i - 1, and the ES 2.0 path's 2i + 0.001 for unknown sizes
// lands there too (it snaps onto the edge). So in both paths the mask covers the odd
// columns (stencil 0), whole columns from top to bottom; line 0 falls just left of the window. 320 x 240
// is not a known size: the mask is drawn as 800 x 480, of which the window shows a corner.
const MaskCase MASK_CASES[] = {
    {"Gl1_800x480", PATH_GL1, 800, 480},
    {"Gl2_800x480", PATH_GL2, 800, 480},
    {"Gl1_320x240", PATH_GL1, 320, 240},
    {"Gl2_320x240", PATH_GL2, 320, 240},
};

class MaskColumnsOnMesa : public CompositionOnMesa,
                          public ::testing::WithParamInterface<MaskCase> {};

TEST_P(MaskColumnsOnMesa, TheMaskHoldsEverySecondColumn) {
    const MaskCase& each = GetParam();
    Open(each.m_path, each.m_width, each.m_height);
    Present();
    Present();  // the second frame redraws the same mask over a cleared stencil
    ExpectMaskOn(1);
}

INSTANTIATE_TEST_SUITE_P(Sizes, MaskColumnsOnMesa, ::testing::ValuesIn(MASK_CASES),
                         [](const ::testing::TestParamInfo<MaskCase>& test) {
                             return test.param.m_label;
                         });

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
