#ifndef OVO_TOOLS_PROFILE_TEXT_TEXT_TOKENS_H
#define OVO_TOOLS_PROFILE_TEXT_TEXT_TOKENS_H

// The pieces of the profile's text form: lines of `name = value`, '#' comments, words,
// numbers and double-quoted strings.

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace ovo_profile {

constexpr uint32_t FLOAT_SIGN_BIT = 0x80000000u;
constexpr uint32_t FLOAT_EXPONENT_BITS = 0x7F800000u;
constexpr uint32_t FLOAT_MANTISSA_BITS = 0x007FFFFFu;
constexpr uint32_t FLOAT_QUIET_NAN_MANTISSA = 0x00400000u;  // what "nan" reads as

// printf into a string (up to 511 bytes).
std::string FormatText(const char* format, ...) __attribute__((format(printf, 1, 2)));

// The text split at each '\n' (a final empty piece when it ends with one), so that joining
// the pieces with '\n' gives the text back.
std::vector<std::string> SplitLines(const std::string& text);

// One line: `name = value`, with an optional '#' comment (a '#' inside a double-quoted
// string starts none).
struct TextLine {
    bool m_blank = true;  // nothing but white space and a comment
    bool m_has_equals = false;
    std::string m_text;   // the line without its comment, trimmed
    std::string m_name;   // before '=', trimmed
    std::string m_value;  // after '=', trimmed
    // Where the value stands in the line (an empty range right after '=' and its spaces
    // when there is none).
    size_t m_value_begin = 0;
    size_t m_value_end = 0;
};

TextLine ReadTextLine(const std::string& line);

// Whitespace-separated words; a double-quoted string (with its escapes) is one word.
std::vector<std::string> SplitWords(const std::string& text);

enum class NumberStatus { OK, MALFORMED, OUT_OF_RANGE };

// A whole integer: decimal with an optional sign, or hexadecimal with a 0x prefix.
NumberStatus ParseInteger(const std::string& text, int64_t minimum, int64_t maximum, int64_t& value);

// A whole 32-bit float as strtof reads it (so "%.9g" output reads back exactly), or a NaN
// by its bits, "nan(0xM)".
NumberStatus ParseFloat(const std::string& text, float& value);

// Bytes of a double-quoted string with the escapes \\ \" \0 \n \t \xNN.
bool ParseQuoted(const std::string& text, std::string& bytes, std::string& problem);

}  // namespace ovo_profile

#endif
