#include "stereo/es2_stereo_layer.h"

#include <cstring>

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "egl/current_context.h"
#include "stereo/depth_shift.h"
#include "stereo/double_width_draws.h"
#include "stereo/draw_call.h"
#include "stereo/eye_bracket.h"
#include "stereo/eye_viewport.h"
#include "stereo/frame_parameters.h"
#include "stereo/gl_object_tracker.h"
#include "stereo/shader_source_store.h"

namespace ovo {

namespace {

// The one game whose render textures are drawn at double width.
constexpr char TRACKED_PROCESS_NAME[] = "com.vectorunit.green";

// The stock live wallpaper's own separation, in place of the profile's.
constexpr float WALLPAPER_DEPTH_THRESHOLD = 0.1f;
constexpr float WALLPAPER_DEPTH_GAIN = 0.05f;

void SetUpEye(StereoManager& manager, int eye) {
    SetDepthShift(manager, eye);
    ApplyEyeViewport(manager, eye, manager.ScaleX(), manager.ScaleY());
}

// Draws into the window in the direct submode: the per-eye uniform, and for the stock
// live wallpaper (asked anew per eye) its own separation on top.
void DrawDirect(StereoManager& manager, const DrawCall& draw) {
    StereoProfile& profile = *manager.m_profile;
    if (profile.m_ramp == STEREO_RAMP_ON && manager.m_interleave) StepRampEs2(manager);
    GLint framebuffer = 0;
    raw::glGetIntegerv(GL_FRAMEBUFFER_BINDING, &framebuffer);
    if (framebuffer != 0) {
        draw.Issue();
        return;
    }
    BeginEyeMask(manager);
    LookUpDepthShift(manager);
    DrawEyePair(manager, draw, [&](int eye) {
        SetUpEye(manager, eye);
        if (draw.m_elements || profile.DetectLiveWallpaper() != LIVE_WALLPAPER_ANDROID) return;
        const float sign = EyeSign(eye);
        SetDepthShiftValue(manager, sign * WALLPAPER_DEPTH_THRESHOLD, sign * WALLPAPER_DEPTH_GAIN);
        ApplyEyeViewport(manager, eye, manager.ScaleX(), manager.ScaleY());
    });
}

void DrawTracked(StereoManager& manager, const DrawCall& draw) {
    LookUpDepthShift(manager);
    GlObjectTracker& objects = *manager.m_objects;
    if (objects.m_current_framebuffer != 0) {
        DrawIntoDoubleWidth(manager, draw);
        return;
    }
    const TextureRecord* texture = objects.TextureRecordOf(objects.m_current_texture);
    if (texture != nullptr && texture->m_attached != 0) {
        DrawRenderTexturePerEye(manager, draw, *texture);
        return;
    }
    DrawEyeBracket(manager, draw, [&](int eye) { SetUpEye(manager, eye); });
}

// The share group of the calling thread's context: shader names are per group.
uint32_t CurrentShareGroup(const StereoManager& manager) {
    return manager.m_contexts->ShareGroupOf(CurrentContext());
}

}  // namespace

uint32_t Es2StereoLayer::SubmodeFor(const char* process_name) {
    return std::strcmp(process_name, TRACKED_PROCESS_NAME) == 0 ? LAYER_SUBMODE_TRACKED
                                                                 : LAYER_SUBMODE_DIRECT;
}

void Es2StereoLayer::Draw(StereoManager& manager, const DrawCall& draw) {
    if (Tracked()) {
        DrawTracked(manager, draw);
    } else {
        DrawDirect(manager, draw);
    }
}

void Es2StereoLayer::glShaderSource(StereoManager& manager, GLuint shader, GLsizei count,
                                    const GLchar* const* string, const GLint* length) {
    raw::glShaderSource(shader, count, string, length);
    // A call the vendor refused leaves the shader's last source, which may be a rewritten
    // one already.
    if (count < 0 || (count > 0 && string == nullptr)) return;
    for (GLsizei i = 0; i < count; ++i) {
        if (string[i] == nullptr) return;
    }
    InjectDepthShift(shader, *manager.m_shader_sources, CurrentShareGroup(manager));
}

void Es2StereoLayer::glGetShaderiv(StereoManager& manager, GLuint shader, GLenum pname,
                                   GLint* params) {
    if (pname == GL_SHADER_SOURCE_LENGTH && params != nullptr &&
        manager.m_shader_sources->SourceLength(CurrentShareGroup(manager), shader, params)) {
        return;
    }
    raw::glGetShaderiv(shader, pname, params);
}

void Es2StereoLayer::glGetShaderSource(StereoManager& manager, GLuint shader, GLsizei bufSize,
                                       GLsizei* length, GLchar* source) {
    // A negative size is the vendor's to refuse.
    if (bufSize >= 0 && manager.m_shader_sources->CopySource(CurrentShareGroup(manager), shader,
                                                             bufSize, length, source)) {
        return;
    }
    raw::glGetShaderSource(shader, bufSize, length, source);
}

void Es2StereoLayer::glDeleteShader(StereoManager& manager, GLuint shader) {
    raw::glDeleteShader(shader);
    if (shader != 0) manager.m_shader_sources->Forget(CurrentShareGroup(manager), shader);
}

void Es2StereoLayer::glClear(StereoManager& manager, GLbitfield mask) {
    // Render targets are twice as wide as the game believes.
    if (Tracked()) {
        raw::glScissor(0, 0, DoubleWidth(manager.m_profile->m_width), manager.m_profile->m_height);
    }
    raw::glClear(mask);
}

void Es2StereoLayer::glBindTexture(StereoManager& manager, GLenum target, GLuint texture) {
    raw::glBindTexture(target, texture);
    if (Tracked()) manager.m_objects->NoteBoundTexture(texture);
}

void Es2StereoLayer::glBindFramebuffer(StereoManager& manager, GLenum target,
                                       GLuint framebuffer) {
    raw::glBindFramebuffer(target, framebuffer);
    if (Tracked()) manager.m_objects->NoteBoundFramebuffer(framebuffer);
}

void Es2StereoLayer::glDeleteTextures(StereoManager& manager, GLsizei n,
                                      const GLuint* textures) {
    raw::glDeleteTextures(n, textures);
    if (Tracked()) manager.m_objects->NoteDeletedTextures(n, textures);
}

void Es2StereoLayer::glTexImage2D(StereoManager& manager, GLenum target, GLint level,
                                  GLint internalformat, GLsizei width, GLsizei height,
                                  GLint border, GLenum format, GLenum type, const void* pixels) {
    raw::glTexImage2D(target, level, internalformat, width, height, border, format, type, pixels);
    if (Tracked()) {
        manager.m_objects->NoteTexImage(target, level, internalformat, width, height, border,
                                        format, type);
    }
}

void Es2StereoLayer::glFramebufferTexture2D(StereoManager& manager, GLenum target,
                                            GLenum attachment, GLenum textarget,
                                            GLuint texture, GLint level) {
    raw::glFramebufferTexture2D(target, attachment, textarget, texture, level);
    if (Tracked()) WidenRenderTexture(manager, texture);
}

void Es2StereoLayer::glRenderbufferStorage(StereoManager&, GLenum target,
                                           GLenum internalformat, GLsizei width,
                                           GLsizei height) {
    raw::glRenderbufferStorage(target, internalformat, Tracked() ? DoubleWidth(width) : width,
                               height);
}

}  // namespace ovo
