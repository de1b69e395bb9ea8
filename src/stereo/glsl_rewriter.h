#ifndef OVO_STEREO_GLSL_REWRITER_H
#define OVO_STEREO_GLSL_REWRITER_H

#include <cstddef>
#include <cstdint>

namespace ovo {

// What the tokeniser returns; only words, `#` and braces steer the rewrite.
enum GlslToken : int32_t {
    GLSL_TOKEN_END = 0,
    GLSL_TOKEN_STRING = 7,
    GLSL_TOKEN_WORD = 8,
    GLSL_TOKEN_OPEN_PAREN = 10,
    GLSL_TOKEN_CLOSE_PAREN = 11,
    GLSL_TOKEN_OPEN_BRACE = 12,
    GLSL_TOKEN_CLOSE_BRACE = 13,
    GLSL_TOKEN_OPERATOR = 14,
    GLSL_TOKEN_HASH = 15,
    GLSL_TOKEN_SEMICOLON = 16,
    GLSL_TOKEN_LINE_COMMENT = 17,
    GLSL_TOKEN_BLOCK_COMMENT = 18,
};

// Room for the text of one word or string: 1023 characters and the terminator.
constexpr size_t GLSL_TOKEN_CAPACITY = 1024;

struct SourceCursor;

// Inserts a pre-string in front of a vertex shader's first directive or word and a
// post-string in front of the end of its main (or main's last `return`), without parsing
// GLSL. Traces what it finds on standard output.
class GlslRewriter {
public:
    GlslRewriter();
    ~GlslRewriter();
    GlslRewriter(const GlslRewriter&) = delete;
    GlslRewriter& operator=(const GlslRewriter&) = delete;

    void Init();
    void SetPreString(const char* text);
    void SetPostString(const char* text);
    void Clear();
    // 1 when text was inserted (out then holds the spliced source, NUL-terminated), 0 when
    // no insertion was made (out untouched). out must have room for
    // length + strlen(pre) + max_points * strlen(post) + 1 bytes.
    int Rewrite(char* out, const char* source, int32_t length, int32_t max_points);

private:
    GlslToken NextToken(SourceCursor* cursor, char* text);
    uint8_t NextChar(SourceCursor* cursor);
    void GiveBack() { m_pushed_back = m_last_char; }
    // Reads into text up to a closing quote or the end.
    GlslToken ReadString(SourceCursor* cursor, char* text);
    GlslToken ReadWord(SourceCursor* cursor, char* text, uint8_t first);
    GlslToken SkipLineComment(SourceCursor* cursor);
    GlslToken SkipBlockComment(SourceCursor* cursor);
    void Splice(char* out, const char* source, int32_t length, int32_t first,
                const int32_t* positions, int32_t count) const;

    char* m_pre_string = nullptr;
    char* m_post_string = nullptr;
    char m_token_text[GLSL_TOKEN_CAPACITY];
    uint8_t m_pushed_back;  // 0: none
    uint8_t m_last_char;
    int32_t m_token_start;
};

}  // namespace ovo

#endif
