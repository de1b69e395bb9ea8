#ifndef OVO_EGL_CONTEXT_OBJECTS_H
#define OVO_EGL_CONTEXT_OBJECTS_H

// The GL objects that the library makes for itself in the application's contexts: each
// belongs to the context or the share group it was made for, and is deleted when that
// context or group ends (eglDestroyContext, eglTerminate), in a context that sees it.

#include "core/gl_api.h"
#include "egl/context_registry.h"
#include "egl/current_context.h"

namespace ovo {

// Records of such objects, one per owner: a context, or a share group's number. `Record`
// is a plain record whose Delete() deletes its objects in the current context. Fixed size,
// no lock: the draws that use a record and the EGL calls that end its owner run on the
// application's one rendering thread.
template <typename Owner, typename Record>
class ContextObjectTable {
public:
    Record* Find(Owner owner) {
        Slot* slot = OwnedSlot(owner);
        return slot != nullptr ? &slot->m_record : nullptr;
    }
    bool Holds(Owner owner) const { return OwnedSlot(owner) != nullptr; }
    // A zeroed record for `owner`, which has none; null for no owner or a full table.
    Record* Claim(Owner owner) {
        Slot* slot = owner != Owner() ? SlotOf(Owner()) : nullptr;
        if (slot == nullptr) return nullptr;
        *slot = Slot{owner, Record()};
        return &slot->m_record;
    }
    // Takes `owner`'s record out, deleting its objects first when `deletable` (a context
    // that sees them is current); otherwise the names are only forgotten.
    void Release(Owner owner, bool deletable) {
        Slot* slot = OwnedSlot(owner);
        if (slot == nullptr) return;
        if (deletable) slot->m_record.Delete();
        *slot = Slot();
    }

private:
    struct Slot {
        Owner m_owner;  // Owner(): the slot is free
        Record m_record;
    };

    // The first slot held by `owner` (with Owner(): the first free one), or null.
    Slot* SlotOf(Owner owner) const {
        for (const Slot& slot : m_slots) {
            if (slot.m_owner == owner) return const_cast<Slot*>(&slot);
        }
        return nullptr;
    }
    Slot* OwnedSlot(Owner owner) const { return owner != Owner() ? SlotOf(owner) : nullptr; }

    Slot m_slots[CONTEXT_REGISTRY_CAPACITY] = {};
};

// Makes the application's contexts current on the calling thread one after another, for
// deleting the library's objects in them, and on leaving puts back exactly what the thread
// had: display, surfaces, context and GL table. A context already current here costs no
// EGL call; otherwise the vendor's eglMakeCurrent binds it without a surface. The
// application's EGL call that follows stays the last, so eglGetError reports its error.
class ContextVisit {
public:
    ContextVisit();
    ~ContextVisit();
    ContextVisit(const ContextVisit&) = delete;
    ContextVisit& operator=(const ContextVisit&) = delete;

    // True when `context` is now current here with the GL table of its client version, so
    // that GL calls delete its objects. False when it cannot be: it is current on another
    // thread, the vendor binds no context without a surface, or the thread's own context
    // or surface would end if the thread left it. Its objects are then only forgotten: the
    // driver frees them with the context (or with its share group).
    bool Enter(const ContextFacts& context);

private:
    EglBinding m_binding;          // the thread's own
    const void* m_hooks;           // the thread's own GL table
    EGLDisplay m_display;          // of the context current here now
    EGLContext m_context;          // current here now
};

}  // namespace ovo

#endif
