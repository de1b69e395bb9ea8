// The shared main of the sample programs:  PROGRAM OUTPUT.png [--frames N]
#include <EGL/egl.h>
#include <GLES2/gl2.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>

#include "png_writer.h"
#include "sample.h"

namespace {

bool Fail(const char* what) {
    std::fprintf(stderr, "%s: %s failed (EGL error 0x%x)\n", SAMPLE.m_name, what, eglGetError());
    return false;
}

struct PbufferContext {
    EGLDisplay m_display = EGL_NO_DISPLAY;
    EGLSurface m_surface = EGL_NO_SURFACE;
    EGLContext m_context = EGL_NO_CONTEXT;
};

// Plain eglGetDisplay, as games call it, so that the library's start-up runs.
bool CreatePbufferContext(PbufferContext& egl) {
    egl.m_display = eglGetDisplay(EGL_DEFAULT_DISPLAY);
    if (egl.m_display == EGL_NO_DISPLAY) return Fail("eglGetDisplay");
    if (!eglInitialize(egl.m_display, nullptr, nullptr)) return Fail("eglInitialize");
    EGLint renderable = SAMPLE.m_client_version == 2 ? EGL_OPENGL_ES2_BIT : EGL_OPENGL_ES_BIT;
    const EGLint config_attributes[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_RENDERABLE_TYPE,
                                        renderable, EGL_RED_SIZE, 8, EGL_GREEN_SIZE, 8,
                                        EGL_BLUE_SIZE, 8, EGL_ALPHA_SIZE, 8, EGL_DEPTH_SIZE, 16,
                                        EGL_NONE};
    EGLConfig config;
    EGLint count = 0;
    if (!eglChooseConfig(egl.m_display, config_attributes, &config, 1, &count) || count < 1) {
        return Fail("eglChooseConfig");
    }
    const EGLint surface_attributes[] = {EGL_WIDTH, SAMPLE_WIDTH, EGL_HEIGHT, SAMPLE_HEIGHT, EGL_NONE};
    egl.m_surface = eglCreatePbufferSurface(egl.m_display, config, surface_attributes);
    if (egl.m_surface == EGL_NO_SURFACE) return Fail("eglCreatePbufferSurface");
    const EGLint context_attributes[] = {EGL_CONTEXT_CLIENT_VERSION, SAMPLE.m_client_version, EGL_NONE};
    egl.m_context = eglCreateContext(egl.m_display, config, EGL_NO_CONTEXT, context_attributes);
    if (egl.m_context == EGL_NO_CONTEXT) return Fail("eglCreateContext");
    if (!eglMakeCurrent(egl.m_display, egl.m_surface, egl.m_surface, egl.m_context)) {
        return Fail("eglMakeCurrent");
    }
    return true;
}

void DestroyPbufferContext(PbufferContext& egl) {
    eglMakeCurrent(egl.m_display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
    eglDestroyContext(egl.m_display, egl.m_context);
    eglDestroySurface(egl.m_display, egl.m_surface);
    eglTerminate(egl.m_display);
}

}  // namespace

int main(int argc, char** argv) {
    const char* output = nullptr;
    int frames = 3;
    for (int argument = 1; argument < argc; ++argument) {
        if (std::strcmp(argv[argument], "--frames") == 0 && argument + 1 < argc) {
            frames = std::atoi(argv[++argument]);
        } else if (output == nullptr && argv[argument][0] != '-') {
            output = argv[argument];
        } else {
            output = nullptr;
            break;
        }
    }
    if (output == nullptr || frames < 1) {
        std::fprintf(stderr, "usage: %s OUTPUT.png [--frames N]\n", SAMPLE.m_name);
        return 2;
    }
    PbufferContext egl;
    if (!CreatePbufferContext(egl)) return 1;
    if (!SAMPLE.m_set_up(SAMPLE_WIDTH, SAMPLE_HEIGHT)) {
        std::fprintf(stderr, "%s: setting up the scene failed\n", SAMPLE.m_name);
        return 1;
    }
    std::vector<uint8_t> pixels(static_cast<size_t>(SAMPLE_WIDTH) * SAMPLE_HEIGHT * 4);
    for (int frame = 0; frame < frames; ++frame) {
        SAMPLE.m_draw_frame(frame);
        // The last frame is read before its swap: a swapped pbuffer's content is undefined.
        if (frame == frames - 1) {
            glReadPixels(0, 0, SAMPLE_WIDTH, SAMPLE_HEIGHT, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
        }
        eglSwapBuffers(egl.m_display, egl.m_surface);
    }
    DestroyPbufferContext(egl);
    if (!WritePng(output, SAMPLE_WIDTH, SAMPLE_HEIGHT, pixels.data())) {
        std::fprintf(stderr, "%s: cannot write %s\n", SAMPLE.m_name, output);
        return 1;
    }
    std::printf("%s: wrote %s\n", SAMPLE.m_name, output);
    return 0;
}
