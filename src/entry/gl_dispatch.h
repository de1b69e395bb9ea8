#ifndef OVO_ENTRY_GL_DISPATCH_H
#define OVO_ENTRY_GL_DISPATCH_H

#include "core/driver_hooks.h"
#include "core/gl_layer.h"
#include "core/stereo_manager.h"
#include "present/composition_renderer.h"
#include "stereo/overlay_target.h"

namespace ovo {

// The control codes of glGetFloatv, glGetIntegerv, glTexParameterf and glTexParameteri
// that read and set the live stereo parameters.
enum StereoParam : GLenum {
    STEREO_PARAM_EYE_DISTANCE = 0x1000,
    STEREO_PARAM_EYE_ANGLE = 0x1001,
    STEREO_PARAM_EYE_SHIFT = 0x1002,
    STEREO_PARAM_SPLIT = 0x1003,
    STEREO_PARAM_EYE_ORDER = 0x1004,
};

// Whether the calling thread has a context current. A thread without one reaches nothing,
// and must not touch what the rendering thread's captures and stereo layer keep either.
inline bool ThreadHasContext() { return &CurrentHooks() != &g_vendor_driver.m_no_context_hooks; }

// The layer that serves the calling thread. Without a profile the manager's layer passes
// every call through and keeps nothing, so only a stereo process pays the thread lookup.
inline GlLayer& ThreadLayer(StereoManager& manager) {
    if (!manager.m_profile->m_enabled || ThreadHasContext()) return *manager.m_layer;
    return ContextlessLayer();
}

// What an exported GL function does once it has the manager: by default, the calling
// thread's layer's operation of the same name with the arguments unchanged.
template <GlEntryIndex INDEX>
struct GlDispatch;

#define OVO_GL_ENTRY(index, result, name, params, args)                             \
    template <>                                                                     \
    struct GlDispatch<GL_ENTRY_##name> {                                            \
        static result Call OVO_PREPEND(StereoManager& manager, params) {           \
            return ThreadLayer(manager).name OVO_PREPEND(manager, args);            \
        }                                                                           \
    };
#include "core/gl_entry_table.inc"

// The entry points that record state or serve the control channel first.
template <GlEntryIndex INDEX>
struct GlEntryPoint : GlDispatch<INDEX> {};

template <>
struct GlEntryPoint<GL_ENTRY_glViewport> {
    static void Call(StereoManager& manager, GLint x, GLint y, GLsizei width, GLsizei height) {
        if (ThreadHasContext()) manager.m_viewport = GlRect{x, y, width, height};
        ThreadLayer(manager).glViewport(manager, x, y, width, height);
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glScissor> {
    static void Call(StereoManager& manager, GLint x, GLint y, GLsizei width, GLsizei height) {
        if (ThreadHasContext()) manager.m_scissor = GlRect{x, y, width, height};
        ThreadLayer(manager).glScissor(manager, x, y, width, height);
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glClear> {
    static void Call(StereoManager& manager, GLbitfield mask) {
        // The column-interleave mask lives in the stencil buffer; the game must not wipe it.
        if (manager.m_interleave) mask = CompositionRenderer::FilterClearMask(mask);
        ThreadLayer(manager).glClear(manager, mask);
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glBindFramebuffer> {
    static void Call(StereoManager& manager, GLenum target, GLuint framebuffer) {
        if (ThreadHasContext()) manager.m_overlay->SetBoundFramebuffer(framebuffer);
        ThreadLayer(manager).glBindFramebuffer(manager, target, framebuffer);
    }
};

// Three OES names reach the core operation, so that a layer overriding it sees both.
template <>
struct GlEntryPoint<GL_ENTRY_glBindFramebufferOES> {
    static void Call(StereoManager& manager, GLenum target, GLuint framebuffer) {
        ThreadLayer(manager).glBindFramebuffer(manager, target, framebuffer);
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glFramebufferTexture2DOES> {
    static void Call(StereoManager& manager, GLenum target, GLenum attachment, GLenum textarget,
                     GLuint texture, GLint level) {
        ThreadLayer(manager).glFramebufferTexture2D(manager, target, attachment, textarget,
                                                    texture, level);
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glRenderbufferStorageOES> {
    static void Call(StereoManager& manager, GLenum target, GLenum internalformat, GLsizei width,
                     GLsizei height) {
        ThreadLayer(manager).glRenderbufferStorage(manager, target, internalformat, width, height);
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glGetFloatv> {
    static void Call(StereoManager& manager, GLenum pname, GLfloat* params) {
        const StereoProfile& profile = *manager.m_profile;
        switch (pname) {
            case STEREO_PARAM_EYE_DISTANCE: params[0] = profile.m_eye_distance; return;
            case STEREO_PARAM_EYE_ANGLE: params[0] = profile.m_eye_angle; return;
            case STEREO_PARAM_EYE_SHIFT: params[0] = profile.m_eye_shift; return;
            default: ThreadLayer(manager).glGetFloatv(manager, pname, params);
        }
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glGetIntegerv> {
    static void Call(StereoManager& manager, GLenum pname, GLint* params) {
        const StereoProfile& profile = *manager.m_profile;
        switch (pname) {
            case STEREO_PARAM_SPLIT: params[0] = static_cast<GLint>(profile.m_split); return;
            case STEREO_PARAM_EYE_ORDER: params[0] = static_cast<GLint>(profile.m_eye_order); return;
            default: ThreadLayer(manager).glGetIntegerv(manager, pname, params);
        }
    }
};

// The setters take the code from `target`, so no real texture parameter is touched.
template <>
struct GlEntryPoint<GL_ENTRY_glTexParameterf> {
    static void Call(StereoManager& manager, GLenum target, GLenum pname, GLfloat param) {
        StereoProfile& profile = *manager.m_profile;
        switch (target) {
            case STEREO_PARAM_EYE_DISTANCE: profile.m_eye_distance = param; return;
            case STEREO_PARAM_EYE_ANGLE: profile.m_eye_angle = param; return;
            case STEREO_PARAM_EYE_SHIFT: profile.m_eye_shift = param; return;
            default: ThreadLayer(manager).glTexParameterf(manager, target, pname, param);
        }
    }
};

template <>
struct GlEntryPoint<GL_ENTRY_glTexParameteri> {
    static void Call(StereoManager& manager, GLenum target, GLenum pname, GLint param) {
        StereoProfile& profile = *manager.m_profile;
        switch (target) {
            case STEREO_PARAM_SPLIT: profile.m_split = static_cast<uint32_t>(param); return;
            case STEREO_PARAM_EYE_ORDER: profile.m_eye_order = static_cast<uint32_t>(param); return;
            default: ThreadLayer(manager).glTexParameteri(manager, target, pname, param);
        }
    }
};

}  // namespace ovo

#endif
