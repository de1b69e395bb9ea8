// The column mask on the recording vendor: the lines, the stencil references, the panel's
// composition start, the exact calls of one frame in each drawing path, and the mask a
// window surface gets at its first stereo draw after it was made current; and the saved-state
// tables beyond what the mask's two paths exercise.
#include "present/composition_renderer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "core/gl_state_table.h"
#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "stereo/es1_stereo_layer.h"
#include "stereo/es2_stereo_layer.h"
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
        m_context = m_egl.CreateContext(path == PATH_GL2 ? 2 : 1);
        ASSERT_EQ(m_egl.MakeCurrent(m_context), EGL_TRUE);
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
    EGLContext m_context = EGL_NO_CONTEXT;
    ovo::CompositionRenderer m_renderer{1};
};

using Calls = std::vector<std::string>;

// The recorded GL calls (or `calls`), naming the first one that differs.
void ExpectCalls(const Calls& expected, const Calls& calls = RecordedGlCalls()) {
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
    int32_t m_width, m_height, m_count;
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

// The application's vertex pointer, as the OpenGL ES 1.x path saves it.
const void* const APPLICATION_VERTICES = &APPLICATION_VERTICES;

// Saved values of the OpenGL ES 1.x path, unlike everything a frame sets.
void AnswerGl1State() {
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
    AnswerBytes(ovo::GL_ENTRY_glGetPointerv, GL_VERTEX_ARRAY_POINTER, &APPLICATION_VERTICES,
                sizeof(void*));
}

// One OpenGL ES 1.x mask over the state of AnswerGl1State, clearing `clear` (as recorded):
// its lines built for 1280 x 720, drawn at 960 x 540.
Calls Gl1MaskCalls(const std::string& clear) {
    return {
        "glEnable(0x0B90)", "glClearStencil(1)", "glClear(" + clear + ")",
        "glStencilFunc(0x0200, 0, 1)", "glStencilOp(0x1E01, 0x1E00, 0x1E00)",
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
}

// The application's attribute 0 as the OpenGL ES 2.0 path saves it: at offset 8 of its buffer.
const void* const ATTRIBUTE_OFFSET = reinterpret_cast<const void*>(8);

// Saved values of the OpenGL ES 2.0 path, and the names of the mask's program (7, its
// uniforms at 3) when it is built.
void AnswerGl2State() {
    AnswerSharedState();
    AnswerEachInteger({{GL_CURRENT_PROGRAM, 9}});
    // The application's attribute 0: off, in buffer 14 (not the array buffer 10).
    AnswerEachInteger({{GL_VERTEX_ATTRIB_ARRAY_ENABLED, 0}, {GL_VERTEX_ATTRIB_ARRAY_BUFFER_BINDING, 14},
                       {GL_VERTEX_ATTRIB_ARRAY_SIZE, 3}, {GL_VERTEX_ATTRIB_ARRAY_TYPE, GL_SHORT},
                       {GL_VERTEX_ATTRIB_ARRAY_NORMALIZED, 1}, {GL_VERTEX_ATTRIB_ARRAY_STRIDE, 12}},
                      ovo::GL_ENTRY_glGetVertexAttribiv);
    AnswerBytes(ovo::GL_ENTRY_glGetVertexAttribPointerv, GL_VERTEX_ATTRIB_ARRAY_POINTER,
                &ATTRIBUTE_OFFSET, sizeof(void*));
    AnswerResult(ovo::GL_ENTRY_glCreateProgram, 0, 7);
    AnswerResult(ovo::GL_ENTRY_glCreateShader, GL_VERTEX_SHADER, 11);
    AnswerResult(ovo::GL_ENTRY_glCreateShader, GL_FRAGMENT_SHADER, 12);
    AnswerResult(ovo::GL_ENTRY_glGetUniformLocation, 7, 3);
}

// One OpenGL ES 2.0 mask over the state of AnswerGl2State at an unknown target size (drawn
// as 800 x 480), clearing `clear`; the share group's program is built first when
// `builds_program`.
Calls Gl2MaskCalls(const std::string& clear, bool builds_program) {
    Calls calls = {
        "glEnable(0x0B90)", "glClearStencil(1)", "glClear(" + clear + ")",
        "glStencilFunc(0x0200, 0, 1)", "glStencilOp(0x1E01, 0x1E00, 0x1E00)",
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
        "glDisable(0x0B44)", "glDisable(0x0B71)"};
    // the share group's program, built at its first mask and kept
    const Calls build = {
        "glCreateProgram()", "glCreateShader(0x8B31)", "glShaderSource(11, 1, ptr, null)",
        "glCompileShader(11)", "glCreateShader(0x8B30)", "glShaderSource(12, 1, ptr, null)",
        "glCompileShader(12)", "glAttachShader(7, 11)", "glAttachShader(7, 12)",
        "glBindAttribLocation(7, 0, ptr)", "glLinkProgram(7)", "glDeleteShader(11)",
        "glDeleteShader(12)", "glGetProgramiv(7, 0x8B82, ptr)", "glGetUniformLocation(7, ptr)",
        "glGetUniformLocation(7, ptr)"};
    if (builds_program) calls.insert(calls.end(), build.begin(), build.end());
    const Calls drawn_and_restored = {
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
    calls.insert(calls.end(), drawn_and_restored.begin(), drawn_and_restored.end());
    return calls;
}

TEST_F(CompositionRendererTest, OneGl1FrameSavesSetsDrawsAndRestoresInOrder) {
    Start(PATH_GL1, 1280, 720);
    m_renderer.Present(Manager());  // builds the lines
    AnswerGl1State();
    SetTargetSize(960, 540);  // the lines stay; viewport and projection follow
    ResetRecorder();
    m_renderer.Present(Manager());
    ExpectCalls(Gl1MaskCalls("0x4500"));
    const RecordedCall* pointer =
        FindRecordedCall(RECORDER_API_GLES1, ovo::GL_ENTRY_glVertexPointer);
    ASSERT_NE(pointer, nullptr);
    EXPECT_EQ(pointer->m_arguments[3], ArgumentBits(APPLICATION_VERTICES))
        << "the saved pointer is put back";
}

TEST_F(CompositionRendererTest, OneGl2FrameBuildsItsProgramAndRestoresInOrder) {
    Start(PATH_GL2, 1024, 600);
    AnswerGl2State();
    m_renderer.Present(Manager());
    ExpectCalls(Gl2MaskCalls("0x4500", true));
    const RecordedCall* pointer =
        FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glVertexAttribPointer);
    ASSERT_NE(pointer, nullptr);
    EXPECT_EQ(pointer->m_arguments[5], ArgumentBits(ATTRIBUTE_OFFSET))
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

// A second window surface for the context of Start.
const EGLSurface OTHER_SURFACE = reinterpret_cast<EGLSurface>(0x6000);

// The mask a window surface gets at its first stereo draw after it was made current, as
// the layers' eye bracket reaches it through the manager's renderer.
class NewSurfaceMaskTest : public CompositionRendererTest {
protected:
    // Interleaving through the manager's renderer; the OpenGL ES 1.x draws are flat.
    void StartInterleaved(DrawingPath path, int32_t width, int32_t height) {
        m_path = path;
        Start(path, width, height);
        if (Manager().m_composer == nullptr) Manager().m_composer = new ovo::CompositionRenderer(1);
        Manager().m_interleave = true;
        const std::vector<GLfloat> identity = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
        for (GLenum matrix : {GL_PROJECTION_MATRIX, GL_MODELVIEW_MATRIX}) {
            AnswerBytes(ovo::GL_ENTRY_glGetFloatv, matrix, identity.data(),
                        identity.size() * sizeof(GLfloat));
        }
    }

    // The process's first Present is over, with the path's state answered.
    void StartPresented(DrawingPath path) {
        if (path == PATH_GL1) {
            StartInterleaved(PATH_GL1, 1280, 720);
            Composer().Present(Manager());
            AnswerGl1State();
            SetTargetSize(960, 540);
        } else {
            StartInterleaved(PATH_GL2, 1024, 600);
            AnswerGl2State();
            Composer().Present(Manager());
        }
    }

    static ovo::CompositionRenderer& Composer() { return *Manager().m_composer; }

    void MakeCurrent(EGLSurface surface) {
        ASSERT_EQ(eglMakeCurrent(m_egl.m_display, surface, surface, m_context), EGL_TRUE);
    }

    // One draw through the path's stereo layer; its GL calls.
    Calls Draw() {
        ResetRecorder();
        if (m_path == PATH_GL1) {
            m_es1.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        } else {
            m_es2.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
        }
        return RecordedGlCalls();
    }

    // The framebuffer query and the stencil-only mask of a new window surface.
    Calls NewSurfaceMask() const {
        Calls calls = {"glGetIntegerv(0x8CA6, ptr)"};
        const Calls mask =
            m_path == PATH_GL1 ? Gl1MaskCalls("0x0400") : Gl2MaskCalls("0x0400", false);
        calls.insert(calls.end(), mask.begin(), mask.end());
        return calls;
    }

    // `draw` with `calls` just before its mask test goes on.
    static Calls BeforeMaskTest(Calls draw, const Calls& calls) {
        const auto mask_test = std::find(draw.begin(), draw.end(), "glEnable(0x0B90)");
        EXPECT_NE(mask_test, draw.end()) << "the draw never switched the mask test on";
        draw.insert(mask_test, calls.begin(), calls.end());
        return draw;
    }

    DrawingPath m_path = PATH_GL1;
    ovo::Es1StereoLayer m_es1;
    ovo::Es2StereoLayer m_es2{ovo::LAYER_SUBMODE_DIRECT};
};

class NewSurfaceMaskPathTest : public NewSurfaceMaskTest,
                               public ::testing::WithParamInterface<DrawingPath> {};

enum Release { RELEASE_NONE, RELEASE_MAKE_CURRENT, RELEASE_THREAD };

// Each case follows the one before it, on a surface that a Present has just masked: its
// first draw is the plain one with the stencil-only mask before its mask test, or the
// plain one; its second draw is the plain one.
TEST_P(NewSurfaceMaskPathTest, ASurfaceIsMaskedAgainOnlyAfterAReleaseOrAnotherSurface) {
    StartPresented(GetParam());
    const Calls plain = Draw();
    struct Case {
        const char* m_label;
        Release m_release;
        EGLSurface m_surface;
        bool m_masked;
    } cases[] = {
        {"the same surface again", RELEASE_NONE, EglSession::Surface(), false},
        {"the same surface after a make-current without a context", RELEASE_MAKE_CURRENT,
         EglSession::Surface(), true},
        {"the same surface after eglReleaseThread", RELEASE_THREAD, EglSession::Surface(), true},
        {"another surface", RELEASE_NONE, OTHER_SURFACE, true},
        {"the other surface again", RELEASE_NONE, OTHER_SURFACE, false},
        {"the first surface back", RELEASE_NONE, EglSession::Surface(), true},
    };
    for (const Case& each : cases) {
        SCOPED_TRACE(each.m_label);
        Composer().Present(Manager());
        if (each.m_release == RELEASE_MAKE_CURRENT) {
            ASSERT_EQ(m_egl.MakeCurrent(EGL_NO_CONTEXT), EGL_TRUE);
        }
        // The recording vendor answers eglReleaseThread with a value of its own, not EGL_TRUE.
        if (each.m_release == RELEASE_THREAD) {
            ASSERT_NE(eglReleaseThread(), EGL_FALSE);
        }
        MakeCurrent(each.m_surface);
        ExpectCalls(each.m_masked ? BeforeMaskTest(plain, NewSurfaceMask()) : plain, Draw());
        ExpectCalls(plain, Draw());
    }
}

INSTANTIATE_TEST_SUITE_P(Paths, NewSurfaceMaskPathTest, ::testing::Values(PATH_GL1, PATH_GL2),
                         [](const ::testing::TestParamInfo<DrawingPath>& test) {
                             return test.param == PATH_GL2 ? "Gl2" : "Gl1";
                         });

TEST_F(NewSurfaceMaskTest, NothingIsMaskedBeforeTheProcesssFirstPresent) {
    StartInterleaved(PATH_GL1, 1280, 720);
    AnswerGl1State();
    MakeCurrent(OTHER_SURFACE);
    const Calls before = Draw();
    Composer().Present(Manager());  // builds the lines and masks the surface
    SetTargetSize(960, 540);
    const Calls plain = Draw();
    ExpectCalls(plain, before);
    MakeCurrent(EglSession::Surface());
    ExpectCalls(BeforeMaskTest(plain, NewSurfaceMask()), Draw());
}

// The framebuffer binding is asked at every draw until the window's is bound.
TEST_F(NewSurfaceMaskTest, NothingIsMaskedWhileTheApplicationsFramebufferIsBound) {
    StartPresented(PATH_GL1);
    const Calls plain = Draw();
    MakeCurrent(OTHER_SURFACE);
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_FRAMEBUFFER_BINDING, {5});
    for (int draw = 0; draw < 2; ++draw) {
        ExpectCalls(BeforeMaskTest(plain, {"glGetIntegerv(0x8CA6, ptr)"}), Draw());
    }
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_FRAMEBUFFER_BINDING, {0});
    ExpectCalls(BeforeMaskTest(plain, NewSurfaceMask()), Draw());
    ExpectCalls(plain, Draw());
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

// Appending saves, the capacity, and positions that were never saved.
TEST(GlStateTableTest, SavesAppendUpToTheCapacityAndRestoreOnlyWhatWasSaved) {
    vendor_root::InstallRecorder();
    EglSession egl;
    egl.Open();
    ASSERT_EQ(egl.MakeCurrent(egl.CreateContext(1)), EGL_TRUE);
    const ovo::GlStateItem alpha = {ovo::GL_STATE_ALPHA_FUNC, 0, true, {GL_NOTEQUAL, 0}};
    std::vector<ovo::GlStateItem> many(ovo::GL_STATE_CAPACITY + 5,
                                       {ovo::GL_STATE_ENABLE, GL_DITHER, false, {}});
    many[ovo::GL_STATE_CAPACITY - 2] = {ovo::GL_STATE_ENABLE, GL_FOG, true, {0}};
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_ALPHA_TEST_FUNC, {GL_LESS});
    AnswerFloats(ovo::GL_ENTRY_glGetFloatv, GL_ALPHA_TEST_REF, {0.75f});
    AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_FOG, GL_TRUE);
    AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_DITHER, GL_FALSE);
    ResetRecorder();

    ovo::GlStateSnapshot saved;
    saved.Save(&alpha, 1);
    saved.Save(many.data(), many.size());
    EXPECT_EQ(saved.Count(), ovo::GL_STATE_CAPACITY);
    std::vector<std::string> calls = RecordedGlCalls();
    ASSERT_EQ(calls.size(), 2 + 1 + (ovo::GL_STATE_CAPACITY - 1) + 1);
    EXPECT_EQ(calls[2], "glAlphaFunc(0x0205, 0)");
    EXPECT_EQ(calls[calls.size() - 2], "glIsEnabled(0x0B60)") << "the last item that fits";
    EXPECT_EQ(calls.back(), "glDisable(0x0B60)");

    ResetRecorder();
    const uint8_t order[] = {ovo::GL_STATE_CAPACITY - 1, ovo::GL_STATE_CAPACITY, 0, 200, 1};
    saved.Restore(order, std::size(order));
    EXPECT_EQ(RecordedGlCalls(), (std::vector<std::string>{"glEnable(0x0B60)",
                                                           "glAlphaFunc(0x0201, 0.75)",
                                                           "glDisable(0x0BD0)"}));
}

}  // namespace
