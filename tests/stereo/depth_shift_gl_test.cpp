// The depth-shift injection on Mesa, reached through the library: the text the driver ends
// up holding, and that it still compiles.
#include <string>
#include <vector>

#include "depth_shift_on_mesa.h"

namespace {

const std::string DECLARATION = "uniform vec2 uZpDepthShift;\n";
const std::string STATEMENT =
    "gl_Position.x = gl_Position.x + (uZpDepthShift.y * min((uZpDepthShift.x * "
    "gl_Position.w) - gl_Position.z, 0.0));\n";

struct Case {
    const char* m_name;
    GLenum m_type;
    std::vector<const char*> m_strings;
    std::string m_expected;  // as Mesa holds it
    bool m_compiles = true;
};

void ExpectCompiledAs(const std::vector<Case>& cases) {
    for (const Case& each : cases) {
        const CompiledShader shader = DepthShiftOnMesa::Compile(each.m_type, each.m_strings);
        EXPECT_EQ(shader.m_compiled, each.m_compiles) << each.m_name << ": " << shader.m_log;
        EXPECT_EQ(shader.m_source, each.m_expected) << each.m_name;
    }
}

TEST_F(DepthShiftOnMesa, VertexShadersCompileWithTheShiftAtTheEndOfMainFragmentShadersAsWritten) {
    const char* fragment = "precision mediump float;\nvoid main() { gl_FragColor = vec4(1.0); }\n";
    ExpectCompiledAs({
        {"as the samples write them: a leading newline, the statement before main's brace",
         GL_VERTEX_SHADER,
         {"\nuniform mat4 u_mvp;\nattribute vec4 a_position;\n",
          "void main() {\n    gl_Position = u_mvp * a_position;\n}\n"},
         "\n" + DECLARATION +
             "uniform mat4 u_mvp;\nattribute vec4 a_position;\nvoid main() {\n    gl_Position "
             "= u_mvp * a_position;\n" + STATEMENT + "}\n"},
        {"a leading comment and precision statement; the last return of main takes it",
         GL_VERTEX_SHADER,
         {"// lit\nprecision highp float;\nattribute vec4 p;\nvoid main() {\n"
          "    gl_Position = p;\n    if (p.x > 0.0) { gl_Position = -p; return; }\n"
          "    gl_Position.y = 1.0;\n    return;\n}\n"},
         "// lit\n" + DECLARATION +
             "precision highp float;\nattribute vec4 p;\nvoid main() {\n    gl_Position = p;\n"
             "    if (p.x > 0.0) { gl_Position = -p; return; }\n    gl_Position.y = 1.0;\n    " +
             STATEMENT + "return;\n}\n"},
        {"a fragment shader", GL_FRAGMENT_SHADER, {fragment}, fragment},
    });
}

// Nothing but comments and blanks may come before #version, and Mesa refuses #extension
// after a declaration: the declaration goes in after the leading #version and #extension
// lines. (Mesa refuses comments on an #extension line itself.)
TEST_F(DepthShiftOnMesa, TheDeclarationFollowsTheLeadingVersionAndExtensionLines) {
    const std::string body = "attribute vec4 p;\nvoid main() {\n    gl_Position = p;\n";
    const std::string whole_body = body + "}\n";
    const std::string injected_body = DECLARATION + body + STATEMENT + "}\n";
    const std::string extension = "#extension GL_OES_standard_derivatives : enable";
    const std::string commented =
        "// header\n\n#version 100 // why\n\n/* two\n   lines */\n  # extension "
        "GL_OES_standard_derivatives : enable\n\t#\textension "
        "GL_OES_standard_derivatives : enable\n// after\n";
    ExpectCompiledAs({
        {"#version first", GL_VERTEX_SHADER, {"#version 100\n", whole_body.c_str()},
         "#version 100\n" + injected_body},
        {"comments and blank lines among the directives, blanks around #", GL_VERTEX_SHADER,
         {commented.c_str(), whole_body.c_str()}, commented + injected_body},
        {"CRLF line ends", GL_VERTEX_SHADER,
         {"#version 100\r\n#extension GL_OES_standard_derivatives : enable\r\n"
          "attribute vec4 p;\r\nvoid main() {\r\n    gl_Position = p;\r\n}\r\n"},
         "#version 100\r\n" + extension + "\r\n" + DECLARATION +
             "attribute vec4 p;\r\nvoid main() {\r\n    gl_Position = p;\r\n" + STATEMENT +
             "}\r\n"},
        {"CR line ends", GL_VERTEX_SHADER,
         {"#version 100\r#extension GL_OES_standard_derivatives : enable\r"
          "attribute vec4 p;\rvoid main() {\r    gl_Position = p;\r}\r"},
         "#version 100\r" + extension + "\r" + DECLARATION +
             "attribute vec4 p;\rvoid main() {\r    gl_Position = p;\r" + STATEMENT + "}\r"},
        {"other directives end the kept lines", GL_VERTEX_SHADER,
         {"#version 100\n#pragma optimize(on)\n#ifdef GL_ES\nprecision highp float;\n#endif\n"
          "#define SCALE 1.0\n",
          "attribute vec4 p;\nvoid main() {\n    gl_Position = p * SCALE;\n}\n"},
         "#version 100\n" + DECLARATION +
             "#pragma optimize(on)\n#ifdef GL_ES\nprecision highp float;\n#endif\n#define SCALE 1.0\nattribute vec4 "
             "p;\nvoid main() {\n    gl_Position = p * SCALE;\n" + STATEMENT + "}\n"},
        // Left as written, which Mesa refuses for want of a declaration.
        {"directives only, the last without a line end", GL_VERTEX_SHADER,
         {"#version 100\n", extension.c_str()}, "#version 100\n" + extension, false},
    });
}

// The end of main is found by words and braces alone. An early return takes the statement
// (a return without braces then no longer depends on its condition, and what main computes
// after it is lost; with braces only the early path is shifted); a prototype starts main at
// the next function or struct; a brace in a macro counts where it is written, not where the
// macro is used.
TEST_F(DepthShiftOnMesa, EarlyReturnsPrototypesAndMacrosMisplaceTheShift) {
    const std::string head = "attribute vec4 p;\nuniform float u;\n";
    const std::string unbraced = "void main() {\n    gl_Position = p;\n    if (u > 0.5) return;\n"
                                 "    gl_Position.x = gl_Position.x + 1.0;\n}\n";
    const std::string braced = "void main() {\n    gl_Position = p;\n    if (u > 0.5) { return; }\n"
                               "    gl_Position.x = gl_Position.x + 1.0;\n}\n";
    const std::string helper = "void main();\nvec4 position() { return p; }\n"
                               "void main() { gl_Position = position(); }\n";
    const std::string structure = "void main();\nstruct Light { vec4 colour; };\n"
                                  "void main() { gl_Position = p; }\n";
    const std::string main_macros = "#define BEGIN_MAIN void main() {\n#define END_MAIN }\n" + head +
                                    "BEGIN_MAIN\n    gl_Position = p;\nEND_MAIN\n";
    const std::string end_macro =
        "#define END_MAIN }\n" + head + "void main() {\n    gl_Position = p;\nEND_MAIN\n";
    auto before = [](const std::string& text, const std::string& at) {
        std::string injected = DECLARATION + text;
        return injected.insert(injected.find(at), STATEMENT);
    };
    ExpectCompiledAs({
        {"a return without braces", GL_VERTEX_SHADER, {head.c_str(), unbraced.c_str()},
         before(head + unbraced, "return;")},
        {"a return in braces", GL_VERTEX_SHADER, {head.c_str(), braced.c_str()},
         before(head + braced, "return;")},
        {"a prototype, then a function", GL_VERTEX_SHADER, {head.c_str(), helper.c_str()},
         before(head + helper, "return p;")},
        {"a prototype, then a struct", GL_VERTEX_SHADER, {head.c_str(), structure.c_str()},
         before(head + structure, "};"), false},
        {"main begun and ended by macros", GL_VERTEX_SHADER, {main_macros.c_str()},
         before(main_macros, "}\nattribute"), false},
        {"main ended by a macro defined before it", GL_VERTEX_SHADER, {end_macro.c_str()}, end_macro},
    });
}

}  // namespace
