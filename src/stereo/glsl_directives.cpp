#include "stereo/glsl_directives.h"

#include <cstring>

namespace ovo {

namespace {

// Walks a source up to its length or its first NUL, whichever comes first.
class DirectiveScanner {
public:
    DirectiveScanner(const char* source, int32_t length) : m_source(source), m_length(length) {}

    bool AtEnd() const { return m_at >= m_length || m_source[m_at] == '\0'; }
    char Peek() const { return AtEnd() ? '\0' : m_source[m_at]; }
    int32_t Position() const { return m_at; }

    bool SkipChar(char c) {
        if (Peek() != c) return false;
        m_at += 1;
        return true;
    }

    // Blanks and comments, and line ends too when `across_lines`.
    void SkipSpace(bool across_lines) {
        while (!AtEnd()) {
            const char c = m_source[m_at];
            if (c == ' ' || c == '\t' || c == '\v' || c == '\f' ||
                (across_lines && IsLineEnd(c))) {
                m_at += 1;
            } else if (!SkipComment()) {
                return;
            }
        }
    }

    // A directive name, which no letter, digit or underscore may continue.
    bool SkipName(const char* name) {
        const int32_t size = static_cast<int32_t>(std::strlen(name));
        if (m_length - m_at < size || std::memcmp(m_source + m_at, name, size) != 0) return false;
        const char next = m_length - m_at > size ? m_source[m_at + size] : '\0';
        if ((next >= 'a' && next <= 'z') || (next >= 'A' && next <= 'Z') ||
            (next >= '0' && next <= '9') || next == '_') {
            return false;
        }
        m_at += size;
        return true;
    }

    // To past the line's end ("\r\n" is one); a comment that spans lines is part of it.
    void SkipLine() {
        while (!AtEnd()) {
            const char c = m_source[m_at];
            if (IsLineEnd(c)) {
                m_at += 1;
                if (c == '\r' && Peek() == '\n') m_at += 1;
                return;
            }
            if (!SkipComment()) m_at += 1;
        }
    }

private:
    static bool IsLineEnd(char c) { return c == '\n' || c == '\r'; }

    // A `//` comment up to its line's end, a `/* */` comment past its end; false when none
    // starts here.
    bool SkipComment() {
        if (m_source[m_at] != '/' || m_length - m_at < 2) return false;
        const char kind = m_source[m_at + 1];
        if (kind != '/' && kind != '*') return false;
        m_at += 2;
        while (!AtEnd()) {
            const char c = m_source[m_at];
            if (kind == '/' && IsLineEnd(c)) return true;
            m_at += 1;
            if (kind == '*' && c == '*' && Peek() == '/') {
                m_at += 1;
                return true;
            }
        }
        return true;
    }

    const char* m_source;
    int32_t m_length;
    int32_t m_at = 0;
};

}  // namespace

int32_t LeadingDirectivesLength(const char* source, int32_t length) {
    if (source == nullptr || length <= 0) return 0;
    DirectiveScanner scanner(source, length);
    int32_t kept = 0;
    for (;;) {
        scanner.SkipSpace(true);
        if (!scanner.SkipChar('#')) return kept;
        scanner.SkipSpace(false);
        if (!scanner.SkipName("version") && !scanner.SkipName("extension")) return kept;
        scanner.SkipLine();
        kept = scanner.Position();
    }
}

}  // namespace ovo
