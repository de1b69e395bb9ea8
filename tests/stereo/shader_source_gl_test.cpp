// The application reads back the vertex-shader source it set, while Mesa compiles the
// rewritten text; what the library keeps follows the shaders and their share groups.
#include <EGL/egl.h>
#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "stereo/es2_stereo_layer.h"
#include "stereo/shader_source_store.h"
#include "support/mesa_context.h"

namespace {

const char DECLARATION[] = "uniform vec2 uZpDepthShift;";

using GetShaderiv = void (*)(GLuint, GLenum, GLint*);
using GetShaderSource = void (*)(GLuint, GLsizei, GLsizei*, GLchar*);

// Everything a reader learns of a shader's source: the length, then glGetShaderSource into
// buffers too small, just right and larger, each with its written count and what it left.
std::vector<std::string> Answers(GLuint shader, GetShaderiv get_iv, GetShaderSource get_source) {
    GLint length = -1;
    get_iv(shader, GL_SHADER_SOURCE_LENGTH, &length);
    std::vector<std::string> answers = {"length " + std::to_string(length)};
    for (GLsizei size : {0, 1, 7, length - 1, length, length + 5}) {
        if (size < 0) continue;
        std::string buffer(static_cast<size_t>(size) + 1, '#');
        GLsizei written = -1;
        get_source(shader, size, &written, &buffer[0]);
        answers.push_back(std::to_string(size) + ": " + std::to_string(written) + " [" + buffer + "]");
    }
    return answers;
}

// The source as the library, or past it the vendor, answers it; up to its first NUL.
std::string SourceOf(GLuint shader, bool from_vendor = false) {
    const GetShaderiv get_iv = from_vendor ? &ovo::raw::glGetShaderiv : &glGetShaderiv;
    const GetShaderSource get_source = from_vendor ? &ovo::raw::glGetShaderSource : &glGetShaderSource;
    GLint length = 0;
    get_iv(shader, GL_SHADER_SOURCE_LENGTH, &length);
    std::string text(static_cast<size_t>(length), '\0');
    if (length > 0) get_source(shader, length, nullptr, &text[0]);
    return text.c_str();
}

size_t Occurrences(const std::string& text, const std::string& part) {
    size_t count = 0;
    for (size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) ++count;
    return count;
}

GLuint VertexShader(const char* source) {
    const GLuint shader = glCreateShader(GL_VERTEX_SHADER);
    glShaderSource(shader, 1, &source, nullptr);
    return shader;
}

class ShaderSourceOnMesa : public MesaSessionTest {
protected:
    void SetUp() override {
        ASSERT_NO_FATAL_FAILURE(MesaSessionTest::SetUp());
        ASSERT_TRUE(MakeCurrent(m_context));
        // No profile here: the rewriting layer is put in by hand.
        ovo::StereoManager& manager = ovo::StereoManager::instance();
        delete manager.m_layer;
        manager.m_layer = new ovo::Es2StereoLayer(ovo::LAYER_SUBMODE_DIRECT);
    }

    bool MakeCurrent(EGLContext context) {
        return eglMakeCurrent(m_session.m_display, m_surface, m_surface, context) == EGL_TRUE;
    }

    static size_t KeptCount() { return ovo::StereoManager::instance().m_shader_sources->Count(); }
};

// Each set of strings goes once through the library and once straight to Mesa: every
// answer about the source must be the one Mesa gives for the application's own strings.
TEST_F(ShaderSourceOnMesa, TheApplicationReadsBackItsOwnStringsAsTheVendorJoinsThem) {
    const char body[] = "attribute vec4 p;\nvoid main() {\n    gl_Position = p;\n}\n";
    const char with_nul[] = "attribute vec4 p;\nvoid main() { gl_Position = p; }\n\0// after";
    struct Case {
        const char* m_label;
        std::vector<const char*> m_strings;
        std::vector<GLint> m_lengths;  // empty: a null length array
    } cases[] = {
        {"one terminated string", {body}, {}},
        {"pieces, some cut by their lengths",
         {"// made of pieces\nattribute vec4 p;\nvoid ", "main() { gl_Position = p; }\nIGNORED", "// end\n"},
         {-1, 28, -1}},
        {"a NUL inside the given length", {with_nul}, {static_cast<GLint>(sizeof(with_nul) - 1)}},
        {"a leading version directive", {"#version 100\n", body}, {}},
    };
    for (const Case& each : cases) {
        SCOPED_TRACE(each.m_label);
        const GLsizei count = static_cast<GLsizei>(each.m_strings.size());
        const GLint* lengths = each.m_lengths.empty() ? nullptr : each.m_lengths.data();
        const GLuint through_library = glCreateShader(GL_VERTEX_SHADER);
        glShaderSource(through_library, count, each.m_strings.data(), lengths);
        const GLuint on_mesa = ovo::raw::glCreateShader(GL_VERTEX_SHADER);
        ovo::raw::glShaderSource(on_mesa, count, each.m_strings.data(), lengths);

        EXPECT_EQ(Answers(through_library, &glGetShaderiv, &glGetShaderSource),
                  Answers(on_mesa, &ovo::raw::glGetShaderiv, &ovo::raw::glGetShaderSource));
        // Mesa holds and compiles the rewrite; its verdict reaches the application as is.
        EXPECT_EQ(Occurrences(SourceOf(through_library, true), DECLARATION), 1u);
        glCompileShader(through_library);
        GLint compiled = GL_FALSE;
        glGetShaderiv(through_library, GL_COMPILE_STATUS, &compiled);
        EXPECT_EQ(compiled, GL_TRUE);
        glDeleteShader(through_library);
        ovo::raw::glDeleteShader(on_mesa);
    }
    EXPECT_EQ(KeptCount(), 0u) << "every kept source went with its shader";
}

// A call the vendor refuses leaves the source as it was; it is not rewritten a second time.
TEST_F(ShaderSourceOnMesa, ARefusedSourceKeepsTheOneBefore) {
    const char source[] = "attribute vec4 p;\nvoid main() { gl_Position = p; }\n";
    const GLuint shader = VertexShader(source);
    const char* refused[] = {"void main() {}\n"};
    glShaderSource(shader, -1, refused, nullptr);
    EXPECT_EQ(glGetError(), static_cast<GLenum>(GL_INVALID_VALUE));
    EXPECT_EQ(SourceOf(shader), source);
    EXPECT_EQ(Occurrences(SourceOf(shader, true), DECLARATION), 1u);
    // A new source replaces the kept one.
    const char replaced[] = "attribute vec4 q;\nvoid main() { gl_Position = q; }\n";
    const char* strings[] = {replaced};
    glShaderSource(shader, 1, strings, nullptr);
    EXPECT_EQ(SourceOf(shader), replaced);
    EXPECT_EQ(KeptCount(), 1u);
}

// Shader names belong to share groups: contexts that share nothing may hold shaders of one
// name, each with its own source; a sharing context sees its group's.
TEST_F(ShaderSourceOnMesa, SourcesFollowShareGroupsAndGoWithThem) {
    const char first[] = "attribute vec4 a;\nvoid main() { gl_Position = a; }\n";
    const char second[] = "attribute vec4 b;\nvoid main() { gl_Position = b; }\n";
    const GLuint in_first = VertexShader(first);
    const EGLContext alone = m_session.CreateContext();
    const EGLContext sharing = m_session.CreateContext(m_context);
    ASSERT_TRUE(MakeCurrent(alone));
    const GLuint in_alone = VertexShader(second);
    ASSERT_EQ(in_alone, in_first) << "Mesa numbers each share group's shaders from 1";
    EXPECT_EQ(SourceOf(in_alone), second);
    ASSERT_TRUE(MakeCurrent(sharing));
    EXPECT_EQ(SourceOf(in_first), first);
    EXPECT_EQ(KeptCount(), 2u);

    // The lone context's group ends with it; the first group lives on in the sharing one.
    ASSERT_TRUE(eglDestroyContext(m_session.m_display, alone));
    EXPECT_EQ(KeptCount(), 1u);
    ASSERT_TRUE(eglDestroyContext(m_session.m_display, m_context));
    EXPECT_EQ(SourceOf(in_first), first);
    glDeleteShader(in_first);
    EXPECT_EQ(KeptCount(), 0u);
}

}  // namespace
