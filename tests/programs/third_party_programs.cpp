#include "third_party_programs.h"

#include <cctype>

namespace {

// The size the composition renderer knows and the profile names: the mask covers the
// whole window.
constexpr char WINDOW_SIZE[] = "800x480";
constexpr char SDL_TESTS[] = "/usr/libexec/installed-tests/SDL2";

// glmark2's default benchmarks, each run as a program of its own for a few frames. Every
// scene has its own context, as glmark2 makes one per scene.
struct Glmark2Benchmark {
    const char* m_description;
    SceneKind m_scene;
};

const Glmark2Benchmark GLMARK2_BENCHMARKS[] = {
    {"build:use-vbo=false", SCENE_3D},
    {"build:use-vbo=true", SCENE_3D},
    {"texture:texture-filter=nearest", SCENE_3D},
    {"texture:texture-filter=linear", SCENE_3D},
    {"texture:texture-filter=mipmap", SCENE_3D},
    {"shading:shading=gouraud", SCENE_3D},
    {"shading:shading=blinn-phong-inf", SCENE_3D},
    {"shading:shading=phong", SCENE_3D},
    {"shading:shading=cel", SCENE_3D},
    {"bump:bump-render=high-poly", SCENE_3D},
    {"bump:bump-render=normals", SCENE_3D},
    {"bump:bump-render=height", SCENE_3D},
    {"effect2d:kernel=0,1,0;1,-4,1;0,1,0;", SCENE_FLAT},
    {"effect2d:kernel=1,1,1,1,1;1,1,1,1,1;1,1,1,1,1;", SCENE_FLAT},
    {"pulsar:light=false:quads=5:texture=false", SCENE_3D},
    {"desktop:blur-radius=5:effect=blur:passes=1:separable=true:windows=4", SCENE_OFFSCREEN},
    {"desktop:effect=shadow:windows=4", SCENE_OFFSCREEN},
    {"buffer:columns=200:interleave=false:update-dispersion=0.9:update-fraction=0.5:update-method=map",
     SCENE_3D_THIN_LINES},
    {"buffer:columns=200:interleave=false:update-dispersion=0.9:update-fraction=0.5:update-method=subdata",
     SCENE_3D_THIN_LINES},
    {"buffer:columns=200:interleave=true:update-dispersion=0.9:update-fraction=0.5:update-method=map",
     SCENE_3D_THIN_LINES},
    {"ideas:speed=duration", SCENE_3D},
    {"jellyfish", SCENE_3D},
    {"terrain", SCENE_OFFSCREEN},
    {"shadow", SCENE_3D},
    {"refract", SCENE_3D},
    {"conditionals:fragment-steps=0:vertex-steps=0", SCENE_3D_SCREEN_COLOURED},
    {"conditionals:fragment-steps=5:vertex-steps=0", SCENE_3D_SCREEN_COLOURED},
    {"conditionals:fragment-steps=0:vertex-steps=5", SCENE_3D_SCREEN_COLOURED},
    {"function:fragment-complexity=low:fragment-steps=5", SCENE_3D_SCREEN_COLOURED},
    {"function:fragment-complexity=medium:fragment-steps=5", SCENE_3D_SCREEN_COLOURED},
    {"loop:fragment-loop=false:fragment-steps=5:vertex-steps=5", SCENE_3D_SCREEN_COLOURED},
    {"loop:fragment-steps=5:fragment-uniform=false:vertex-steps=5", SCENE_3D_SCREEN_COLOURED},
    {"loop:fragment-steps=5:fragment-uniform=true:vertex-steps=5", SCENE_3D_SCREEN_COLOURED},
};

// glmark2's scenes animate by the clock: half a second a frame takes each well into its
// animation within the few frames of a run (some start black or as a line).
constexpr char GLMARK2_CLOCK_STEP[] = "OVO_FRAME_CLOCK_STEP_MS=500";

// SDL's renderer tests on its OpenGL ES 2.0 renderer: 2D, everything at depth 0.
const char* const SDL_RENDERER_TESTS[] = {"testsprite2",   "testrendercopyex", "testscale",
                                          "testdraw2",     "testviewport",     "testrendertarget",
                                          "testgeometry",  "teststreaming"};

// A test name from a benchmark description: letters and digits, the rest one underscore.
std::string TestName(const std::string& text) {
    std::string name;
    for (char each : text) {
        if (std::isalnum(static_cast<unsigned char>(each))) {
            name.push_back(each);
        } else if (!name.empty() && name.back() != '_') {
            name.push_back('_');
        }
    }
    while (!name.empty() && name.back() == '_') name.pop_back();
    return name;
}

}  // namespace

std::vector<ThirdPartyProgram> ThirdPartyPrograms() {
    std::vector<ThirdPartyProgram> programs;
    for (const Glmark2Benchmark& benchmark : GLMARK2_BENCHMARKS) {
        const std::string description = benchmark.m_description;
        // glmark2 asks for a configuration without stencil unless told: the library gives
        // every configuration a stencil buffer for the column mask, and glmark2 then finds
        // none that matches exactly.
        programs.push_back({"glmark2_" + TestName(description),
                            {"glmark2-es2", "-b", description + ":nframes=3", "--size", WINDOW_SIZE,
                             "--visual-config", "stencil=8"},
                            "", {GLMARK2_CLOCK_STEP}, 3, true, REDRAW_CONTINUOUS, benchmark.m_scene, ""});
    }
    programs.push_back({"es2gears_x11", {"es2gears_x11"}, "", {}, 4, false, REDRAW_CONTINUOUS,
                        SCENE_3D, ""});
    programs.push_back({"es2tri", {"es2tri"}, "", {}, 2, false, REDRAW_ON_EXPOSE, SCENE_FLAT, ""});
    // SDL picks GLX for an OpenGL ES context on X11 when the X server offers it; on a
    // device it always takes EGL, and so must it here to reach the library.
    const std::vector<std::string> sdl_environment = {"SDL_VIDEO_X11_FORCE_EGL=1"};
    programs.push_back({"testgles2", {"./testgles2", "--geometry", WINDOW_SIZE}, SDL_TESTS,
                        sdl_environment, 4, false, REDRAW_CONTINUOUS, SCENE_3D, ""});
    // Some tests make their renderer without asking for one by name: the hint chooses it.
    std::vector<std::string> renderer_environment = sdl_environment;
    renderer_environment.push_back("SDL_RENDER_DRIVER=opengles2");
    for (const char* test : SDL_RENDERER_TESTS) {
        programs.push_back({std::string("sdl_") + test,
                            {std::string("./") + test, "--renderer", "opengles2", "--geometry", WINDOW_SIZE},
                            SDL_TESTS, renderer_environment, 4, false, REDRAW_CONTINUOUS, SCENE_FLAT, ""});
    }
    // OpenGL ES 1.x: piglit's point-sprite checkerboards, taken out of Debian's piglit
    // package (scripts/fetch-piglit-corpus.sh). It draws when its window is exposed, and it
    // opens libGLESv1_CM.so.1 itself, after eglGetDisplay.
    programs.push_back({"piglit_arb_point_sprite_checkerboard_gles1",
                        {OVO_PIGLIT_DIR "/bin/arb_point_sprite-checkerboard_gles1"}, "",
                        {"PIGLIT_PLATFORM=x11_egl"}, 2, false, REDRAW_ON_EXPOSE, SCENE_ES1_FLAT,
                        OVO_PIGLIT_DIR "/lib"});
    return programs;
}

void PrintTo(const ThirdPartyProgram& program, std::ostream* out) {
    for (const std::string& argument : program.m_arguments) *out << argument << ' ';
}
