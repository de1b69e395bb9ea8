#ifndef OVO_CONFIG_XML_TOKENIZER_H
#define OVO_CONFIG_XML_TOKENIZER_H

#include <cstddef>
#include <cstdio>

namespace ovo {

enum XmlToken {
    XML_TOKEN_EOF,
    XML_TOKEN_TAG_OPEN,
    XML_TOKEN_CLOSE_TAG_OPEN,
    XML_TOKEN_PI_OPEN,
    XML_TOKEN_COMMENT,
    XML_TOKEN_TAG_END,
    XML_TOKEN_EMPTY_TAG_END,
    XML_TOKEN_PI_CLOSE,
    XML_TOKEN_EQUALS,
    XML_TOKEN_STRING,
    XML_TOKEN_NAME,
    XML_TOKEN_ERROR,
};

// Room for the text of one token: 1023 characters and the terminator.
constexpr size_t XML_TOKEN_CAPACITY = 1024;

// Splits a stream into tokens, one character at a time with one character of push-back.
class XmlTokenizer {
public:
    explicit XmlTokenizer(FILE* stream);
    XmlTokenizer(const XmlTokenizer&) = delete;
    XmlTokenizer& operator=(const XmlTokenizer&) = delete;

    XmlToken Next();
    // Text content up to the next "<" (left in the stream) with its white space folded.
    // Returns its length; the text is in Text().
    size_t ReadText();
    // The text of the last name, string or text content.
    const char* Text() const { return m_text; }

private:
    int Get();
    void Unget(int c);
    XmlToken SkipComment();
    XmlToken ReadString();
    XmlToken ReadName(int first);
    // Appends while there is room; false once the text would not fit.
    bool Append(size_t* length, int c);

    FILE* m_stream;
    int m_pushed;
    bool m_has_pushed;
    char m_text[XML_TOKEN_CAPACITY];
};

}  // namespace ovo

#endif
