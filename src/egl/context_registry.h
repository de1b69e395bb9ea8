#ifndef OVO_EGL_CONTEXT_REGISTRY_H
#define OVO_EGL_CONTEXT_REGISTRY_H

#include <EGL/egl.h>

#include <cstddef>
#include <cstdint>
#include <mutex>

namespace ovo {

// 0 stands for "no share group known": a context the library never saw created.
constexpr uint32_t SHARE_GROUP_NONE = 0;

// What the registry knows of one living context.
struct ContextFacts {
    EGLDisplay m_display;
    EGLContext m_context;
    uint32_t m_share_group;
    uint32_t m_client_api_index;  // the DriverHooks table of its client version: 0 ES 1.x, 1 ES 2.0
    bool m_ends_group;            // no other context is left in its share group
};
// More contexts than a game keeps alive at once; contexts beyond it are not recorded and
// behave as contexts of no known share group.
constexpr size_t CONTEXT_REGISTRY_CAPACITY = 64;

// The contexts the application created and which of them share their objects, so that
// what the library keeps per shader or per context follows the driver's own sharing.
// Guarded by a lock: a loading thread may compile shaders while the rendering thread
// makes contexts. Nothing here runs on the draw path.
class ContextRegistry {
public:
    ContextRegistry() = default;
    ContextRegistry(const ContextRegistry&) = delete;
    ContextRegistry& operator=(const ContextRegistry&) = delete;

    // A context the vendor made: it joins the share group of `share_context` when that one
    // is known, or starts a group of its own.
    void NoteCreated(EGLDisplay display, EGLContext context, EGLContext share_context,
                     uint32_t client_api_index);
    // A context the vendor destroyed. The share group it leaves behind with no context, or
    // SHARE_GROUP_NONE while others still hold the group.
    uint32_t NoteDestroyed(EGLDisplay display, EGLContext context);
    // eglTerminate: every context of `display` goes. Calls `dead_group(group)` for each share
    // group left without a context.
    template <typename DeadGroup>
    void NoteTerminated(EGLDisplay display, DeadGroup dead_group);

    uint32_t ShareGroupOf(EGLContext context) const;
    // The facts of `context` of `display`, m_ends_group telling whether it is the last
    // context of its group; false when the registry does not know it there.
    bool Lookup(EGLDisplay display, EGLContext context, ContextFacts* facts) const;
    // The contexts of `display` (at most CONTEXT_REGISTRY_CAPACITY) and their count. All of
    // them end together, so m_ends_group is set on one context of each group: the last listed.
    size_t ContextsOf(EGLDisplay display, ContextFacts* facts) const;

private:
    struct Entry {
        EGLDisplay m_display;
        EGLContext m_context;
        uint32_t m_share_group;  // SHARE_GROUP_NONE: the slot is free
        uint32_t m_client_api_index;
    };

    // The slot of `context`, or null; under the lock.
    Entry* Find(EGLContext context);
    const Entry* Find(EGLContext context) const;
    // Frees `entry`; the group it left empty, or SHARE_GROUP_NONE. Under the lock.
    uint32_t Remove(Entry& entry);
    // How many contexts hold `group`; under the lock.
    size_t GroupSize(uint32_t group) const;

    mutable std::mutex m_lock;
    Entry m_entries[CONTEXT_REGISTRY_CAPACITY] = {};
    uint32_t m_next_group = 1;
};

template <typename DeadGroup>
void ContextRegistry::NoteTerminated(EGLDisplay display, DeadGroup dead_group) {
    uint32_t dead[CONTEXT_REGISTRY_CAPACITY];
    size_t dead_count = 0;
    {
        std::lock_guard<std::mutex> hold(m_lock);
        for (Entry& entry : m_entries) {
            if (entry.m_share_group == SHARE_GROUP_NONE || entry.m_display != display) continue;
            const uint32_t group = Remove(entry);
            if (group != SHARE_GROUP_NONE) dead[dead_count++] = group;
        }
    }
    // Outside the lock: the callback may ask the registry again.
    for (size_t i = 0; i < dead_count; ++i) dead_group(dead[i]);
}

}  // namespace ovo

#endif
