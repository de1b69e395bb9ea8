#ifndef OVO_TESTS_STEREO_DEPTH_SHIFT_ON_MESA_H
#define OVO_TESTS_STEREO_DEPTH_SHIFT_ON_MESA_H

#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "core/gl_layer.h"
#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "stereo/es2_stereo_layer.h"
#include "support/mesa_context.h"

// A shader compiled on Mesa, its source and log as Mesa holds them.
struct CompiledShader {
    bool m_compiled;
    std::string m_source;
    std::string m_log;
};

// An OpenGL ES 2.0 context on Mesa with the injecting layer in place. The source is always
// read from Mesa itself, past the library, whose own glGetShaderSource may answer with the
// application's source.
class DepthShiftOnMesa : public ::testing::Test {
public:
    static void SetUpTestSuite() {
        ASSERT_NO_FATAL_FAILURE(MakeMesaContextCurrent(2));
        // No profile here: the injecting layer is put in by hand.
        ovo::StereoManager& manager = ovo::StereoManager::instance();
        delete manager.m_layer;
        manager.m_layer = new ovo::Es2StereoLayer(ovo::LAYER_SUBMODE_DIRECT);
    }

    // Set through the library, which injects into vertex shaders, or on Mesa directly, as the
    // application wrote it.
    static CompiledShader Compile(GLenum type, const std::vector<const char*>& strings, bool through_library = true) {
        const GLsizei count = static_cast<GLsizei>(strings.size());
        GLuint shader = 0;
        if (through_library) {
            shader = glCreateShader(type);
            glShaderSource(shader, count, strings.data(), nullptr);
            glCompileShader(shader);
        } else {
            shader = ovo::raw::glCreateShader(type);
            ovo::raw::glShaderSource(shader, count, strings.data(), nullptr);
            ovo::raw::glCompileShader(shader);
        }
        GLint compiled = GL_FALSE;
        ovo::raw::glGetShaderiv(shader, GL_COMPILE_STATUS, &compiled);
        const CompiledShader result = {compiled == GL_TRUE,
                                       ReadText(shader, GL_SHADER_SOURCE_LENGTH, ovo::raw::glGetShaderSource),
                                       ReadText(shader, GL_INFO_LOG_LENGTH, ovo::raw::glGetShaderInfoLog)};
        ovo::raw::glDeleteShader(shader);
        return result;
    }

private:
    // A text whose length, terminator included, `length_name` gives.
    static std::string ReadText(GLuint shader, GLenum length_name,
                                void (*read)(GLuint, GLsizei, GLsizei*, GLchar*)) {
        GLint length = 0;
        ovo::raw::glGetShaderiv(shader, length_name, &length);
        if (length <= 0) return std::string();
        std::string text(static_cast<size_t>(length), '\0');
        GLsizei written = 0;
        read(shader, length, &written, &text[0]);
        text.resize(static_cast<size_t>(written));
        return text;
    }
};

#endif
