// The OpenGL ES 2.0 layers on the recording vendor: the exact calls of the shader
// injection, of each draw path (the stock live wallpaper's across a rename) and of the
// render-texture bookkeeping.
#include <sys/prctl.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <iterator>
#include <string>
#include <utility>

#include "egl/current_context.h"
#include "stereo/es2_scaled_layer.h"
#include "stereo/es2_stereo_layer.h"
#include "stereo/eye_texture.h"
#include "stereo/gl_object_tracker.h"
#include "stereo/gl_state_guard.h"
#include "stereo_fixture.h"
#include "support/scenario_process.h"

namespace {

using namespace recorded_calls;

constexpr GLuint PROGRAM = 9;
constexpr GLint LOCATION = 4;

class Es2LayerTest : public StereoFixture {
protected:
    void SetUp() override {
        StereoFixture::SetUp();
        UseEs2();
        AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_CURRENT_PROGRAM, {static_cast<GLint>(PROGRAM)});
        AnswerResult(ovo::GL_ENTRY_glGetUniformLocation, PROGRAM, LOCATION);
        BoundFramebuffer(0);
    }

    static void BoundFramebuffer(GLint framebuffer) {
        AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_FRAMEBUFFER_BINDING, {framebuffer});
    }

    // The shader's type and source as the driver answers them.
    static void DriverShader(GLenum type, const char* source) {
        const GLint length = static_cast<GLint>(std::strlen(source) + 1);
        AnswerIntegers(ovo::GL_ENTRY_glGetShaderiv, GL_SHADER_TYPE, {static_cast<GLint>(type)});
        AnswerIntegers(ovo::GL_ENTRY_glGetShaderiv, GL_SHADER_SOURCE_LENGTH, {length});
        AnswerBytes(ovo::GL_ENTRY_glGetShaderSource, length, source, length);
    }

    ovo::Es2StereoLayer m_direct{ovo::LAYER_SUBMODE_DIRECT};
    ovo::Es2StereoLayer m_tracked{ovo::LAYER_SUBMODE_TRACKED};
    ovo::Es2ScaledLayer m_scaled;
};

// The texture coordinates of each glVertexAttribPointer call for attribute 1.
std::vector<const GLfloat*> CoordinatesPointed() {
    std::vector<const GLfloat*> pointed;
    const RecorderState& state = *RecorderGetState();
    for (uint32_t i = 0; i < state.m_call_count; ++i) {
        const RecordedCall& call = state.m_calls[i];
        if (call.m_index == ovo::GL_ENTRY_glVertexAttribPointer && call.m_arguments[0] == 1)
            pointed.push_back(reinterpret_cast<const GLfloat*>(call.m_arguments[5]));
    }
    return pointed;
}

TEST(Es2StereoLayerSubmode, OnlyTheOneGameIsTracked) {
    EXPECT_EQ(ovo::Es2StereoLayer::SubmodeFor("com.vectorunit.green"), ovo::LAYER_SUBMODE_TRACKED);
    for (const char* name : {"com.vectorunit.green2", "com.vectorunit", "", "no.proc.name"}) {
        EXPECT_EQ(ovo::Es2StereoLayer::SubmodeFor(name), ovo::LAYER_SUBMODE_DIRECT) << name;
    }
}

// A vertex shader with main is read back and set again as one string; fragment shaders and
// shaders without main keep the application's source.
TEST_F(Es2LayerTest, OnlyVertexShadersWithMainAreReadBackAndSetAgainAsOneString) {
    const char* parts[] = {"void main() {", " gl_Position = vec4(0.0); }"};
    const char* no_main[] = {"void f() { }"};
    const Calls read_back = {"glGetShaderiv(5, 0x8B4F, ptr)", "glGetShaderiv(5, 0x8B88, ptr)"};
    const struct {
        GLenum m_type;
        const char** m_strings;
        GLsizei m_count;
        Calls m_expected;
    } cases[] = {
        {GL_VERTEX_SHADER, parts, 2,
         Join({{"glShaderSource(5, 2, ptr, null)"}, read_back,
               {"glGetShaderSource(5, 41, ptr, ptr)", "glShaderSource(5, 1, ptr, ptr)"}})},
        {GL_FRAGMENT_SHADER, no_main, 1, {"glShaderSource(5, 1, ptr, null)", "glGetShaderiv(5, 0x8B4F, ptr)"}},
        {GL_VERTEX_SHADER, no_main, 1,
         Join({{"glShaderSource(5, 1, ptr, null)"}, read_back, {"glGetShaderSource(5, 13, ptr, ptr)"}})},
    };
    for (const auto& each : cases) {
        std::string joined;
        for (GLsizei i = 0; i < each.m_count; ++i) joined += each.m_strings[i];
        DriverShader(each.m_type, joined.c_str());
        for (ovo::Es2StereoLayer* layer : {&m_direct, &m_tracked}) {
            ResetRecorder();
            layer->glShaderSource(Manager(), 5, each.m_count, each.m_strings, nullptr);
            EXPECT_EQ(RecordedGlCalls(), each.m_expected) << &each - cases;
        }
    }
}

// For the tracked layer a texture it saw made and bound but never attached is an ordinary one.
TEST_F(Es2LayerTest, AWindowDrawSetsEachEyesUniformThroughTheMask) {
    Interleave(true);
    m_tracked.glBindTexture(Manager(), GL_TEXTURE_2D, 6);
    m_tracked.glTexImage2D(Manager(), GL_TEXTURE_2D, 0, GL_RGBA, 128, 64, 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
    const Calls lookup = {"glGetIntegerv(0x8B8D, ptr)", "glGetUniformLocation(9, ptr)"};
    const Calls eyes = {"glUniform2f(4, 0.25, 0.5)",   "glStencilFunc(0x0202, 1, 1)", "glDrawArrays(4, 0, 3)",
                        "glUniform2f(4, -0.25, -0.5)", "glStencilFunc(0x0202, 0, 1)", "glDrawArrays(4, 0, 3)",
                        "glDisable(0x0B90)"};
    const struct {
        ovo::Es2StereoLayer* m_layer;
        Calls m_expected;
    } cases[] = {{&m_direct, Join({{"glGetIntegerv(0x8CA6, ptr)", "glEnable(0x0B90)"}, lookup, eyes})},
                 {&m_tracked, Join({lookup, {"glEnable(0x0B90)"}, eyes})}};
    for (const auto& each : cases) {
        EXPECT_EQ(Drawn(*each.m_layer), each.m_expected) << &each - cases;
    }
    EXPECT_EQ(Manager().m_program, PROGRAM);
    EXPECT_EQ(Manager().m_depth_shift_location, LOCATION);
    // The name the injected shaders declare.
    const RecordedCall* lookup_call = FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glGetUniformLocation);
    ASSERT_NE(lookup_call, nullptr);
    EXPECT_STREQ(reinterpret_cast<const char*>(lookup_call->m_arguments[1]), "uZpDepthShift");
}

TEST_F(Es2LayerTest, WithoutInterleavingEachEyeDrawsIntoItsHalf) {
    Interleave(false);
    Profile().m_split = ovo::STEREO_SPLIT_TOP_BOTTOM;
    m_direct.glDrawElements(Manager(), GL_TRIANGLES, 6, GL_UNSIGNED_SHORT, nullptr);
    const Calls expected = {
        "glGetIntegerv(0x8CA6, ptr)",  "glGetIntegerv(0x8B8D, ptr)",  "glGetUniformLocation(9, ptr)",
        "glUniform2f(4, 0.25, 0.5)",   "glViewport(0, 240, 800, 240)", "glScissor(0, 240, 800, 240)",
        "glDrawElements(4, 6, 0x1403, null)", "glUniform2f(4, -0.25, -0.5)", "glViewport(0, 0, 800, 240)",
        "glScissor(0, 0, 800, 240)", "glDrawElements(4, 6, 0x1403, null)"};
    EXPECT_EQ(RecordedGlCalls(), expected);
}

// Eye 0's (angle, distance) at three textures in a row: the ramp runs only while
// interleaving, in its OpenGL ES 2.0 form (the z selector ramps the distance).
TEST_F(Es2LayerTest, TheDirectSubmodeRampsInterleavedDrawsAtEachNewTexture) {
    const RampCase cases[] = {
        {ovo::STEREO_RAMP_ON, true, ovo::STEREO_AXIS_X,
         {"glUniform2f(4, 0.25, -0.04)", "glUniform2f(4, 0.25, -0.03)", "glUniform2f(4, 0.25, -0.02)"}},
        {ovo::STEREO_RAMP_ON, true, ovo::STEREO_AXIS_Z,
         {"glUniform2f(4, 0.25, -0.04)", "glUniform2f(4, 0.25, -0.03)", "glUniform2f(4, 0.25, -0.02)"}},
        {ovo::STEREO_RAMP_ON, true, ovo::STEREO_AXIS_Y,
         {"glUniform2f(4, 0.25, -0.04)", "glUniform2f(4, 0.1875, -0.04)", "glUniform2f(4, 0.125, -0.04)"}},
        {ovo::STEREO_RAMP_ON, false, ovo::STEREO_AXIS_X, Calls(3, "glUniform2f(4, 0.5, 0.75)")},
        {ovo::STEREO_RAMP_OFF, true, ovo::STEREO_AXIS_X, Calls(3, "glUniform2f(4, 0.5, 0.75)")},
    };
    Profile().m_eye_distance_set = -0.04f;
    Profile().m_eye_angle_set = 0.25f;
    Profile().m_ramp_steps = 4.0f;
    for (const RampCase& each : cases) {
        Profile().m_eye_angle = 0.5f;
        Profile().m_eye_distance = 0.75f;
        const Calls seen =
            AtThreeTextures(each, [&] { m_direct.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3); }, "glUniform2f", 0);
        EXPECT_EQ(seen, each.m_seen) << std::hex << each.m_ramp << " " << each.m_param;
    }
}

// Scaled as EyeViewportTest's rounding cases, in each path that draws into the window; for a
// render texture the copies' viewport, the window's back, then the halves.
TEST_F(Es2LayerTest, EachWindowDrawScalesTheEyesHalvesByTheOutputsFactors) {
    Interleave(false);
    ScaleOutput();
    for (ovo::Es2StereoLayer* layer : {&m_direct, &m_tracked}) {
        EXPECT_EQ(Drawn(*layer, {"glViewport", "glScissor"}), SCALED_HALVES) << (layer == &m_tracked);
    }
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_TEXTURE_BINDING_2D, {5});
    MakeRenderTexture(m_tracked);
    m_tracked.glBindFramebuffer(Manager(), GL_FRAMEBUFFER, 0);
    EXPECT_EQ(Drawn(m_tracked, {"glViewport", "glScissor"}),
              Join({{"glViewport(0, 0, 128, 64)", "glViewport(10, 20, 401, 243)"}, SCALED_HALVES}));
}

TEST_F(Es2LayerTest, ADirectDrawIntoTheApplicationsFramebufferIsIssuedOnceUnchanged) {
    Interleave(true);
    BoundFramebuffer(3);
    m_direct.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    EXPECT_EQ(RecordedGlCalls(), Calls({"glGetIntegerv(0x8CA6, ptr)", "glDrawArrays(4, 0, 3)"}));
}

// Run as the stock live wallpaper: which separations its two kinds of draws set.
TEST_F(Es2LayerTest, DISABLED_PrintWallpaperSeparations) {
    Interleave(true);
    Profile().m_ramp = ovo::STEREO_RAMP_OFF;  // the wallpaper's preset ramps its separation
    m_direct.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    m_direct.glDrawElements(Manager(), GL_TRIANGLES, 3, GL_UNSIGNED_SHORT, nullptr);
    for (const std::string& call : Only({"glUniform2f", "glDrawArrays", "glDrawElements"})) {
        std::printf("draw-log %s\n", call.c_str());
    }
}

TEST(Es2WallpaperTest, TheStockWallpapersArrayDrawsAddItsOwnSeparationPerEye) {
    const ScenarioResult result =
        RunScenario("com.android.wallpaper", "Es2LayerTest.DISABLED_PrintWallpaperSeparations");
    EXPECT_EQ(result.m_exit_code, 0);
    const std::string expected =
        "draw-log glUniform2f(4, 0.25, 0.5)\ndraw-log glUniform2f(4, 0.1, 0.05)\ndraw-log glDrawArrays(4, 0, 3)\n"
        "draw-log glUniform2f(4, -0.25, -0.5)\ndraw-log glUniform2f(4, -0.1, -0.05)\ndraw-log glDrawArrays(4, 0, 3)\n"
        "draw-log glUniform2f(4, 0.25, 0.5)\ndraw-log glDrawElements(4, 3, 0x1403, null)\n"
        "draw-log glUniform2f(4, -0.25, -0.5)\ndraw-log glDrawElements(4, 3, 0x1403, null)\n";
    std::string logged;
    for (size_t at = result.m_output.find("draw-log "); at != std::string::npos;
         at = result.m_output.find("draw-log ", at + 1)) {
        logged += result.m_output.substr(at, result.m_output.find('\n', at) + 1 - at);
    }
    EXPECT_EQ(logged, expected) << result.m_output;
}

// A rename after start, as Android renames a process forked from the zygote: a name written
// over the argument strings in place, and given to prctl(PR_SET_NAME).
struct Rename {
    const char* m_label;
    std::string m_command_line;  // the arguments at start, separated by NULs
    std::string m_environment;   // the first environment string, which lies right past them
    std::string m_written;       // written over the arguments from the first one's start
    int m_rest;                  // then over the rest of them, unless KEEP_THE_REST
    int m_kind;                  // the live-wallpaper kind after the rename
};
constexpr int KEEP_THE_REST = -1;
const std::string START = std::string("com.example.game\0--a-flag-long-enough-for-any-name", 50);

const Rename RENAMES[] = {
    {"a longer name, into the next argument", START, "", "com.android.wallpaper", '\0', 2},
    {"a shorter name", "com.android.wallpaper.livepicker", "", "com.android.wallpaper", '\0', 2},
    {"away from the wallpaper", "com.android.wallpaper", "", "com.example.game", '\0', 0},
    {"another kind", START, "", "fishnoodle.koipond", '\0', 3},
    {"the longest name", START, "", "au.com.dealsmap.lwp.cube.PackEarth", '\0', 6},
    {"a name and its NUL, the rest kept", START, "", std::string("com.android.wallpaper\0", 22), KEEP_THE_REST, 2},
    {"no NUL, over a longer name", "com.android.wallpaperXYZ", "", "com.android.wallpaper", KEEP_THE_REST, 0},
    {"a space in front", START, "", " com.android.wallpaper", '\0', 0},
    {"a space behind", START, "", "com.android.wallpaper ", '\0', 0},
    {"a tab behind", START, "", "com.android.wallpaper\t", '\0', 0},
    {"empty", "com.android.wallpaper", "", "", '\0', 0},
    // Without a NUL in the area the kernel reads on into the environment.
    {"no NUL left in the area", START, "", "com.android.wallpaper", 'x', 0},
    {"no NUL, the environment ends the wallpaper's name", "cX", ".android.wallpaper", "com", KEEP_THE_REST, 2},
    {"no NUL, the environment ends another name", "cX", ".android.wallpaper.x", "com", KEEP_THE_REST, 0},
    {"no NUL, no wallpaper's name begins so", "xX", ".android.wallpaper", "xom", KEEP_THE_REST, 0},
};

// Run under a case's command line: a draw, the case's rename, a draw, and what the profile
// and the file then say.
TEST_F(Es2LayerTest, DISABLED_PrintDrawsAcrossARename) {
    const char* index = std::getenv("OVO_RENAME_CASE");
    ASSERT_NE(index, nullptr);
    const Rename& rename = RENAMES[std::atoi(index)];
    // The arguments lie one after the other from the first; the file shows them all while
    // the last one ends in its NUL.
    const size_t area_length = CommandLineFile().size();
    ASSERT_LE(rename.m_written.size(), area_length);
    Interleave(true);
    Profile().m_ramp = ovo::STEREO_RAMP_OFF;
    // Draws once into the window; how many eyes set the stock wallpaper's own separation.
    auto wallpaper_setups = [&] {
        const Calls calls = Drawn(m_direct);
        return std::count(calls.begin(), calls.end(), "glUniform2f(4, 0.1, 0.05)") +
               std::count(calls.begin(), calls.end(), "glUniform2f(4, -0.1, -0.05)");
    };
    const auto before = wallpaper_setups();
    prctl(PR_SET_NAME, rename.m_written.c_str());
    char* area = program_invocation_name;
    std::memcpy(area, rename.m_written.data(), rename.m_written.size());
    if (rename.m_rest != KEEP_THE_REST) {
        std::memset(area + rename.m_written.size(), rename.m_rest, area_length - rename.m_written.size());
    }
    const auto after = wallpaper_setups();
    char name[ovo::PROFILE_PROCESS_NAME_CAPACITY];
    ovo::StereoProfile::ReadProcessName(name);
    std::printf("wallpaper setups %d then %d, detected %d, file %d\n", static_cast<int>(before),
                static_cast<int>(after), Profile().DetectLiveWallpaper(), ovo::LiveWallpaperKindOf(name));
}

TEST(Es2WallpaperTest, ARenameIsSeenAtTheNextDrawAsTheFileShowsIt) {
    if (!CommandLineFileFollowsRenames()) GTEST_SKIP() << "/proc/self/cmdline does not follow renames here";
    for (size_t index = 0; index < std::size(RENAMES); ++index) {
        const Rename& rename = RENAMES[index];
        std::string environment = "OVO_RENAME_CASE=" + std::to_string(index);
        if (!rename.m_environment.empty()) environment = rename.m_environment + '\0' + environment;
        const ScenarioResult result =
            RunScenario(rename.m_command_line, "Es2LayerTest.DISABLED_PrintDrawsAcrossARename", environment);
        const bool wallpaper_at_start = std::string(rename.m_command_line.c_str()) == "com.android.wallpaper";
        const bool wallpaper_after = rename.m_kind == ovo::LIVE_WALLPAPER_ANDROID;
        char expected[96];
        std::snprintf(expected, sizeof(expected), "wallpaper setups %d then %d, detected %d, file %d\n",
                      wallpaper_at_start ? 2 : 0, wallpaper_after ? 2 : 0, rename.m_kind, rename.m_kind);
        EXPECT_NE(result.m_output.find(expected), std::string::npos) << rename.m_label << "\n" << result.m_output;
    }
}

class TrackedLayerTest : public Es2LayerTest {};

TEST_F(TrackedLayerTest, UntrackedNamesAndUnsizedTexturesAreNeverRespecified) {
    struct Case {
        GLuint m_texture;
        bool m_sized;
    } cases[] = {{0, true}, {4096, true}, {0xFFFFFFFFu, true}, {8, false}};
    for (const Case& each : cases) {
        m_tracked.glBindTexture(Manager(), GL_TEXTURE_2D, each.m_texture);
        if (each.m_sized) {
            m_tracked.glTexImage2D(Manager(), GL_TEXTURE_2D, 0, GL_RGBA, 32, 32, 0, GL_RGBA,
                                   GL_UNSIGNED_BYTE, nullptr);
        }
        ResetRecorder();
        m_tracked.glFramebufferTexture2D(Manager(), GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0,
                                         GL_TEXTURE_2D, each.m_texture, 0);
        EXPECT_EQ(RecordedGlCalls().size(), 1u) << each.m_texture;
    }
    // Deleted while bound: the next image goes to texture 0, not to the forgotten name.
    const GLuint deleted = 9;
    m_tracked.glBindTexture(Manager(), GL_TEXTURE_2D, deleted);
    m_tracked.glDeleteTextures(Manager(), 1, &deleted);
    m_tracked.glTexImage2D(Manager(), GL_TEXTURE_2D, 0, GL_RGBA, 32, 32, 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
    m_tracked.glBindTexture(Manager(), GL_TEXTURE_2D, deleted);
    ResetRecorder();
    m_tracked.glFramebufferTexture2D(Manager(), GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D, deleted, 0);
    EXPECT_EQ(RecordedGlCalls().size(), 1u) << "deleted";
}

// Attached, a texture gets twice its width (renderbuffers: HostileSizesTest) and the texture the
// application has bound comes back; the framebuffer keeps the size it was given.
TEST_F(TrackedLayerTest, RenderTexturesBecomeTwiceAsWideAndTheBoundTextureComesBack) {
    m_tracked.glBindTexture(Manager(), GL_TEXTURE_2D, 5);
    m_tracked.glTexImage2D(Manager(), GL_TEXTURE_2D, 0, GL_RGB, 100, 50, 0, GL_RGB, GL_UNSIGNED_SHORT_5_6_5, nullptr);
    m_tracked.glBindTexture(Manager(), GL_TEXTURE_2D, 8);
    m_tracked.glBindFramebuffer(Manager(), GL_FRAMEBUFFER, 3);
    ResetRecorder();
    m_tracked.glFramebufferTexture2D(Manager(), GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D, 5, 0);
    const Calls expected = {"glFramebufferTexture2D(0x8D40, 0x8CE0, 0x0DE1, 5, 0)", "glBindTexture(0x0DE1, 5)",
                            "glTexImage2D(0x0DE1, 0, 6407, 200, 50, 0, 0x1907, 0x8363, null)",
                            "glBindTexture(0x0DE1, 8)"};
    EXPECT_EQ(RecordedGlCalls(), expected);
    const ovo::FramebufferRecord* framebuffer = Manager().m_objects->FindFramebufferRecord(3);
    ASSERT_NE(framebuffer, nullptr);
    EXPECT_EQ(framebuffer->m_width, 100u);
    EXPECT_EQ(framebuffer->m_height, 50u);
    // 67 shares 3's slot and so has no record of its own.
    EXPECT_EQ(Manager().m_objects->FindFramebufferRecord(67), nullptr);
    // Deleted, the name is forgotten: a new texture of that name starts unbound.
    const GLuint name = 5;
    m_tracked.glDeleteTextures(Manager(), 1, &name);
    EXPECT_EQ(Manager().m_objects->TextureRecordOf(5)->m_attached, 0u);
    EXPECT_EQ(Manager().m_objects->TextureRecordOf(5)->m_width, 0u);
}

TEST_F(TrackedLayerTest, EachEyeDrawsIntoItsHalfOfTheApplicationsFramebuffer) {
    Interleave(true);
    MakeRenderTexture(m_tracked);
    // Narrower than the texture: eye 1 starts at the texture's own width.
    Manager().m_viewport = {3, 0, 64, 32};
    const Calls expected = {"glGetIntegerv(0x8B8D, ptr)", "glGetUniformLocation(9, ptr)", "glViewport(3, 0, 64, 32)",
                            "glUniform2f(4, 0.25, 0.5)",  "glDrawArrays(4, 0, 3)",        "glViewport(131, 0, 64, 32)",
                            "glUniform2f(4, -0.25, -0.5)", "glDrawArrays(4, 0, 3)"};
    EXPECT_EQ(Drawn(m_tracked), expected);
}

TEST_F(TrackedLayerTest, ARenderTextureDrawnToTheWindowGivesEachEyeItsOwnHalf) {
    Interleave(true);
    MakeRenderTexture(m_tracked);
    m_tracked.glBindFramebuffer(Manager(), GL_FRAMEBUFFER, 0);
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_TEXTURE_BINDING_2D, {5});
    AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_BLEND, 1);
    AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_DEPTH_TEST, 1);
    AnswerIntegers(ovo::GL_ENTRY_glGenTextures, 1, {21});
    AnswerIntegers(ovo::GL_ENTRY_glGenFramebuffers, 1, {22});
    m_tracked.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);  // makes the eye textures
    // The vendor gave both the same names; eye 1's texture is told apart here.
    Manager().m_eye_textures->Find(ovo::CurrentContext())->m_eyes[1].m_texture = 31;
    const Calls drawn = Drawn(m_tracked, {"glGetUniformLocation", "glDisable", "glEnable", "glViewport",
                                          "glBindFramebuffer", "glDrawArrays", "glBindTexture", "glUniform2f",
                                          "glStencilFunc"});
    // Both copies sample texture 5 (still bound) into the eye textures' framebuffer; the
    // window's viewport comes back before the eyes draw, each with its own texture.
    const Calls copy = {"glDisable(0x0B71)", "glBindFramebuffer(0x8D40, 22)", "glDrawArrays(5, 0, 4)",
                        "glBindTexture(0x0DE1, 5)", "glBindFramebuffer(0x8D40, 0)", "glEnable(0x0B71)"};
    const Calls expected = Join(
        {{"glGetUniformLocation(9, ptr)", "glDisable(0x0BE2)", "glViewport(0, 0, 128, 64)"}, copy, copy,
         {"glEnable(0x0BE2)", "glViewport(0, 0, 800, 480)", "glEnable(0x0B90)", "glBindTexture(0x0DE1, 21)",
          "glUniform2f(4, 0.25, 0.5)", "glStencilFunc(0x0202, 1, 1)", "glDrawArrays(4, 0, 3)",
          "glBindTexture(0x0DE1, 31)", "glUniform2f(4, -0.25, -0.5)", "glStencilFunc(0x0202, 0, 1)",
          "glDrawArrays(4, 0, 3)", "glDisable(0x0B90)", "glBindTexture(0x0DE1, 5)"}});
    EXPECT_EQ(drawn, expected);
    // Eye 0's copy samples the left half, eye 1's the right: the first texture coordinates.
    std::vector<GLfloat> first_coordinates;
    for (const GLfloat* coordinates : CoordinatesPointed()) {
        if (coordinates != nullptr) first_coordinates.push_back(coordinates[0]);
    }
    EXPECT_EQ(first_coordinates, (std::vector<GLfloat>{0.0f, 0.5f}));
}

// The eye textures belong to the context that drew: made there once, used there again
// after other contexts drew, and deleted in it, before the vendor destroys it.
TEST_F(TrackedLayerTest, EachContextKeepsItsOwnEyeTexturesUntilItEnds) {
    Interleave(true);
    MakeRenderTexture(m_tracked);
    m_tracked.glBindFramebuffer(Manager(), GL_FRAMEBUFFER, 0);
    AnswerResult(ovo::GL_ENTRY_glCreateProgram, 0, 23);
    AnswerIntegers(ovo::GL_ENTRY_glGetProgramiv, GL_LINK_STATUS, {GL_TRUE});
    const EGLContext first = ovo::CurrentContext();
    const EGLContext second = m_egl.CreateContext(2);
    const std::pair<EGLContext, size_t> draws[] = {{first, 2}, {second, 2}, {first, 0}, {second, 0}};
    for (auto [context, textures_made] : draws) {
        ASSERT_EQ(m_egl.MakeCurrent(context), EGL_TRUE);
        EXPECT_EQ(Drawn(m_tracked, {"glGenTextures"}).size(), textures_made);
    }
    ResetRecorder();
    ASSERT_NE(eglDestroyContext(m_egl.m_display, first), EGL_FALSE);
    const std::string display = FormatHandle(m_egl.m_display);
    const Calls expected = {
        "eglMakeCurrent(" + display + ", null, null, " + FormatHandle(first) + ")",
        "glDeleteFramebuffers(1, ptr)", "glDeleteTextures(1, ptr)", "glDeleteFramebuffers(1, ptr)",
        "glDeleteTextures(1, ptr)", "glDeleteProgram(23)",
        "eglMakeCurrent(" + display + ", 0x5000, 0x5000, " + FormatHandle(second) + ")",
        "eglDestroyContext(" + display + ", " + FormatHandle(first) + ")"};
    EXPECT_EQ(RecordedCalls(true), expected);
}

// The tracked layer's clears cover twice the output's width (here the screen, wider than the
// target), the direct layer's are the application's; the plain mode scales clears and window
// draws, with no 0.5 anywhere: 401 x 1.6 = 641.6 gives 641.
TEST_F(Es2LayerTest, ClearsCoverTheDoubleWidthAndTheScaledLayerScalesWindowDrawsAndClearsOnly) {
    Profile().m_width = 1280;
    Profile().m_height = 720;
    Manager().UpdateScale();
    Manager().m_viewport = {10, 20, 401, 240};
    Manager().m_scissor = {0, 0, 801, 480};
    m_tracked.glClear(Manager(), GL_COLOR_BUFFER_BIT);
    m_direct.glClear(Manager(), GL_DEPTH_BUFFER_BIT);
    m_scaled.glClear(Manager(), GL_COLOR_BUFFER_BIT);
    m_scaled.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    m_scaled.glBindFramebuffer(Manager(), GL_FRAMEBUFFER, 3);
    m_scaled.glDrawArrays(Manager(), GL_TRIANGLES, 0, 3);
    const Calls expected = {"glScissor(0, 0, 2560, 720)",   "glClear(0x4000)",       "glClear(0x0100)",
                            "glScissor(0, 0, 1281, 720)",   "glClear(0x4000)",       "glViewport(16, 30, 641, 360)",
                            "glDrawArrays(4, 0, 3)",        "glBindFramebuffer(0x8D40, 3)",
                            "glViewport(10, 20, 401, 240)", "glDrawArrays(4, 0, 3)"};
    EXPECT_EQ(RecordedGlCalls(), expected);
}

TEST_F(Es2LayerTest, TheStateGuardPutsBackOnlyWhatItSavedAndOnlyOnce) {
    const void* offset = reinterpret_cast<const void*>(16);
    AnswerIntegers(ovo::GL_ENTRY_glGetIntegerv, GL_TEXTURE_BINDING_2D, {5});
    BoundFramebuffer(6);
    // Both attributes answer alike: the queries do not tell the index apart.
    for (auto [name, value] : {std::pair<GLenum, GLint>{GL_VERTEX_ATTRIB_ARRAY_ENABLED, 1},
                               {GL_VERTEX_ATTRIB_ARRAY_BUFFER_BINDING, 12}, {GL_VERTEX_ATTRIB_ARRAY_SIZE, 3},
                               {GL_VERTEX_ATTRIB_ARRAY_TYPE, GL_SHORT}, {GL_VERTEX_ATTRIB_ARRAY_NORMALIZED, 1},
                               {GL_VERTEX_ATTRIB_ARRAY_STRIDE, 24}})
        AnswerIntegers(ovo::GL_ENTRY_glGetVertexAttribiv, name, {value});
    AnswerBytes(ovo::GL_ENTRY_glGetVertexAttribPointerv, GL_VERTEX_ATTRIB_ARRAY_POINTER, &offset, sizeof(offset));
    const struct {
        uint32_t m_flags;
        bool m_depth_test;
        Calls m_restored;
    } cases[] = {
        {ovo::GUARD_TEXTURE | ovo::GUARD_ATTRIBUTE_1 | ovo::GUARD_DEPTH_TEST, false,
         {"glBindTexture(0x0DE1, 5)", "glEnableVertexAttribArray(1)", "glBindBuffer(0x8892, 12)",
          "glVertexAttribPointer(1, 3, 0x1402, 1, 24, ptr)", "glDisable(0x0B71)"}},
        {ovo::GUARD_ALL, true,
         {"glBindTexture(0x0DE1, 5)", "glUseProgram(9)", "glBindFramebuffer(0x8D40, 6)",
          "glEnableVertexAttribArray(0)", "glBindBuffer(0x8892, 12)", "glVertexAttribPointer(0, 3, 0x1402, 1, 24, ptr)",
          "glEnableVertexAttribArray(1)", "glBindBuffer(0x8892, 12)", "glVertexAttribPointer(1, 3, 0x1402, 1, 24, ptr)",
          "glEnable(0x0B71)"}},
    };
    for (const auto& each : cases) {
        AnswerResult(ovo::GL_ENTRY_glIsEnabled, GL_DEPTH_TEST, each.m_depth_test);
        ovo::GlStateGuard guard;
        guard.Save(each.m_flags);
        ResetRecorder();
        guard.Restore();
        guard.Restore();
        EXPECT_EQ(RecordedGlCalls(), each.m_restored) << each.m_flags;
        const RecordedCall* pointer = FindRecordedCall(RECORDER_API_GLES2, ovo::GL_ENTRY_glVertexAttribPointer);
        ASSERT_NE(pointer, nullptr);
        EXPECT_EQ(pointer->m_arguments[5], ArgumentBits(offset)) << each.m_flags;
    }
}

// Each eye's texture samples linearly, clamped, and is its framebuffer's colour; it gets
// new storage whenever either side of the size changes, never for an empty size.
TEST_F(Es2LayerTest, EyeTexturesSampleLinearlyAndFollowEverySizeChange) {
    AnswerIntegers(ovo::GL_ENTRY_glGenTextures, 1, {21});
    AnswerIntegers(ovo::GL_ENTRY_glGenFramebuffers, 1, {22});
    ovo::EyeTexturePair pair{};
    pair.Create();
    const Calls target = {"glBindTexture(0x0DE1, 21)", "glTexParameteri(0x0DE1, 0x2801, 9729)",
                          "glTexParameteri(0x0DE1, 0x2800, 9729)", "glTexParameteri(0x0DE1, 0x2802, 33071)",
                          "glTexParameteri(0x0DE1, 0x2803, 33071)", "glBindFramebuffer(0x8D40, 22)",
                          "glFramebufferTexture2D(0x8D40, 0x8CE0, 0x0DE1, 21, 0)"};
    const Calls put_back = {"glBindTexture(0x0DE1, 0)", "glBindFramebuffer(0x8D40, 0)"};
    EXPECT_EQ(Only({"glBindTexture", "glTexParameteri", "glBindFramebuffer", "glFramebufferTexture2D"}),
              Join({target, target, put_back}));

    const struct {
        GLuint m_width;
        GLuint m_height;
        bool m_storage;
    } sizes[] = {{128, 64, true}, {128, 64, false}, {128, 32, true}, {64, 32, true}, {0, 32, false},
                 {64, 32, true},  {64, 0, false}};
    for (const auto& each : sizes) {
        ResetRecorder();
        pair.m_eyes[0].Resize(each.m_width, each.m_height);
        const Calls expected =
            each.m_storage ? Calls{"glTexImage2D(0x0DE1, 0, 6408, " + std::to_string(each.m_width) + ", " +
                                   std::to_string(each.m_height) + ", 0, 0x1908, 0x1401, null)"}
                           : Calls();
        EXPECT_EQ(Only({"glTexImage2D"}), expected) << each.m_width << "x" << each.m_height;
    }
}

// The copy's quad lives in client memory, so the array buffer is unbound before it is
// pointed at; each half samples its own side of the render texture.
TEST_F(Es2LayerTest, AHalfCopyDrawsItsSideFromClientMemory) {
    AnswerIntegers(ovo::GL_ENTRY_glGetVertexAttribiv, GL_VERTEX_ATTRIB_ARRAY_BUFFER_BINDING, {12});
    const ovo::EyeTexture eye = {21, 22, 128, 64, 23};
    const struct {
        void (ovo::EyeTexture::*m_copy)() const;
        GLfloat m_coordinates[8];
    } halves[] = {{&ovo::EyeTexture::CopyHalfLeft, {0, 1, 0, 0, 0.5f, 1, 0.5f, 0}},
                  {&ovo::EyeTexture::CopyHalfRight, {0.5f, 1, 0.5f, 0, 1, 1, 1, 0}}};
    for (const auto& half : halves) {
        ResetRecorder();
        (eye.*half.m_copy)();
        const Calls expected = {"glDisable(0x0B71)", "glBindFramebuffer(0x8D40, 22)", "glUseProgram(23)",
                                "glEnableVertexAttribArray(0)", "glEnableVertexAttribArray(1)",
                                "glBindBuffer(0x8892, 0)", "glVertexAttribPointer(0, 2, 0x1406, 0, 0, ptr)",
                                "glVertexAttribPointer(1, 2, 0x1406, 0, 0, ptr)", "glDrawArrays(5, 0, 4)"};
        const Calls calls = RecordedGlCalls();
        const auto draw = std::find(calls.begin(), calls.end(), "glDrawArrays(5, 0, 4)");
        ASSERT_NE(draw, calls.end());
        Calls copy;
        for (auto call = calls.begin(); call != draw + 1; ++call)
            if (call->compare(0, 5, "glGet") != 0 && call->compare(0, 11, "glIsEnabled") != 0) copy.push_back(*call);
        EXPECT_EQ(copy, expected);
        const std::vector<const GLfloat*> pointed = CoordinatesPointed();
        ASSERT_FALSE(pointed.empty());
        EXPECT_EQ(std::vector<GLfloat>(pointed[0], pointed[0] + 8),
                  std::vector<GLfloat>(half.m_coordinates, half.m_coordinates + 8));
    }
}

}  // namespace
