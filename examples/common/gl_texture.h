#ifndef OVO_EXAMPLES_COMMON_GL_TEXTURE_H
#define OVO_EXAMPLES_COMMON_GL_TEXTURE_H

#include <cstdint>

#include "common/rgba_image.h"

// Kept free of the GL headers so that OpenGL ES 1.1 and 2.0 samples both include it; the
// arguments are GL names and enum values.
namespace ovo_sample {

struct TextureSampling {
    int32_t m_min_filter;
    int32_t m_mag_filter;
    int32_t m_wrap_s;
    int32_t m_wrap_t;
};

// A new RGBA8 2D texture holding `image`, left bound to GL_TEXTURE_2D. A mipmapped
// minification filter needs the caller to make the mipmaps (ES 2.0: glGenerateMipmap).
uint32_t CreateTexture(const RgbaImage& image, const TextureSampling& sampling);

void DeleteTexture(uint32_t* texture);

// `*texture` becomes `replacement`, a texture made elsewhere; the one it held before is
// deleted (unless it is the same).
void ReplaceTexture(uint32_t* texture, uint32_t replacement);

}  // namespace ovo_sample

#endif
