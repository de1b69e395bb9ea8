#include "stereo/shader_source_store.h"

#include <algorithm>
#include <cstring>
#include <iterator>

namespace ovo {

void ShaderSourceStore::Keep(uint32_t group, GLuint shader, const char* source,
                             GLint source_length) {
    std::lock_guard<std::mutex> hold(m_lock);
    m_sources[Key(group, shader)] = KeptSource{source, source_length};
}

void ShaderSourceStore::Forget(uint32_t group, GLuint shader) {
    std::lock_guard<std::mutex> hold(m_lock);
    m_sources.erase(Key(group, shader));
}

void ShaderSourceStore::ForgetGroup(uint32_t group) {
    std::lock_guard<std::mutex> hold(m_lock);
    for (auto kept = m_sources.begin(); kept != m_sources.end();) {
        kept = (kept->first >> 32) == group ? m_sources.erase(kept) : std::next(kept);
    }
}

bool ShaderSourceStore::SourceLength(uint32_t group, GLuint shader, GLint* length) const {
    std::lock_guard<std::mutex> hold(m_lock);
    const auto kept = m_sources.find(Key(group, shader));
    if (kept == m_sources.end()) return false;
    *length = kept->second.m_source_length;
    return true;
}

// As drivers answer: at most buffer_size - 1 characters and a terminator, the count
// without the terminator; nothing at all into an empty buffer.
bool ShaderSourceStore::CopySource(uint32_t group, GLuint shader, GLsizei buffer_size,
                                   GLsizei* length, GLchar* source) const {
    std::lock_guard<std::mutex> hold(m_lock);
    const auto kept = m_sources.find(Key(group, shader));
    if (kept == m_sources.end()) return false;
    const std::string& text = kept->second.m_text;
    size_t copied = 0;
    if (buffer_size > 0 && source != nullptr) {
        copied = std::min(text.size(), static_cast<size_t>(buffer_size) - 1);
        std::memcpy(source, text.data(), copied);
        source[copied] = '\0';
    }
    if (length != nullptr) *length = static_cast<GLsizei>(copied);
    return true;
}

size_t ShaderSourceStore::Count() const {
    std::lock_guard<std::mutex> hold(m_lock);
    return m_sources.size();
}

}  // namespace ovo
