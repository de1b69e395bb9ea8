// The recording EGL library. It also plays the vendor's resolver: eglGetProcAddress hands
// out GL functions for the names a test allows, recording as RECORDER_API_RESOLVER.
#define EGL_EGLEXT_PROTOTYPES 1
#include <EGL/egl.h>
#include <EGL/eglext.h>

#include <cstring>

#include "core/entry_tables.h"
#include "core/gl_api.h"
#include "recorder.h"

#define RECORDER_EXPORT __attribute__((visibility("default")))

namespace {

using ProcPointer = __eglMustCastToProperFunctionPointerType;

const ProcPointer RESOLVED_FUNCTIONS[] = {
#define OVO_GL_ENTRY(index, result, name, params, args)                          \
    reinterpret_cast<ProcPointer>(                                               \
        &Recorder<RECORDER_API_RESOLVER, index, result(GL_APIENTRY*) params>::Call),
#include "core/gl_entry_table.inc"
};

// What a function answers beyond being recorded; by default its recorded result.
template <uint32_t INDEX>
struct Answer {
    template <typename Result, typename... Arguments>
    static Result Give(Result recorded, Arguments...) {
        return recorded;
    }
};

template <>
struct Answer<ovo::EGL_ENTRY_eglGetProcAddress> {
    static ProcPointer Give(ProcPointer, const char* name) {
        for (uint32_t index = 0; index < RECORDER_GL_NAMES; ++index) {
            if (std::strcmp(ovo::GlEntryTable[index], name) == 0) {
                return RecorderGetState()->m_resolver_knows[index] ? RESOLVED_FUNCTIONS[index]
                                                                   : nullptr;
            }
        }
        return nullptr;
    }
};

// Each context a handle of its own, the first one the recorded result.
template <>
struct Answer<ovo::EGL_ENTRY_eglCreateContext> {
    static EGLContext Give(EGLContext recorded, EGLDisplay, EGLConfig, EGLContext, const EGLint*) {
        static uintptr_t created = 0;
        return reinterpret_cast<EGLContext>(reinterpret_cast<uintptr_t>(recorded) + 0x100 * created++);
    }
};

template <>
struct Answer<ovo::EGL_ENTRY_eglMakeCurrent> {
    static EGLBoolean Give(EGLBoolean, EGLDisplay, EGLSurface, EGLSurface, EGLContext) {
        return RecorderGetState()->m_make_current_fails ? EGL_FALSE : EGL_TRUE;
    }
};

template <>
struct Answer<ovo::EGL_ENTRY_eglSwapBuffers> {
    static EGLBoolean Give(EGLBoolean recorded, EGLDisplay, EGLSurface) {
        return RecorderGetState()->m_swap_fails ? EGL_FALSE : recorded;
    }
};

template <>
struct Answer<ovo::EGL_ENTRY_eglQuerySurface> {
    static EGLBoolean Give(EGLBoolean recorded, EGLDisplay, EGLSurface, EGLint attribute,
                           EGLint* value) {
        const RecorderState& state = *RecorderGetState();
        if (attribute == EGL_WIDTH) *value = state.m_surface_width;
        if (attribute == EGL_HEIGHT) *value = state.m_surface_height;
        return recorded;
    }
};

template <>
struct Answer<ovo::EGL_ENTRY_eglChooseConfig> {
    static EGLBoolean Give(EGLBoolean recorded, EGLDisplay, const EGLint* attributes, EGLConfig*,
                           EGLint, EGLint*) {
        EGLint* copy = RecorderGetState()->m_chosen_attributes;
        uint32_t count = 0;
        while (attributes != nullptr && count + 1 < RECORDER_ATTRIBUTE_CAPACITY &&
               attributes[count] != EGL_NONE) {
            copy[count] = attributes[count];
            ++count;
        }
        copy[count] = EGL_NONE;
        return recorded;
    }
};

}  // namespace

extern "C" {

#define OVO_EGL_ENTRY(index, result, name, params, args)                                  \
    RECORDER_EXPORT result EGLAPIENTRY name params {                                      \
        return Answer<index>::Give OVO_PREPEND((RecordCall<RECORDER_API_EGL, index, result> args), \
                                               args);                                     \
    }
#include "core/egl_entry_table.inc"

}  // extern "C"
