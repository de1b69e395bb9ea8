#include "stereo/double_width_draws.h"

#include <cstdint>
#include <new>

#include "core/raw_gl.h"
#include "core/saturating_math.h"
#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "egl/current_context.h"
#include "stereo/depth_shift.h"
#include "stereo/draw_call.h"
#include "stereo/eye_bracket.h"
#include "stereo/eye_texture.h"
#include "stereo/eye_viewport.h"
#include "stereo/gl_object_tracker.h"
#include "stereo/gl_state_guard.h"

namespace ovo {

namespace {

// The current context's eye textures, made at its first use; null for a context that the
// library cannot see end (past the registry's capacity, or destroyed while still current),
// or when there is no room to keep them.
EyeTexturePair* KeptEyeTextures(StereoManager& manager) {
    if (manager.m_eye_textures == nullptr) {
        manager.m_eye_textures = new (std::nothrow) EyeTextureTable();
        if (manager.m_eye_textures == nullptr) return nullptr;
    }
    const EGLContext context = CurrentContext();
    if (EyeTexturePair* kept = manager.m_eye_textures->Find(context)) return kept;
    if (manager.m_contexts->ShareGroupOf(context) == SHARE_GROUP_NONE) return nullptr;
    EyeTexturePair* made = manager.m_eye_textures->Claim(context);
    if (made != nullptr) made->Create();
    return made;
}

}  // namespace

GLsizei DoubleWidth(GLsizei width) {
    return SaturatingMul(width, 2);
}

void WidenRenderTexture(StereoManager& manager, GLuint texture) {
    GlObjectTracker& objects = *manager.m_objects;
    TextureRecord* record = objects.NoteAttachedTexture(texture);
    if (record == nullptr) return;
    if (FramebufferRecord* framebuffer =
            objects.ClaimFramebufferRecord(objects.m_current_framebuffer)) {
        *framebuffer = FramebufferRecord{1, record->m_width, record->m_height, framebuffer->m_name};
    }
    // Only a size the application gave through glTexImage2D can be doubled; re-specifying
    // any other texture would throw its contents away.
    if (record->m_width == 0 || record->m_height == 0) return;
    raw::glBindTexture(GL_TEXTURE_2D, texture);
    raw::glTexImage2D(record->m_target, static_cast<GLint>(record->m_level),
                      static_cast<GLint>(record->m_internalformat),
                      DoubleWidth(static_cast<GLsizei>(record->m_width)),
                      static_cast<GLsizei>(record->m_height),
                      static_cast<GLint>(record->m_border), record->m_format, record->m_type,
                      nullptr);
    raw::glBindTexture(GL_TEXTURE_2D, objects.m_current_texture);
}

void DrawIntoDoubleWidth(StereoManager& manager, const DrawCall& draw) {
    const GlObjectTracker& objects = *manager.m_objects;
    const FramebufferRecord* framebuffer =
        objects.FindFramebufferRecord(objects.m_current_framebuffer);
    // A framebuffer without a recorded texture has no right half to move to.
    const GLint half = framebuffer != nullptr ? static_cast<GLint>(framebuffer->m_width) : 0;
    const GlRect& viewport = manager.m_viewport;
    for (int eye = 0; eye < 2; ++eye) {
        raw::glViewport(SaturatingAdd(viewport.m_x, eye * half), viewport.m_y, viewport.m_width,
                        viewport.m_height);
        SetDepthShift(manager, eye);
        draw.Issue();
    }
}

void DrawRenderTexturePerEye(StereoManager& manager, const DrawCall& draw,
                             const TextureRecord& texture) {
    EyeTexturePair* kept = KeptEyeTextures(manager);
    EyeTexturePair for_this_draw{};
    if (kept == nullptr) for_this_draw.Create();
    EyeTexturePair& eyes = kept != nullptr ? *kept : for_this_draw;
    GlStateGuard guard;
    guard.Save(GUARD_TEXTURE);
    for (EyeTexture& eye : eyes.m_eyes) eye.Resize(texture.m_width, texture.m_height);
    const bool blend = raw::glIsEnabled(GL_BLEND) != GL_FALSE;
    raw::glDisable(GL_BLEND);
    raw::glViewport(0, 0, static_cast<GLsizei>(texture.m_width),
                    static_cast<GLsizei>(texture.m_height));
    eyes.m_eyes[0].CopyHalfLeft();
    eyes.m_eyes[1].CopyHalfRight();
    if (blend) raw::glEnable(GL_BLEND);
    // While interleaving the eyes keep the window's viewport, which the copies replaced.
    const GlRect& viewport = manager.m_viewport;
    raw::glViewport(viewport.m_x, viewport.m_y, viewport.m_width, viewport.m_height);
    DrawEyeBracket(manager, draw, [&](int eye) {
        raw::glBindTexture(GL_TEXTURE_2D, eyes.m_eyes[eye].m_texture);
        SetDepthShift(manager, eye);
        ApplyEyeViewport(manager, eye, manager.ScaleX(), manager.ScaleY());
    });
    guard.Restore();
    if (kept == nullptr) for_this_draw.Delete();
}

}  // namespace ovo
