#include "present/live_tuning_text.h"

#include <cstdlib>

namespace ovo {

namespace {

constexpr int TEXT_END = -1;

int Lower(int c) { return c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c; }
bool IsSpace(int c) { return c == ' ' || (c >= '\t' && c <= '\r'); }
bool IsDigit(int c) { return c >= '0' && c <= '9'; }
bool IsHexDigit(int c) { return IsDigit(c) || (Lower(c) >= 'a' && Lower(c) <= 'f'); }

// The text one character at a time with one of push-back, as a stream is read. Notes when
// it had to look past the end of a text that is not the whole file.
class TextCursor {
public:
    TextCursor(const char* text, size_t size, bool whole)
        : m_text(text), m_size(size), m_position(0), m_whole(whole), m_cut(false) {}

    int Get() {
        if (m_position < m_size) return static_cast<unsigned char>(m_text[m_position++]);
        m_cut = m_cut || !m_whole;
        return TEXT_END;
    }
    void Unget(int c) {
        if (c != TEXT_END) --m_position;
    }
    size_t Position() const { return m_position; }
    bool Cut() const { return m_cut; }

private:
    const char* m_text;
    size_t m_size;
    size_t m_position;
    bool m_whole;
    bool m_cut;
};

// The rest of `word` (lower case), in either case.
bool TakeWord(TextCursor& in, const char* word) {
    for (; *word != '\0'; ++word) {
        if (Lower(in.Get()) != *word) return false;
    }
    return true;
}

// Digits, point and exponent of a decimal or hexadecimal number whose first character after
// any sign is `c`. A character that cannot continue the number ends it and is put back;
// nothing taken is ever given back, so "1e+" stays taken when no digit follows. False when
// nothing but the sign, or nothing but "0x", was taken.
bool TakeDigits(TextCursor& in, int c, size_t sign_length) {
    const size_t start = in.Position() - 1 - sign_length;
    bool hex = false, digit = false, point = false, exponent = false;
    int exponent_mark = 'e';
    int last = 0;  // the last character taken, an exponent mark in lower case
    if (c == '0') {
        last = c;
        c = in.Get();
        if (Lower(c) == 'x') {
            hex = true;
            exponent_mark = 'p';
            last = c;
            c = in.Get();
        } else {
            digit = true;
        }
    }
    for (;; c = in.Get()) {
        if (IsDigit(c) || (hex && !exponent && IsHexDigit(c))) {
            digit = true;
        } else if (exponent && last == exponent_mark && (c == '-' || c == '+')) {
        } else if (digit && !exponent && Lower(c) == exponent_mark) {
            exponent = point = true;
            c = exponent_mark;
        } else if (!point && c == '.') {
            point = true;
        } else {
            in.Unget(c);
            break;
        }
        last = c;
    }
    const size_t taken = in.Position() - start;
    return taken != sign_length && !(hex && taken == sign_length + 2);
}

// One "%f" conversion into `value`.
bool ScanNumber(TextCursor& in, char* text, float* value) {
    int c;
    do {
        c = in.Get();
    } while (IsSpace(c));
    if (c == TEXT_END) return false;
    const size_t start = in.Position() - 1;
    const size_t sign_length = c == '-' || c == '+' ? 1 : 0;
    if (sign_length == 1 && (c = in.Get()) == TEXT_END) return false;
    if (Lower(c) == 'n') {
        if (!TakeWord(in, "an")) return false;
    } else if (Lower(c) == 'i') {
        if (!TakeWord(in, "nf")) return false;
        c = in.Get();
        if (Lower(c) != 'i') {
            in.Unget(c);
        } else if (!TakeWord(in, "nity")) {
            return false;
        }
    } else if (!TakeDigits(in, c, sign_length)) {
        return false;
    }

    // strtof sees exactly the characters taken: the byte after them is borrowed for the
    // terminator.
    const size_t end = in.Position();
    const char after = text[end];
    text[end] = '\0';
    char* stop = nullptr;
    const float converted = std::strtof(text + start, &stop);
    text[end] = after;
    if (stop == text + start) return false;
    *value = converted;
    return true;
}

}  // namespace

int ScanLiveTuningText(char* text, size_t size, bool whole, float (&values)[LIVE_TUNING_VALUES]) {
    TextCursor in(text, size, whole);
    int converted = 0;
    float value;
    while (converted < LIVE_TUNING_VALUES && ScanNumber(in, text, &value) && !in.Cut()) {
        values[converted++] = value;
    }
    return converted;
}

}  // namespace ovo
