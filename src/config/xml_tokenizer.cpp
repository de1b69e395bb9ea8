#include "config/xml_tokenizer.h"

namespace ovo {

namespace {

bool IsSpace(int c) { return c == '\t' || c == ' ' || c == '\n' || c == '\r'; }

bool IsNameStart(int c) {
    return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == ':' || c == '_' ||
           (c >= 0xC0 && c <= 0xD6) || (c >= 0xD8 && c <= 0xF6);
}

bool EndsName(int c) {
    return c == EOF || IsSpace(c) || c == '<' || c == '>' || c == '=' || c == '/';
}

}  // namespace

XmlTokenizer::XmlTokenizer(FILE* stream) : m_stream(stream), m_pushed(EOF), m_has_pushed(false) {
    m_text[0] = '\0';
}

int XmlTokenizer::Get() {
    if (m_has_pushed) {
        m_has_pushed = false;
        return m_pushed;
    }
    return std::fgetc(m_stream);
}

void XmlTokenizer::Unget(int c) {
    m_pushed = c;
    m_has_pushed = true;
}

bool XmlTokenizer::Append(size_t* length, int c) {
    if (*length + 1 >= XML_TOKEN_CAPACITY) return false;
    m_text[(*length)++] = static_cast<char>(c);
    m_text[*length] = '\0';
    return true;
}

XmlToken XmlTokenizer::Next() {
    for (;;) {
        int c = Get();
        switch (c) {
            case EOF:
                return XML_TOKEN_EOF;
            case '<':
                c = Get();
                if (c == '/') return XML_TOKEN_CLOSE_TAG_OPEN;
                if (c == '?') return XML_TOKEN_PI_OPEN;
                if (c == '!') {
                    if (Get() != '-' || Get() != '-') return XML_TOKEN_ERROR;
                    return SkipComment();
                }
                Unget(c);
                return XML_TOKEN_TAG_OPEN;
            case '>':
                return XML_TOKEN_TAG_END;
            case '/':
                return Get() == '>' ? XML_TOKEN_EMPTY_TAG_END : XML_TOKEN_ERROR;
            case '?':
                return Get() == '>' ? XML_TOKEN_PI_CLOSE : XML_TOKEN_ERROR;
            case '=':
                return XML_TOKEN_EQUALS;
            case '"':
                return ReadString();
            default:
                if (IsNameStart(c)) return ReadName(c);
                break;  // white space and stray characters between tokens
        }
    }
}

// The search for "-->" starts at the second dash of "<!--", so "<!--->" is complete.
// End of file also ends a comment.
XmlToken XmlTokenizer::SkipComment() {
    int before_last = 0;
    int last = '-';
    for (int c = Get(); c != EOF; c = Get()) {
        if (before_last == '-' && last == '-' && c == '>') break;
        before_last = last;
        last = c;
    }
    return XML_TOKEN_COMMENT;
}

// The end of file ends a string as it ends the element around it, so a configuration
// cut off inside its last value keeps everything read. A string or name too long for the
// buffer is read to its end before the error is reported, so that reading resumes after
// it rather than inside it.
XmlToken XmlTokenizer::ReadString() {
    size_t length = 0;
    bool fits = true;
    m_text[0] = '\0';
    for (int c = Get(); c != '"' && c != EOF; c = Get()) fits = Append(&length, c) && fits;
    return fits ? XML_TOKEN_STRING : XML_TOKEN_ERROR;
}

XmlToken XmlTokenizer::ReadName(int first) {
    size_t length = 0;
    bool fits = true;
    m_text[0] = '\0';
    int c = first;
    do {
        fits = Append(&length, c) && fits;
        c = Get();
    } while (!EndsName(c));
    Unget(c);
    return fits ? XML_TOKEN_NAME : XML_TOKEN_ERROR;
}

// Text that does not fit is cut at 1023 characters and the rest skipped: a long text
// is no reason to lose the element around it.
size_t XmlTokenizer::ReadText() {
    size_t length = 0;
    bool space_pending = false;
    m_text[0] = '\0';
    int c = Get();
    for (; c != EOF && c != '<'; c = Get()) {
        if (IsSpace(c)) {
            space_pending = length > 0;
            continue;
        }
        if (space_pending) Append(&length, ' ');
        space_pending = false;
        Append(&length, c);
    }
    if (space_pending) Append(&length, ' ');
    Unget(c);
    return length;
}

}  // namespace ovo
