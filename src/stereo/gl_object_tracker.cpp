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

FramebufferRecord* GlObjectTracker::ClaimFramebufferRecord(GLuint framebuffer) {
    if (m_framebuffer_records == nullptr || framebuffer == 0) return nullptr;
    FramebufferRecord& record = m_framebuffer_records[framebuffer % TRACKED_FRAMEBUFFER_COUNT];
    if (record.m_name == 0) record.m_name = framebuffer;
    // A second framebuffer on the same slot gets no record rather than the other's size.
    return record.m_name == framebuffer ? &record : nullptr;
}

const FramebufferRecord* GlObjectTracker::FindFramebufferRecord(GLuint framebuffer) const {
    if (m_framebuffer_records == nullptr || framebuffer == 0) return nullptr;
    const FramebufferRecord& record =
        m_framebuffer_records[framebuffer % TRACKED_FRAMEBUFFER_COUNT];
    return record.m_name == framebuffer ? &record : nullptr;
}

void GlObjectTracker::ForgetTexture(GLuint texture) {
    if (TextureRecord* record = TextureRecordOf(texture)) std::memset(record, 0, sizeof(*record));
}

void GlObjectTracker::NoteBoundTexture(GLuint texture) {
    m_current_texture = texture;
    if (TextureRecord* record = TextureRecordOf(texture)) record->m_bound = 1;
}

void GlObjectTracker::NoteDeletedTextures(GLsizei count, const GLuint* textures) {
    if (textures == nullptr) return;
    for (GLsizei i = 0; i < count; ++i) ForgetTexture(textures[i]);
}

TextureRecord* GlObjectTracker::NoteAttachedTexture(GLuint texture) {
    // Detaching (texture 0) must not turn texture 0 into a render texture.
    TextureRecord* record = texture != 0 ? TextureRecordOf(texture) : nullptr;
    if (record != nullptr) record->m_attached = 1;
    return record;
}

void GlObjectTracker::NoteTexImage(GLenum target, GLint level, GLint internalformat,
                                   GLsizei width, GLsizei height, GLint border, GLenum format,
                                   GLenum type) {
    TextureRecord* record = TextureRecordOf(m_current_texture);
    if (record == nullptr || record->m_bound != 1) return;
    *record = TextureRecord{record->m_bound,
                            record->m_attached,
                            target,
                            static_cast<uint32_t>(level),
                            static_cast<uint32_t>(internalformat),
                            static_cast<uint32_t>(width),
                            static_cast<uint32_t>(height),
                            static_cast<uint32_t>(border),
                            format,
                            type};
}

}  // namespace ovo
