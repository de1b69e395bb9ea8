#include "stereo/glsl_rewriter.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <new>

namespace ovo {

struct SourceCursor {
    const uint8_t* m_data;
    int32_t m_length;
    int32_t m_position;
};

namespace {

// A character given back by the buffer's very last token is never read again: the end
// is the cursor's, whatever waits in the push-back slot.
bool AtEnd(const SourceCursor* cursor) { return cursor->m_position >= cursor->m_length; }

enum GlslCharClass : uint8_t {
    GLSL_CHAR_STARTS_WORD = 1,
    GLSL_CHAR_ENDS_WORD = 2,
    GLSL_CHAR_OPERATOR = 4,
};

struct GlslCharTable {
    uint8_t m_classes[256];
};

constexpr GlslCharTable MakeCharTable() {
    GlslCharTable table = {};
    for (int c = 0; c < 256; ++c) {
        if ((c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '_' ||
            (c >= '0' && c <= '9') || (c >= 0xC0 && c <= 0xD6) || (c >= 0xD8 && c <= 0xF6)) {
            table.m_classes[c] |= GLSL_CHAR_STARTS_WORD;
        }
    }
    for (const char* c = "\t \n\r<>=/-+(*;):,&|%^?!{}[]#"; *c != '\0'; ++c) {
        table.m_classes[static_cast<uint8_t>(*c)] |= GLSL_CHAR_ENDS_WORD;
    }
    for (const char* c = "!%&*+,-<=>?^|"; *c != '\0'; ++c) {
        table.m_classes[static_cast<uint8_t>(*c)] |= GLSL_CHAR_OPERATOR;
    }
    return table;
}

constexpr GlslCharTable GLSL_CHAR_TABLE = MakeCharTable();

bool HasClass(uint8_t c, GlslCharClass char_class) {
    return (GLSL_CHAR_TABLE.m_classes[c] & char_class) != 0;
}

// Characters past the token text's room are dropped while the token is read on to its end:
// only "void", "main" and "return" are ever compared, and no cut-off piece of a longer word
// may pass for one of them.
void AppendChar(char* text, int32_t* read, uint8_t c) {
    if (*read < static_cast<int32_t>(GLSL_TOKEN_CAPACITY) - 1) {
        text[*read] = static_cast<char>(c);
    } else if (*read >= static_cast<int32_t>(GLSL_TOKEN_CAPACITY)) {
        std::puts("[SSM] OUT_OF_BUFFER_MAX_SIZE");
    }
    *read += 1;
}

void EndText(char* text, int32_t read) {
    text[std::min(read, static_cast<int32_t>(GLSL_TOKEN_CAPACITY) - 1)] = '\0';
}

void PrintString(const char* label, const char* text) {
    std::printf("%s %s\n", label, text != nullptr ? text : "(null)");
}

char* CopyString(const char* text) {
    if (text == nullptr) return nullptr;
    const size_t size = std::strlen(text) + 1;
    char* copy = static_cast<char*>(std::malloc(size));
    if (copy != nullptr) std::memcpy(copy, text, size);
    return copy;
}

size_t Length(const char* text) { return text != nullptr ? std::strlen(text) : 0; }

}  // namespace

GlslRewriter::GlslRewriter() { Init(); }

GlslRewriter::~GlslRewriter() { Clear(); }

void GlslRewriter::Init() {
    Clear();
    m_token_text[0] = '\0';
    m_pushed_back = 0;
    m_last_char = 0;
    m_token_start = 0;
}

void GlslRewriter::SetPreString(const char* text) {
    PrintString("PreString", text);
    std::free(m_pre_string);
    m_pre_string = CopyString(text);
}

void GlslRewriter::SetPostString(const char* text) {
    PrintString("PostString", text);
    std::free(m_post_string);
    m_post_string = CopyString(text);
}

void GlslRewriter::Clear() {
    std::free(m_pre_string);
    std::free(m_post_string);
    m_pre_string = nullptr;
    m_post_string = nullptr;
}

uint8_t GlslRewriter::NextChar(SourceCursor* cursor) {
    uint8_t c = 0;
    if (m_pushed_back != 0) {
        c = m_pushed_back;
        m_pushed_back = 0;
    } else if (!AtEnd(cursor)) {
        c = cursor->m_data[cursor->m_position++];
    }
    m_last_char = c;
    return c;
}

GlslToken GlslRewriter::NextToken(SourceCursor* cursor, char* text) {
    text[0] = '\0';
    for (;;) {
        if (AtEnd(cursor)) return GLSL_TOKEN_END;
        // A waiting pushed-back character belongs to this token, which is said to start
        // at the next byte of the buffer.
        m_token_start = cursor->m_position;
        const uint8_t c = NextChar(cursor);
        switch (c) {
            case '/': {
                const uint8_t c2 = NextChar(cursor);
                if (c2 == '/') return SkipLineComment(cursor);
                if (c2 == '*') return SkipBlockComment(cursor);
                GiveBack();
                return GLSL_TOKEN_OPERATOR;
            }
            case '(': return GLSL_TOKEN_OPEN_PAREN;
            case ')': return GLSL_TOKEN_CLOSE_PAREN;
            case '{': return GLSL_TOKEN_OPEN_BRACE;
            case '}': return GLSL_TOKEN_CLOSE_BRACE;
            case ';': return GLSL_TOKEN_SEMICOLON;
            case '#': return GLSL_TOKEN_HASH;
            case '"': return ReadString(cursor, text);
            default:
                if (HasClass(c, GLSL_CHAR_OPERATOR)) return GLSL_TOKEN_OPERATOR;
                if (HasClass(c, GLSL_CHAR_STARTS_WORD)) return ReadWord(cursor, text, c);
                break;  // blanks, '.', ':', '[', ']' and every other byte
        }
    }
}

GlslToken GlslRewriter::ReadString(SourceCursor* cursor, char* text) {
    int32_t read = 0;
    while (!AtEnd(cursor)) {
        const uint8_t c = NextChar(cursor);
        if (c == '"') break;
        AppendChar(text, &read, c);
    }
    EndText(text, read);
    return GLSL_TOKEN_STRING;
}

GlslToken GlslRewriter::ReadWord(SourceCursor* cursor, char* text, uint8_t first) {
    int32_t read = 0;
    AppendChar(text, &read, first);
    while (!AtEnd(cursor)) {
        const uint8_t c = NextChar(cursor);
        if (HasClass(c, GLSL_CHAR_ENDS_WORD)) {
            GiveBack();
            break;
        }
        AppendChar(text, &read, c);
    }
    EndText(text, read);
    return GLSL_TOKEN_WORD;
}

GlslToken GlslRewriter::SkipLineComment(SourceCursor* cursor) {
    while (!AtEnd(cursor)) {
        const uint8_t c = NextChar(cursor);
        if (c == '\n' || c == '\r') break;
    }
    return GLSL_TOKEN_LINE_COMMENT;
}

GlslToken GlslRewriter::SkipBlockComment(SourceCursor* cursor) {
    while (!AtEnd(cursor)) {
        if (NextChar(cursor) != '*') continue;
        if (NextChar(cursor) == '/') break;
        GiveBack();  // "**/" still ends the comment
    }
    return GLSL_TOKEN_BLOCK_COMMENT;
}

int GlslRewriter::Rewrite(char* out, const char* source, int32_t length, int32_t max_points) {
    m_pushed_back = 0;
    m_token_start = 0;
    if (source == nullptr || length < 0 || max_points < 1) return 0;
    SourceCursor cursor = {reinterpret_cast<const uint8_t*>(source), length, 0};
    // Every kept position is a `return` that reads at least five bytes of the source, or
    // the one closing brace of main: no more can be kept than the source holds.
    const int32_t capacity = std::min(max_points, length / 5 + 1);
    int32_t* positions = new (std::nothrow) int32_t[capacity];
    if (positions == nullptr) return 0;
    int32_t count = 0;
    int32_t first = -1;
    int32_t depth = 0;
    bool in_main = false;
    while (!AtEnd(&cursor)) {
        const GlslToken kind = NextToken(&cursor, m_token_text);
        if ((kind == GLSL_TOKEN_HASH || kind == GLSL_TOKEN_WORD) && first == -1) {
            first = m_token_start;
        }
        if (in_main) {
            if (kind == GLSL_TOKEN_OPEN_BRACE) {
                depth += 1;
                continue;
            }
            if (kind == GLSL_TOKEN_CLOSE_BRACE) {
                depth -= 1;
                if (depth != 0) continue;
                if (count == 0) {
                    positions[count++] = m_token_start;
                    std::printf("[BLOCK_END]********** %d ***********\n", m_token_start);
                }
                break;
            }
            if (kind == GLSL_TOKEN_WORD && std::strcmp(m_token_text, "return") == 0) {
                // Past the limit a later `return` replaces the last one kept.
                positions[count < capacity ? count++ : capacity - 1] = m_token_start;
                std::printf("[RETURN]********** %d ***********\n", m_token_start);
            }
        }
        if (kind != GLSL_TOKEN_WORD || std::strcmp(m_token_text, "void") != 0) continue;
        if (NextToken(&cursor, m_token_text) == GLSL_TOKEN_WORD &&
            std::strcmp(m_token_text, "main") == 0) {
            in_main = true;
        }
    }
    if (first >= 0 && count > 0) {
        std::printf("First Character '%c': %d\n", static_cast<uint8_t>(source[first]), first);
        for (int32_t j = 0; j < count; ++j) {
            std::printf("Last Character '%c': %d\n", static_cast<uint8_t>(source[positions[j]]),
                        positions[j]);
        }
        Splice(out, source, length, first, positions, count);
    }
    delete[] positions;
    return first >= 0 && count > 0 ? 1 : 0;
}

// At one position at most one of the two strings goes in; copying stops at a NUL.
void GlslRewriter::Splice(char* out, const char* source, int32_t length, int32_t first,
                          const int32_t* positions, int32_t count) const {
    const size_t pre_length = Length(m_pre_string);
    const size_t post_length = Length(m_post_string);
    size_t o = 0;
    int32_t j = 0;
    for (int32_t i = 0; i < length; ++i) {
        if (i == first && m_pre_string != nullptr) {
            std::memcpy(out + o, m_pre_string, pre_length);
            o += pre_length;
        } else if (j < count && i == positions[j]) {
            if (m_post_string != nullptr) std::memcpy(out + o, m_post_string, post_length);
            o += post_length;
            j += 1;
        }
        if (source[i] == '\0') break;
        out[o++] = source[i];
    }
    out[o] = '\0';
}

}  // namespace ovo
