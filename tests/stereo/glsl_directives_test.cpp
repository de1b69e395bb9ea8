// Where the leading #version and #extension lines end, for what Mesa cannot show: sources cut
// short, NULs, names that only begin like a directive's, comments inside a directive's line.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "stereo/glsl_directives.h"

namespace {

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
