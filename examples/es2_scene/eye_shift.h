#ifndef OVO_EXAMPLES_ES2_SCENE_EYE_SHIFT_H
#define OVO_EXAMPLES_ES2_SCENE_EYE_SHIFT_H

#include <GLES2/gl2.h>

#include <string>
#include <vector>

#include "common/reference_options.h"

namespace ovo_sample {

// One eye of the stereo pair, drawn by the game itself: every vertex shader ends by moving
// its clip-space x by d * min(a * w - z, 0), where (a, d) is the uniform uZpDepthShift, set
// to (s * eye angle, s * eye distance) with the eye sign s (+1 eye 0, -1 eye 1). Without
// an eye the shaders and draws are the game's own.
class EyeShift {
public:
    explicit EyeShift(const ReferenceOptions& reference) : m_reference(reference) {}

    // `source` with the uniform declared in front of its first word and the shift as the
    // last statement of main (in front of the last '}').
    std::string VertexShader(const char* source) const;

    // Sets the current program's uniform for its next draws. Window draws take the eye's
    // value. A draw into one of the game's framebuffers takes it too when the texture pass
    // is per eye; drawn once, it takes what the program's last window draw left: eye 1's
    // value, since each pair of window draws ends with eye 1, or 0 before any.
    void SetForCurrentProgram();

    // The game deleted its programs, and with them their uniforms' values; a name that
    // comes again belongs to a new program.
    void ForgetPrograms() { m_window_programs.clear(); }

private:
    ReferenceOptions m_reference;
    // Programs that have drawn into the window.
    std::vector<GLuint> m_window_programs;
};

}  // namespace ovo_sample

#endif
