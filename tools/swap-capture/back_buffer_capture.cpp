#include "back_buffer_capture.h"

#include <GLES2/gl2.h>
#include <dlfcn.h>

#include <cstring>
#include <vector>

#include "common/png_writer.h"

namespace ovo_swap_capture {

namespace {

constexpr size_t CAPTURE_PIXEL_BYTES = 4;

// Mesa's own entry points, not the ones the GLES library under test exports.
struct MesaGles {
    decltype(&glBindFramebuffer) m_bind_framebuffer = nullptr;
    decltype(&glGetIntegerv) m_get_integerv = nullptr;
    decltype(&glPixelStorei) m_pixel_storei = nullptr;
    decltype(&glReadPixels) m_read_pixels = nullptr;

    MesaGles() {
        void* library = dlopen(OVO_MESA_GLES2_PATH, RTLD_NOW | RTLD_LOCAL);
        if (library == nullptr) return;
        m_bind_framebuffer = reinterpret_cast<decltype(m_bind_framebuffer)>(dlsym(library, "glBindFramebuffer"));
        m_get_integerv = reinterpret_cast<decltype(m_get_integerv)>(dlsym(library, "glGetIntegerv"));
        m_pixel_storei = reinterpret_cast<decltype(m_pixel_storei)>(dlsym(library, "glPixelStorei"));
        m_read_pixels = reinterpret_cast<decltype(m_read_pixels)>(dlsym(library, "glReadPixels"));
    }

    bool IsComplete() const {
        return m_bind_framebuffer != nullptr && m_get_integerv != nullptr && m_pixel_storei != nullptr &&
               m_read_pixels != nullptr;
    }
};

const MesaGles& Gles() {
    static const MesaGles gles;
    return gles;
}

}  // namespace

bool CaptureBackBuffer(int32_t width, int32_t height, const char* path) {
    const MesaGles& gles = Gles();
    if (!gles.IsComplete()) return false;

    // The swap shows the window's buffer whatever framebuffer object the game left bound.
    // An OpenGL ES 1.x context takes the same call through its OES alias.
    GLint framebuffer = 0;
    GLint alignment = 0;
    gles.m_get_integerv(GL_FRAMEBUFFER_BINDING, &framebuffer);
    gles.m_get_integerv(GL_PACK_ALIGNMENT, &alignment);
    if (framebuffer != 0) gles.m_bind_framebuffer(GL_FRAMEBUFFER, 0);
    gles.m_pixel_storei(GL_PACK_ALIGNMENT, 4);

    const size_t row_bytes = static_cast<size_t>(width) * CAPTURE_PIXEL_BYTES;
    std::vector<uint8_t> bottom_up(row_bytes * static_cast<size_t>(height));
    gles.m_read_pixels(0, 0, width, height, GL_RGBA, GL_UNSIGNED_BYTE, bottom_up.data());

    gles.m_pixel_storei(GL_PACK_ALIGNMENT, alignment);
    if (framebuffer != 0) gles.m_bind_framebuffer(GL_FRAMEBUFFER, static_cast<GLuint>(framebuffer));

    std::vector<uint8_t> top_down(bottom_up.size());
    for (int32_t row = 0; row < height; ++row) {
        std::memcpy(&top_down[row_bytes * static_cast<size_t>(row)],
                    &bottom_up[row_bytes * static_cast<size_t>(height - 1 - row)], row_bytes);
    }
    return ovo_sample::WritePng(path, width, height, top_down.data());
}

}  // namespace ovo_swap_capture
