#ifndef OVO_TESTS_PROGRAMS_THIRD_PARTY_PROGRAMS_H
#define OVO_TESTS_PROGRAMS_THIRD_PARTY_PROGRAMS_H

#include <ostream>
#include <string>
#include <vector>

#include "program_run.h"

// Where a program's geometry lies in depth, which decides the disparity its eyes must show.
enum SceneDepth {
    // A perspective 3D scene: its surfaces lie behind the screen, so some parts of it must
    // show a disparity above measuring noise.
    SCENE_DEPTH_3D,
    // Everything at clip-space depth 0 (2D renderers, full-screen effects): no disparity.
    SCENE_DEPTH_FLAT,
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
    SceneDepth m_depth;
    // In the test command's fast subset.
    bool m_fast;
};

std::vector<ThirdPartyProgram> ThirdPartyPrograms();

// For gtest: a program shows as its command line, not as its bytes.
void PrintTo(const ThirdPartyProgram& program, std::ostream* out);

#endif
