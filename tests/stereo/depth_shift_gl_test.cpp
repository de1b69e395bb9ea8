// The depth-shift injection on Mesa, reached through the library: the text the driver ends
// up holding, and that it still compiles.
#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "core/gl_layer.h"
#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "stereo/es2_stereo_layer.h"
#include "support/mesa_context.h"

namespace {

const std::string DECLARATION = "uniform vec2 uZpDepthShift;\n";
const std::string STATEMENT =
    "gl_Position.x = gl_Position.x + (uZpDepthShift.y * min((uZpDepthShift.x * "
    "gl_Position.w) - gl_Position.z, 0.0));\n";

class DepthShiftOnMesa : public ::testing::Test {
protected:
    static void SetUpTestSuite() {
        ASSERT_NO_FATAL_FAILURE(MakeMesaContextCurrent(2));
        // No profile here: the injecting layer is put in by hand.
        ovo::StereoManager& manager = ovo::StereoManager::instance();
        delete manager.m_layer;
        manager.m_layer = new ovo::Es2StereoLayer(ovo::LAYER_SUBMODE_DIRECT);
    }

    // The source Mesa holds after the application's glShaderSource; empty when the shader
    // did not compile.
    static std::string SetAndCompile(GLenum type, const std::vector<const char*>& strings) {
        const GLuint shader = glCreateShader(type);
        glShaderSource(shader, static_cast<GLsizei>(strings.size()), strings.data(), nullptr);
        glCompileShader(shader);
        GLint compiled = GL_FALSE;
        glGetShaderiv(shader, GL_COMPILE_STATUS, &compiled);
        // The vendor's text: through the library the application reads its own source.
        GLint length = 0;
        ovo::raw::glGetShaderiv(shader, GL_SHADER_SOURCE_LENGTH, &length);
        std::string source(static_cast<size_t>(length), '\0');
        ovo::raw::glGetShaderSource(shader, length, nullptr, &source[0]);
        glDeleteShader(shader);
        source.resize(source.empty() ? 0 : source.size() - 1);
        return compiled == GL_TRUE ? source : std::string();
    }
};

TEST_F(DepthShiftOnMesa, VertexShadersCompileWithTheShiftAtTheEndOfMainFragmentShadersAsWritten) {
    const char* fragment = "precision mediump float;\nvoid main() { gl_FragColor = vec4(1.0); }\n";
    struct Case {
        GLenum m_type;
        std::vector<const char*> m_strings;
        std::string m_expected;
    } cases[] = {
        // As the samples write them: a leading newline, the statement before main's brace.
        {GL_VERTEX_SHADER,
         {"\nuniform mat4 u_mvp;\nattribute vec4 a_position;\n",
          "void main() {\n    gl_Position = u_mvp * a_position;\n}\n"},
         "\n" + DECLARATION +
             "uniform mat4 u_mvp;\nattribute vec4 a_position;\nvoid main() {\n    gl_Position "
             "= u_mvp * a_position;\n" + STATEMENT + "}\n"},
        // A leading comment and precision statement; the last return of main takes it.
        {GL_VERTEX_SHADER,
         {"// lit\nprecision highp float;\nattribute vec4 p;\nvoid main() {\n"
          "    gl_Position = p;\n    if (p.x > 0.0) { gl_Position = -p; return; }\n"
          "    gl_Position.y = 1.0;\n    return;\n}\n"},
         "// lit\n" + DECLARATION +
             "precision highp float;\nattribute vec4 p;\nvoid main() {\n    gl_Position = p;\n"
             "    if (p.x > 0.0) { gl_Position = -p; return; }\n    gl_Position.y = 1.0;\n    " +
             STATEMENT + "return;\n}\n"},
        {GL_FRAGMENT_SHADER, {fragment}, fragment},
    };
    for (const Case& each : cases) {
        EXPECT_EQ(SetAndCompile(each.m_type, each.m_strings), each.m_expected);
    }
}

}  // namespace
