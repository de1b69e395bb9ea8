// Debian's piglit as a corpus of real vertex shaders: every GLSL ES 1.00 one that Mesa
// compiles as written must compile after the depth-shift injection too, with the declaration
// right after its leading #version and #extension lines. A shader that cannot is listed in
// EXCEPTIONS with the reason, and must fail in just the way named there.
#include <algorithm>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <regex>
#include <string>
#include <system_error>
#include <vector>

#include "depth_shift_on_mesa.h"
#include "stereo/depth_shift.h"

namespace {

namespace fs = std::filesystem;

// The piglit package's folder of shader tests, extracted by scripts/fetch-piglit-corpus.sh.
const fs::path PIGLIT_TESTS = fs::path(OVO_PIGLIT_DIR) / "shader-tests";
const std::string ES_100_FOLDER = "glsl-es-1.00/";

// A shader that Mesa compiles as written but not after the injection.
struct Exception {
    const char* m_name;    // as CorpusShader names it
    const char* m_reason;
    const char* m_log;     // a piece of Mesa's log for the injected shader
};

// None on Mesa 22.3: every shader that it compiles as written compiles after the injection.
const std::vector<Exception> EXCEPTIONS = {};

struct CorpusShader {
    std::string m_name;  // the path below PIGLIT_TESTS, with " [vertex shader N]" for a section
    std::vector<std::string> m_strings;  // as piglit hands them to glShaderSource
    std::string m_expect_result;         // a .vert's own verdict, pass or fail
};

std::string ReadFile(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

// The value of "key: value" on the first line holding the key; empty without one.
std::string Field(const std::string& text, const std::string& key) {
    const size_t at = text.find(key + ":");
    if (at == std::string::npos) return std::string();
    const size_t begin = text.find_first_not_of(" \t", at + key.size() + 1);
    const size_t end = text.find_first_of("\r\n", at);
    return begin < end ? text.substr(begin, end - begin) : std::string();
}

// Each [vertex shader] section as shader_runner submits it: a `#version 100` line in front
// when the section has no #version of its own (the GLSL ES version the test requires).
void AddSections(const std::string& name, const std::string& text, std::vector<CorpusShader>* corpus) {
    const std::string header = "[vertex shader]\n";
    int number = 0;
    for (size_t at = text.find(header); at != std::string::npos; at = text.find(header, at + 1)) {
        if (at > 0 && text[at - 1] != '\n') continue;
        const size_t begin = at + header.size();
        size_t end = text.find("\n[", begin - 1);
        end = end == std::string::npos ? text.size() : end + 1;
        const std::string section = text.substr(begin, end - begin);
        CorpusShader shader{name + " [vertex shader " + std::to_string(++number) + "]", {}, "pass"};
        if (section.find("#version ") == std::string::npos) {
            EXPECT_NE(text.find("\nGLSL ES >= 1.00\n"), std::string::npos) << name << ": wants another GLSL ES";
            shader.m_strings.push_back("#version 100\n");
        }
        shader.m_strings.push_back(section);
        corpus->push_back(shader);
    }
}

// Every *.vert below glsl-es-1.00, the [vertex shader] sections of its *.shader_test,
// and every other *.vert whose [config] says glsl_version 1.00; in path order.
std::vector<CorpusShader> ReadCorpus(int* sections) {
    std::vector<fs::path> paths;
    std::error_code error;
    for (fs::recursive_directory_iterator it(PIGLIT_TESTS, error), end; !error && it != end; it.increment(error)) {
        if (it->is_regular_file()) paths.push_back(it->path());
    }
    EXPECT_FALSE(error) << PIGLIT_TESTS << ": " << error.message();
    std::sort(paths.begin(), paths.end());
    std::vector<CorpusShader> corpus;
    *sections = 0;
    for (const fs::path& path : paths) {
        const std::string name = path.lexically_relative(PIGLIT_TESTS).generic_string();
        const bool es_100 = name.compare(0, ES_100_FOLDER.size(), ES_100_FOLDER) == 0;
        const std::string text = ReadFile(path);
        if (path.extension() == ".shader_test" && es_100) {
            const size_t before = corpus.size();
            AddSections(name, text, &corpus);
            *sections += static_cast<int>(corpus.size() - before);
        } else if (path.extension() == ".vert" && (es_100 || Field(text, "glsl_version") == "1.00")) {
            corpus.push_back({name, {text}, Field(text, "expect_result")});
        }
    }
    return corpus;
}

// Comments blanked out, byte for byte, line ends kept.
std::string WithoutComments(std::string text) {
    for (size_t i = 0; i + 1 < text.size(); ++i) {
        if (text[i] != '/' || (text[i + 1] != '/' && text[i + 1] != '*')) continue;
        const bool line = text[i + 1] == '/';
        size_t end = line ? text.find('\n', i) : text.find("*/", i + 2);
        end = end == std::string::npos ? text.size() : end + (line ? 0 : 2);
        for (size_t j = i; j < end; ++j) {
            if (text[j] != '\n') text[j] = ' ';
        }
        i = end - 1;
    }
    return text;
}

bool IsKeptDirective(const std::string& line) {
    static const std::regex KEPT("^[ \\t]*#[ \\t]*(version|extension)\\b");
    return std::regex_search(line, KEPT);
}

bool DefinesMain(const std::string& bare) {
    static const std::regex MAIN("\\bvoid\\s+main\\s*\\(");
    return std::regex_search(bare, MAIN);
}

// The declaration stands right in front of the first thing that is neither blank, comment
// nor a #version or #extension line; the rest is the application's text with the statement
// added once.
void ExpectDeclarationAfterDirectives(const std::string& name, const std::string& written,
                                      const std::string& injected) {
    const std::string declaration = ovo::DEPTH_SHIFT_DECLARATION;
    const size_t at = injected.find(declaration);
    ASSERT_NE(at, std::string::npos) << name << ": nothing injected";
    ASSERT_LT(at, written.size()) << name;
    EXPECT_EQ(injected.compare(0, at, written, 0, at), 0) << name;
    const std::string bare = WithoutComments(written);
    size_t line_start = 0;
    for (size_t end = bare.find('\n'); end != std::string::npos && end < at;
         line_start = end + 1, end = bare.find('\n', line_start)) {
        const std::string line = bare.substr(line_start, end - line_start);
        EXPECT_TRUE(line.find_first_not_of(" \t\r") == std::string::npos || IsKeptDirective(line))
            << name << ": in front of the declaration: " << line;
    }
    EXPECT_EQ(bare.find_first_not_of(" \t\r", line_start), at)
        << name << ": the declaration is not in front of the first other line";
    EXPECT_FALSE(IsKeptDirective(bare.substr(at, bare.find('\n', at) - at))) << name;

    std::string rest = injected;
    rest.erase(at, declaration.size());
    const size_t statement = rest.find(ovo::DEPTH_SHIFT_STATEMENT, at);
    ASSERT_NE(statement, std::string::npos) << name << ": no statement";
    rest.erase(statement, std::strlen(ovo::DEPTH_SHIFT_STATEMENT));
    EXPECT_EQ(rest, written) << name;
}

TEST_F(DepthShiftOnMesa, PiglitGlslEs100VertexShadersStillCompileWithTheDeclarationAfterTheirDirectives) {
    ASSERT_TRUE(fs::is_directory(PIGLIT_TESTS / ES_100_FOLDER))
        << PIGLIT_TESTS << " holds no piglit corpus: the test PiglitCorpus.Fetch "
        << "(scripts/fetch-piglit-corpus.sh) puts it there";
    int sections = 0;
    const std::vector<CorpusShader> corpus = ReadCorpus(&sections);
    int native = 0;
    int injected = 0;
    int without_main = 0;  // kept as written
    std::vector<std::string> left_out;
    int left_out_expected = 0;  // of them, those whose own verdict is fail
    std::vector<const Exception*> met;
    for (const CorpusShader& shader : corpus) {
        std::vector<const char*> strings;
        std::string written;
        for (const std::string& each : shader.m_strings) {
            strings.push_back(each.c_str());
            written += each;
        }
        const CompiledShader as_written = Compile(GL_VERTEX_SHADER, strings, false);
        if (!as_written.m_compiled) {
            left_out.push_back(shader.m_name + " (expect_result: " + shader.m_expect_result + ")");
            left_out_expected += shader.m_expect_result == "fail" ? 1 : 0;
            continue;
        }
        native += 1;
        const CompiledShader result = Compile(GL_VERTEX_SHADER, strings);
        const auto exception = std::find_if(EXCEPTIONS.begin(), EXCEPTIONS.end(),
                                            [&](const Exception& each) { return shader.m_name == each.m_name; });
        if (exception != EXCEPTIONS.end()) {
            met.push_back(&*exception);
            EXPECT_FALSE(result.m_compiled) << shader.m_name << " is listed as failing, but compiles";
            EXPECT_NE(result.m_log.find(exception->m_log), std::string::npos)
                << shader.m_name << " fails otherwise than listed (" << exception->m_reason
                << "):\n" << result.m_log;
            continue;
        }
        EXPECT_TRUE(result.m_compiled) << shader.m_name << ":\n" << result.m_log << "\n" << result.m_source;
        injected += result.m_compiled ? 1 : 0;
        if (DefinesMain(WithoutComments(written))) {
            ExpectDeclarationAfterDirectives(shader.m_name, written, result.m_source);
        } else {
            without_main += 1;
            EXPECT_EQ(result.m_source, written) << shader.m_name << " has no main to inject into";
        }
    }
    for (const Exception& exception : EXCEPTIONS) {
        EXPECT_NE(std::find(met.begin(), met.end(), &exception), met.end())
            << exception.m_name << " is listed but not among the shaders that compile natively";
    }
    for (const std::string& name : left_out) std::printf("left out, fails natively: %s\n", name.c_str());
    std::printf("piglit corpus: %zu vertex shaders (%d of them shader_test sections), %d compile natively, %zu do "
                "not and are left out (%d of them expected to fail), %d compile after the injection (%d of them "
                "without main, kept as written), %zu listed exceptions\n",
                corpus.size(), sections, native, left_out.size(), left_out_expected, injected, without_main,
                met.size());
    EXPECT_GT(native, 0);
    EXPECT_GT(sections, 0);
}

}  // namespace
