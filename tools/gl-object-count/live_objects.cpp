#include "live_objects.h"

namespace ovo_gl_count {

void LiveObjects::Add(ObjectKind kind, int32_t count, const uint32_t* names) {
    if (names == nullptr) return;
    std::lock_guard<std::mutex> lock(m_mutex);
    for (int32_t i = 0; i < count; ++i) {
        // 0 is what a failed glCreate* answers; it names no object.
        if (names[i] == 0) continue;
        m_names[static_cast<size_t>(kind)].insert(names[i]);
        ++m_made;
    }
}

void LiveObjects::Remove(ObjectKind kind, int32_t count, const uint32_t* names) {
    if (names == nullptr) return;
    std::lock_guard<std::mutex> lock(m_mutex);
    for (int32_t i = 0; i < count; ++i) m_names[static_cast<size_t>(kind)].erase(names[i]);
}

size_t LiveObjects::Count(ObjectKind kind) const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_names[static_cast<size_t>(kind)].size();
}

size_t LiveObjects::Made() const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_made;
}

}  // namespace ovo_gl_count
