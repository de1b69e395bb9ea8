#include "key_script.h"

#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

#include <cctype>
#include <cerrno>
#include <cstring>

namespace ovo_tune {

namespace {

constexpr size_t KEY_SCRIPT_READ_BYTES = 4096;

bool IsSpace(char byte) { return std::isspace(static_cast<unsigned char>(byte)) != 0; }

// Drops white space and comments at the start of `text`; false when a comment's line end
// has not arrived yet.
bool SkipSeparators(std::string& text, bool ended) {
    size_t index = 0;
    while (index < text.size()) {
        if (IsSpace(text[index])) {
            ++index;
        } else if (text[index] == '#') {
            const size_t line_end = text.find('\n', index);
            if (line_end == std::string::npos) {
                text.erase(0, ended ? text.size() : index);
                return ended;
            }
            index = line_end + 1;
        } else {
            break;
        }
    }
    text.erase(0, index);
    return true;
}

}  // namespace

KeyScript::~KeyScript() {
    if (m_owns_descriptor) close(m_descriptor);
}

void KeyScript::SetText(const std::string& text) { m_pending = text; }

bool KeyScript::OpenFile(const std::string& path, std::string* problem) {
    if (path == "-") {
        m_descriptor = STDIN_FILENO;
        return true;
    }
    m_descriptor = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (m_descriptor < 0) {
        *problem = "cannot open the key script " + path + ": " + std::strerror(errno);
        return false;
    }
    m_owns_descriptor = true;
    return true;
}

void KeyScript::ReadAvailable() {
    while (m_descriptor >= 0) {
        pollfd ready = {m_descriptor, POLLIN, 0};
        if (poll(&ready, 1, 0) != 1) return;
        char buffer[KEY_SCRIPT_READ_BYTES];
        const ssize_t count = read(m_descriptor, buffer, sizeof(buffer));
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) {
            if (m_owns_descriptor) close(m_descriptor);
            m_descriptor = -1;
            m_owns_descriptor = false;
            return;
        }
        m_pending.append(buffer, static_cast<size_t>(count));
    }
}

bool KeyScript::NextWord(std::string* word) {
    ReadAvailable();
    const bool ended = m_descriptor < 0;
    if (!SkipSeparators(m_pending, ended) || m_pending.empty()) return false;
    size_t end = 0;
    while (end < m_pending.size() && !IsSpace(m_pending[end]) && m_pending[end] != '#') ++end;
    // A word at the end of what has arrived may go on in what comes next.
    if (end == m_pending.size() && !ended) return false;
    *word = m_pending.substr(0, end);
    m_pending.erase(0, end);
    return true;
}

bool KeyScript::Finished() {
    ReadAvailable();
    SkipSeparators(m_pending, m_descriptor < 0);
    return m_descriptor < 0 && m_pending.empty();
}

}  // namespace ovo_tune
