#include "stereo/gl_object_tracker.h"

#include <cstdlib>
#include <cstring>

namespace ovo {

GlObjectTracker::GlObjectTracker()
    : m_current_texture(0),
      m_current_framebuffer(0),
      m_texture_records(
          static_cast<TextureRecord*>(std::calloc(TRACKED_TEXTURE_COUNT, sizeof(TextureRecord)))),
      m_framebuffer_records(static_cast<FramebufferRecord*>(
          std::calloc(TRACKED_FRAMEBUFFER_COUNT, sizeof(FramebufferRecord)))) {}

GlObjectTracker::~GlObjectTracker() {
    std::free(m_texture_records);
    std::free(m_framebuffer_records);
}

TextureRecord* GlObjectTracker::TextureRecordOf(GLuint texture) {
    if (m_texture_records == nullptr || texture >= TRACKED_TEXTURE_COUNT) return nullptr;
    return &m_texture_records[texture];
}

FramebufferRecord* GlObjectTracker::FramebufferRecordOf(GLuint framebuffer) {
    if (m_framebuffer_records == nullptr || framebuffer == 0) return nullptr;
    FramebufferRecord& record = m_framebuffer_records[framebuffer % TRACKED_FRAMEBUFFER_COUNT];
    if (record.m_name == 0) record.m_name = framebuffer;
    // A second framebuffer on the same slot gets no record rather than the other's size.
    return record.m_name == framebuffer ? &record : nullptr;
}

void GlObjectTracker::ForgetTexture(GLuint texture) {
    if (TextureRecord* record = TextureRecordOf(texture)) std::memset(record, 0, sizeof(*record));
}

}  // namespace ovo
