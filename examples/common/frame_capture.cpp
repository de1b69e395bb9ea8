#include "common/frame_capture.h"

#include <GLES2/gl2.h>

#include <algorithm>
#include <cstddef>

// Only calls that OpenGL ES 1.1 and 2.0 share, so both kinds of sample link this.
namespace ovo_sample {

namespace {
constexpr int32_t MAX_PENDING_GL_ERRORS = 16;
}  // namespace

std::vector<uint8_t> ReadFrame(int32_t width, int32_t height) {
    const size_t row_bytes = static_cast<size_t>(width) * 4;
    std::vector<uint8_t> pixels(row_bytes * static_cast<size_t>(height));
    glPixelStorei(GL_PACK_ALIGNMENT, 4);
    glReadPixels(0, 0, width, height, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
    for (int32_t top = 0, bottom = height - 1; top < bottom; ++top, --bottom) {
        std::swap_ranges(pixels.begin() + static_cast<std::ptrdiff_t>(row_bytes * top),
                         pixels.begin() + static_cast<std::ptrdiff_t>(row_bytes * (top + 1)),
                         pixels.begin() + static_cast<std::ptrdiff_t>(row_bytes * bottom));
    }
    return pixels;
}

uint32_t TakeGlError() {
    const uint32_t first = glGetError();
    // A lost context keeps answering errors; stop after a few.
    int32_t drained = 0;
    while (drained < MAX_PENDING_GL_ERRORS && glGetError() != GL_NO_ERROR) ++drained;
    return first;
}

}  // namespace ovo_sample
