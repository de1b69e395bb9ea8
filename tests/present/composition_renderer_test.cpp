// The column mask on the recording vendor: the lines, the stencil references, the panel's
// composition start, and the exact calls of one frame in each drawing path.
#include "present/composition_renderer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "support/device_files.h"
#include "support/egl_session.h"
#include "support/forwarding_check.h"
#include "support/recorded_calls.h"
#include "support/vendor_root.h"

namespace {

using namespace recorded_calls;

enum DrawingPath : bool { PATH_GL1 = false, PATH_GL2 = true };

class CompositionRendererTest : public ::testing::Test {
protected:
    void Start(DrawingPath path, int32_t width, int32_t height) {
        vendor_root::InstallRecorder();
        m_egl.Open();
        ASSERT_NE(m_egl.m_display, EGL_NO_DISPLAY);
        ASSERT_EQ(m_egl.MakeCurrent(m_egl.CreateContext(path == PATH_GL2 ? 2 : 1)), EGL_TRUE);
        device_files::Write("/dev/zdriver", "");
        Manager().m_es2_layer_installed = path == PATH_GL2;
        SetTargetSize(width, height);
        ClearAnswers();
        ResetRecorder();
    }

    static ovo::StereoManager& Manager() { return ovo::StereoManager::instance(); }
    static void SetTargetSize(int32_t width, int32_t height) {
        Manager().m_profile->m_target_width = width;
        Manager().m_profile->m_target_height = height;
    }

    EglSession m_egl;
    ovo::CompositionRenderer m_renderer{1};
};

// The recorded GL calls, naming the first one that differs.
void ExpectCalls(const std::vector<std::string>& expected) {
    const std::vector<std::string> calls = RecordedGlCalls();
    for (size_t i = 0; i < std::max(calls.size(), expected.size()); ++i) {
        ASSERT_EQ(i < calls.size() ? calls[i] : "(none)",
                  i < expected.size() ? expected[i] : "(none)")
            << "call " << i;
    }
}

// glGetIntegerv (or the query given) answers one value for each name.
void AnswerEachInteger(std::initializer_list<std::pair<GLenum, GLint>> values,
                       uint32_t gl_index = ovo::GL_ENTRY_glGetIntegerv) {
    for (auto [name, value] : values) AnswerIntegers(gl_index, name, {value});
}

// Saved values, unlike everything a frame sets, of the state that both paths save.
void AnswerSharedState() {
    AnswerBooleans(ovo::GL_ENTRY_glGetBooleanv, GL_COLOR_WRITEMASK, {0, 1, 0, 1});
    AnswerBooleans(ovo::GL_ENTRY_glGetBooleanv, GL_DEPTH_WRITEMASK, {1});
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_VIEWPORT, {1, 2, 3, 4});
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_SCISSOR_BOX, {5, 6, 7, 8});
    AnswerEachInteger({{GL_ARRAY_BUFFER_BINDING, 10}, {GL_CULL_FACE_MODE, GL_FRONT}, {GL_FRONT_FACE, GL_CW}});
    for (GLenum on : {GL_BLEND, GL_CULL_FACE}) AnswerResult(ovo::GL_ENTRY_glIsEnabled, on, GL_TRUE);
    AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_DEPTH_TEST, GL_FALSE);
}

struct Line {
    float m_ends[4];  // x0, y0, x1, y1
};

struct LineCase {
    const char* m_label;
    DrawingPath m_path;
    int32_t m_width;
    int32_t m_height;
    int32_t m_count;
    Line m_first;
    Line m_last;
};

// Unknown sizes are drawn as 800 x 480.
constexpr Line GL2_FALLBACK_FIRST = {{0.001f, 480, 0.001f, 0}};
constexpr Line GL2_FALLBACK_LAST = {{800.001f, 480, 800.001f, 0}};
constexpr Line GL1_FALLBACK_FIRST = {{-400, 240, -400, -240}};
constexpr Line GL1_FALLBACK_LAST = {{400, 240, 400, -240}};

const LineCase LINE_CASES[] = {
    {"Gl2_1280x720", PATH_GL2, 1280, 720, 641, {0, 0, 0, 720}, {1280, 0, 1280, 720}},
    {"Gl1_1280x720", PATH_GL1, 1280, 720, 641, {-640, 360, -640, -360}, {640, 360, 640, -360}},
    {"Gl1_480x800", PATH_GL1, 480, 800, 241, {-240, 400, -240, -400}, {240, 400, 240, -400}},
    // Every other known size, once in one path.
    {"Gl2_800x480", PATH_GL2, 800, 480, 401, {0, 0, 0, 480}, {800, 0, 800, 480}},
    {"Gl1_800x1280", PATH_GL1, 800, 1280, 401, {-400, 640, -400, -640}, {400, 640, 400, -640}},
    {"Gl2_960x540", PATH_GL2, 960, 540, 481, {0, 0, 0, 540}, {960, 0, 960, 540}},
    {"Gl1_540x960", PATH_GL1, 540, 960, 271, {-270, 480, -270, -480}, {270, 480, 270, -480}},
    {"Gl2_1280x800", PATH_GL2, 1280, 800, 641, {0, 0, 0, 800}, {1280, 0, 1280, 800}},
    {"Gl1_720x1280", PATH_GL1, 720, 1280, 361, {-360, 640, -360, -640}, {360, 640, 360, -640}},
    {"Gl2_1024x600", PATH_GL2, 1024, 600, 401, GL2_FALLBACK_FIRST, GL2_FALLBACK_LAST},
    {"Gl1_1024x600", PATH_GL1, 1024, 600, 401, GL1_FALLBACK_FIRST, GL1_FALLBACK_LAST},
    {"Gl2_0x0", PATH_GL2, 0, 0, 401, GL2_FALLBACK_FIRST, GL2_FALLBACK_LAST},
    {"Gl1_0x0", PATH_GL1, 0, 0, 401, GL1_FALLBACK_FIRST, GL1_FALLBACK_LAST},
    {"Gl2_Negative", PATH_GL2, -800, -480, 401, GL2_FALLBACK_FIRST, GL2_FALLBACK_LAST},
    {"Gl1_Negative", PATH_GL1, -1280, 720, 401, GL1_FALLBACK_FIRST, GL1_FALLBACK_LAST},
    {"Gl1_Huge", PATH_GL1, 0x7FFFFFFF, 0x7FFFFFFF, 401, GL1_FALLBACK_FIRST, GL1_FALLBACK_LAST},
};

void ExpectLine(const float* line, const Line& expected, const char* which) {
    for (int i = 0; i < 4; ++i) EXPECT_FLOAT_EQ(line[i], expected.m_ends[i]) << which << " end " << i;
}

// Names the case in the test list, which otherwise shows its bytes.
void PrintTo(const LineCase& each, std::ostream* out) { *out << each.m_label; }

class MaskLinesTest : public CompositionRendererTest,
                      public ::testing::WithParamInterface<LineCase> {};

// Each case is a process of its own: the lines are built once per process.
TEST_P(MaskLinesTest, AreBuiltForTheTargetSizeOfTheFirstPresent) {
    const LineCase& each = GetParam();
    Start(each.m_path, each.m_width, each.m_height);
    m_renderer.Present(Manager());
    ASSERT_EQ(m_renderer.LineCount(), each.m_count);
    const float* lines = m_renderer.Vertices();
    ExpectLine(lines, each.m_first, "line 0");
    ExpectLine(&lines[4 * (each.m_count - 1)], each.m_last, "last line");
    for (int32_t i = 1; i < each.m_count; ++i) {
        ASSERT_NEAR(lines[4 * i] - lines[4 * (i - 1)], 2.0f, 1e-3f)
            << "line " << i << " is two columns on";
        ASSERT_EQ(lines[4 * i], lines[4 * i + 2]) << "line " << i << " is vertical";
    }
    const std::string draw = "glDrawArrays(1, 0, " + std::to_string(2 * each.m_count) + ")";
    const std::vector<std::string> calls = RecordedGlCalls();
    EXPECT_NE(std::find(calls.begin(), calls.end(), draw), calls.end()) << draw;
}

INSTANTIATE_TEST_SUITE_P(Sizes, MaskLinesTest, ::testing::ValuesIn(LINE_CASES),
                         [](const ::testing::TestParamInfo<LineCase>& test) {
                             return test.param.m_label;
                         });

TEST_F(CompositionRendererTest, EyesSelectTheirStencilReferenceAndClearsKeepTheMask) {
    Start(PATH_GL2, 800, 480);
    struct Case {
        uint32_t m_swap_eyes;
        int m_eye;
        const char* m_call;
    } cases[] = {{1, 0, "glStencilFunc(0x0202, 1, 1)"},
                 {1, 1, "glStencilFunc(0x0202, 0, 1)"},
                 {7, 0, "glStencilFunc(0x0202, 1, 1)"},
                 {0, 0, "glStencilFunc(0x0202, 0, 1)"},
                 {0, 1, "glStencilFunc(0x0202, 1, 1)"}};
    for (const Case& each : cases) {
        ResetRecorder();
        ovo::CompositionRenderer(each.m_swap_eyes).SelectEye(each.m_eye);
        EXPECT_EQ(RecordedGlCalls(), std::vector<std::string>{each.m_call})
            << "swap " << each.m_swap_eyes << " eye " << each.m_eye;
    }
    ResetRecorder();
    m_renderer.SetMaskTest(1);
    m_renderer.SetMaskTest(0);
    m_renderer.SetMaskTest(2);
    EXPECT_EQ(RecordedGlCalls(), (std::vector<std::string>{"glEnable(0x0B90)", "glDisable(0x0B90)",
                                                           "glDisable(0x0B90)"}));
    EXPECT_EQ(ovo::CompositionRenderer::FilterClearMask(0x4500), 0x4100u);
    EXPECT_EQ(ovo::CompositionRenderer::FilterClearMask(0x4000), 0x4000u);
    EXPECT_EQ(ovo::CompositionRenderer::FilterClearMask(0x0400), 0x0000u);
}

TEST_F(CompositionRendererTest,
       TheCompositionStartsOnceAndLaterSizesMoveOnlyViewportAndProjection) {
    Start(PATH_GL2, 800, 480);
    m_renderer.Present(Manager());
    SetTargetSize(1280, 720);
    ResetRecorder();
    m_renderer.Present(Manager());
    m_renderer.Present(Manager());
    EXPECT_EQ(device_files::Read("/dev/zdriver"), "request=0x616 argument=1\n");
    EXPECT_EQ(m_renderer.LineCount(), 401);
    const std::vector<std::string> calls = RecordedGlCalls();
    EXPECT_EQ(std::count(calls.begin(), calls.end(), "glViewport(0, 0, 1280, 720)"), 2);
    EXPECT_EQ(std::count(calls.begin(), calls.end(), "glDrawArrays(1, 0, 802)"), 2);
    // The projection is read where the vendor received it.
    const RecordedCall* uniform =
        FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glUniformMatrix4fv);
    ASSERT_NE(uniform, nullptr);
    const float* projection = reinterpret_cast<const float*>(uniform->m_arguments[3]);
    EXPECT_FLOAT_EQ(projection[0], 2.0f / 1280);
    EXPECT_FLOAT_EQ(projection[5], 2.0f / 720);
    // Each frame points attribute 0 at the lines, before putting the application's back.
    const RecorderState& state = *RecorderGetState();
    int line_pointers = 0;
    for (uint32_t i = 0; i < state.m_call_count; ++i) {
        const RecordedCall& call = state.m_calls[i];
        line_pointers += call.m_index == ovo::GL_ENTRY_glVertexAttribPointer &&
                         call.m_arguments[5] == ArgumentBits(m_renderer.Vertices());
    }
    EXPECT_EQ(line_pointers, 2);
}

// A context that the registry cannot follow (past its capacity) has no share group to keep
// the mask's program for: each frame makes its own and deletes it.
TEST_F(CompositionRendererTest, AContextOfNoKnownGroupDeletesItsProgramEachFrame) {
    Start(PATH_GL2, 800, 480);
    EGLContext last = EGL_NO_CONTEXT;
    for (size_t i = 0; i < ovo::CONTEXT_REGISTRY_CAPACITY; ++i) last = m_egl.CreateContext(2);
    ASSERT_EQ(m_egl.MakeCurrent(last), EGL_TRUE);
    ASSERT_EQ(Manager().m_contexts->ShareGroupOf(last), ovo::SHARE_GROUP_NONE);
    AnswerResult(ovo::GL_ENTRY_glCreateProgram, 0, 7);
    ResetRecorder();
    m_renderer.Present(Manager());
    m_renderer.Present(Manager());
    const std::vector<std::string> calls = RecordedGlCalls();
    EXPECT_EQ(std::count(calls.begin(), calls.end(), "glCreateProgram()"), 2);
    EXPECT_EQ(std::count(calls.begin(), calls.end(), "glDeleteProgram(7)"), 2);
}

TEST_F(CompositionRendererTest, OneGl1FrameSavesSetsDrawsAndRestoresInOrder) {
    Start(PATH_GL1, 1280, 720);
    m_renderer.Present(Manager());  // builds the lines
    AnswerSharedState();
    AnswerEachInteger({{GL_MATRIX_MODE, GL_TEXTURE}, {GL_BLEND_SRC, GL_SRC_ALPHA},
                       {GL_BLEND_DST, GL_ONE_MINUS_SRC_ALPHA}, {GL_ALPHA_TEST_FUNC, GL_GREATER},
                       {GL_TEXTURE_BINDING_2D, 21}, {GL_VERTEX_ARRAY_SIZE, 3}, {GL_VERTEX_ARRAY_TYPE, GL_SHORT},
                       {GL_VERTEX_ARRAY_STRIDE, 12}, {GL_TEXTURE_COORD_ARRAY_SIZE, 2},
                       {GL_TEXTURE_COORD_ARRAY_TYPE, GL_FLOAT}, {GL_TEXTURE_COORD_ARRAY_STRIDE, 8}});
    for (GLenum on :
         {GL_TEXTURE_2D, GL_ALPHA_TEST, GL_TEXTURE_COORD_ARRAY, GL_COLOR_ARRAY, GL_NORMAL_ARRAY})
        AnswerResult(ovo::GL_ENTRY_glIsEnabled, on, GL_TRUE);
    for (GLenum off : {GL_LIGHTING, GL_SCISSOR_TEST, GL_VERTEX_ARRAY, GL_POINT_SIZE_ARRAY_OES})
        AnswerResult(ovo::GL_ENTRY_glIsEnabled, off, GL_FALSE);
    AnswerFloats(ovo::GL_ENTRY_glGetFloatv, GL_ALPHA_TEST_REF, {0.5f});
    AnswerFloats(ovo::GL_ENTRY_glGetFloatv, GL_CURRENT_COLOR, {0.25f, 0.5f, 0.75f, 0.125f});
    AnswerIntegers(ovo::GL_ENTRY_glGetTexEnviv, GL_TEXTURE_ENV_MODE, {GL_MODULATE});
    const void* application_vertices = &application_vertices;
    AnswerBytes(ovo::GL_ENTRY_glGetPointerv, GL_VERTEX_ARRAY_POINTER, &application_vertices, sizeof(void*));
    SetTargetSize(960, 540);  // the lines stay; viewport and projection follow
    ResetRecorder();
    m_renderer.Present(Manager());
    const std::vector<std::string> expected = {
        "glEnable(0x0B90)", "glClearStencil(1)", "glClear(0x4500)", "glStencilFunc(0x0200, 0, 1)",
        "glStencilOp(0x1E01, 0x1E00, 0x1E00)",
        // saved, the write masks switched off right away
        "glGetBooleanv(0x0C23, ptr)", "glColorMask(0, 0, 0, 0)", "glGetBooleanv(0x0B72, ptr)",
        "glDepthMask(0)", "glGetIntegerv(0x0BA0, ptr)", "glGetIntegerv(0x0BE1, ptr)",
        "glGetIntegerv(0x0BE0, ptr)", "glGetIntegerv(0x0BA2, ptr)", "glGetIntegerv(0x0C10, ptr)",
        "glIsEnabled(0x0BE2)", "glIsEnabled(0x0B71)", "glIsEnabled(0x0DE1)", "glIsEnabled(0x0B50)",
        "glIsEnabled(0x0BC0)", "glIsEnabled(0x0C11)", "glGetIntegerv(0x0BC1, ptr)",
        "glGetFloatv(0x0BC2, ptr)", "glGetIntegerv(0x8069, ptr)",
        "glGetTexEnviv(0x2300, 0x2200, ptr)", "glGetIntegerv(0x8894, ptr)", "glIsEnabled(0x8078)",
        "glIsEnabled(0x8074)", "glIsEnabled(0x8076)", "glIsEnabled(0x8075)", "glIsEnabled(0x8B9C)",
        "glGetFloatv(0x0B00, ptr)", "glIsEnabled(0x0B44)",
        "glGetIntegerv(0x0B45, ptr)", "glGetIntegerv(0x0B46, ptr)", "glGetIntegerv(0x807A, ptr)",
        "glGetIntegerv(0x807B, ptr)", "glGetIntegerv(0x807C, ptr)", "glGetPointerv(0x808E, ptr)",
        "glGetIntegerv(0x8088, ptr)", "glGetIntegerv(0x8089, ptr)", "glGetIntegerv(0x808A, ptr)",
        "glGetPointerv(0x8092, ptr)",
        // set
        "glCullFace(0x0405)", "glFrontFace(0x0901)", "glBindBuffer(0x8892, 0)",
        "glBindTexture(0x0DE1, 0)", "glMatrixMode(0x1701)", "glPushMatrix()", "glLoadIdentity()",
        "glOrthof(-480, 480, -270, 270, -1, 1)", "glViewport(0, 0, 960, 540)",
        "glScissor(0, 0, 960, 540)", "glMatrixMode(0x1700)", "glPushMatrix()", "glLoadIdentity()",
        "glEnableClientState(0x8074)", "glDisableClientState(0x8078)",
        "glDisableClientState(0x8076)", "glDisableClientState(0x8075)",
        "glDisableClientState(0x8B9C)", "glDisable(0x0DE1)", "glDisable(0x0BC0)",
        "glDisable(0x0C11)", "glDisable(0x0B50)", "glDisable(0x0B44)", "glDisable(0x0B71)",
        "glColor4f(1, 1, 1, 1)",
        // drawn: the 641 lines built for 1280 x 720
        "glVertexPointer(2, 0x1406, 0, ptr)", "glDrawArrays(1, 0, 1282)",
        // restored
        "glMatrixMode(0x1701)", "glPopMatrix()", "glMatrixMode(0x1700)", "glPopMatrix()",
        "glEnable(0x0BC0)", "glAlphaFunc(0x0204, 0.5)", "glDisable(0x0C11)", "glEnable(0x0BE2)",
        "glDisable(0x0B71)", "glEnable(0x0DE1)", "glDisable(0x0B50)", "glMatrixMode(0x1702)",
        "glViewport(1, 2, 3, 4)", "glScissor(5, 6, 7, 8)", "glBlendFunc(0x0302, 0x0303)",
        "glBindTexture(0x0DE1, 21)", "glTexEnvi(0x2300, 0x2200, 8448)", "glBindBuffer(0x8892, 10)",
        "glEnableClientState(0x8078)", "glDisableClientState(0x8074)",
        "glEnableClientState(0x8076)", "glEnableClientState(0x8075)",
        "glDisableClientState(0x8B9C)", "glColor4f(0.25, 0.5, 0.75, 0.125)", "glEnable(0x0B44)",
        "glCullFace(0x0404)",
        "glFrontFace(0x0900)", "glVertexPointer(3, 0x1402, 12, ptr)",
        "glTexCoordPointer(2, 0x1406, 8, null)", "glDepthMask(1)", "glColorMask(0, 1, 0, 1)",
        // the stencil stage back to keeping
        "glStencilOp(0x1E00, 0x1E00, 0x1E00)", "glDisable(0x0B90)"};
    ExpectCalls(expected);
    const RecordedCall* pointer =
        FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glVertexPointer);
    ASSERT_NE(pointer, nullptr);
    EXPECT_EQ(pointer->m_arguments[3], ArgumentBits(application_vertices))
        << "the saved pointer is put back";
}

TEST_F(CompositionRendererTest, OneGl2FrameBuildsItsProgramAndRestoresInOrder) {
    Start(PATH_GL2, 1024, 600);  // unknown: drawn as 800 x 480
    AnswerSharedState();
    AnswerEachInteger({{GL_CURRENT_PROGRAM, 9}});
    // The application's attribute 0: off, at offset 8 of buffer 14 (not the array buffer 10).
    AnswerEachInteger({{GL_VERTEX_ATTRIB_ARRAY_ENABLED, 0}, {GL_VERTEX_ATTRIB_ARRAY_BUFFER_BINDING, 14},
                       {GL_VERTEX_ATTRIB_ARRAY_SIZE, 3}, {GL_VERTEX_ATTRIB_ARRAY_TYPE, GL_SHORT},
                       {GL_VERTEX_ATTRIB_ARRAY_NORMALIZED, 1}, {GL_VERTEX_ATTRIB_ARRAY_STRIDE, 12}},
                      ovo::GL_ENTRY_glGetVertexAttribiv);
    const void* attribute_offset = reinterpret_cast<const void*>(8);
    AnswerBytes(ovo::GL_ENTRY_glGetVertexAttribPointerv, GL_VERTEX_ATTRIB_ARRAY_POINTER,
                &attribute_offset, sizeof(void*));
    AnswerResult(ovo::GL_ENTRY_glCreateProgram, 0, 7);
    AnswerResult(ovo::GL_ENTRY_glCreateShader, GL_VERTEX_SHADER, 11);
    AnswerResult(ovo::GL_ENTRY_glCreateShader, GL_FRAGMENT_SHADER, 12);
    AnswerResult(ovo::GL_ENTRY_glGetUniformLocation, 7, 3);
    m_renderer.Present(Manager());
    const std::vector<std::string> expected = {
        "glEnable(0x0B90)", "glClearStencil(1)", "glClear(0x4500)", "glStencilFunc(0x0200, 0, 1)",
        "glStencilOp(0x1E01, 0x1E00, 0x1E00)",
        // saved
        "glGetIntegerv(0x8B8D, ptr)", "glGetBooleanv(0x0C23, ptr)", "glGetBooleanv(0x0B72, ptr)",
        "glGetIntegerv(0x0BA2, ptr)", "glGetIntegerv(0x0C10, ptr)", "glIsEnabled(0x0BE2)",
        "glIsEnabled(0x0B71)", "glGetIntegerv(0x8894, ptr)", "glGetVertexAttribiv(0, 0x8622, ptr)",
        "glGetVertexAttribiv(0, 0x889F, ptr)", "glGetVertexAttribiv(0, 0x8623, ptr)",
        "glGetVertexAttribiv(0, 0x8625, ptr)", "glGetVertexAttribiv(0, 0x886A, ptr)",
        "glGetVertexAttribiv(0, 0x8624, ptr)", "glGetVertexAttribPointerv(0, 0x8645, ptr)",
        "glIsEnabled(0x0B44)",
        "glGetIntegerv(0x0B45, ptr)", "glGetIntegerv(0x0B46, ptr)",
        // set
        "glColorMask(0, 0, 0, 0)", "glDepthMask(0)", "glCullFace(0x0405)", "glFrontFace(0x0901)",
        "glBindBuffer(0x8892, 0)", "glViewport(0, 0, 800, 480)", "glScissor(0, 0, 800, 480)",
        "glDisable(0x0B44)", "glDisable(0x0B71)",
        // the share group's program, built at its first frame and kept
        "glCreateProgram()", "glCreateShader(0x8B31)", "glShaderSource(11, 1, ptr, null)",
        "glCompileShader(11)", "glCreateShader(0x8B30)", "glShaderSource(12, 1, ptr, null)",
        "glCompileShader(12)", "glAttachShader(7, 11)", "glAttachShader(7, 12)",
        "glBindAttribLocation(7, 0, ptr)", "glLinkProgram(7)", "glDeleteShader(11)",
        "glDeleteShader(12)", "glGetProgramiv(7, 0x8B82, ptr)", "glGetUniformLocation(7, ptr)",
        "glGetUniformLocation(7, ptr)",
        // drawn
        "glUseProgram(7)", "glUniformMatrix4fv(3, 1, 0, ptr)", "glUniform4f(3, 1, 1, 1, 1)",
        "glEnableVertexAttribArray(0)", "glVertexAttribPointer(0, 2, 0x1406, 0, 0, ptr)",
        "glDrawArrays(1, 0, 802)",
        // restored: the attribute's buffer bound to put it back, then the application's
        "glEnable(0x0BE2)", "glDisable(0x0B71)", "glViewport(1, 2, 3, 4)", "glScissor(5, 6, 7, 8)",
        "glDisableVertexAttribArray(0)", "glBindBuffer(0x8892, 14)",
        "glVertexAttribPointer(0, 3, 0x1402, 1, 12, ptr)", "glBindBuffer(0x8892, 10)",
        "glEnable(0x0B44)", "glCullFace(0x0404)", "glFrontFace(0x0900)",
        "glDepthMask(1)", "glColorMask(0, 1, 0, 1)", "glUseProgram(9)",
        "glStencilOp(0x1E00, 0x1E00, 0x1E00)", "glDisable(0x0B90)"};
    ExpectCalls(expected);
    const RecordedCall* pointer =
        FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glVertexAttribPointer);
    ASSERT_NE(pointer, nullptr);
    EXPECT_EQ(pointer->m_arguments[5], ArgumentBits(attribute_offset))
        << "the saved offset is put back";
    // The sources, byte for byte, as the vendor received them.
    const char* const sources[] = {
        "attribute vec4 myVertex;uniform mat4 myPMVMatrix;void main(void){\tgl_Position = "
        "myPMVMatrix * myVertex;}",
        "uniform mediump vec4 color;void main (void){\tgl_FragColor = color;}"};
    const RecorderState& state = *RecorderGetState();
    int source = 0;
    for (uint32_t i = 0; i < state.m_call_count; ++i) {
        const RecordedCall& call = state.m_calls[i];
        if (call.m_index != ovo::GL_ENTRY_glShaderSource) continue;
        ASSERT_LT(source, 2);
        EXPECT_STREQ(*reinterpret_cast<const char* const*>(call.m_arguments[2]), sources[source++]);
    }
    EXPECT_EQ(source, 2);
}

}  // namespace
