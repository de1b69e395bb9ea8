#ifndef OVO_STEREO_GL_OBJECT_TRACKER_H
#define OVO_STEREO_GL_OBJECT_TRACKER_H

#include <cstdint>

#include "core/gl_api.h"

namespace ovo {

constexpr uint32_t TRACKED_TEXTURE_COUNT = 4096;
constexpr uint32_t TRACKED_FRAMEBUFFER_COUNT = 64;

// What the application did with one texture name.
struct TextureRecord {
    uint32_t m_bound;     // 1 once the name was bound
    uint32_t m_attached;  // 1 once attached to a framebuffer
    // The last glTexImage2D arguments before the pixels.
    uint32_t m_target;
    uint32_t m_level;
    uint32_t m_internalformat;
    uint32_t m_width;
    uint32_t m_height;
    uint32_t m_border;
    uint32_t m_format;
    uint32_t m_type;
};

// The colour texture of one framebuffer, at the size the application gave it.
struct FramebufferRecord {
    uint32_t m_has_texture;
    uint32_t m_width;
    uint32_t m_height;
    uint32_t m_name;  // the framebuffer that owns the slot
};

// The application's bound texture and framebuffer and what it did with each name, for
// the layers that render into the application's framebuffers at double width.
class GlObjectTracker {
public:
    GlObjectTracker();
    ~GlObjectTracker();
    GlObjectTracker(const GlObjectTracker&) = delete;
    GlObjectTracker& operator=(const GlObjectTracker&) = delete;

    // The record of `texture`; null for names past the table, which are not tracked.
    TextureRecord* TextureRecordOf(GLuint texture);
    // The record of `framebuffer`, claimed for it when free. Names share a slot modulo the
    // table size; null when another framebuffer holds it, or for framebuffer 0.
    FramebufferRecord* ClaimFramebufferRecord(GLuint framebuffer);
    // The record that `framebuffer` claimed; null when it has none.
    const FramebufferRecord* FindFramebufferRecord(GLuint framebuffer) const;
    // Forgets everything recorded for `texture` (glDeleteTextures).
    void ForgetTexture(GLuint texture);

    // What the tracking layers note of the application's calls.
    void NoteBoundTexture(GLuint texture);
    void NoteBoundFramebuffer(GLuint framebuffer) { m_current_framebuffer = framebuffer; }
    void NoteDeletedTextures(GLsizei count, const GLuint* textures);
    // Marks `texture` as a framebuffer's colour texture; its record, or null for texture 0
    // and untracked names.
    TextureRecord* NoteAttachedTexture(GLuint texture);
    // glTexImage2D's arguments, kept for the current texture once it was bound.
    void NoteTexImage(GLenum target, GLint level, GLint internalformat, GLsizei width,
                      GLsizei height, GLint border, GLenum format, GLenum type);

    GLuint m_current_texture;
    GLuint m_current_framebuffer;

private:
    TextureRecord* m_texture_records;
    FramebufferRecord* m_framebuffer_records;
};

}  // namespace ovo

#endif
