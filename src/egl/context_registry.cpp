#include "egl/context_registry.h"

namespace ovo {

void ContextRegistry::NoteCreated(EGLDisplay display, EGLContext context,
                                  EGLContext share_context, uint32_t client_api_index) {
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
        entry = Entry{display, context, group, client_api_index};
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

bool ContextRegistry::Lookup(EGLDisplay display, EGLContext context, ContextFacts* facts) const {
    std::lock_guard<std::mutex> hold(m_lock);
    const Entry* entry = Find(context);
    if (entry == nullptr || entry->m_display != display) return false;
    *facts = ContextFacts{display, context, entry->m_share_group, entry->m_client_api_index,
                          GroupSize(entry->m_share_group) == 1};
    return true;
}

size_t ContextRegistry::ContextsOf(EGLDisplay display, ContextFacts* facts) const {
    std::lock_guard<std::mutex> hold(m_lock);
    size_t count = 0;
    for (const Entry& entry : m_entries) {
        if (entry.m_share_group == SHARE_GROUP_NONE || entry.m_display != display) continue;
        facts[count++] = ContextFacts{display, entry.m_context, entry.m_share_group,
                                      entry.m_client_api_index, true};
    }
    // Contexts of one group share a display, so the whole group is in the list.
    for (size_t i = 0; i < count; ++i) {
        for (size_t later = i + 1; later < count; ++later) {
            if (facts[later].m_share_group == facts[i].m_share_group) facts[i].m_ends_group = false;
        }
    }
    return count;
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
    return GroupSize(group) == 0 ? group : SHARE_GROUP_NONE;
}

size_t ContextRegistry::GroupSize(uint32_t group) const {
    size_t size = 0;
    for (const Entry& entry : m_entries) size += entry.m_share_group == group;
    return size;
}

}  // namespace ovo
