#include "text_tokens.h"

#include <cctype>
#include <cerrno>
#include <cmath>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace ovo_profile {

namespace {

constexpr char LINE_SPACE[] = " \t\r";

bool IsLineSpace(char byte) { return byte == ' ' || byte == '\t' || byte == '\r'; }

std::string Trim(const std::string& text) {
    size_t begin = text.find_first_not_of(LINE_SPACE);
    if (begin == std::string::npos) return "";
    size_t end = text.find_last_not_of(LINE_SPACE);
    return text.substr(begin, end - begin + 1);
}

// Where the comment starts: at a '#' outside a double-quoted string; the line's end when
// there is none.
size_t CommentStart(const std::string& line) {
    bool quoted = false;
    for (size_t index = 0; index < line.size(); ++index) {
        const char byte = line[index];
        if (quoted && byte == '\\') {
            ++index;
        } else if (byte == '"') {
            quoted = !quoted;
        } else if (byte == '#' && !quoted) {
            return index;
        }
    }
    return line.size();
}

// "nan(0xM)" with an optional sign: the NaN whose mantissa bits are M (1 to 0x7FFFFF).
NumberStatus ParseNanBits(const std::string& text, float& value) {
    const bool negative = text[0] == '-';
    const size_t start = (negative || text[0] == '+') ? 5 : 4;  // after "nan("
    int64_t mantissa = 0;
    const NumberStatus status =
        ParseInteger(text.substr(start, text.size() - start - 1), 1, FLOAT_MANTISSA_BITS, mantissa);
    if (status != NumberStatus::OK) return status;
    const uint32_t bits = (negative ? FLOAT_SIGN_BIT : 0) | FLOAT_EXPONENT_BITS | static_cast<uint32_t>(mantissa);
    std::memcpy(&value, &bits, sizeof(value));
    return NumberStatus::OK;
}

bool IsNanWithBits(const std::string& text) {
    const size_t start = (!text.empty() && (text[0] == '-' || text[0] == '+')) ? 1 : 0;
    return text.compare(start, 4, "nan(") == 0 && text.back() == ')';
}

}  // namespace

std::string FormatText(const char* format, ...) {
    char text[512];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof(text), format, arguments);
    va_end(arguments);
    return text;
}

std::vector<std::string> SplitLines(const std::string& text) {
    std::vector<std::string> lines;
    size_t position = 0;
    while (true) {
        const size_t end = text.find('\n', position);
        if (end == std::string::npos) break;
        lines.push_back(text.substr(position, end - position));
        position = end + 1;
    }
    lines.push_back(text.substr(position));
    return lines;
}

TextLine ReadTextLine(const std::string& line) {
    TextLine read;
    const size_t comment = CommentStart(line);
    const std::string content = line.substr(0, comment);
    read.m_text = Trim(content);
    read.m_blank = read.m_text.empty();
    const size_t equals = content.find('=');
    if (read.m_blank || equals == std::string::npos) return read;
    read.m_has_equals = true;
    read.m_name = Trim(content.substr(0, equals));
    read.m_value = Trim(content.substr(equals + 1));
    size_t begin = equals + 1;
    while (begin < comment && IsLineSpace(line[begin])) ++begin;
    size_t end = comment;
    while (end > begin && IsLineSpace(line[end - 1])) --end;
    read.m_value_begin = begin;
    read.m_value_end = end;
    return read;
}

std::vector<std::string> SplitWords(const std::string& text) {
    std::vector<std::string> words;
    size_t index = 0;
    while (index < text.size()) {
        if (text[index] == ' ' || text[index] == '\t') {
            ++index;
            continue;
        }
        size_t start = index;
        bool quoted = false;
        while (index < text.size() && (quoted || (text[index] != ' ' && text[index] != '\t'))) {
            if (quoted && text[index] == '\\') {
                ++index;
            } else if (text[index] == '"') {
                quoted = !quoted;
            }
            ++index;
        }
        words.push_back(text.substr(start, index - start));
    }
    return words;
}

NumberStatus ParseInteger(const std::string& text, int64_t minimum, int64_t maximum, int64_t& value) {
    if (text.empty()) return NumberStatus::MALFORMED;
    size_t start = (text[0] == '-' || text[0] == '+') ? 1 : 0;
    const bool hex =
        text.size() > start + 2 && text[start] == '0' && (text[start + 1] == 'x' || text[start + 1] == 'X');
    const size_t digits = start + (hex ? 2 : 0);
    if (digits >= text.size()) return NumberStatus::MALFORMED;
    for (size_t index = digits; index < text.size(); ++index) {
        if (!(hex ? std::isxdigit(static_cast<unsigned char>(text[index]))
                  : std::isdigit(static_cast<unsigned char>(text[index])))) {
            return NumberStatus::MALFORMED;
        }
    }
    errno = 0;
    const long long parsed = std::strtoll(text.c_str(), nullptr, hex ? 16 : 10);
    if (errno == ERANGE || parsed < minimum || parsed > maximum) return NumberStatus::OUT_OF_RANGE;
    value = parsed;
    return NumberStatus::OK;
}

NumberStatus ParseFloat(const std::string& text, float& value) {
    if (text.empty() || std::isspace(static_cast<unsigned char>(text[0]))) return NumberStatus::MALFORMED;
    if (IsNanWithBits(text)) return ParseNanBits(text, value);
    char* end = nullptr;
    errno = 0;
    const float parsed = std::strtof(text.c_str(), &end);
    if (end == text.c_str() || *end != '\0') return NumberStatus::MALFORMED;
    // Overflow gives an infinity, underflow below the smallest single gives 0 (both with
    // ERANGE); a subnormal result is kept.
    if (errno == ERANGE && (std::isinf(parsed) || parsed == 0.0f)) return NumberStatus::OUT_OF_RANGE;
    value = parsed;
    return NumberStatus::OK;
}

bool ParseQuoted(const std::string& text, std::string& bytes, std::string& problem) {
    if (text.size() < 2 || text.front() != '"' || text.back() != '"') {
        problem = "expected a double-quoted string";
        return false;
    }
    bytes.clear();
    for (size_t index = 1; index + 1 < text.size(); ++index) {
        char byte = text[index];
        if (byte != '\\') {
            bytes += byte;
            continue;
        }
        if (index + 2 >= text.size()) {
            problem = "a '\\' ends the string";
            return false;
        }
        const char escape = text[++index];
        switch (escape) {
            case '\\': bytes += '\\'; break;
            case '"': bytes += '"'; break;
            case '0': bytes += '\0'; break;
            case 'n': bytes += '\n'; break;
            case 't': bytes += '\t'; break;
            case 'x': {
                if (index + 3 >= text.size() || !std::isxdigit(static_cast<unsigned char>(text[index + 1])) ||
                    !std::isxdigit(static_cast<unsigned char>(text[index + 2]))) {
                    problem = "'\\x' needs two hexadecimal digits";
                    return false;
                }
                bytes += static_cast<char>(std::strtol(text.substr(index + 1, 2).c_str(), nullptr, 16));
                index += 2;
                break;
            }
            default: problem = FormatText("unknown escape '\\%c'", escape); return false;
        }
    }
    return true;
}

}  // namespace ovo_profile
