#include "stereo/depth_shift.h"

#include <cstdint>
#include <cstdlib>
#include <cstring>

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "stereo/eye_viewport.h"
#include "stereo/glsl_directives.h"
#include "stereo/glsl_rewriter.h"
#include "stereo/shader_source_store.h"

namespace ovo {

namespace {

// Room the buffers keep beyond the source and the inserted text.
constexpr int64_t SOURCE_SLACK = 10;

}  // namespace

void InjectDepthShift(GLuint shader, ShaderSourceStore& sources, uint32_t group) {
    GLint type = 0;
    raw::glGetShaderiv(shader, GL_SHADER_TYPE, &type);
    if (type != GL_VERTEX_SHADER) return;
    // Whatever comes of the rewrite, the source kept before is no longer the one set.
    sources.Forget(group, shader);
    GLint length = 0;  // with the terminating NUL
    raw::glGetShaderiv(shader, GL_SHADER_SOURCE_LENGTH, &length);
    const int64_t inserted =
        static_cast<int64_t>(sizeof(DEPTH_SHIFT_DECLARATION) + sizeof(DEPTH_SHIFT_STATEMENT));
    if (length <= 0 || length > INT32_MAX - inserted - SOURCE_SLACK) return;

    // Zero-filled: a driver that answers with less than it announced leaves a terminator.
    char* source = static_cast<char*>(std::calloc(static_cast<size_t>(length + SOURCE_SLACK), 1));
    char* rewritten =
        static_cast<char*>(std::malloc(static_cast<size_t>(length + inserted + SOURCE_SLACK)));
    if (source != nullptr && rewritten != nullptr) {
        GLsizei read = 0;
        raw::glGetShaderSource(shader, length, &read, source);
        // Nothing but comments may precede #version, and Mesa refuses #extension after a
        // declaration: those lines stay in front and only the rest is rewritten. The
        // rewriter's trace gives its positions in that rest.
        const int32_t kept = LeadingDirectivesLength(source, length);
        std::memcpy(rewritten, source, static_cast<size_t>(kept));
        GlslRewriter rewriter;
        rewriter.SetPreString(DEPTH_SHIFT_DECLARATION);
        rewriter.SetPostString(DEPTH_SHIFT_STATEMENT);
        // Without an insertion the application's source, set already, stays as it is.
        if (rewriter.Rewrite(rewritten + kept, source + kept, length - kept, 1) == 1) {
            const GLchar* strings[1] = {rewritten};
            const GLint lengths[1] = {static_cast<GLint>(std::strlen(rewritten))};
            raw::glShaderSource(shader, 1, strings, lengths);
            sources.Keep(group, shader, source, length);
        }
        rewriter.Clear();
    }
    std::free(source);
    std::free(rewritten);
}

void LookUpDepthShift(StereoManager& manager) {
    GLint program = 0;
    raw::glGetIntegerv(GL_CURRENT_PROGRAM, &program);
    manager.m_program = static_cast<GLuint>(program);
    // Program 0 has no uniforms: asking would raise an error the application never caused.
    manager.m_depth_shift_location =
        program != 0 ? raw::glGetUniformLocation(manager.m_program, DEPTH_SHIFT_UNIFORM) : -1;
}

void SetDepthShift(const StereoManager& manager, int eye) {
    const StereoProfile& profile = *manager.m_profile;
    const float sign = EyeSign(eye);
    SetDepthShiftValue(manager, sign * profile.m_eye_angle, sign * profile.m_eye_distance);
}

void SetDepthShiftValue(const StereoManager& manager, float threshold, float gain) {
    if (manager.m_program == 0) return;
    raw::glUniform2f(manager.m_depth_shift_location, threshold, gain);
}

}  // namespace ovo
