// The vertex-shader rewriter: where the two strings land, its trace and hostile sources. Where
// the leading #version and #extension lines end, for what Mesa cannot show: sources cut short,
// NULs, names that only begin like a directive's, comments inside a directive's line.
#include <gtest/gtest.h>

#include <climits>
#include <cstring>
#include <string>
#include <vector>

#include "stereo/glsl_directives.h"
#include "stereo/glsl_rewriter.h"

namespace {

constexpr char PRE[] = "<P>";
constexpr char POST[] = "<Q>";
constexpr char FILL = '\x7f';
constexpr size_t GUARD_BYTES = 32;

struct Outcome {
    int m_result;
    std::string m_out;    // up to the terminator; empty when nothing was inserted
    std::string m_trace;  // everything printed, from the strings' own lines on
    bool m_untouched;     // no byte of the buffer written
    bool m_guard_intact;  // no byte written past the stated room
};

// All of `source`'s bytes are the length; the buffer is exactly the stated room.
Outcome RunRewrite(const std::string& source, int32_t max_points = 1, const char* pre = PRE,
                   const char* post = POST) {
    const size_t room =
        source.size() + (pre ? std::strlen(pre) : 0) + max_points * (post ? std::strlen(post) : 0) + 1;
    std::vector<char> out(room + GUARD_BYTES, FILL);
    testing::internal::CaptureStdout();
    Outcome outcome;
    {
        ovo::GlslRewriter rewriter;
        rewriter.SetPreString(pre);
        rewriter.SetPostString(post);
        const int32_t length = static_cast<int32_t>(source.size());
        outcome.m_result = rewriter.Rewrite(out.data(), source.data(), length, max_points);
    }
    outcome.m_trace = testing::internal::GetCapturedStdout();
    outcome.m_out = outcome.m_result == 1 ? std::string(out.data()) : std::string();
    outcome.m_untouched = std::string(out.begin(), out.end()) == std::string(out.size(), FILL);
    outcome.m_guard_intact = std::string(out.begin() + room, out.end()) == std::string(GUARD_BYTES, FILL);
    return outcome;
}

size_t Count(const std::string& text, const std::string& piece) {
    size_t count = 0;
    for (size_t at = text.find(piece); at != std::string::npos; at = text.find(piece, at + 1)) ++count;
    return count;
}

TEST(GlslRewriter, PlacesBothStrings) {
    const struct {
        const char* name;
        std::string source;
        int32_t max_points;
        std::string expected;
    } cases[] = {
        {"comments before the version directive",
         "// lead\n/* block */\n#version 100\nattribute vec4 p;\nvoid main() {\n  x = p;\n}\n", 1,
         "// lead\n/* block */\n<P>#version 100\nattribute vec4 p;\nvoid main() {\n  x = p;\n<Q>}\n"},
        {"precision first, final brace after a blank",
         "\n  precision mediump float;\nvoid main() { gl_Position = vec4(0.0); }", 1,
         "\n  <P>precision mediump float;\nvoid main() { gl_Position = vec4(0.0); <Q>}"},
        {"brace after a word starts one byte late", "void main(){gl_Position=p}\n", 1,
         "<P>void main(){gl_Position=p}<Q>\n"},
        {"brace after a semicolon", "void main(){x=p;}", 1, "<P>void main(){x=p;<Q>}"},
        {"nested return",
         "void main() {\n  if (a > 0.0) {\n    gl_Position = p;\n    return;\n  }\n}\n", 1,
         "<P>void main() {\n  if (a > 0.0) {\n    gl_Position = p;\n    <Q>return;\n  }\n}\n"},
        {"later of two returns", "void main() { if (c) { return; } gl_Position = p; return; }\n", 1,
         "<P>void main() { if (c) { return; } gl_Position = p; <Q>return; }\n"},
        {"both returns", "void main() { if (c) { return; } gl_Position = p; return; }\n", 2,
         "<P>void main() { if (c) { <Q>return; } gl_Position = p; <Q>return; }\n"},
        {"last kept return replaced", "void main(){ return; return; return; }", 2,
         "<P>void main(){ <Q>return; return; <Q>return; }"},
        {"return outside main", "float f() { return 1.0; }\nvoid main() { gl_Position = vec4(f()); }\n", 1,
         "<P>float f() { return 1.0; }\nvoid main() { gl_Position = vec4(f()); <Q>}\n"},
        {"main(void)", "void main(void)\n{\n  gl_Position = p;\n}\n", 1,
         "<P>void main(void)\n{\n  gl_Position = p;\n<Q>}\n"},
        {"x.y is one word", "void main(){ v.return; }", 1, "<P>void main(){ v.return; <Q>}"},
        {"a/b is word, operator, word", "void main(){ v/return; }", 1, "<P>void main(){ v/r<Q>eturn; }"},
        {"leading operator slash", "/a void main(){ }\n", 1, "/a<P> void main(){ <Q>}\n"},
        {"brace in a string", "void main(){ s = \"}\"; }\n", 1, "<P>void main(){ s = \"}\"; <Q>}\n"},
        {"brace in a line comment", "void main(){ // }\n x; }\n", 1, "<P>void main(){ // }\n x; <Q>}\n"},
        {"comment closed by **/", "void main(){ /* a **/ x; }\n", 1, "<P>void main(){ /* a **/ x; <Q>}\n"},
        {"inner block", "#define X 1\nvoid main(){ { } }", 1, "<P>#define X 1\nvoid main(){ { } <Q>}"},
        {"terminator counted in the length", std::string("void main(){ }\0", 15), 1, "<P>void main(){ <Q>}"},
        {"copy stops at a NUL after main", std::string("void main(){ }\0tail", 19), 1, "<P>void main(){ <Q>}"},
        {"copy stops at a NUL before main", std::string("uniform vec4 u;\0void main(){ }", 30), 1,
         "<P>uniform vec4 u;"},
        {"unterminated comment after main", "void main(){ x; } /* open", 1, "<P>void main(){ x; <Q>} /* open"},
    };
    for (const auto& c : cases) {
        const Outcome outcome = RunRewrite(c.source, c.max_points);
        EXPECT_EQ(outcome.m_result, 1) << c.name;
        EXPECT_EQ(outcome.m_out, c.expected) << c.name;
        EXPECT_TRUE(outcome.m_guard_intact) << c.name;
    }
    EXPECT_EQ(RunRewrite("void main(){ }", 1, nullptr, POST).m_out, "void main(){ <Q>}");
    EXPECT_EQ(RunRewrite("void main(){ }", 1, PRE, nullptr).m_out, "<P>void main(){ }");
}

TEST(GlslRewriter, LeavesTheBufferWithoutAnInsertionPoint) {
    const std::string sources[] = {
        "", "   \n\t", "/* only a comment */ // and another\n",
        "attribute vec4 p;\nvoid other() { gl_Position = p; }\n",
        "void main(){gl_Position=p}",  // the final brace, given back at the end, is never read
        "void /* x */ main() { }\n", "void main() { gl_Position = p;\n", "void main(){ /* never closed }\n",
        "void main(){ \"never closed }\n"};
    for (const std::string& source : sources) {
        const Outcome outcome = RunRewrite(source);
        EXPECT_EQ(outcome.m_result, 0) << source;
        EXPECT_TRUE(outcome.m_untouched) << source;
        EXPECT_EQ(outcome.m_trace, "PreString <P>\nPostString <Q>\n") << source;
    }
    char out[8] = "intact";
    ovo::GlslRewriter rewriter;
    EXPECT_EQ(rewriter.Rewrite(out, "void main(){ }", 14, 0), 0);
    EXPECT_EQ(rewriter.Rewrite(out, "void main(){ }", -1, 1), 0);
    EXPECT_EQ(rewriter.Rewrite(out, nullptr, 14, 1), 0);
    EXPECT_EQ(rewriter.Rewrite(out, "void main(){ }", 13, 1), 0) << "the brace lies past the length";
    EXPECT_STREQ(out, "intact");
}

TEST(GlslRewriter, TracesWhatItFinds) {
    EXPECT_EQ(RunRewrite("void main() { if (c) { return; } return; }\n", 2).m_trace,
              "PreString <P>\nPostString <Q>\n[RETURN]********** 23 ***********\n"
              "[RETURN]********** 33 ***********\nFirst Character 'v': 0\n"
              "Last Character 'r': 23\nLast Character 'r': 33\n");
    EXPECT_EQ(RunRewrite("void main(){x=p}\n", 1, nullptr, nullptr).m_trace,
              "PreString (null)\nPostString (null)\n[BLOCK_END]********** 16 ***********\n"
              "First Character 'v': 0\nLast Character '\n': 16\n");
    const Outcome nul_first = RunRewrite(std::string("/a\0 void main(){ }", 18));
    EXPECT_EQ(nul_first.m_out, "/a<P>");
    const char nul_lines[] = "First Character '\0': 2\nLast Character '}': 17\n";
    EXPECT_EQ(nul_first.m_trace.substr(nul_first.m_trace.find("First")),
              std::string(nul_lines, sizeof(nul_lines) - 1));
}

TEST(GlslRewriter, ReadsLongTokensToTheirEnd) {
    const std::string message = "[SSM] OUT_OF_BUFFER_MAX_SIZE\n";
    const struct {
        std::string token;
        size_t messages;
    } cases[] = {
        {std::string(1023, 'w'), 0},
        {std::string(1024, 'w'), 0},
        {std::string(1025, 'w'), 1},
        {std::string(3000, 'w'), 1976},
        {'"' + std::string(1025, 's') + '"', 1},
        {std::string(1023, 'w') + "return", 5},  // no cut-off piece passes for a return
    };
    for (const auto& c : cases) {
        const Outcome outcome = RunRewrite("void main(){ " + c.token + "; }");
        EXPECT_EQ(Count(outcome.m_trace, message), c.messages) << c.token.size();
        EXPECT_EQ(outcome.m_out, "<P>void main(){ " + c.token + "; <Q>}") << c.token.size();
    }
}

TEST(GlslRewriter, RewritesMegabyteSources) {
    std::string source = "attribute vec4 p;\nvoid main() {\n";
    while (source.size() < (4u << 20)) source += "    gl_Position = p * 1.0; // step {\n";
    source += "    if (p.w < 0.0) { return; }\n    gl_Position.y = -gl_Position.y;\n}\n";
    std::string expected = "<P>" + source;
    expected.insert(expected.rfind("return"), POST);
    EXPECT_EQ(RunRewrite(source).m_out, expected);
    const Outcome open_comment = RunRewrite("void main() { /*" + std::string(3u << 20, '*'));
    EXPECT_EQ(open_comment.m_result, 0);
    EXPECT_TRUE(open_comment.m_untouched);
    // Every kept position fits however many are asked for.
    const Outcome all_returns = RunRewrite("void main() { return; return; return; }", INT_MAX, PRE, "");
    EXPECT_EQ(Count(all_returns.m_trace, "Last Character"), 3u);
}

TEST(LeadingDirectivesLength, EndsAfterTheLastVersionOrExtensionLine) {
    const struct {
        const char* m_name;
        std::string m_kept;
        std::string m_rest;
    } cases[] = {
        {"none", "", "attribute vec4 p;\n"},
        {"a comment alone", "", "// c\nattribute vec4 p;\n"},
        {"version", "#version 100\n", "attribute vec4 p;\n"},
        {"blanks around #, CRLF", " \t#\t version 100\r\n#extension A : enable\r\n", "x"},
        {"CR only", "#version 100\r", "\rx"},
        {"comments among them", "/* a\n b */\n#version 100\n// c\n\n#extension A : enable\n", "x"},
        {"a comment over lines in the line", "#version 100 /* a\nb */ c\n", "x"},
        {"a comment between # and the name", "# /* a\n */ version 100\n", "x"},
        {"the last line without its end", "#version 100\n#extension A : enable", ""},
        {"an unterminated comment in the line", "#version 100 /* a\n", ""},
        {"other directives end them", "#version 100\n", "#define A\n#extension B : enable\n"},
        {"precision ends them", "#version 100\n", "precision highp float;\n"},
        {"only the start of a name", "", "#versionx 100\n"},
        {"a longer name", "#version 100\n", "#extensions A\n"},
        {"a comment instead of a name", "", "#// version\n#version 100\n"},
        {"a NUL ends the source", "#version 100\n", std::string("\0#extension A\n", 14)},
    };
    for (const auto& each : cases) {
        // Exactly the source's bytes, no terminator: reading past them is a sanitizer finding.
        std::vector<char> bytes(each.m_kept.begin(), each.m_kept.end());
        bytes.insert(bytes.end(), each.m_rest.begin(), each.m_rest.end());
        EXPECT_EQ(ovo::LeadingDirectivesLength(bytes.data(), static_cast<int32_t>(bytes.size())),
                  static_cast<int32_t>(each.m_kept.size()))
            << each.m_name;
    }
}

// The source cut at each length: a name cut short is none, a line cut short is kept whole.
TEST(LeadingDirectivesLength, ASourceCutShortEndsWhereItIsCut) {
    const std::string source = "#version 100\n#extension A : enable\nx";
    const struct {
        int32_t m_length;
        int32_t m_kept;
    } cuts[] = {{7, 0}, {8, 8}, {12, 12}, {13, 13}, {22, 13}, {23, 23}, {35, 35}, {36, 35}};
    for (const auto& cut : cuts) {
        const std::vector<char> bytes(source.begin(), source.begin() + cut.m_length);
        EXPECT_EQ(ovo::LeadingDirectivesLength(bytes.data(), cut.m_length), cut.m_kept)
            << cut.m_length;
    }
}

}  // namespace
