#include "egl/context_registry.h"

namespace ovo {

void ContextRegistry::NoteCreated(EGLDisplay display, EGLContext context,
                                  EGLContext share_context) {
    if (context == EGL_NO_CONTEXT) return;
    std::lock_guard<std::mutex> hold(m_lock);
    // The driver may hand out the handle of a context destroyed behind our back again.
    if (Entry* stale = Find(context)) Remove(*stale);
    uint32_t group = SHARE_GROUP_NONE;
    if (share_context != EGL_NO_CONTEXT) {
        if (const Entry* shared = Find(share_context)) group = shared->m_share_group;
    }
    if (group == SHARE_GROUP_NONE) group = m_next_group++;
    for (Entry& entry : m_entries) {
        if (entry.m_share_group != SHARE_GROUP_NONE) continue;
        entry = Entry{display, context, group};
        return;
    }
}

uint32_t ContextRegistry::NoteDestroyed(EGLDisplay display, EGLContext context) {
    std::lock_guard<std::mutex> hold(m_lock);
    Entry* entry = Find(context);
    if (entry == nullptr || entry->m_display != display) return SHARE_GROUP_NONE;
    return Remove(*entry);
}

uint32_t ContextRegistry::ShareGroupOf(EGLContext context) const {
    std::lock_guard<std::mutex> hold(m_lock);
    const Entry* entry = Find(context);
    return entry != nullptr ? entry->m_share_group : SHARE_GROUP_NONE;
}

ContextRegistry::Entry* ContextRegistry::Find(EGLContext context) {
    const ContextRegistry& self = *this;
    return const_cast<Entry*>(self.Find(context));
}

const ContextRegistry::Entry* ContextRegistry::Find(EGLContext context) const {
    if (context == EGL_NO_CONTEXT) return nullptr;
    for (const Entry& entry : m_entries) {
        if (entry.m_share_group != SHARE_GROUP_NONE && entry.m_context == context) return &entry;
    }
    return nullptr;
}

uint32_t ContextRegistry::Remove(Entry& entry) {
    const uint32_t group = entry.m_share_group;
    entry = Entry{};
    for (const Entry& other : m_entries) {
        if (other.m_share_group == group) return SHARE_GROUP_NONE;
    }
    return group;
}

}  // namespace ovo
