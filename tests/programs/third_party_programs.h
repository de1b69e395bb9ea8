#ifndef OVO_TESTS_PROGRAMS_THIRD_PARTY_PROGRAMS_H
#define OVO_TESTS_PROGRAMS_THIRD_PARTY_PROGRAMS_H

#include <ostream>
#include <string>
#include <vector>

#include "program_run.h"

// What a program draws, which decides what its stereo frame must show (the checks of each
// kind: stereo_frame_checks.cpp).
enum SceneKind {
    // A perspective 3D scene drawn into the window: its surfaces lie behind the screen.
    SCENE_3D,
    // The same, of lines one pixel wide: moved by a fraction of a pixel, a line lights other
    // pixels, so an eye moved back matches the native frame less closely.
    SCENE_3D_THIN_LINES,
    // A 3D scene whose fragments take their colour from their place on the screen
    // (gl_FragCoord): moving the geometry sideways leaves the colours where they were, so
    // only the geometry's outline can be compared with the native frame.
    SCENE_3D_SCREEN_COLOURED,
    // 3D drawn into the program's own framebuffer and shown by one flat draw: draws into an
    // application framebuffer are made once, unchanged, so the window shows it flat.
    SCENE_OFFSCREEN,
    // Everything at clip-space depth 0 (2D renderers, full-screen effects): flat.
    SCENE_FLAT,
    // OpenGL ES 1.x drawing with a flat projection: each eye's draws move as a whole by the
    // profile's eye shift, eye 0 right and eye 1 left, in front of the screen.
    SCENE_ES1_FLAT,
};

// A real, unmodified OpenGL ES 2.0 program from Debian, as the suite starts it.
struct ThirdPartyProgram {
    std::string m_name;  // the test's name
    std::vector<std::string> m_arguments;
    std::string m_working_directory;
    std::vector<std::string> m_environment;
    int m_frames;
    bool m_stops_by_itself;
    RedrawKind m_redraw;
    SceneKind m_scene;
    // A folder of libraries the program needs beyond the system's, or empty.
    std::string m_libraries;
};

std::vector<ThirdPartyProgram> ThirdPartyPrograms();

// For gtest: a program shows as its command line, not as its bytes.
void PrintTo(const ThirdPartyProgram& program, std::ostream* out);

#endif
