#ifndef OVO_TOOLS_GL_OBJECT_COUNT_LIVE_OBJECTS_H
#define OVO_TOOLS_GL_OBJECT_COUNT_LIVE_OBJECTS_H

#include <cstddef>
#include <cstdint>
#include <mutex>
#include <unordered_set>

namespace ovo_gl_count {

enum class ObjectKind { PROGRAM, SHADER, TEXTURE, FRAMEBUFFER, RENDERBUFFER, BUFFER };

constexpr size_t OBJECT_KIND_COUNT = 6;
// By ObjectKind, as the report names them.
constexpr const char* OBJECT_KIND_NAMES[OBJECT_KIND_COUNT] = {
    "programs", "shaders", "textures", "framebuffers", "renderbuffers", "buffers"};

// The GL names of each kind that have been made and not yet deleted, whoever made them.
// Names count by the calls alone: a name that only a bind brings into being is not seen,
// and a program deleted while in use counts as gone although GL keeps it until unbound.
class LiveObjects {
public:
    void Add(ObjectKind kind, int32_t count, const uint32_t* names);
    void Remove(ObjectKind kind, int32_t count, const uint32_t* names);
    size_t Count(ObjectKind kind) const;
    // Names of any kind added since the start: none means the calls never came here.
    size_t Made() const;

private:
    mutable std::mutex m_mutex;
    size_t m_made = 0;
    std::unordered_set<uint32_t> m_names[OBJECT_KIND_COUNT];
};

}  // namespace ovo_gl_count

#endif
